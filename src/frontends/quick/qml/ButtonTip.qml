// The name of the button that the pointer rests on. It stands below: above many buttons lies the window's header.
import QtQuick.Controls.Basic
import Vespscope.Quick

ToolTip {
    required property IconButton button

    parent: button
    y: button.height
    margins: 4
    delay: 700
    text: button.text
    visible: button.hovered && !button.used
}

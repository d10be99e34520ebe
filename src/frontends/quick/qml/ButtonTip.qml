// The name of the button under the pointer. It is shown below the button, because above many buttons is the window's
// header.
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

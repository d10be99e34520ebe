// A button that is a drawing; `text` names it to screen readers and in its tip.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

AbstractButton {
    id: button

    required property string glyph
    // Whether it was pressed since the pointer entered: then the tip does not cover what the button opened.
    property bool used: false

    // Next to a title, width is scarcer than height.
    implicitWidth: 48
    implicitHeight: Theme.target
    hoverEnabled: true
    Accessible.name: text
    Accessible.role: Accessible.Button

    onPressed: used = true
    onHoveredChanged: {
        if (!hovered)
            used = false;
    }

    Loader {
        active: button.hovered
        Component.onCompleted: setSource("ButtonTip.qml", { button: button })
    }

    background: Rectangle {
        anchors.centerIn: parent
        width: Math.min(parent.width, parent.height) - 8
        height: width
        radius: width / 2
        color: button.pressed ? Theme.pressed : Theme.hovered
        visible: button.pressed || button.hovered || button.visualFocus
        border.width: button.visualFocus ? 2 : 0
        border.color: Theme.accentText
    }
    contentItem: Item {
        Glyph {
            anchors.centerIn: parent
            width: Theme.scaled(22)
            height: width
            name: button.glyph
            color: Theme.text
        }
    }
}

// A button that is a word.
import QtQuick
import QtQuick.Templates as T

T.AbstractButton {
    id: button

    implicitWidth: Math.max(Theme.target, implicitContentWidth + leftPadding + rightPadding)
    implicitHeight: Theme.target
    leftPadding: 12
    rightPadding: 12
    hoverEnabled: true
    Accessible.name: text
    Accessible.role: Accessible.Button

    background: Rectangle {
        y: 4
        height: parent.height - 2 * y
        radius: Theme.radius
        color: button.pressed ? Theme.pressed : Theme.hovered
        visible: button.pressed || button.hovered || button.visualFocus
        border.width: button.visualFocus ? 2 : 0
        border.color: Theme.accentText
    }
    contentItem: Text {
        text: button.text
        textFormat: Text.PlainText
        font.pixelSize: Theme.bodySize
        font.weight: Font.Bold
        color: Theme.accentText
        horizontalAlignment: Text.AlignHCenter
        verticalAlignment: Text.AlignVCenter
        elide: Text.ElideRight
    }
}

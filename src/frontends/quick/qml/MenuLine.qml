// One choice of the menu.
import QtQuick
import QtQuick.Templates as T

T.MenuItem {
    id: choice

    // The key with the same action.
    property string keys: ""

    implicitWidth: 200
    implicitHeight: Theme.target
    leftPadding: Theme.padding
    rightPadding: Theme.padding
    hoverEnabled: true
    Accessible.name: text
    Accessible.role: Accessible.MenuItem

    background: Rectangle {
        radius: Theme.radius - 4
        color: choice.down ? Theme.pressed : choice.highlighted ? Theme.changed : "transparent"
    }
    contentItem: Item {
        Text {
            anchors.verticalCenter: parent.verticalCenter
            width: parent.width - Theme.scaled(24)
            text: choice.text
            textFormat: Text.PlainText
            font.pixelSize: Theme.bodySize
            color: Theme.text
            elide: Text.ElideRight
            Accessible.ignored: true
        }
        Text {
            anchors.verticalCenter: parent.verticalCenter
            anchors.right: parent.right
            text: choice.keys
            textFormat: Text.PlainText
            font.pixelSize: Theme.smallSize
            color: Theme.secondaryText
            visible: choice.keys !== ""
            Accessible.ignored: true
        }
        Rectangle {
            anchors.verticalCenter: parent.verticalCenter
            anchors.right: parent.right
            width: 10
            height: width
            radius: 5
            color: Theme.accentText
            visible: choice.checked
        }
    }
}

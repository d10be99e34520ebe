// Shown next to the lists until a screen is chosen.
import QtQuick
import Vespscope.Quick

Item {
    id: welcome

    required property StatusModel status

    Rectangle {
        width: 1
        height: parent.height
        color: Theme.line
    }
    Column {
        anchors.centerIn: parent
        width: Math.min(parent.width - 2 * Theme.padding, Theme.scaled(420))

        Glyph {
            anchors.horizontalCenter: parent.horizontalCenter
            width: Theme.scaled(56)
            height: width
            name: "mark"
            color: Theme.accentText
            visible: welcome.height > Theme.scaled(480)
        }
        Text {
            width: parent.width
            topPadding: Theme.padding
            text: qsTr("Choose a row on the left")
            textFormat: Text.PlainText
            horizontalAlignment: Text.AlignHCenter
            wrapMode: Text.Wrap
            font.pixelSize: Theme.scaled(17)
            font.weight: Font.Bold
            color: Theme.text
        }
        SourceCard {
            width: parent.width
            status: welcome.status
            visible: welcome.height > Theme.scaled(420)
        }
    }
}

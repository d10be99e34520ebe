// Shown instead of rows.
import QtQuick
import Vespscope.Quick

Item {
    id: empty

    required property string title
    required property string explanation

    Accessible.role: Accessible.StaticText
    Accessible.name: title + ". " + explanation

    Column {
        anchors.centerIn: parent
        width: Math.min(parent.width - 4 * Theme.padding, Theme.scaled(360))
        spacing: Theme.gap

        Glyph {
            anchors.horizontalCenter: parent.horizontalCenter
            width: Theme.scaled(56)
            height: width
            name: "mark"
            color: Theme.secondaryText
        }
        Item {
            width: 1
            height: Theme.gap
        }
        Text {
            width: parent.width
            text: empty.title
            textFormat: Text.PlainText
            horizontalAlignment: Text.AlignHCenter
            wrapMode: Text.Wrap
            font.pixelSize: Theme.scaled(17)
            font.weight: Font.Bold
            color: Theme.text
            Accessible.ignored: true
        }
        Text {
            width: parent.width
            text: empty.explanation
            textFormat: Text.PlainText
            horizontalAlignment: Text.AlignHCenter
            wrapMode: Text.Wrap
            font.pixelSize: Theme.scaled(14)
            lineHeight: 1.2
            color: Theme.secondaryText
            Accessible.ignored: true
        }
    }
}

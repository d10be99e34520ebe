// The facts about the source as a card of rows, if there is room for them.
import QtQuick
import Vespscope.Quick

Column {
    id: facts

    required property StatusModel status

    topPadding: Theme.scaled(22)

    Text {
        x: Theme.gutter + Theme.padding
        bottomPadding: Theme.scaled(7)
        text: qsTr("Source")
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        font.weight: Font.Bold
        color: Theme.secondaryText
    }
    Rectangle {
        x: Theme.gutter
        width: parent.width - 2 * x
        height: rows.height
        radius: Theme.radius
        color: Theme.card

        Column {
            id: rows

            width: parent.width

            Repeater {
                model: facts.status.factNames.length

                // qmllint disable unqualified
                Item {
                    id: fact

                    required property int index
                    // For a moment there may be fewer facts than rows.
                    readonly property string label: facts.status.factNames[index] ?? ""
                    readonly property string value: facts.status.factValues[index] ?? ""

                    width: parent ? parent.width : 0
                    height: Math.max(Theme.scaled(38), what.height + 16)
                    Accessible.role: Accessible.StaticText
                    Accessible.name: label + ", " + value

                    Text {
                        id: name

                        anchors.verticalCenter: parent.verticalCenter
                        x: Theme.padding
                        text: fact.label
                        textFormat: Text.PlainText
                        font.pixelSize: Theme.scaled(14)
                        color: Theme.secondaryText
                        Accessible.ignored: true
                    }
                    Text {
                        id: what

                        anchors.verticalCenter: parent.verticalCenter
                        anchors.right: parent.right
                        anchors.rightMargin: Theme.padding
                        width: parent.width - name.width - 2 * Theme.padding - Theme.gap
                        text: fact.value
                        textFormat: Text.PlainText
                        wrapMode: Text.Wrap
                        horizontalAlignment: Text.AlignRight
                        font.pixelSize: Theme.scaled(14)
                        color: Theme.text
                        Accessible.ignored: true
                    }
                    Rectangle {
                        x: Theme.padding
                        y: parent.height - 1
                        width: parent.width - x
                        height: 1
                        color: Theme.line
                        visible: fact.index < facts.status.factNames.length - 1
                    }
                }
                // qmllint enable unqualified
            }
        }
    }
}

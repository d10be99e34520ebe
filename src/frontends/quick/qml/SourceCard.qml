// The facts about the source as a card of rows, where there is room for them.
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
                model: [
                    [facts.status.kind, facts.status.source],
                    [qsTr("Manager"), facts.status.connection],
                    [qsTr("Last event"), facts.status.lastEvent],
                    [qsTr("Events"), facts.status.events],
                    [qsTr("Per second"), facts.status.rate],
                    [qsTr("Not decoded"), facts.status.failures],
                    [qsTr("Lost"), facts.status.lost]
                ]

                Item {
                    id: fact

                    required property int index
                    required property var modelData

                    width: parent ? parent.width : 0
                    height: Math.max(Theme.scaled(38), what.height + 16)
                    Accessible.role: Accessible.StaticText
                    Accessible.name: modelData[0] + ", " + modelData[1]

                    Text {
                        id: name

                        anchors.verticalCenter: parent.verticalCenter
                        x: Theme.padding
                        text: fact.modelData[0]
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
                        width: Math.min(implicitWidth, parent.width - name.width - 2 * Theme.padding - Theme.gap)
                        text: fact.modelData[1]
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
                        visible: fact.index < 6
                    }
                }
            }
        }
    }
}

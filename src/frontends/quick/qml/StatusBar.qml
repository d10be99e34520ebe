// Where the data comes from and when the last event came, above everything.
import QtQuick
import Vespscope.Quick

Rectangle {
    id: bar

    required property StatusModel status
    readonly property bool roomy: width >= 620

    readonly property color levelColor: status.level === StatusModel.Flowing ? Theme.goodText
                                      : status.level === StatusModel.Silent ? Theme.accentText : Theme.badText

    implicitHeight: Math.max(32, kind.implicitHeight + 14)
    color: Theme.bar
    Accessible.role: Accessible.StaticText
    Accessible.name: qsTr("%1 %2, %3, last event %4")
        .arg(status.kind).arg(status.source).arg(status.connection).arg(status.lastEvent)

    Rectangle {
        id: light

        x: Theme.gutter + Theme.padding - 12
        anchors.verticalCenter: parent.verticalCenter
        width: Theme.scaled(8)
        height: width
        radius: width / 2
        color: bar.levelColor
    }
    Text {
        id: kind

        anchors.verticalCenter: parent.verticalCenter
        x: light.x + light.width + Theme.gap
        width: Math.min(implicitWidth, age.x - x - Theme.gap)
        text: bar.status.kind
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        font.weight: Font.Bold
        color: Theme.text
        elide: Text.ElideRight
        Accessible.ignored: true
    }
    Text {
        anchors.verticalCenter: parent.verticalCenter
        x: kind.x + kind.width + Theme.gap
        width: Math.max(0, (bar.roomy ? flow.x : age.x) - x - Theme.gap)
        text: bar.status.source
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        color: Theme.secondaryText
        elide: Text.ElideMiddle
        visible: width > 40
        Accessible.ignored: true
    }
    Text {
        id: flow

        anchors.verticalCenter: parent.verticalCenter
        x: age.x - width - Theme.padding
        text: qsTr("%1 events · %2 per second").arg(bar.status.events).arg(bar.status.rate)
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        color: Theme.secondaryText
        visible: bar.roomy
        Accessible.ignored: true
    }
    Text {
        id: age

        anchors.verticalCenter: parent.verticalCenter
        anchors.right: parent.right
        anchors.rightMargin: Theme.gutter + 4
        text: bar.status.level === StatusModel.Disconnected ? bar.status.connection : bar.status.lastEvent
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        font.weight: bar.status.level === StatusModel.Flowing ? Font.Normal : Font.Bold
        color: bar.levelColor
        Accessible.ignored: true
    }
}

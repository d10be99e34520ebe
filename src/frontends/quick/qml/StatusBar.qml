// Where the data comes from, when the last event came, and what went wrong with events, above everything.
import QtQuick
import Vespscope.Quick

Rectangle {
    id: bar

    required property StatusModel status
    readonly property bool roomy: width >= 620 * Theme.textScale
    // What has no room beside the rest stands on a line of its own.
    readonly property bool ageBelow: kind.x + kind.implicitWidth + age.implicitWidth + 3 * Theme.padding > width
    readonly property bool troubled: status.trouble !== ""
    readonly property bool troubleBelow: troubled && besideTrouble + troubleMetrics.advanceWidth > width
    // What else stands on the first line, with a bit of the source's name.
    readonly property real besideTrouble: kind.x + kind.implicitWidth + (roomy ? flow.implicitWidth : 0)
                                        + age.implicitWidth + 4 * Theme.padding + Theme.scaled(90)
    readonly property int lineHeight: Math.max(32, kind.implicitHeight + 14)

    readonly property color levelColor: status.level === StatusModel.Flowing ? Theme.goodText
                                      : status.level === StatusModel.Silent ? Theme.accentText : Theme.badText

    implicitHeight: lineHeight + (ageBelow ? age.height : 0) + (troubleBelow ? trouble.height : 0)
        + (ageBelow || troubleBelow ? 7 : 0)
    color: Theme.bar
    Accessible.role: Accessible.StaticText
    Accessible.name: qsTr("%1 %2, %3, last event %4").arg(status.kind).arg(status.source).arg(status.connection)
        .arg(status.lastEvent) + (troubled ? ", " + status.trouble : "")

    TextMetrics {
        id: troubleMetrics

        text: bar.status.trouble
        font: trouble.font
    }
    Rectangle {
        id: light

        x: Theme.gutter + Theme.padding - 12
        y: (bar.lineHeight - height) / 2
        width: Theme.scaled(8)
        height: width
        radius: width / 2
        color: bar.levelColor
    }
    Text {
        id: kind

        x: light.x + light.width + Theme.gap
        y: (bar.lineHeight - height) / 2
        width: Math.min(implicitWidth, (bar.ageBelow ? bar.width : age.x) - x - Theme.gap)
        text: bar.status.kind
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        font.weight: Font.Bold
        color: Theme.text
        elide: Text.ElideRight
        Accessible.ignored: true
    }
    Text {
        readonly property Text next: bar.troubled && !bar.troubleBelow ? trouble : bar.roomy ? flow : age

        x: kind.x + kind.width + Theme.gap
        y: kind.y
        width: Math.max(0, (bar.ageBelow ? bar.width : next.x) - x - Theme.gap)
        text: bar.status.source
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        color: Theme.secondaryText
        elide: Text.ElideMiddle
        visible: width > 40
        Accessible.ignored: true
    }
    Text {
        id: trouble

        x: bar.troubleBelow ? kind.x : flow.x - width - Theme.padding
        y: bar.troubleBelow ? bar.lineHeight + (bar.ageBelow ? age.height : 0) - 3 : kind.y
        width: bar.troubleBelow ? bar.width - kind.x - Theme.gutter : Math.ceil(troubleMetrics.advanceWidth) + 1
        text: bar.status.trouble
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        font.pixelSize: Theme.smallSize
        font.weight: Font.Bold
        color: Theme.badText
        visible: bar.troubled
        Accessible.ignored: true
    }
    Text {
        id: flow

        x: age.x - width - Theme.padding
        y: kind.y
        text: qsTr("%1 events · %2 per second").arg(bar.status.events).arg(bar.status.rate)
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        color: Theme.secondaryText
        visible: bar.roomy
        Accessible.ignored: true
    }
    Text {
        id: age

        x: bar.ageBelow ? kind.x : bar.width - width - Theme.gutter - 4
        y: bar.ageBelow ? bar.lineHeight - 3 : kind.y
        text: bar.status.freshness
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        font.weight: bar.status.level === StatusModel.Flowing ? Font.Normal : Font.Bold
        color: bar.levelColor
        Accessible.ignored: true
    }
}

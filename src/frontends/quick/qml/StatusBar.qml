// The bar above everything: the source of the data, how current it is, and problems.
import QtQuick
import Vespscope.Quick

Rectangle {
    id: bar

    required property StatusModel status
    readonly property bool roomy: width >= 620 * Theme.textScale
    // Parts that do not fit next to the rest have a line of their own.
    readonly property bool ageBelow: kind.x + kind.implicitWidth + age.implicitWidth + 3 * Theme.padding > width
    readonly property bool troubled: status.trouble !== ""
    readonly property bool troubleBelow: troubled && besideTrouble + troubleMetrics.advanceWidth > width
    // The width of the rest of the first line, with a minimum for the source's name.
    readonly property real besideTrouble: kind.x + kind.implicitWidth + (roomy ? flow.implicitWidth : 0)
                                        + age.implicitWidth + 4 * Theme.padding + Theme.scaled(90)
    readonly property int lineHeight: Math.max(32, kind.implicitHeight + 14)

    // The source's text reports its problem, so it is shown in full.
    readonly property bool sourceBelow: alerting && status.reason === "" && source.implicitWidth > source.room
    readonly property real below: (ageBelow ? age.height : 0) + (troubleBelow ? trouble.height : 0)
                                + (reason.visible ? reason.height : 0)
    // Green means live only.
    readonly property color tone: status.tone === StatusModel.Live ? Theme.goodText
                                : status.tone === StatusModel.Playback ? Theme.playbackText
                                : status.tone === StatusModel.Simulated ? Theme.simulatedText
                                : status.tone === StatusModel.Waiting ? Theme.accentText
                                : status.tone === StatusModel.Disconnected ? Theme.badText : Theme.secondaryText
    readonly property bool alerting: status.tone === StatusModel.Waiting || status.tone === StatusModel.Disconnected

    implicitHeight: lineHeight + (below > 0 ? below + 7 : 0)
    color: Theme.bar
    Accessible.role: Accessible.StaticText
    Accessible.name: status.summary

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
        color: bar.tone
    }
    Text {
        id: kind

        x: light.x + light.width + Theme.gap
        y: (bar.lineHeight - height) / 2
        width: Math.min(implicitWidth, (bar.ageBelow ? bar.width : age.x) - x - Theme.gap)
        text: bar.status.sim === "" ? bar.status.kind : bar.status.kind + " · " + bar.status.sim
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        font.weight: Font.Bold
        color: Theme.text
        elide: Text.ElideRight
        Accessible.ignored: true
    }
    Text {
        id: source

        readonly property Text next: bar.troubled && !bar.troubleBelow ? trouble : bar.roomy ? flow : age
        readonly property real room: Math.max(0, (bar.ageBelow ? bar.width : next.x) - x - Theme.gap)

        x: kind.x + kind.width + Theme.gap
        y: kind.y
        width: room
        text: bar.status.source
        textFormat: Text.PlainText
        font.pixelSize: Theme.smallSize
        color: Theme.secondaryText
        elide: Text.ElideMiddle
        visible: width > 40 && !bar.sourceBelow
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
        text: bar.status.flow
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
        width: bar.ageBelow ? bar.width - kind.x - Theme.gutter : implicitWidth
        text: bar.status.time
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        font.pixelSize: Theme.smallSize
        font.weight: bar.alerting ? Font.Bold : Font.Normal
        color: bar.tone
        Accessible.ignored: true
    }
    Text {
        id: reason

        x: kind.x
        y: bar.lineHeight + (bar.ageBelow ? age.height : 0) + (bar.troubleBelow ? trouble.height : 0) - 3
        width: bar.width - x - Theme.gutter
        text: bar.sourceBelow ? bar.status.source : bar.status.reason
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        maximumLineCount: 3
        elide: Text.ElideRight
        font.pixelSize: Theme.smallSize
        color: Theme.secondaryText
        visible: text !== ""
        Accessible.ignored: true
    }
}

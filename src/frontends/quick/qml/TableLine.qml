// One line of a table: a section header, or a row of a card with a label and maybe a value.
import QtQuick
import Vespscope.Quick

Item {
    id: line

    required property int index
    required property bool header
    required property string label
    required property string value
    required property bool hasValue
    required property bool disclosure
    required property bool first
    required property bool last
    required property bool apart
    required property bool changed
    required property bool expanded
    required property bool opened

    // Whether the keyboard's current line is this one.
    property bool current: false
    // Whether the screen that this row opened is shown next to it.
    property bool marksOpened: false

    readonly property bool chosen: opened && marksOpened
    readonly property real room: width - 2 * (Theme.gutter + Theme.padding) - (disclosure ? mark.width : 0)
    readonly property real labelWidth: Math.ceil(labelMetrics.advanceWidth) + 1
    readonly property real valueWidth: Math.ceil(valueMetrics.advanceWidth) + 1
    readonly property bool stacked: expanded || (hasValue && labelWidth + valueWidth + 2 * Theme.gap > room)
    readonly property int margin: Theme.scaled(13)
    readonly property int above: apart ? Theme.padding : 0

    signal pressed
    signal clicked
    signal copyAsked

    implicitHeight: header ? labelText.height + Theme.scaled(index === 0 ? 12 : 22) + Theme.scaled(7)
                           : above + Math.max(Theme.target, body.height + 2 * margin)
    Accessible.role: header ? Accessible.StaticText : Accessible.ListItem
    Accessible.name: hasValue ? label + ", " + value : label
    Accessible.focusable: !header
    Accessible.selected: current
    Accessible.onPressAction: line.clicked()

    TextMetrics {
        id: labelMetrics
        text: line.label
        font.pixelSize: Theme.bodySize
    }
    TextMetrics {
        id: valueMetrics
        text: line.value
        font.pixelSize: Theme.bodySize
    }

    TapHandler {
        id: finger

        property bool held: false

        enabled: !line.header
        onPressedChanged: {
            if (!pressed)
                return;
            held = false;
            line.pressed();
        }
        onLongPressed: {
            held = true;
            line.copyAsked();
        }
        onTapped: {
            if (!held)
                line.clicked();
        }
    }
    HoverHandler {
        id: pointer

        enabled: !line.header
    }

    Item {
        anchors.fill: parent
        visible: !line.header

        Rectangle {
            id: card
            x: Theme.gutter
            y: line.above
            width: parent.width - 2 * x
            height: parent.height - y
            radius: line.first || line.last ? Theme.radius : 0
            color: line.changed ? Theme.changed
                 : finger.pressed ? Theme.pressed
                 : pointer.hovered ? Theme.hovered : Theme.card
            Behavior on color {
                ColorAnimation { duration: Theme.markDuration }
            }

            // Between rows the card's corners are square.
            Rectangle {
                width: parent.width
                height: Theme.radius
                color: card.color
                visible: line.last && !line.first
            }
            Rectangle {
                y: parent.height - height
                width: parent.width
                height: Theme.radius
                color: card.color
                visible: line.first && !line.last
            }
            Rectangle {
                x: Theme.padding
                y: parent.height - 1
                width: parent.width - x
                height: 1
                color: Theme.line
                visible: !line.last && !line.chosen
            }
            Rectangle {
                anchors.fill: parent
                anchors.margins: 4
                radius: Theme.radius - 4
                color: Theme.accent
                visible: line.chosen
            }
            Rectangle {
                y: Theme.radius
                width: 3
                height: parent.height - 2 * y
                radius: 1.5
                color: Theme.accent
                visible: line.changed
            }
            Rectangle {
                anchors.fill: parent
                anchors.margins: 4
                radius: Theme.radius - 4
                color: "transparent"
                border.width: 2
                border.color: line.chosen ? Theme.accentInk : Theme.accentText
                visible: line.current
            }
        }
    }

    Item {
        id: body

        x: Theme.gutter + Theme.padding
        y: line.header ? line.height - height - Theme.scaled(7) : line.above + Math.round((line.height - line.above - height) / 2)
        width: line.room
        height: line.header || !line.hasValue ? labelText.height
              : line.expanded ? labelText.height + 4 + details.height
              : line.stacked ? labelText.height + 4 + valueText.height
              : Math.max(labelText.height, valueText.height)

        Text {
            id: labelText

            width: line.stacked || line.header || !line.hasValue ? parent.width : line.labelWidth
            text: line.label
            textFormat: Text.PlainText
            wrapMode: Text.Wrap
            font.pixelSize: line.header || line.stacked ? Theme.smallSize : Theme.bodySize
            font.weight: line.header ? Font.Bold : Font.Normal
            color: line.chosen ? Theme.accentInk
                 : line.header || line.hasValue ? Theme.secondaryText : Theme.text
            Accessible.ignored: true
        }
        Text {
            id: valueText

            x: line.stacked ? 0 : parent.width - width
            y: line.stacked ? labelText.height + 4 : 0
            width: line.stacked ? parent.width : line.valueWidth
            text: line.value
            textFormat: Text.PlainText
            wrapMode: Text.Wrap
            font.pixelSize: Theme.bodySize
            color: Theme.text
            visible: line.hasValue && !line.expanded
            Accessible.ignored: true
        }
        Loader {
            id: details

            y: labelText.height + 4
            width: parent.width
            active: line.expanded && line.hasValue
            Component.onCompleted: setSource("RowDetails.qml", { line: line })
        }
    }

    Glyph {
        id: mark

        x: parent.width - Theme.gutter - Theme.padding - width + 6
        y: line.above + (line.height - line.above - height) / 2
        width: Theme.scaled(18)
        height: width
        name: "forward"
        color: line.chosen ? Theme.accentInk : Theme.secondaryText
        visible: line.disclosure
    }
}

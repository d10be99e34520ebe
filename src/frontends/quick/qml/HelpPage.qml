// The keys, and the meaning of the marks and the words around the tables.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

FocusScope {
    id: page

    signal closed

    readonly property list<var> groups: [
        {
            title: qsTr("Moving"),
            entries: [
                [qsTr("Up, Down"), qsTr("previous or next row; a wide window shows the row's screen beside it")],
                [qsTr("Page Up, Page Down"), qsTr("one page up or down")],
                [qsTr("Home, End"), qsTr("first or last row")],
                [qsTr("Enter, Space"), qsTr("open the row's screen, or show the row's whole text")],
                [qsTr("Right, Left"), qsTr("next column, or back")],
                [qsTr("Esc"), qsTr("close the filter, the log or this help, or go back")],
                [qsTr("Swipe"), qsTr("from the left edge: back")]
            ]
        },
        {
            title: qsTr("Reading"),
            entries: [
                [qsTr("/"), qsTr("find rows by section, label or value (Ctrl+F)")],
                [qsTr("r"), qsTr("read the values again now (F5)")],
                [qsTr("s"), qsTr("show the phone's other SIM card, when several report")],
                [qsTr("y, long press"), qsTr("copy the row (Ctrl+C)")],
                [qsTr("Y"), qsTr("copy the whole screen (Ctrl+Shift+C)")],
                [qsTr("l"), qsTr("log: the last lines that the program logged (Ctrl+L)")],
                [qsTr("?"), qsTr("this help (F1)")],
                [qsTr("Ctrl+D"), qsTr("dark or light")],
                [qsTr("Ctrl and +, −, 0"), qsTr("larger, smaller or the system's text size")],
                [qsTr("Ctrl+Q"), qsTr("quit")]
            ]
        },
        {
            title: qsTr("Marks"),
            entries: [
                [qsTr("Amber row"), qsTr("the value changed, or the row is new, since the screen was last read")],
                [qsTr("Arrow"), qsTr("the row leads to another screen")],
                [qsTr("updated 3 s ago"), qsTr("the age of what the screen shows; amber: reports are missing")],
                [qsTr("last known"), qsTr("the phone uses another technology now, or the connection is lost")]
            ]
        },
        {
            title: qsTr("Source"),
            entries: [
                [qsTr("Live modem"), qsTr("green: values come from a modem at this moment; the age is that of the last event")],
                [qsTr("Playback"), qsTr("blue: values come from a recording, with its own clock and position")],
                [qsTr("Simulated drive"), qsTr("violet: values come from a simulated drive")],
                [qsTr("SIM 1 (also SIM 2)"), qsTr("the SIM card whose values are shown, and the others that report")],
                [qsTr("no manager"), qsTr("no baseband manager has answered yet; the viewer tries again")],
                [qsTr("reconnecting"), qsTr("the connection was lost; the values shown are the last ones received")],
                [qsTr("connected, not subscribed"), qsTr("the baseband manager answers, but sends no events; the reason stands beside it")],
                [qsTr("decode failures"), qsTr("events whose payload could not be decoded")],
                [qsTr("lost"), qsTr("events dropped because this program was too slow")],
                [qsTr("gaps"), qsTr("times the connection was lost and made again; what passed between is unknown")]
            ]
        }
    ]

    Accessible.role: Accessible.Pane
    Accessible.name: qsTr("Help")
    Keys.onEscapePressed: closed()
    Keys.onBackPressed: closed()
    Keys.onReturnPressed: closed()
    Keys.onEnterPressed: closed()
    Component.onCompleted: scroll.forceActiveFocus()

    Rectangle {
        anchors.fill: parent
        color: Theme.window

        // Touches do not reach the screens below.
        MouseArea {
            anchors.fill: parent
            Accessible.ignored: true
        }
    }
    Rectangle {
        width: 1
        height: parent.height
        color: Theme.line
    }
    Item {
        id: bar

        width: parent.width
        height: Theme.target + Theme.gap

        Text {
            anchors.verticalCenter: parent.verticalCenter
            x: Theme.gutter + Theme.padding
            width: button.x - x
            text: qsTr("Help")
            textFormat: Text.PlainText
            font.pixelSize: Theme.titleSize
            font.weight: Font.Bold
            color: Theme.text
            elide: Text.ElideRight
        }
        IconButton {
            id: button

            anchors.right: parent.right
            anchors.rightMargin: 4
            anchors.verticalCenter: parent.verticalCenter
            glyph: "close"
            text: qsTr("Close the help")
            onClicked: page.closed()
        }
    }
    Flickable {
        id: scroll

        objectName: "help"
        y: bar.height
        width: parent.width
        height: parent.height - y
        contentHeight: all.height + Theme.padding
        clip: true
        boundsBehavior: Flickable.StopAtBounds
        ScrollBar.vertical: PageScrollBar {}

        function turn(by: real) {
            contentY = Math.max(0, Math.min(contentHeight - height, contentY + by));
        }
        Keys.onUpPressed: turn(-Theme.target)
        Keys.onDownPressed: turn(Theme.target)
        Keys.onPressed: event => {
            const turns = {
                [Qt.Key_Home]: -contentHeight,
                [Qt.Key_End]: contentHeight,
                [Qt.Key_PageUp]: Theme.target - height,
                [Qt.Key_PageDown]: height - Theme.target
            };
            if (event.key in turns) {
                turn(turns[event.key]);
                event.accepted = true;
            }
        }

        Column {
            id: all

            width: scroll.width

            Repeater {
                model: page.groups

                Column {
                    id: group

                    required property var modelData

                    width: parent ? parent.width : 0
                    topPadding: Theme.gap

                    Text {
                        x: Theme.gutter + Theme.padding
                        width: parent.width - 2 * x
                        bottomPadding: Theme.scaled(7)
                        text: group.modelData.title
                        textFormat: Text.PlainText
                        font.pixelSize: Theme.smallSize
                        font.weight: Font.Bold
                        color: Theme.secondaryText
                    }
                    Rectangle {
                        x: Theme.gutter
                        width: parent.width - 2 * x
                        height: entries.height + 2 * Theme.gap
                        radius: Theme.radius
                        color: Theme.card

                        Column {
                            id: entries

                            y: Theme.gap
                            width: parent.width

                            Repeater {
                                model: group.modelData.entries

                                Item {
                                    id: entry

                                    required property var modelData
                                    readonly property int keyWidth: Theme.scaled(104)

                                    width: parent ? parent.width : 0
                                    height: Math.max(key.height, meaning.height) + 12
                                    Accessible.role: Accessible.StaticText
                                    Accessible.name: modelData[0] + ", " + modelData[1]

                                    Text {
                                        id: key

                                        x: Theme.padding
                                        y: 6
                                        width: entry.keyWidth
                                        text: entry.modelData[0]
                                        textFormat: Text.PlainText
                                        wrapMode: Text.Wrap
                                        font.pixelSize: Theme.scaled(14)
                                        font.weight: Font.Bold
                                        color: Theme.text
                                        Accessible.ignored: true
                                    }
                                    Text {
                                        id: meaning

                                        x: key.x + key.width + Theme.padding
                                        y: 6
                                        width: parent.width - x - Theme.padding
                                        text: entry.modelData[1]
                                        textFormat: Text.PlainText
                                        wrapMode: Text.Wrap
                                        font.pixelSize: Theme.scaled(14)
                                        color: Theme.secondaryText
                                        Accessible.ignored: true
                                    }
                                }
                            }
                        }
                    }
                }
            }
        }
    }
}

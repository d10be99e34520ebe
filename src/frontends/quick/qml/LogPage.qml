// The latest log lines; follows the newest unless the user has scrolled away from it.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

FocusScope {
    id: page

    required property LogModel log

    signal closed
    signal told(string message)

    Accessible.role: Accessible.Pane
    Accessible.name: qsTr("Log")
    Keys.onEscapePressed: closed()
    Keys.onBackPressed: closed()

    function copyAll() {
        told(log.copyAll());
    }

    Component.onCompleted: {
        log.watched = true;
        lines.positionViewAtEnd();
        lines.forceActiveFocus();
    }
    Component.onDestruction: log.watched = false

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
        width: parent.width
        height: 1
        color: Theme.line
    }
    Item {
        id: bar

        width: parent.width
        height: Theme.target + Theme.gap

        Text {
            anchors.verticalCenter: parent.verticalCenter
            x: Theme.gutter + Theme.padding
            width: buttons.x - x
            text: qsTr("Log")
            textFormat: Text.PlainText
            font.pixelSize: Theme.titleSize
            font.weight: Font.Bold
            color: Theme.text
            elide: Text.ElideRight
        }
        Row {
            id: buttons

            anchors.right: parent.right
            anchors.rightMargin: 4
            anchors.verticalCenter: parent.verticalCenter

            IconButton {
                glyph: "copy"
                text: qsTr("Copy all lines")
                onClicked: page.copyAll()
            }
            IconButton {
                glyph: "close"
                text: qsTr("Close the log")
                onClicked: page.closed()
            }
        }
    }
    ListView {
        id: lines

        property bool follows: true

        objectName: "log"
        y: bar.height
        width: parent.width
        height: parent.height - y
        clip: true
        focus: true
        model: page.log
        bottomMargin: Theme.padding
        boundsBehavior: Flickable.StopAtBounds
        Accessible.role: Accessible.List
        Accessible.name: qsTr("Log lines")
        ScrollBar.vertical: PageScrollBar {}
        onMovementEnded: follows = atYEnd
        onContentHeightChanged: {
            if (follows)
                positionViewAtEnd();
        }
        Keys.onUpPressed: {
            follows = false;
            flick(0, 600);
        }
        Keys.onDownPressed: flick(0, -600)

        delegate: Item {
            id: entry

            required property string time
            required property string text
            required property bool isSystem

            width: ListView.view.width
            height: words.height + 6
            Accessible.role: Accessible.ListItem
            Accessible.name: text

            Text {
                id: words

                x: Theme.gutter + Theme.padding
                width: parent.width - 2 * x
                text: entry.time + "  " + entry.text
                textFormat: Text.PlainText
                wrapMode: Text.Wrap
                font.family: "monospace"
                font.pixelSize: Theme.smallSize
                color: entry.isSystem ? Theme.secondaryText : Theme.text
                Accessible.ignored: true
            }
        }
    }
    EmptyState {
        anchors.fill: lines
        visible: page.log.count === 0
        title: qsTr("No lines yet")
        explanation: qsTr("The program's log lines appear here.")
    }
}

// One screen: its title with the actions, the filter if it is open, and the table's lines.
import QtQuick
import Vespscope.Quick

FocusScope {
    id: page

    required property TableModel table
    required property StatusModel status
    required property int level
    // Whether this page has a back button, and whether the window's actions refer to this screen.
    property bool hasBack: false
    property bool topmost: true
    property bool menuShown: true
    property alias besideNext: lines.besideNext
    property alias showsSource: lines.showsSource
    readonly property alias currentLine: lines.currentIndex

    property bool filtering: false

    signal backAsked
    signal menuAsked(Item button)
    signal told(string message)
    signal opened(int line)
    signal moved(int line)
    signal leftAsked
    signal rightAsked

    Accessible.role: Accessible.Pane
    Accessible.name: table.title

    function takeFocus() {
        lines.forceActiveFocus();
    }
    function openFilter() {
        filtering = true;
        filter.takeFocus();
    }
    function closeFilter() {
        filtering = false;
        filter.text = "";
        takeFocus();
    }
    function copyRow() {
        lines.copyRow();
    }
    function copyAll() {
        told(table.copyAll());
    }
    Rectangle {
        anchors.fill: parent
        color: Theme.window
    }

    Item {
        id: bar

        width: parent.width
        height: Math.max(Theme.target, title.implicitHeight + age.room) + Theme.gap

        IconButton {
            id: backButton

            x: 4
            anchors.verticalCenter: parent.verticalCenter
            glyph: "back"
            text: qsTr("Back")
            visible: page.hasBack
            onClicked: page.backAsked()
        }
        Text {
            id: title

            anchors.verticalCenter: parent.verticalCenter
            anchors.verticalCenterOffset: -age.room / 2
            x: page.hasBack ? backButton.x + backButton.width + 2 : Theme.gutter + Theme.padding
            width: actions.x - x - (page.topmost ? 0 : Theme.gutter)
            text: page.table.title
            textFormat: Text.PlainText
            font.pixelSize: Theme.titleSize
            font.weight: Font.Bold
            color: Theme.text
            elide: Text.ElideRight
            maximumLineCount: 2
            // The item keeps the height of the unshrunk text.
            verticalAlignment: Text.AlignVCenter
            fontSizeMode: Text.HorizontalFit
            minimumPixelSize: Math.max(16, Theme.scaled(12))
            wrapMode: Text.Wrap
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
        Text {
            id: age

            // The part of the bar's height that it needs.
            readonly property real room: visible ? implicitHeight : 0

            x: title.x
            y: title.y + title.height
            width: title.width
            text: page.table.age
            textFormat: Text.PlainText
            font.pixelSize: Theme.smallSize
            font.weight: page.table.outdated ? Font.Bold : Font.Normal
            color: page.table.outdated ? Theme.accentText : Theme.secondaryText
            wrapMode: Text.Wrap
            visible: text !== ""
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
        Row {
            id: actions

            anchors.right: parent.right
            anchors.rightMargin: 4
            anchors.verticalCenter: parent.verticalCenter
            visible: page.topmost
            width: visible ? implicitWidth : 0

            IconButton {
                glyph: "search"
                text: qsTr("Filter rows")
                onClicked: page.filtering ? page.closeFilter() : page.openFilter()
            }
            IconButton {
                glyph: "copy"
                text: qsTr("Copy all rows")
                visible: page.width >= 420
                onClicked: page.copyAll()
            }
            IconButton {
                id: menuButton

                glyph: "more"
                text: qsTr("Menu")
                visible: page.menuShown
                onClicked: page.menuAsked(menuButton)
            }
        }
    }

    SearchField {
        id: filter

        y: bar.height
        width: parent.width
        height: visible ? implicitHeight : 0
        visible: page.filtering
        onTextChanged: page.table.filter = text
        onClosed: page.closeFilter()
        onLeftDownwards: {
            page.takeFocus();
            lines.step(1);
        }
    }

    TableList {
        id: lines

        objectName: "lines"
        y: filter.y + filter.height
        width: parent.width
        height: parent.height - y
        focus: true
        table: page.table
        status: page.status
        onOpened: line => page.opened(line)
        onMoved: line => page.moved(line)
        onTold: message => page.told(message)
        onLeftAsked: page.leftAsked()
        onRightAsked: page.rightAsked()
    }

    EmptyState {
        anchors.fill: lines
        visible: page.table.count === 0
        title: page.table.filtered ? qsTr("No row contains “%1”").arg(page.table.filter) : qsTr("Waiting for Update")
        explanation: page.table.filtered ? qsTr("Close the filter to see all rows.") 
                   : page.table.reported ? page.status.waitingForEntries : page.status.waiting
    }
}

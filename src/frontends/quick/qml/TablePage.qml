// One screen: its title with the actions, the filter when it is open, and the table's lines.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

FocusScope {
    id: page

    required property TableModel table
    required property StatusModel status
    required property int level
    // Whether a way back is offered here, and whether this is the screen that the window's actions mean.
    property bool hasBack: false
    property bool topmost: true
    property bool menuShown: true
    // Whether the screen opened from here stands beside this one.
    property bool besideNext: false
    // Below the lines.
    property Component footer: null

    property bool filtering: false
    property bool byKeyboard: false

    signal backAsked
    signal menuAsked(Item button)
    signal told(string message)
    signal opened(int line)
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
        if (lines.currentIndex >= 0)
            told(table.copyRow(lines.currentIndex));
        else
            copyAll();
    }
    function copyAll() {
        told(table.copyAll());
    }
    function step(by) {
        byKeyboard = true;
        goTo(table.rowFrom(lines.currentIndex, by));
    }
    function goTo(line) {
        lines.currentIndex = line;
        if (line >= 0)
            lines.positionViewAtIndex(line, ListView.Contain);
        // With the first row its header comes into view.
        if (line <= 1)
            lines.positionViewAtBeginning();
    }
    // A screenful up or down, less one row.
    function turn(direction) {
        byKeyboard = true;
        lines.contentY += direction * Math.max(Theme.target, lines.height - Theme.target);
        lines.returnToBounds();
        const edge = lines.contentY + (direction > 0 ? lines.height - 1 : 1);
        const line = lines.indexAt(lines.width / 2, edge);
        // The row at that edge, or the nearest one further in.
        lines.currentIndex = table.rowFrom(line < 0 ? -1 : line + direction, -direction);
    }
    function activate(line) {
        if (line < 0)
            return;
        lines.currentIndex = line;
        opened(line);
    }

    Rectangle {
        anchors.fill: parent
        color: Theme.window
    }

    Item {
        id: bar

        width: parent.width
        height: Math.max(Theme.target, title.implicitHeight) + Theme.gap

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
            x: page.hasBack ? backButton.x + backButton.width + 2 : Theme.gutter + Theme.padding
            width: actions.x - x - (page.topmost ? 0 : Theme.gutter)
            text: page.table.title
            textFormat: Text.PlainText
            font.pixelSize: Theme.titleSize
            font.weight: Font.Bold
            color: Theme.text
            elide: Text.ElideRight
            maximumLineCount: 2
            wrapMode: Text.Wrap
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
            page.step(1);
        }
    }

    ListView {
        id: lines

        objectName: "lines"
        y: filter.y + filter.height
        width: parent.width
        height: parent.height - y
        focus: true
        clip: true
        model: page.table
        currentIndex: -1
        highlightFollowsCurrentItem: false
        keyNavigationEnabled: false
        cacheBuffer: 200
        bottomMargin: Theme.padding
        footer: count > 0 ? page.footer : null
        Accessible.role: Accessible.List
        Accessible.name: page.table.title

        ScrollBar.vertical: ScrollBar {
            id: scrollBar

            contentItem: Rectangle {
                implicitWidth: 5
                radius: 2.5
                color: Theme.border
                opacity: scrollBar.active && scrollBar.size < 1 ? 0.8 : 0
                Behavior on opacity {
                    NumberAnimation { duration: 200 }
                }
            }
        }

        delegate: TableLine {
            width: ListView.view.width
            current: page.byKeyboard && ListView.isCurrentItem && lines.activeFocus
            marksOpened: page.besideNext
            onPressed: page.byKeyboard = false
            onClicked: page.activate(index)
            onCopyAsked: page.told(page.table.copyRow(index))
        }

        Keys.onUpPressed: page.step(-1)
        Keys.onDownPressed: page.step(1)
        Keys.onLeftPressed: page.leftAsked()
        Keys.onRightPressed: page.rightAsked()
        Keys.onReturnPressed: page.activate(currentIndex)
        Keys.onEnterPressed: page.activate(currentIndex)
        Keys.onSpacePressed: page.activate(currentIndex)
        Keys.onPressed: event => {
            const actions = {
                [Qt.Key_Home]: () => page.step(-count),
                [Qt.Key_End]: () => page.step(count),
                [Qt.Key_PageUp]: () => page.turn(-1),
                [Qt.Key_PageDown]: () => page.turn(1)
            };
            if (event.key in actions) {
                actions[event.key]();
                event.accepted = true;
            }
        }
    }

    Loader {
        anchors.fill: lines
        active: page.table.count === 0
        sourceComponent: EmptyState {
            title: page.table.filtered ? qsTr("No row contains “%1”").arg(page.table.filter)
                                       : qsTr("Waiting for Update")
            explanation: page.table.filtered ? qsTr("Close the filter to see all rows.")
                                             : page.status.waiting
        }
    }
}

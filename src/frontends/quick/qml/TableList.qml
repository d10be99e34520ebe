// The lines of a table, keyboard navigation in them, and their actions.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

ListView {
    id: list

    required property TableModel table
    required property StatusModel status
    // Whether the screen opened from here is shown next to this one.
    property bool besideNext: false
    // Whether the facts about the source are shown below the lines.
    property bool showsSource: false
    // Whether the last step was made with a key.
    property bool byKeyboard: false

    signal opened(int line)
    signal told(string message)
    // A key moved to this line.
    signal moved(int line)
    signal leftAsked
    signal rightAsked

    function step(by: int) {
        byKeyboard = true;
        const line = table.rowFrom(currentIndex, by);
        currentIndex = line;
        if (line >= 0)
            positionViewAtIndex(line, ListView.Contain);
        // With the first row its header comes into view.
        if (line <= 1)
            positionViewAtBeginning();
        moved(line);
    }
    // A screenful up or down, less one row.
    function turn(direction: int) {
        byKeyboard = true;
        contentY += direction * Math.max(Theme.target, height - Theme.target);
        returnToBounds();
        const edge = contentY + (direction > 0 ? height - 1 : 1);
        const line = indexAt(width / 2, edge);
        // The row at that edge, or the nearest one inside it.
        currentIndex = table.rowFrom(line < 0 ? -1 : line + direction, -direction);
        moved(currentIndex);
    }
    function activate(line: int) {
        if (line < 0)
            return;
        currentIndex = line;
        opened(line);
    }
    function copyRow() {
        told(currentIndex >= 0 ? table.copyRow(currentIndex) : table.copyAll());
    }

    model: table
    currentIndex: -1
    clip: true
    highlightFollowsCurrentItem: false
    keyNavigationEnabled: false
    cacheBuffer: 200
    bottomMargin: Theme.padding
    footer: showsSource && count > 0 ? sourceFooter : null
    Accessible.role: Accessible.List
    Accessible.name: table.title

    ScrollBar.vertical: PageScrollBar {}
    delegate: TableLine {
        id: line

        readonly property TableList view: ListView.view as TableList

        width: view ? Math.min(view.width, Theme.widest) : 0
        current: view !== null && view.byKeyboard && view.activeFocus && ListView.isCurrentItem
        marksOpened: view !== null && view.besideNext
        onPressed: view.byKeyboard = false
        onClicked: view.activate(index)
        onCopyAsked: view.told(view.table.copyRow(index))
    }

    Component {
        id: sourceFooter

        SourceCard {
            readonly property TableList view: ListView.view as TableList

            width: view ? view.width : 0
            status: view ? view.status : null
        }
    }

    Keys.onUpPressed: step(-1)
    Keys.onDownPressed: step(1)
    Keys.onLeftPressed: leftAsked()
    Keys.onRightPressed: rightAsked()
    Keys.onReturnPressed: activate(currentIndex)
    Keys.onEnterPressed: activate(currentIndex)
    Keys.onSpacePressed: activate(currentIndex)
    Keys.onPressed: event => {
        const actions = {
            [Qt.Key_Home]: () => step(-count),
            [Qt.Key_End]: () => step(count),
            [Qt.Key_PageUp]: () => turn(-1),
            [Qt.Key_PageDown]: () => turn(1)
        };
        if (event.key in actions) {
            actions[event.key]();
            event.accepted = true;
        }
    }
}

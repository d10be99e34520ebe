// The screen stack: one page at a time that slides on a phone, columns side by side on a wide window.
//
// Both use the same pages, so that turning the device keeps every page as it was.
import QtQuick
import Vespscope.Quick

FocusScope {
    id: pages

    required property NavigationModel navigation
    required property StatusModel status

    readonly property int depth: navigation.depth
    readonly property int columns: width >= 940 * Math.sqrt(Theme.textScale) ? 3
                                 : width >= 620 * Math.sqrt(Theme.textScale) ? 2 : 1
    readonly property real sidebar: columns === 3 ? Math.min(width * 0.235, Theme.scaled(300))
                                                  : Math.min(width * 0.42, Theme.scaled(320))
    // The level of the page at the left edge; between two levels while pages slide.
    property real shift: 0
    property bool leaving: false
    // Whether a screen opens next to its list while the keyboard focus stays in the list.
    property bool previewing: false
    readonly property bool sliding: slide.running

    signal menuAsked(Item button)
    signal told(string message)

    function page(level: int): TablePage {
        return repeater.itemAt(level) as TablePage;
    }
    function current(): TablePage {
        return page(navigation.depth - 1);
    }
    // The page with the keyboard focus.
    function focused(): TablePage {
        for (let level = 0; level < navigation.depth; ++level) {
            if (page(level).activeFocus)
                return page(level);
        }
        return current();
    }
    function takeFocus(level: int) {
        const taker = page(level);
        if (taker)
            taker.takeFocus();
    }
    function open(level: int, line: int): bool {
        if (!navigation.open(level, line))
            return false;
        takeFocus(level + 1);
        return true;
    }
    // On a wide window, shows the screen that a line leads to and leaves the keyboard focus where it is.
    function preview(level: int, line: int) {
        if (columns === 1 || line < 0)
            return;
        previewing = true;
        navigation.open(level, line);
        previewing = false;
        takeFocus(level);
    }
    // Leaves the topmost screen; returns false if it is the first one.
    function back(): bool {
        if (leaving)
            slide.complete();
        if (navigation.depth < 2)
            return false;
        if (columns === 1) {
            leaving = true;
            slideTo(navigation.depth - 2);
        } else {
            navigation.leaveTo(navigation.depth - 1);
        }
        return true;
    }
    function slideTo(level: int) {
        slide.stop();
        slide.to = level;
        slide.start();
    }
    function settle(slides: bool) {
        leaving = false;
        const goal = Math.max(0, navigation.depth - columns);
        if (slides && columns === 1 && goal > shift) {
            slideTo(goal);
        } else {
            slide.stop();
            shift = goal;
        }
        if (!previewing)
            takeFocus(navigation.depth - 1);
    }

    onDepthChanged: settle(true)
    onColumnsChanged: settle(false)
    Component.onCompleted: settle(false)

    NumberAnimation {
        id: slide

        target: pages
        property: "shift"
        duration: Theme.pageDuration
        easing.type: Easing.OutCubic
        onFinished: {
            if (pages.leaving) {
                pages.leaving = false;
                pages.navigation.leaveTo(pages.navigation.depth - 1);
            }
        }
    }

    Rectangle {
        anchors.fill: parent
        color: Theme.window
    }

    Repeater {
        id: repeater

        model: pages.navigation

        // qmllint disable unqualified
        TablePage {
            id: each

            required property int index

            readonly property real slot: index - pages.shift
            readonly property bool isLast: slot >= pages.columns - 1

            level: index
            status: pages.status
            // On a phone the page below moves at a quarter of the speed.
            x: pages.columns > 1 ? slot * pages.sidebar : slot < 0 ? slot * width / 4 : slot * width
            width: isLast || pages.columns === 1 ? pages.width - (pages.columns - 1) * pages.sidebar : pages.sidebar
            height: pages.height
            visible: slot > -1 && slot < pages.columns
            enabled: !pages.sliding
            hasBack: index > 0 && Math.round(slot) === 0
            topmost: index === pages.navigation.depth - 1
            besideNext: pages.columns > 1
            showsSource: index === 0 && pages.columns === 1
            onBackAsked: pages.back()
            onMenuAsked: button => pages.menuAsked(button)
            onTold: message => pages.told(message)
            onOpened: line => {
                if (!pages.open(index, line))
                    table.toggleExpanded(line);
            }
            onMoved: line => pages.preview(index, line)
            onLeftAsked: {
                if (pages.columns === 1 || slot <= 0)
                    pages.back();
                else if (index > 0)
                    pages.takeFocus(index - 1);
            }
            onRightAsked: {
                if (!topmost)
                    pages.takeFocus(index + 1);
                else if (currentLine >= 0)
                    pages.open(index, currentLine);
            }

            Rectangle {
                width: 1
                height: parent.height
                color: Theme.line
                visible: each.slot > 0
            }
        }
        // qmllint enable unqualified
    }

    Loader {
        x: pages.navigation.depth * pages.sidebar
        width: pages.width - x
        height: pages.height
        active: pages.columns > pages.navigation.depth
        Component.onCompleted: setSource("Welcome.qml", { status: pages.status })
    }

    // A swipe from the left edge goes back.
    Item {
        width: 24
        height: parent.height

        DragHandler {
            target: null
            enabled: pages.columns === 1 && pages.navigation.depth > 1 && !pages.sliding
            yAxis.enabled: false
            margin: 0
            onActiveTranslationChanged: {
                if (active)
                    pages.shift = pages.navigation.depth - 1
                        - Math.max(0, Math.min(1, activeTranslation.x / pages.width));
            }
            onActiveChanged: {
                if (active)
                    return;
                const progress = pages.navigation.depth - 1 - pages.shift;
                if (progress > 0.35 || centroid.velocity.x > 600)
                    pages.back();
                else
                    pages.slideTo(pages.navigation.depth - 1);
            }
        }
    }
}

// The application window.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

ApplicationWindow {
    id: window

    required property NavigationModel navigation
    required property StatusModel status
    required property LogModel log
    required property Appearance appearance

    width: 1040
    height: 720
    minimumWidth: 280
    minimumHeight: 280
    visible: true
    title: navigation.depth > 1 ? pages.current().table.title + " – vespscope" : "vespscope"
    color: Theme.window

    palette {
        window: Theme.window
        windowText: Theme.text
        base: Theme.card
        alternateBase: Theme.hovered
        text: Theme.text
        placeholderText: Theme.secondaryText
        button: Theme.card
        buttonText: Theme.text
        light: Theme.hovered
        mid: Theme.line
        dark: Theme.border
        highlight: Theme.accent
        highlightedText: Theme.accentInk
        toolTipBase: Theme.toast
        toolTipText: Theme.toastInk
    }

    Binding {
        target: Theme
        property: "dark"
        value: window.appearance.dark
    }
    Binding {
        target: Theme
        property: "textScale"
        value: window.appearance.textScale
    }

    function showLog() {
        helpLoader.active = false;
        logLoader.active = true;
    }
    function showHelp() {
        logLoader.active = false;
        helpLoader.active = true;
    }
    // Closes the log and the help.
    function closePanes() {
        logLoader.active = false;
        helpLoader.active = false;
        pages.forceActiveFocus();
    }
    function copyRow() {
        logLoader.item ? (logLoader.item as LogPage).copyAll() : pages.focused().copyRow();
    }
    function copyAll() {
        logLoader.item ? (logLoader.item as LogPage).copyAll() : pages.focused().copyAll();
    }
    function readAgain() {
        navigation.readAgain();
        status.refresh();
        toast.show(qsTr("Values read again"));
    }
    function showNextSim() {
        const next = status.nextSim;
        navigation.showNextSim();
        toast.show(next === "" ? qsTr("No other SIM card reports") : qsTr("Showing %1").arg(next));
    }
    // The action of a character when no text is entered; the same as in the terminal.
    function act(event: var) {
        if (event.modifiers & (Qt.ControlModifier | Qt.AltModifier | Qt.MetaModifier))
            return;
        const actions = {
            "/": () => {
                closePanes();
                pages.focused().openFilter();
            },
            "?": () => helpLoader.active ? closePanes() : showHelp(),
            "l": () => logLoader.active ? closePanes() : showLog(),
            "r": () => readAgain(),
            "s": () => showNextSim(),
            "y": () => copyRow(),
            "Y": () => copyAll()
        };
        if (event.text in actions) {
            actions[event.text]();
            event.accepted = true;
        }
    }
    function openMenu(button: Item) {
        menuLoader.active = true;
        const menu = menuLoader.item as AppMenu;
        const corner = button.mapToItem(window.contentItem, button.width, button.height);
        menu.x = Math.max(0, Math.min(corner.x, window.width - 8) - menu.width);
        menu.y = corner.y;
        menu.open();
    }

    StatusBar {
        id: statusBar

        width: parent.width
        status: window.status
    }
    Pages {
        id: pages

        y: statusBar.height
        width: parent.width
        height: parent.height - y
        focus: true
        navigation: window.navigation
        status: window.status
        onMenuAsked: button => window.openMenu(button)
        onTold: message => toast.show(message)

        Keys.onEscapePressed: event => {
            event.accepted = back();
        }
        Keys.onBackPressed: event => {
            event.accepted = back();
        }
        Keys.onPressed: event => window.act(event)

        // The back button of a mouse.
        TapHandler {
            acceptedDevices: PointerDevice.Mouse
            acceptedButtons: Qt.BackButton
            onTapped: pages.back()
        }
    }
    Loader {
        id: logLoader

        readonly property real share: pages.columns > 1 && pages.height > 500 ? 0.45 : 1

        y: pages.y + pages.height * (1 - share)
        width: parent.width
        height: pages.height * share
        active: false
        focus: active
        Keys.onPressed: event => window.act(event)
        Component.onCompleted: setSource("LogPage.qml", { log: window.log })
    }
    Loader {
        id: helpLoader

        anchors.right: parent.right
        y: pages.y
        width: pages.columns > 1 ? Math.min(pages.width, Theme.scaled(480)) : pages.width
        height: pages.height
        active: false
        focus: active
        source: "HelpPage.qml"
        Keys.onPressed: event => window.act(event)
    }
    Connections {
        target: helpLoader.item as HelpPage
        function onClosed() {
            window.closePanes();
        }
    }
    Connections {
        target: logLoader.item as LogPage
        function onTold(message) {
            toast.show(message);
        }
        function onClosed() {
            window.closePanes();
        }
    }
    Loader {
        id: menuLoader

        active: false
        Component.onCompleted: setSource("AppMenu.qml", { appearance: window.appearance, status: window.status })
    }
    Connections {
        target: menuLoader.item as AppMenu
        function onSimAsked() {
            window.showNextSim();
        }
        function onCopyAsked() {
            pages.current().copyAll();
        }
        function onLogAsked() {
            window.showLog();
        }
        function onHelpAsked() {
            window.showHelp();
        }
        function onClosed() {
            if (!logLoader.active && !helpLoader.active)
                pages.forceActiveFocus();
        }
    }
    Toast {
        id: toast

        anchors.horizontalCenter: parent.horizontalCenter
        y: parent.height - height - Theme.target
    }

    Shortcut {
        sequence: "Ctrl+F"
        onActivated: {
            window.closePanes();
            pages.focused().openFilter();
        }
    }
    Shortcut {
        sequence: "Ctrl+C"
        onActivated: window.copyRow()
    }
    Shortcut {
        sequence: "Ctrl+Shift+C"
        onActivated: window.copyAll()
    }
    Shortcut {
        sequence: "Ctrl+L"
        onActivated: logLoader.active ? window.closePanes() : window.showLog()
    }
    Shortcut {
        sequence: "F1"
        onActivated: helpLoader.active ? window.closePanes() : window.showHelp()
    }
    Shortcut {
        sequence: "F5"
        onActivated: window.readAgain()
    }
    Shortcut {
        sequence: "Ctrl+D"
        onActivated: window.appearance.toggle()
    }
    Shortcut {
        sequences: ["Ctrl++", "Ctrl+="]
        onActivated: window.appearance.zoom(1)
    }
    Shortcut {
        sequence: "Ctrl+-"
        onActivated: window.appearance.zoom(-1)
    }
    Shortcut {
        sequence: "Ctrl+0"
        onActivated: window.appearance.zoom(0)
    }
    Shortcut {
        sequence: "Ctrl+Q"
        onActivated: Qt.quit()
    }
}

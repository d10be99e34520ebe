// The menu of the window's actions other than its screens.
import QtQuick
import QtQuick.Controls.Basic
import Vespscope.Quick

Menu {
    id: menu

    required property Appearance appearance
    required property StatusModel status

    signal simAsked
    signal copyAsked
    signal logAsked
    signal helpAsked

    width: Math.max(Theme.scaled(230), 200)
    padding: 6
    modal: true
    dim: false

    background: Rectangle {
        radius: Theme.radius
        color: Theme.card
        border.width: 1
        border.color: Theme.border
    }

    MenuLine {
        text: qsTr("Show %1").arg(menu.status.nextSim)
        keys: "s"
        visible: menu.status.nextSim !== ""
        height: visible ? implicitHeight : 0
        onTriggered: menu.simAsked()
    }
    MenuLine {
        text: qsTr("Copy all rows")
        keys: "Y"
        onTriggered: menu.copyAsked()
    }
    MenuLine {
        text: qsTr("Log")
        keys: "l"
        onTriggered: menu.logAsked()
    }
    MenuLine {
        text: qsTr("Help")
        keys: "?"
        onTriggered: menu.helpAsked()
    }
    MenuRule {}
    MenuLine {
        text: qsTr("Follow the system")
        checkable: true
        checked: menu.appearance.mode === Appearance.System
        onTriggered: menu.appearance.mode = Appearance.System
    }
    MenuLine {
        text: qsTr("Light")
        checkable: true
        checked: menu.appearance.mode === Appearance.Light
        onTriggered: menu.appearance.mode = Appearance.Light
    }
    MenuLine {
        text: qsTr("Dark")
        checkable: true
        checked: menu.appearance.mode === Appearance.Dark
        onTriggered: menu.appearance.mode = Appearance.Dark
    }
    MenuRule {}
    MenuLine {
        text: qsTr("Larger text")
        onTriggered: menu.appearance.zoom(1)
    }
    MenuLine {
        text: qsTr("Smaller text")
        onTriggered: menu.appearance.zoom(-1)
    }
}

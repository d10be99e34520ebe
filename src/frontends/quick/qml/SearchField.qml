// The field that filters a table's rows.
import QtQuick
import QtQuick.Templates as T
import Vespscope.Quick

Item {
    id: search

    property alias text: field.text

    signal closed
    signal leftDownwards

    implicitHeight: Theme.target + Theme.gap

    function takeFocus() {
        field.forceActiveFocus(Qt.ShortcutFocusReason);
        field.selectAll();
    }

    T.TextField {
        id: field

        x: Theme.gutter
        width: parent.width - 2 * x
        height: Theme.target
        leftPadding: Theme.padding + Theme.scaled(20) + Theme.gap
        rightPadding: Theme.target
        verticalAlignment: TextInput.AlignVCenter
        font.pixelSize: Theme.bodySize
        color: Theme.text
        selectionColor: Theme.accent
        selectedTextColor: Theme.accentInk
        placeholderText: qsTr("Filter rows")
        inputMethodHints: Qt.ImhNoPredictiveText | Qt.ImhNoAutoUppercase
        selectByMouse: true
        Accessible.role: Accessible.EditableText
        Accessible.name: placeholderText

        Keys.onEscapePressed: search.closed()
        Keys.onBackPressed: search.closed()
        Keys.onDownPressed: search.leftDownwards()
        Keys.onReturnPressed: search.leftDownwards()
        Keys.onEnterPressed: search.leftDownwards()

        background: Rectangle {
            radius: Theme.radius
            color: Theme.card
            border.width: field.activeFocus ? 2 : 1
            border.color: field.activeFocus ? Theme.accentText : Theme.border
        }

        Text {
            x: field.leftPadding
            height: parent.height
            width: parent.width - x - field.rightPadding
            text: field.placeholderText
            textFormat: Text.PlainText
            font: field.font
            color: Theme.secondaryText
            verticalAlignment: Text.AlignVCenter
            elide: Text.ElideRight
            visible: field.length === 0 && field.preeditText.length === 0
            Accessible.ignored: true
        }
        Glyph {
            x: Theme.padding - 2
            anchors.verticalCenter: parent.verticalCenter
            width: Theme.scaled(20)
            height: width
            name: "search"
            color: Theme.secondaryText
        }
        IconButton {
            anchors.right: parent.right
            glyph: "close"
            text: qsTr("Close the filter")
            onClicked: search.closed()
        }
    }
}

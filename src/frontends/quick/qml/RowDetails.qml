// The value of an expanded row: selectable text, and a button that copies the row.
import QtQuick
import Vespscope.Quick

Column {
    id: details

    required property TableLine line

    spacing: 4

    TextEdit {
        width: parent.width
        text: details.line.value
        textFormat: TextEdit.PlainText
        readOnly: true
        selectByMouse: true
        wrapMode: TextEdit.Wrap
        font.pixelSize: Theme.bodySize
        color: Theme.text
        selectionColor: Theme.accent
        selectedTextColor: Theme.accentInk
        Accessible.name: qsTr("Value")
    }
    TextButton {
        x: -leftPadding
        text: qsTr("Copy row")
        onClicked: details.line.copyAsked()
    }
}

// A line between groups of choices.
import QtQuick
import QtQuick.Templates as T

T.MenuSeparator {
    implicitHeight: 13
    contentItem: Item {
        Rectangle {
            anchors.verticalCenter: parent.verticalCenter
            x: 8
            width: parent.width - 2 * x
            height: 1
            color: Theme.line
        }
    }
}

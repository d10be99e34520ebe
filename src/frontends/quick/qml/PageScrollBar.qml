// A thin bar that is shown while its list moves.
import QtQuick
import QtQuick.Templates as T

T.ScrollBar {
    id: bar

    implicitWidth: 9
    padding: 2
    minimumSize: 0.05
    Accessible.ignored: true

    contentItem: Rectangle {
        implicitWidth: 5
        radius: 2.5
        color: Theme.border
        opacity: bar.active && bar.size < 1 ? 0.8 : 0

        Behavior on opacity {
            NumberAnimation { duration: 200 }
        }
    }
}

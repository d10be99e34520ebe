// A short message that disappears automatically.
import QtQuick

Rectangle {
    id: toast

    function show(message: string) {
        words.text = message;
        opacity = 1;
        away.restart();
    }

    implicitWidth: Math.min(words.implicitWidth + 2 * Theme.padding, parent ? parent.width - 2 * Theme.padding : 0)
    implicitHeight: words.height + 2 * Theme.gap + 4
    radius: Math.min(height / 2, 20)
    color: Theme.toast
    opacity: 0
    visible: opacity > 0
    Accessible.role: Accessible.AlertMessage
    Accessible.name: words.text

    Behavior on opacity {
        NumberAnimation { duration: 150 }
    }
    Timer {
        id: away
        interval: 2200
        onTriggered: toast.opacity = 0
    }
    Text {
        id: words

        anchors.verticalCenter: parent.verticalCenter
        x: Theme.padding
        width: toast.width - 2 * x
        textFormat: Text.PlainText
        wrapMode: Text.Wrap
        horizontalAlignment: Text.AlignHCenter
        font.pixelSize: Theme.scaled(14)
        color: Theme.toastInk
        Accessible.ignored: true
    }
}

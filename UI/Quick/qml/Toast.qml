import QtQuick
import Spectrel.Quick

// A short message that goes by itself.
Rectangle {
    id: toast

    required property QuickScreen screen
    readonly property string message: screen.notice
    property bool isOver: false // it was shown long enough

    objectName: "toast"
    visible: message !== "" && !isOver
    width: Math.min(label.implicitWidth + 40, parent.width - 2 * Theme.margin)
    height: 44
    radius: height / 2
    color: Theme.isDark ? "#e8edf3" : "#232b36"
    Accessible.role: Accessible.Notification
    Accessible.name: message
    onMessageChanged: {
        isOver = false;
        clock.restart();
    }

    Text {
        id: label
        objectName: "toastText"
        anchors.fill: parent
        anchors.leftMargin: 20
        anchors.rightMargin: 20
        text: toast.message
        textFormat: Text.PlainText
        font.pixelSize: Theme.messageText
        color: Theme.isDark ? "#10151c" : "#ffffff"
        elide: Text.ElideRight
        horizontalAlignment: Text.AlignHCenter
        verticalAlignment: Text.AlignVCenter
        Accessible.ignored: true
    }
    Timer {
        id: clock
        interval: 3000
        onTriggered: {
            toast.isOver = true;
            toast.screen.clearNotice();
        }
    }
}

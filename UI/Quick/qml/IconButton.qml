import QtQuick
import QtQuick.Templates as T
import Spectrel.Quick

// A sign to press, with room for a thumb.
T.AbstractButton {
    id: button

    required property int shape
    property color color: Theme.accent
    property real size: 24

    implicitWidth: Theme.touch
    implicitHeight: Theme.touch
    focusPolicy: Qt.TabFocus
    opacity: enabled ? 1 : 0.4
    Accessible.role: Accessible.Button
    Accessible.name: text

    background: Rectangle {
        anchors.fill: parent
        anchors.margins: 4
        radius: width / 2
        color: button.pressed || button.hovered ? Theme.pressed : "transparent"
        border.width: button.visualFocus ? 2 : 0
        border.color: Theme.accent
    }
    contentItem: Item {
        Icon {
            anchors.centerIn: parent
            width: button.size
            height: button.size
            shape: button.shape
            color: button.color
        }
    }
}

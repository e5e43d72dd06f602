import QtQuick
import QtQuick.Templates as T

// A word to press. The button that the screen is for is filled.
T.AbstractButton {
    id: button

    property bool isFilled: false

    implicitWidth: Math.max(Theme.touch, label.implicitWidth + 32)
    implicitHeight: Theme.touch
    focusPolicy: Qt.TabFocus
    Accessible.role: Accessible.Button
    Accessible.name: text

    background: Rectangle {
        anchors.fill: parent
        anchors.topMargin: 5
        anchors.bottomMargin: 5
        radius: height / 2
        color: button.isFilled ? Theme.accent : button.pressed || button.hovered ? Theme.pressed : "transparent"
        opacity: button.isFilled && button.pressed ? 0.75 : 1
        border.width: button.visualFocus ? 2 : 0
        border.color: button.isFilled ? Theme.text : Theme.accent
    }
    contentItem: Text {
        id: label
        text: button.text
        textFormat: Text.PlainText
        font.pixelSize: Theme.controlText
        font.bold: button.isFilled
        color: button.isFilled ? Theme.accentText : Theme.accent
        horizontalAlignment: Text.AlignHCenter
        verticalAlignment: Text.AlignVCenter
    }
}

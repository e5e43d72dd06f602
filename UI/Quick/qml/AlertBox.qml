import QtQuick
import QtQuick.Controls.Basic
import QtQuick.Templates as T
import Spectrel.Quick

// A message above everything else, with one button that closes it.
Popup {
    id: box

    required property QuickScreen screen

    parent: T.Overlay.overlay
    anchors.centerIn: parent
    width: parent ? Math.min(parent.width - 48, 320) : 0
    modal: true
    focus: true
    padding: 0
    visible: screen.hasAlert
    closePolicy: Popup.NoAutoClose

    enter: Transition {
        NumberAnimation { property: "opacity"; from: 0; to: 1; duration: Theme.fade }
        NumberAnimation { property: "scale"; from: 0.92; to: 1; duration: Theme.fade; easing.type: Easing.OutCubic }
    }
    exit: Transition {
        NumberAnimation { property: "opacity"; to: 0; duration: Theme.fade }
    }
    T.Overlay.modal: Rectangle { color: Theme.shade }
    background: Rectangle {
        color: Theme.raised
        radius: 1.5 * Theme.radius
    }

    contentItem: Column {
        focus: true
        padding: 24
        bottomPadding: 16
        spacing: 8
        Accessible.role: Accessible.AlertMessage
        Accessible.name: title.text + ". " + message.text
        Keys.onReturnPressed: box.screen.closeAlert()
        Keys.onEnterPressed: box.screen.closeAlert()
        Keys.onEscapePressed: box.screen.closeAlert()

        Text {
            id: title
            objectName: "alertTitle"
            width: box.width - 48
            text: box.screen.alertTitle
            textFormat: Text.PlainText
            font.pixelSize: Theme.titleText
            font.bold: true
            color: Theme.text
            wrapMode: Text.Wrap
            horizontalAlignment: Text.AlignHCenter
        }
        Text {
            id: message
            objectName: "alertMessage"
            width: box.width - 48
            bottomPadding: 12
            text: box.screen.alertMessage
            textFormat: Text.PlainText
            font.pixelSize: Theme.plainText
            color: Theme.faint
            wrapMode: Text.Wrap
            horizontalAlignment: Text.AlignHCenter
        }
        SheetButton {
            objectName: "alertButton"
            width: box.width - 48
            text: box.screen.alertButton
            isFilled: true
            onClicked: box.screen.closeAlert()
        }
    }
}

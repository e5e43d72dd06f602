import QtQuick
import QtQuick.Controls.Basic
import QtQuick.Templates as T
import Spectrel.Quick

// What the program says of itself.
Popup {
    id: box

    required property QuickScreen screen

    parent: T.Overlay.overlay
    anchors.centerIn: parent
    width: parent ? Math.min(parent.width - 48, 320) : 0
    modal: true
    focus: true
    padding: 0
    closePolicy: Popup.CloseOnEscape | Popup.CloseOnPressOutside

    enter: Transition {
        NumberAnimation { property: "opacity"; from: 0; to: 1; duration: Theme.fade }
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
        spacing: 6
        Accessible.role: Accessible.Dialog
        Accessible.name: name.text + " " + version.text + ". " + summary.text
        Keys.onReturnPressed: box.close()
        Keys.onEnterPressed: box.close()

        Icon {
            objectName: "aboutMark"
            anchors.horizontalCenter: parent.horizontalCenter
            width: 48
            height: 48
            shape: Icon.Mark
            color: Theme.accent
            Accessible.ignored: true
        }
        Text {
            id: name
            objectName: "aboutName"
            width: box.width - 48
            topPadding: 8
            text: box.screen.aboutName
            font.pixelSize: Theme.nameText
            font.bold: true
            color: Theme.text
            horizontalAlignment: Text.AlignHCenter
        }
        Text {
            id: version
            objectName: "aboutVersion"
            width: box.width - 48
            text: box.screen.aboutVersion
            font.pixelSize: Theme.messageText
            color: Theme.faint
            horizontalAlignment: Text.AlignHCenter
        }
        Text {
            id: summary
            width: box.width - 48
            topPadding: 6
            bottomPadding: 14
            text: box.screen.aboutSummary
            font.pixelSize: Theme.plainText
            color: Theme.text
            wrapMode: Text.Wrap
            horizontalAlignment: Text.AlignHCenter
        }
        SheetButton {
            objectName: "aboutClose"
            width: box.width - 48
            text: qsTr("Close")
            isFilled: true
            onClicked: box.close()
        }
    }
}

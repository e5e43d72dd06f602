import QtQuick
import QtQuick.Layouts
import Spectrel.Quick

// The toolbar of a pane: loading indicator, status, why there is no session, and where allowed the save button.
Rectangle {
    id: bar

    required property PaneModel pane

    implicitHeight: 56
    color: Theme.surface

    Rectangle {
        width: parent.width
        height: 1
        color: Theme.line
    }
    RowLayout {
        anchors.fill: parent
        anchors.leftMargin: 20
        anchors.rightMargin: 8
        spacing: 10

        Spinner {
            objectName: "spinner"
            running: bar.pane.isLoading
        }
        ColumnLayout {
            Layout.fillWidth: true
            spacing: 0

            Text {
                objectName: "status"
                Layout.fillWidth: true
                text: bar.pane.status
                textFormat: Text.PlainText
                font: Measures.statusFont
                color: Theme.text
                elide: Text.ElideRight
                Accessible.role: Accessible.StaticText
                Accessible.name: text
            }
            Text {
                objectName: "reason"
                Layout.fillWidth: true
                visible: text !== ""
                text: bar.pane.reason
                textFormat: Text.PlainText
                font.pixelSize: Theme.smallText
                color: Theme.warning
                elide: Text.ElideRight
                Accessible.role: Accessible.StaticText
                Accessible.name: text
            }
        }
        IconButton {
            objectName: "save"
            visible: bar.pane.canSave
            shape: Icon.Save
            text: qsTr("Save snapshot")
            onClicked: bar.pane.pressSaveButton()
        }
    }
}

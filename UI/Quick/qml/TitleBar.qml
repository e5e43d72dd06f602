import QtQuick
import QtQuick.Layouts
import Spectrel.Quick

// The back arrow, the pane's name and its path.
Item {
    id: bar

    required property PaneModel pane
    signal backPressed
    signal findPressed
    signal menuPressed

    implicitHeight: 60

    RowLayout {
        anchors.fill: parent
        anchors.leftMargin: bar.pane.isRoot ? 20 : 4
        anchors.rightMargin: 4
        spacing: bar.pane.isRoot ? 12 : 2

        IconButton {
            objectName: "back"
            visible: !bar.pane.isRoot
            shape: Icon.Back
            text: qsTr("Back")
            onClicked: bar.backPressed()
        }
        Icon {
            visible: bar.pane.isRoot
            implicitWidth: 26
            implicitHeight: 26
            shape: Icon.Mark
            color: Theme.accent
            Accessible.ignored: true
        }
        ColumnLayout {
            Layout.fillWidth: true
            spacing: 1

            Text {
                objectName: "title"
                Layout.fillWidth: true
                text: bar.pane.title
                textFormat: Text.PlainText
                font.pixelSize: bar.pane.isRoot ? Theme.rootTitle : Theme.titleText
                font.bold: true
                color: Theme.text
                elide: Text.ElideRight
                Accessible.role: Accessible.Heading
                Accessible.name: text
            }
            Text {
                objectName: "path"
                Layout.fillWidth: true
                visible: !bar.pane.isRoot
                text: bar.pane.path
                textFormat: Text.PlainText
                font.pixelSize: Theme.smallText
                color: Theme.faint
                elide: Text.ElideLeft
                Accessible.role: Accessible.StaticText
                Accessible.name: text
            }
        }
        IconButton {
            objectName: "findButton"
            shape: Icon.Search
            text: qsTr("Find")
            onClicked: bar.findPressed()
        }
        IconButton {
            objectName: "menuButton"
            shape: Icon.More
            text: qsTr("Menu")
            onClicked: bar.menuPressed()
        }
    }
}

import QtQuick
import QtQuick.Controls.Basic
import QtQuick.Layouts
import QtQuick.Templates as T
import Spectrel.Quick

// The search: a text, and the rows of this pane and below that hold it.
Popup {
    id: sheet

    required property FindModel find

    parent: T.Overlay.overlay
    width: parent ? Math.min(parent.width, Theme.columnWidth) : 0
    height: parent ? parent.height : 0
    x: parent ? (parent.width - width) / 2 : 0
    modal: true
    focus: true
    padding: 0
    closePolicy: Popup.NoAutoClose
    onClosed: field.clear()

    readonly property bool isWanted: find.isOpen
    onIsWantedChanged: {
        if (isWanted) {
            open();
            field.forceActiveFocus();
        } else {
            close();
        }
    }

    enter: Transition {
        NumberAnimation { property: "opacity"; from: 0; to: 1; duration: Theme.fade }
    }
    exit: Transition {
        NumberAnimation { property: "opacity"; to: 0; duration: Theme.fade }
    }
    T.Overlay.modal: Rectangle { color: Theme.shade }
    background: Rectangle { color: Theme.background }

    contentItem: FocusScope {
        focus: true
        Accessible.role: Accessible.Dialog
        Accessible.name: qsTr("Find")

        Keys.onPressed: event => {
            event.accepted = true;
            switch (event.key) {
            case Qt.Key_Up: return sheet.find.moveSelection(-1);
            case Qt.Key_Down: return sheet.find.moveSelection(1);
            case Qt.Key_PageUp: return sheet.find.moveSelection(-8);
            case Qt.Key_PageDown: return sheet.find.moveSelection(8);
            case Qt.Key_Return:
            case Qt.Key_Enter: return sheet.find.choose();
            case Qt.Key_Escape:
            case Qt.Key_Back: return sheet.find.close();
            }
            event.accepted = false;
        }

        RowLayout {
            id: top
            width: parent.width
            height: 64
            spacing: 0

            IconButton {
                objectName: "findBack"
                Layout.leftMargin: 4
                shape: Icon.Back
                text: qsTr("Back")
                onClicked: sheet.find.close()
            }
            LineField {
                id: field
                objectName: "findField"
                Layout.fillWidth: true
                focus: true
                placeholderText: qsTr("Name or value")
                inputMethodHints: Qt.ImhNoPredictiveText
                Accessible.name: qsTr("Find by name or value")
                onTypedChanged: {
                    if (sheet.find.isOpen)
                        sheet.find.edit(typed);
                }
            }
            IconButton {
                Layout.rightMargin: 4
                enabled: field.text !== ""
                shape: Icon.Clear
                color: Theme.faint
                size: 20
                text: qsTr("Clear")
                onClicked: {
                    field.clear();
                    field.forceActiveFocus();
                }
            }
        }
        Text {
            id: count
            objectName: "findCount"
            anchors.top: top.bottom
            x: 2 * Theme.margin + 4
            height: 28
            text: sheet.find.countText
            textFormat: Text.PlainText
            font.pixelSize: Theme.noteText
            font.bold: true
            color: Theme.faint
            verticalAlignment: Text.AlignVCenter
            Accessible.role: Accessible.StaticText
            Accessible.name: text
        }
        EdgeSwipe {
            z: 1
            height: parent.height
            onSwiped: sheet.find.close()
        }
        ListView {
            id: list
            objectName: "finds"
            anchors.top: count.bottom
            anchors.bottom: parent.bottom
            x: Theme.margin
            width: parent.width - 2 * Theme.margin
            clip: true
            model: sheet.find
            reuseItems: true
            currentIndex: sheet.find.selected
            highlightMoveDuration: 0
            footer: Item { height: Theme.margin }
            ScrollBar.vertical: ScrollBar { }
            Accessible.role: Accessible.List
            Accessible.name: count.text

            delegate: Item {
                id: entry

                required property int index
                required property string name
                required property string value
                required property bool isInner
                required property string panePath

                objectName: "find"
                width: ListView.view.width
                height: 60
                Accessible.role: Accessible.Button
                Accessible.name: name + ", " + value + ", " + panePath
                Accessible.onPressAction: sheet.find.tap(index)
                ListView.onPooled: visible = false
                ListView.onReused: visible = true

                Rectangle {
                    anchors.fill: parent
                    anchors.bottomMargin: 2
                    radius: 8
                    color: tap.pressed || entry.ListView.isCurrentItem ? Theme.pressed : Theme.surface
                }
                ColumnLayout {
                    anchors.fill: parent
                    anchors.leftMargin: 16
                    anchors.rightMargin: 16
                    anchors.bottomMargin: 2
                    spacing: 0

                    Item { Layout.fillHeight: true }
                    RowLayout {
                        spacing: 16

                        Text {
                            objectName: "findName"
                            Layout.fillWidth: true
                            text: entry.name
                            textFormat: Text.PlainText
                            font.pixelSize: Theme.plainText
                            font.bold: true
                            color: Theme.text
                            elide: Text.ElideRight
                            Accessible.ignored: true
                        }
                        Text {
                            visible: !entry.isInner
                            Layout.maximumWidth: entry.width / 2
                            text: entry.value
                            textFormat: Text.PlainText
                            font.pixelSize: Theme.plainText
                            color: Theme.value
                            elide: Text.ElideRight
                            Accessible.ignored: true
                        }
                        Icon {
                            visible: entry.isInner
                            implicitWidth: 15
                            implicitHeight: 15
                            shape: Icon.Disclosure
                            color: Theme.faint
                            Accessible.ignored: true
                        }
                    }
                    Text {
                        Layout.fillWidth: true
                        text: entry.panePath
                        textFormat: Text.PlainText
                        font.pixelSize: Theme.smallText
                        color: Theme.faint
                        elide: Text.ElideLeft
                        Accessible.ignored: true
                    }
                    Item { Layout.fillHeight: true }
                }
                TapHandler {
                    id: tap
                    onTapped: sheet.find.tap(entry.index)
                }
            }
        }
    }
}

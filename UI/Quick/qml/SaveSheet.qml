import QtQuick
import QtQuick.Controls.Basic
import QtQuick.Templates as T
import QtQuick.Layouts
import Spectrel.Quick

// The save screen: what will be saved, the description, Save and Cancel.
Popup {
    id: sheet

    property SaveModel save: null

    parent: T.Overlay.overlay
    width: parent ? Math.min(parent.width, 560) : 0
    height: parent ? parent.height - (parent.width > 560 ? 96 : 24) : 0
    x: parent ? (parent.width - width) / 2 : 0
    y: parent ? parent.height - height : 0
    modal: true
    focus: true
    padding: 0
    closePolicy: Popup.NoAutoClose
    onClosed: {
        const gone = save;
        save = null;
        gone?.didLeave();
    }

    enter: Transition {
        NumberAnimation {
            property: "y"
            from: sheet.parent.height
            to: sheet.parent.height - sheet.height
            duration: Theme.slide
            easing.type: Easing.OutCubic
        }
    }
    exit: Transition {
        NumberAnimation { property: "y"; to: sheet.parent.height; duration: Theme.slide; easing.type: Easing.InCubic }
    }
    T.Overlay.modal: Rectangle { color: Theme.shade }

    background: Rectangle {
        color: Theme.background
        radius: 2 * Theme.radius

        Rectangle {
            anchors.bottom: parent.bottom
            width: parent.width
            height: parent.radius
            color: parent.color
        }
    }

    contentItem: FocusScope {
        focus: true
        Accessible.role: Accessible.Dialog
        Accessible.name: qsTr("Save snapshot")
        Keys.onEscapePressed: sheet.save?.cancel()
        Keys.onBackPressed: sheet.save?.cancel()
        Keys.onPressed: event => {
            const key = KeyMap.nameOf(event.key, event.modifiers, event.text);
            event.accepted = KeyMap.actionOf(key) === KeyMap.Save;
            if (event.accepted)
                sheet.save?.save();
        }

        Item { id: nobody; focus: true } // has the focus while the description has not
        TapHandler {
            onTapped: sheet.save?.touchBackground()
        }

        RowLayout {
            id: buttons
            width: parent.width
            height: 64
            spacing: 0

            SheetButton {
                objectName: "cancelButton"
                Layout.leftMargin: 8
                text: qsTr("Cancel")
                onClicked: sheet.save?.cancel()
            }
            Text {
                Layout.fillWidth: true
                objectName: "saveTitle"
                text: qsTr("Save Snapshot")
                font.pixelSize: Theme.sheetTitle
                fontSizeMode: Text.HorizontalFit
                minimumPixelSize: Theme.smallText
                font.bold: true
                color: Theme.text
                elide: Text.ElideRight
                horizontalAlignment: Text.AlignHCenter
                Accessible.role: Accessible.Heading
                Accessible.name: text
            }
            SheetButton {
                objectName: "saveButton"
                Layout.rightMargin: 12
                text: qsTr("Save")
                isFilled: true
                onClicked: sheet.save?.save()
            }
        }
        Text {
            id: descriptionTitle
            anchors.top: buttons.bottom
            anchors.topMargin: 8
            x: 2 * Theme.margin + 4
            text: qsTr("Description")
            font.pixelSize: Theme.noteText
            font.bold: true
            color: Theme.faint
            Accessible.ignored: true
        }
        LineField {
            id: field
            objectName: "description"
            anchors.top: descriptionTitle.bottom
            anchors.topMargin: 6
            x: Theme.margin
            width: parent.width - 2 * Theme.margin
            placeholderText: qsTr("What is worth keeping here?")
            Accessible.name: descriptionTitle.text
            onTypedChanged: sheet.save?.edit(typed)
            onActiveFocusChanged: {
                if (activeFocus)
                    sheet.save?.beginEditing();
            }
            Keys.onReturnPressed: sheet.save?.pressReturn()
            Keys.onEnterPressed: sheet.save?.pressReturn()
        }
        Text {
            id: listTitle
            anchors.top: field.bottom
            anchors.topMargin: 20
            x: 2 * Theme.margin + 4
            text: qsTr("Will be saved")
            font.pixelSize: Theme.noteText
            font.bold: true
            color: Theme.faint
            visible: list.count > 0
            Accessible.ignored: true
        }
        ListView {
            id: list
            objectName: "saveRows"
            anchors.top: listTitle.bottom
            anchors.topMargin: 6
            x: Theme.margin
            width: parent.width - 2 * Theme.margin
            height: Math.max(0, Math.min(contentHeight, parent.height - y - Theme.margin))
            clip: true
            model: sheet.save
            boundsBehavior: Flickable.StopAtBounds
            interactive: contentHeight > height
            Accessible.role: Accessible.List
            Accessible.name: listTitle.text

            delegate: Item {
                id: entry

                required property int index
                required property string entryText
                required property bool isChecked

                objectName: "saveRow"
                width: ListView.view.width
                height: Theme.entryHeight
                Accessible.role: Accessible.ListItem
                Accessible.name: entryText
                Accessible.checkable: true
                Accessible.checked: isChecked

                Rectangle {
                    id: card
                    readonly property bool isFirst: entry.index === 0
                    readonly property bool isLast: entry.index === list.count - 1
                    anchors.fill: parent
                    radius: isFirst || isLast ? Theme.radius : 0
                    color: Theme.surface

                    Rectangle {
                        visible: parent.radius > 0 && !(card.isFirst && card.isLast)
                        width: parent.width
                        y: card.isFirst ? parent.height / 2 : 0
                        height: parent.height / 2
                        color: Theme.surface
                    }
                    Rectangle {
                        visible: !card.isLast
                        anchors.bottom: parent.bottom
                        x: 16
                        width: parent.width - 16
                        height: 1
                        color: Theme.line
                    }
                }
                Text {
                    objectName: "entryText"
                    anchors.left: parent.left
                    anchors.leftMargin: 16
                    anchors.right: mark.left
                    anchors.rightMargin: 8
                    anchors.verticalCenter: parent.verticalCenter
                    text: entry.entryText
                    textFormat: Text.PlainText
                    font: Measures.entryFont
                    color: Theme.text
                    elide: Text.ElideRight
                    Accessible.ignored: true
                }
                Icon {
                    id: mark
                    objectName: "checkmark"
                    anchors.right: parent.right
                    anchors.rightMargin: 16
                    anchors.verticalCenter: parent.verticalCenter
                    width: 18
                    height: 18
                    visible: entry.isChecked
                    shape: Icon.Checkmark
                    color: Theme.accent
                    Accessible.ignored: true
                }
                TapHandler {
                    onTapped: sheet.save?.tap(entry.index)
                }
            }
        }
    }

    Connections {
        target: sheet.save
        function onTextChanged() {
            if (!sheet.save.isEditing && field.activeFocus)
                nobody.forceActiveFocus();
        }
    }

    function present(model) {
        field.text = model.description;
        save = model;
        open();
        field.forceActiveFocus();
    }
}

import QtQuick
import QtQuick.Templates as T

// A short list of things to do. `actions` holds { text, name, run }.
T.Popup {
    id: menu

    property var actions: []

    width: 250
    height: implicitHeight
    implicitHeight: contentItem.implicitHeight + 16
    padding: 8
    margins: 8
    focus: true
    modal: true
    dim: false
    closePolicy: T.Popup.CloseOnEscape | T.Popup.CloseOnPressOutside

    enter: Transition {
        NumberAnimation { property: "opacity"; from: 0; to: 1; duration: Theme.fade }
    }
    exit: Transition {
        NumberAnimation { property: "opacity"; to: 0; duration: Theme.fade }
    }
    background: Rectangle {
        radius: Theme.radius
        color: Theme.raised
        border.width: 1
        border.color: Theme.line
    }
    contentItem: Column {
        Repeater {
            id: entries
            model: menu.actions

            T.AbstractButton {
                id: entry

                required property int index
                required property var modelData

                objectName: modelData.name
                width: parent.width
                height: Theme.touch
                text: modelData.text
                focus: index === 0
                Accessible.role: Accessible.MenuItem
                Accessible.name: text
                onClicked: {
                    menu.close();
                    modelData.run();
                }
                Keys.onReturnPressed: clicked()
                Keys.onEnterPressed: clicked()
                Keys.onUpPressed: nextItemInFocusChain(false).forceActiveFocus(Qt.BacktabFocusReason)
                Keys.onDownPressed: nextItemInFocusChain(true).forceActiveFocus(Qt.TabFocusReason)
                background: Rectangle {
                    radius: 8
                    color: entry.pressed || entry.hovered || entry.activeFocus ? Theme.pressed : "transparent"
                }
                contentItem: Text {
                    leftPadding: 12
                    rightPadding: 12
                    text: entry.text
                    textFormat: Text.PlainText
                    font.pixelSize: Theme.controlText
                    color: Theme.text
                    elide: Text.ElideMiddle
                    verticalAlignment: Text.AlignVCenter
                }
            }
        }
    }
}

import QtQuick
import Spectrel.Quick

// One row. Where its labels stand is the controller's arithmetic; a long value scrolls sideways within the row.
Item {
    id: row

    required property int index
    required property string name
    required property string value
    required property bool isInner
    required property rect nameFrame
    required property rect valueFrame
    required property real rowContentWidth
    required property real rowContentOffset
    required property PaneModel pane
    required property bool isLast
    property bool isCurrent: false // the keyboard is at this row

    readonly property bool isScrollable: !isInner && rowContentWidth > area.width
    readonly property bool isPressed: tapBeside.pressed || tapWithin.pressed

    signal tapped
    signal held(point at) // held down, or pressed with the right button

    objectName: "row"
    implicitHeight: Theme.rowHeight
    Accessible.role: isInner ? Accessible.Button : Accessible.ListItem
    Accessible.name: isInner ? name : name + ", " + value
    Accessible.focusable: true
    Accessible.onPressAction: row.tapped()

    // Rounded where the card begins and ends, straight between.
    Rectangle {
        id: card
        objectName: "card"
        readonly property color shown: row.isPressed || row.pane.selectedRow === row.index ? Theme.pressed : Theme.surface
        anchors.fill: parent
        radius: row.index === 0 || row.isLast ? Theme.radius : 0
        color: shown

        Rectangle {
            visible: parent.radius > 0 && !(row.index === 0 && row.isLast)
            anchors.left: parent.left
            anchors.right: parent.right
            y: row.index === 0 ? parent.height / 2 : 0
            height: parent.height / 2
            color: card.shown
        }
    }
    Rectangle {
        visible: !row.isLast
        anchors.bottom: parent.bottom
        anchors.left: parent.left
        anchors.leftMargin: Theme.edge - Theme.margin + 10
        anchors.right: parent.right
        height: 1
        color: Theme.line
    }
    TapHandler {
        id: tapBeside
        enabled: !row.isScrollable
        onTapped: row.tapped()
        onLongPressed: row.held(point.position)
    }
    TapHandler {
        acceptedDevices: PointerDevice.Mouse | PointerDevice.TouchPad
        acceptedButtons: Qt.RightButton
        onTapped: row.held(point.position)
    }

    Flickable {
        id: area
        objectName: "area"
        anchors.fill: parent
        anchors.leftMargin: Theme.edge - Theme.margin
        anchors.rightMargin: Theme.margin + 4
        contentWidth: row.rowContentWidth
        contentHeight: height
        flickableDirection: Flickable.HorizontalFlick
        boundsBehavior: Flickable.StopAtBounds
        interactive: row.isScrollable
        clip: row.isScrollable
        onContentXChanged: {
            if (contentX !== row.rowContentOffset && (moving || dragging))
                row.pane.didScrollSideways(row.index, contentX);
        }

        TapHandler {
            id: tapWithin
            enabled: row.isScrollable
            onTapped: row.tapped()
            onLongPressed: row.held(row.mapFromItem(area, point.position))
        }
        Text {
            // The name of an inner node makes room for the disclosure mark.
            readonly property real room: area.width - disclosure.width - x
            readonly property bool isTooLong: row.isInner && row.nameFrame.width > room
            objectName: "name"
            x: row.nameFrame.x
            y: row.nameFrame.y
            width: isTooLong ? room : row.nameFrame.width
            height: row.nameFrame.height
            elide: isTooLong ? Text.ElideRight : Text.ElideNone
            text: row.name
            textFormat: Text.PlainText
            font: Measures.nameFont
            color: Theme.text
            Accessible.ignored: true
        }
        Text {
            objectName: "value"
            visible: text !== ""
            x: row.valueFrame.x
            y: row.valueFrame.y
            width: row.valueFrame.width
            height: row.valueFrame.height
            text: row.value
            textFormat: Text.PlainText
            font: Measures.valueFont
            color: Theme.value
            Accessible.ignored: true
        }
    }
    // What goes on beyond the edge fades out.
    Rectangle {
        visible: row.isScrollable && !area.atXEnd
        anchors.right: area.right
        width: 28
        height: parent.height - 1
        gradient: Gradient {
            orientation: Gradient.Horizontal
            GradientStop { position: 0; color: Qt.rgba(card.shown.r, card.shown.g, card.shown.b, 0) }
            GradientStop { position: 1; color: card.shown }
        }
    }
    Rectangle {
        visible: row.isScrollable && !area.atXBeginning
        anchors.left: area.left
        width: 28
        height: parent.height - 1
        gradient: Gradient {
            orientation: Gradient.Horizontal
            GradientStop { position: 0; color: card.shown }
            GradientStop { position: 1; color: Qt.rgba(card.shown.r, card.shown.g, card.shown.b, 0) }
        }
    }
    Icon {
        id: disclosure
        objectName: "disclosure"
        visible: row.isInner
        anchors.right: parent.right
        anchors.rightMargin: Theme.margin
        anchors.verticalCenter: parent.verticalCenter
        width: 15
        height: 15
        shape: Icon.Disclosure
        color: Theme.faint
        Accessible.ignored: true
    }
    Rectangle {
        visible: row.isCurrent
        anchors.fill: parent
        anchors.margins: 2
        radius: Theme.radius - 2
        color: "transparent"
        border.width: 2
        border.color: Theme.accent
    }

    onRowContentOffsetChanged: takeOffset()
    // A row that waits to be used again is only out of the picture; a screen reader would still find it.
    ListView.onPooled: visible = false
    ListView.onReused: {
        visible = true;
        takeOffset();
    }

    function takeOffset() {
        if (!area.moving && area.contentX !== rowContentOffset)
            area.contentX = rowContentOffset;
    }
}

import QtQuick
import QtQuick.Controls.Basic
import Spectrel.Quick

// One pane: title bar, rows, toolbar.
FocusScope {
    id: page

    required property PaneModel pane
    required property QuickScreen screen
    property bool showsCursor: false // the keyboard is in use

    readonly property real rowHeight: 50
    readonly property real sidewaysStep: 80 // px

    Accessible.role: Accessible.Pane
    Accessible.name: pane.title
    Component.onDestruction: pane.didLeave()

    Rectangle {
        anchors.fill: parent
        color: Theme.background
    }
    TitleBar {
        id: titleBar
        width: parent.width
        pane: page.pane
        onBackPressed: page.screen.back()
    }
    ListView {
        id: list
        objectName: "rows"
        anchors.top: titleBar.bottom
        anchors.bottom: statusBar.top
        anchors.horizontalCenter: parent.horizontalCenter
        width: Math.min(parent.width, Theme.columnWidth) - 2 * Theme.margin
        focus: true
        clip: true
        model: page.pane
        reuseItems: true
        cacheBuffer: 0
        boundsBehavior: Flickable.DragOverBounds
        keyNavigationEnabled: false
        highlightFollowsCurrentItem: false
        header: Item { height: 4 }
        footer: Item { height: Theme.margin }
        ScrollBar.vertical: ScrollBar { }
        Accessible.role: Accessible.List
        Accessible.name: page.pane.title

        delegate: PaneRow {
            width: ListView.view.width
            pane: page.pane
            isLast: index === list.count - 1
            isCurrent: page.showsCursor && ListView.isCurrentItem
            onTapped: {
                page.showsCursor = false;
                list.currentIndex = index;
                page.pane.tap(index);
            }
        }

        onContentYChanged: tellVisibleRows()
        onHeightChanged: tellVisibleRows()
        onWidthChanged: tellVisibleRows()
        Component.onCompleted: tellVisibleRows()

        function tellVisibleRows() {
            const first = Math.max(0, Math.floor(contentY / page.rowHeight));
            const room = Math.ceil(height / page.rowHeight) + 1;
            page.pane.setVisibleRows(first, room, width - 1.5 * Theme.margin - 4);
        }
    }
    StatusBar {
        id: statusBar
        anchors.bottom: parent.bottom
        width: parent.width
        pane: page.pane
    }

    Keys.onPressed: event => {
        if (event.modifiers & (Qt.ControlModifier | Qt.AltModifier | Qt.MetaModifier))
            return;
        event.accepted = true;
        const perPage = Math.max(1, Math.floor(list.height / rowHeight) - 1);
        switch (event.key) {
        case Qt.Key_Up: return moveBy(-1);
        case Qt.Key_Down: return moveBy(1);
        case Qt.Key_PageUp: return moveBy(-perPage);
        case Qt.Key_PageDown: return moveBy(perPage);
        case Qt.Key_Home: return moveBy(-list.count);
        case Qt.Key_End: return moveBy(list.count);
        case Qt.Key_Return:
        case Qt.Key_Enter:
        case Qt.Key_Space: return open();
        case Qt.Key_Right:
            if (list.currentItem?.isInner)
                open();
            else
                pane.scrollSideways(list.currentIndex, sidewaysStep);
            return;
        case Qt.Key_Left:
            if (!pane.scrollSideways(list.currentIndex, -sidewaysStep))
                screen.back();
            return;
        case Qt.Key_Backspace:
        case Qt.Key_Escape:
        case Qt.Key_Back: return screen.back();
        }
        event.accepted = false;
    }

    // The first key only shows where the keyboard is.
    function moveBy(rows) {
        if (showsCursor)
            list.currentIndex = Math.max(0, Math.min(list.count - 1, list.currentIndex + rows));
        showsCursor = true;
        list.positionViewAtIndex(list.currentIndex, ListView.Contain);
    }

    function open() {
        showsCursor = true;
        pane.tap(list.currentIndex);
    }
}

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
    readonly property real gapAbove: 4 // the first row
    readonly property real sidewaysStep: 80 // px

    Accessible.role: Accessible.Pane
    Accessible.name: pane.title
    Component.onCompleted: showRow(pane.takeRowToShow())
    Component.onDestruction: pane.didLeave()

    signal aboutPressed

    Rectangle {
        anchors.fill: parent
        color: Theme.background
    }
    TitleBar {
        id: titleBar
        width: parent.width
        pane: page.pane
        onBackPressed: page.pane.goBack()
        onFindPressed: page.screen.find.open()
        onMenuPressed: page.openMenu()
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
        header: Item { height: page.gapAbove }
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
            onHeld: at => {
                list.currentIndex = index;
                page.openRowMenu(this, at);
            }
        }

        onContentYChanged: tellVisibleRows()
        onOriginYChanged: tellVisibleRows()
        onHeightChanged: tellVisibleRows()
        onWidthChanged: tellVisibleRows()
        Component.onCompleted: tellVisibleRows()

        function tellVisibleRows() {
            // The list moves its origin rather than the rows in sight when rows come or go above them.
            const top = contentY - originY - page.gapAbove;
            const first = Math.max(0, Math.floor(top / page.rowHeight));
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

    EdgeSwipe {
        height: parent.height
        enabled: !page.pane.isRoot
        onSwiped: page.pane.goBack()
    }

    ActionMenu { id: menu }
    Connections {
        target: page.pane
        function onRowToShowChanged() {
            page.showRow(page.pane.takeRowToShow());
        }
    }

    Keys.onPressed: event => {
        if (event.matches(StandardKey.Copy)) {
            event.accepted = true;
            return copy();
        }
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
        case Qt.Key_Enter: return open();
        case Qt.Key_Space: return screen.playback.isThere ? screen.playback.togglePlaying() : open();
        case Qt.Key_Right:
            if (list.currentItem?.isInner)
                open();
            else
                pane.scrollSideways(list.currentIndex, sidewaysStep);
            return;
        case Qt.Key_Left:
            if (!pane.scrollSideways(list.currentIndex, -sidewaysStep))
                pane.goBack();
            return;
        case Qt.Key_Backspace:
        case Qt.Key_Escape:
        case Qt.Key_Back: return pane.goBack();
        }
        event.accepted = screen.playback.isThere && playbackKey(event.text);
    }

    // The same keys as in the terminal.
    function playbackKey(text) {
        const playback = screen.playback;
        switch (text) {
        case ".": playback.stepMessage(1); return true;
        case ",": playback.stepMessage(-1); return true;
        case "]": playback.stepTick(1); return true;
        case "[": playback.stepTick(-1); return true;
        case ">": playback.seekStep(1); return true;
        case "<": playback.seekStep(-1); return true;
        case "+":
        case "=": playback.changeSpeed(1); return true;
        case "-": playback.changeSpeed(-1); return true;
        case "$": playback.seekToFraction(1); return true;
        }
        if (text < "0" || text > "9")
            return false;
        playback.seekToFraction(parseInt(text) / 10);
        return true;
    }

    // The first key only shows where the keyboard is.
    function moveBy(rows) {
        if (showsCursor)
            list.currentIndex = Math.max(0, Math.min(list.count - 1, list.currentIndex + rows));
        showsCursor = true;
        list.positionViewAtIndex(list.currentIndex, ListView.Contain);
    }

    function showRow(row) {
        if (row < 0)
            return;
        showsCursor = true;
        list.currentIndex = row;
        list.positionViewAtIndex(row, ListView.Contain);
    }

    // The row where the keyboard is; the whole pane where it is not in use.
    function copy() {
        if (showsCursor)
            screen.copyRow(list.currentIndex);
        else
            screen.copyPane();
    }

    function rowActions(row, name) {
        return [{ name: "copyRow", text: qsTr("Copy \u201c%1\u201d").arg(name), run: () => screen.copyRow(row) },
                { name: "copyPane", text: qsTr("Copy whole pane"), run: () => screen.copyPane() }];
    }

    function openMenu() {
        const current = showsCursor ? list.currentItem as PaneRow : null;
        const copying = current ? rowActions(current.index, current.name) : rowActions(-1, "").slice(1);
        menu.actions = [{ name: "find", text: qsTr("Find\u2026"), run: () => screen.find.open() }, ...copying,
                        { name: "about", text: qsTr("About Spectrel"), run: () => aboutPressed() }];
        menu.x = width - menu.width - 8;
        menu.y = titleBar.height - 8;
        menu.open();
    }

    function openRowMenu(row, at) {
        const place = row.mapToItem(page, at.x, at.y);
        menu.actions = rowActions(row.index, row.name);
        menu.x = Math.min(place.x, width - menu.width - 8);
        menu.y = Math.min(place.y, height - menu.implicitHeight - 8);
        menu.open();
    }

    function open() {
        showsCursor = true;
        pane.tap(list.currentIndex);
    }
}

import QtQuick
import QtQuick.Controls.Basic
import Spectrel.Quick

// One pane: title bar, rows, toolbar.
FocusScope {
    id: page

    required property PaneModel pane
    required property QuickScreen screen
    property bool showsCursor: false // the keyboard is in use

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

        onContentYChanged: showVisibleRows()
        onOriginYChanged: showVisibleRows()
        onHeightChanged: showVisibleRows()
        onWidthChanged: showVisibleRows()
        Component.onCompleted: showVisibleRows()

        function showVisibleRows() {
            // The list moves its origin rather than the rows in sight when rows come or go above them.
            const top = contentY - originY - page.gapAbove;
            const first = Math.max(0, Math.floor(top / Theme.rowHeight));
            const room = Math.ceil(height / Theme.rowHeight) + 1;
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
        const key = KeyMap.nameOf(event.key, event.modifiers, event.text);
        event.accepted = screen.playback.press(key) || perform(KeyMap.actionOf(key));
    }

    // False when the page does nothing at it.
    function perform(action) {
        const perPage = Math.max(1, Math.floor(list.height / Theme.rowHeight) - 1);
        switch (action) {
        case KeyMap.RowUp: moveBy(-1); break;
        case KeyMap.RowDown: moveBy(1); break;
        case KeyMap.PageUp: moveBy(-perPage); break;
        case KeyMap.PageDown: moveBy(perPage); break;
        case KeyMap.FirstRow: moveBy(-list.count); break;
        case KeyMap.LastRow: moveBy(list.count); break;
        case KeyMap.Open: open(); break;
        case KeyMap.Forward:
            if (list.currentItem?.isInner)
                open();
            else
                pane.scrollSideways(list.currentIndex, sidewaysStep);
            break;
        case KeyMap.Backward:
            if (!pane.scrollSideways(list.currentIndex, -sidewaysStep))
                pane.goBack();
            break;
        case KeyMap.Back: pane.goBack(); break;
        case KeyMap.Copy: copy(); break;
        default: return false;
        }
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

pragma Singleton
import QtQuick
import Spectrel.Quick

// Colours and measures of every screen, light and dark.
QtObject {
    property bool isDark: false

    readonly property color background: isDark ? "#0f1217" : "#f1f3f7"
    readonly property color surface: isDark ? "#1a1f27" : "#ffffff"
    readonly property color raised: isDark ? "#242b35" : "#ffffff"
    readonly property color pressed: isDark ? "#27303c" : "#e4ecf7"
    readonly property color line: isDark ? "#2c343f" : "#e3e7ee"
    readonly property color text: isDark ? "#edf1f6" : "#131a23"
    readonly property color value: isDark ? "#bfd3ea" : "#2b4a6f"
    readonly property color faint: isDark ? "#94a1b1" : "#5c6a7a"
    readonly property color accent: isDark ? "#62b2ff" : "#0b63c5"
    readonly property color accentText: isDark ? "#06192c" : "#ffffff"
    readonly property color warning: isDark ? "#ffb3a6" : "#a5321f"
    readonly property color shade: isDark ? "#a0000000" : "#66101820"

    readonly property real touch: 48 // px, the least height and width of what a thumb presses
    readonly property real margin: 12
    readonly property real edge: 1.5 * margin // px, from the left edge to what scrolls sideways
    readonly property real radius: 12
    readonly property real columnWidth: 760 // px, the widest that a column of rows gets

    readonly property real rowHeight: Measures.rowHeight // px, of a pane
    readonly property real entryHeight: Measures.entryHeight // px, of the save screen

    // Text heights, px. The fonts of rows, status and entries are the controllers' (Measures).
    readonly property int smallText: 12 // below a line of its own
    readonly property int noteText: 13 // over a list, and the time line
    readonly property int messageText: 14
    readonly property int plainText: 15
    readonly property int controlText: 16 // what is pressed or filled in
    readonly property int sheetTitle: 17
    readonly property int titleText: 18
    readonly property int nameText: 20 // the program's
    readonly property int rootTitle: 22

    readonly property int slide: 260 // ms
    readonly property int fade: 140
}

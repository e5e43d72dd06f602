import QtQuick
import QtQuick.Controls.Basic
import Spectrel.Quick

// A line of text to fill in, with the same looks everywhere.
TextField {
    id: field

    implicitHeight: Theme.touch
    leftPadding: 16
    rightPadding: 16
    font.pixelSize: Theme.controlText
    color: Theme.text
    selectionColor: Theme.accent
    selectedTextColor: Theme.accentText
    placeholderTextColor: Theme.faint
    Accessible.role: Accessible.EditableText

    // What an input method still composes was typed, too.
    readonly property string typed: text.slice(0, cursorPosition) + preeditText + text.slice(cursorPosition)

    background: Rectangle {
        radius: Theme.radius
        color: Theme.surface
        border.width: field.activeFocus ? 2 : 1
        border.color: field.activeFocus ? Theme.accent : Theme.line
    }
}

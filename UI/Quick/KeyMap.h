#pragma once

#include "UI/KeyTable.h"

#include <QObject>
#include <QString>
#include <QStringList>
#include <QtQml/qqmlregistration.h>

namespace spectrel {

/// The window's part of the key table, for the QML.
class KeyMap final : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_SINGLETON

public:
    /// What the QML itself does at a key. -1 stands for no action.
    enum Action {
        RowUp = int(KeyAction::RowUp),
        RowDown = int(KeyAction::RowDown),
        PageUp = int(KeyAction::PageUp),
        PageDown = int(KeyAction::PageDown),
        FirstRow = int(KeyAction::FirstRow),
        LastRow = int(KeyAction::LastRow),
        Open = int(KeyAction::Open),
        Forward = int(KeyAction::Forward),
        Back = int(KeyAction::Back),
        Backward = int(KeyAction::Backward),
        Find = int(KeyAction::Find),
        FindNext = int(KeyAction::FindNext),
        FindPrevious = int(KeyAction::FindPrevious),
        Copy = int(KeyAction::Copy),
        Save = int(KeyAction::Save),
        Quit = int(KeyAction::Quit),
    };
    Q_ENUM(Action)

    /// The key table's name of a key that was pressed: its character, or the toolkit's name with what is held down
    /// beside it. Shift alone names no other key.
    Q_INVOKABLE static QString nameOf(int key, int modifiers, const QString& text);
    /// What the key does on a pane; -1 when nothing.
    Q_INVOKABLE static int actionOf(const QString& key);
    /// The keys of the action, as a Shortcut takes them.
    Q_INVOKABLE static QStringList sequences(int action);
};

} // namespace spectrel

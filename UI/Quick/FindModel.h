#pragma once

#include <QAbstractListModel>
#include <QString>
#include <QtQml/qqmlregistration.h>

namespace spectrel {

class FindController;
class ScreenToolkit;

/// The search in the tree as the QML sees it: the rows found as a list model.
class FindModel final : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("the search comes from the screen")
    Q_PROPERTY(bool isOpen READ isOpen NOTIFY changed)
    Q_PROPERTY(QString countText READ countText NOTIFY changed)
    Q_PROPERTY(int selected READ selected NOTIFY changed)

public:
    enum Role { NameRole = Qt::UserRole, ValueRole, IsInnerRole, PanePathRole };

    /// `toolkit` knows the application and outlives this.
    explicit FindModel(const ScreenToolkit& toolkit);

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

    bool isOpen() const;
    QString countText() const;
    /// -1: nothing is found.
    int selected() const;

    Q_INVOKABLE void open();
    Q_INVOKABLE void close();
    Q_INVOKABLE void edit(const QString& text);
    Q_INVOKABLE void moveSelection(int by);
    /// Opens the selected row's pane.
    Q_INVOKABLE void choose();
    Q_INVOKABLE void tap(int index);
    Q_INVOKABLE void chooseNext();
    Q_INVOKABLE void choosePrevious();

    void findsDidChange();

signals:
    void changed();

private:
    FindController* controller() const;

    const ScreenToolkit& _toolkit;
    int _count = 0; // finds that the QML knows
};

} // namespace spectrel

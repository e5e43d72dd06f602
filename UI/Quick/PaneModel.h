#pragma once

#include "UI/SpectrelPaneController.h"

#include <QAbstractListModel>
#include <QRectF>
#include <QString>
#include <QtQml/qqmlregistration.h>
#include <memory>

namespace spectrel {

/// One pane as the QML sees it: the rows of its table as a list model, its title and its toolbar as properties.
///
/// It draws on the controller and hands taps back. A reload changes rows in place; only rows that came or went are
/// inserted and removed, so that the list keeps its place. It keeps its pane until the page has left the screen.
class PaneModel final : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("panes come from the screen")
    Q_PROPERTY(QString title READ title NOTIFY titleChanged)
    Q_PROPERTY(QString path READ path CONSTANT)
    Q_PROPERTY(bool isRoot READ isRoot CONSTANT)
    Q_PROPERTY(bool isLoading READ isLoading NOTIFY toolbarChanged)
    Q_PROPERTY(QString status READ status NOTIFY toolbarChanged)
    Q_PROPERTY(QString reason READ reason NOTIFY toolbarChanged)
    Q_PROPERTY(bool canSave READ canSave NOTIFY toolbarChanged)
    Q_PROPERTY(int selectedRow READ selectedRow NOTIFY selectedRowChanged)

public:
    enum Role {
        NameRole = Qt::UserRole,
        ValueRole, // empty where the row has no value label
        IsInnerRole, // has the disclosure indicator
        NameFrameRole, // within the row's content
        ValueFrameRole,
        ContentWidthRole, // of the scrollable area
        ContentOffsetRole,
    };

    PaneModel(std::shared_ptr<SpectrelPaneController> pane, bool isRoot, QObject* parent);

    const std::shared_ptr<SpectrelPaneController>& pane() const
    {
        return _pane;
    }

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

    QString title() const;
    QString path() const;
    bool isRoot() const
    {
        return _isRoot;
    }
    bool isLoading() const;
    QString status() const;
    /// Why there is no session; empty where nothing is known.
    QString reason() const;
    bool canSave() const;
    /// -1: none.
    int selectedRow() const
    {
        return _selectedRow;
    }

    /// The room that the screen has: `count` rows from row `first`, each with a content `width` pt wide.
    Q_INVOKABLE void setVisibleRows(int first, int count, double width);
    /// A finger, or the Return key, on the row.
    Q_INVOKABLE void tap(int row);
    /// The back arrow, or what stands for it: closes the pane; nothing while it is not the one in sight.
    Q_INVOKABLE void goBack();
    /// The finger has moved the row's content to this offset.
    Q_INVOKABLE void didScrollSideways(int row, double offset);
    /// Moves the row's content; false when it stayed where it was.
    Q_INVOKABLE bool scrollSideways(int row, double by);
    Q_INVOKABLE void pressSaveButton();
    /// The row that was found and is still to be brought into sight; -1 when there is none. Asked once.
    Q_INVOKABLE int takeRowToShow();
    /// The page has left the screen for good.
    Q_INVOKABLE void didLeave();

    void titleDidChange();
    void toolbarDidChange();
    void rowsDidChange();

signals:
    void titleChanged();
    void toolbarChanged();
    void selectedRowChanged();
    void rowToShowChanged();

private:
    bool isTop() const;
    QVariant cellData(const SpectrelCell& cell, int role) const;
    QVariant nodeData(std::size_t row, int role) const;
    void emitChanged(int first, int end);
    void adoptNode();
    void adoptSelection();

    std::shared_ptr<SpectrelPaneController> _pane;
    bool _isRoot;
    NodeRef _node; // whose children the QML knows
    int _count = 0; // rows that the QML knows
    int _selectedRow = -1;
    int _firstVisible = 0;
    int _endVisible = 0;
};

} // namespace spectrel

#pragma once

#include <QAbstractListModel>
#include <QString>
#include <QtQml/qqmlregistration.h>
#include <vector>

namespace spectrel {

class SpectrelSaveViewController;

/// The save screen as the QML sees it: its list, the description and the buttons.
///
/// The controller goes as soon as the screen is closed; this stays until the screen has slid away, and does nothing.
class SaveModel final : public QAbstractListModel {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("the save screen comes from the screen")
    Q_PROPERTY(QString description READ description NOTIFY textChanged)
    Q_PROPERTY(bool isEditing READ isEditing NOTIFY textChanged)

public:
    enum Role { TextRole = Qt::UserRole, IsCheckedRole };

    SaveModel(SpectrelSaveViewController& controller, QObject* parent);

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

    QString description() const
    {
        return _description;
    }
    /// The description has the input focus.
    bool isEditing() const
    {
        return _isEditing;
    }

    Q_INVOKABLE void save();
    Q_INVOKABLE void cancel();
    Q_INVOKABLE void touchBackground();
    Q_INVOKABLE void tap(int row);
    Q_INVOKABLE void pressReturn();
    Q_INVOKABLE void beginEditing();
    Q_INVOKABLE void edit(const QString& text);
    /// The screen has slid away.
    Q_INVOKABLE void didLeave();

    void textDidChange();
    bool shows(const SpectrelSaveViewController* controller) const
    {
        return _controller == controller;
    }
    /// The controller is gone.
    void controllerDidClose()
    {
        _controller = nullptr;
    }

signals:
    void textChanged();

private:
    struct Row {
        QString text;
        bool isChecked;
    };

    SpectrelSaveViewController* _controller;
    std::vector<Row> _rows;
    QString _description;
    bool _isEditing = false;
};

} // namespace spectrel

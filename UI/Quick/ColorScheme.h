#pragma once

#include <QObject>
#include <QtDBus/QDBusConnection>
#include <QtDBus/QDBusMessage>

namespace spectrel {

/// Whether the desktop is light or dark: what its settings portal says, or, where there is none or it has no
/// preference, whether the palette's window is darker than its text. Follows both.
class ColorScheme final : public QObject {
    Q_OBJECT

public:
    /// `bus` is where the portal is met.
    explicit ColorScheme(QDBusConnection bus = QDBusConnection::sessionBus());

    bool isDark() const;
    bool eventFilter(QObject* watched, QEvent* event) override;

signals:
    void changed();

private slots:
    void settingDidChange(const QDBusMessage& signal);

private:
    enum class Preference { None, Dark, Light }; // the portal's numbers
    void setPreference(uint number);

    Preference _preference = Preference::None;
};

} // namespace spectrel

#include "Platform/Qt/QtPreferences.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QFileInfo>
#include <QSettings>

#include <utility>

namespace spectrel {

namespace {

constexpr int FlushTimeout = 500; // milliseconds for the bus to have taken the signal

QString text(std::string_view utf8)
{
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

/// Asked before the bus is touched: the library would start a bus of its own where there is none.
bool hasSessionBus()
{
    if (!qEnvironmentVariableIsEmpty("DBUS_SESSION_BUS_ADDRESS"))
        return true;
    const QString runtime = qEnvironmentVariable("XDG_RUNTIME_DIR");
    return !runtime.isEmpty() && QFileInfo::exists(runtime + "/bus");
}

} // namespace

QtPreferences::QtPreferences(std::string directory)
    : _directory(std::move(directory))
{
}

QtPreferences::~QtPreferences() = default;

QSettings* QtPreferences::settings(std::string_view domain)
{
    if (domain.empty() || domain.front() == '.' || domain.find('/') != std::string_view::npos)
        return nullptr;
    auto found = _settings.find(domain);
    if (found == _settings.end()) {
        const QString path = text(_directory) + '/' + text(domain) + ".conf";
        found = _settings.emplace(domain, std::make_unique<QSettings>(path, QSettings::IniFormat)).first;
    }
    return found->second.get();
}

void QtPreferences::setBoolean(std::string_view domain, std::string_view key, bool value)
{
    if (QSettings* const file = settings(domain))
        file->setValue(text(key), value);
}

bool QtPreferences::synchronize(std::string_view domain)
{
    QSettings* const file = settings(domain);
    if (!file)
        return false;
    file->sync();
    return file->status() == QSettings::NoError;
}

void QtPreferences::postChanged(std::string_view domain, std::string_view key)
{
    if (!hasSessionBus())
        return;
    const QString name = "spectrel-preferences";
    QDBusConnection bus = QDBusConnection::connectToBus(QDBusConnection::SessionBus, name);
    if (bus.isConnected()) {
        QDBusMessage changed =
            QDBusMessage::createSignal("/org/spectrel/Preferences", "org.spectrel.Preferences", "Changed");
        changed << text(domain) << text(key);
        bus.send(changed);
        // The program may end right away: an answered call shows that the signal before it has left.
        bus.call(QDBusMessage::createMethodCall(
                     "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus.Peer", "Ping"),
            QDBus::Block, FlushTimeout);
    }
    QDBusConnection::disconnectFromBus(name);
}

} // namespace spectrel

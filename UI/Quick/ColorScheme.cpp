#include "UI/Quick/ColorScheme.h"

#include <QEvent>
#include <QGuiApplication>
#include <QPalette>
#include <QtDBus/QDBusVariant>

#include <utility>

namespace spectrel {

namespace {

constexpr auto Service = "org.freedesktop.portal.Desktop";
constexpr auto Path = "/org/freedesktop/portal/desktop";
constexpr auto Interface = "org.freedesktop.portal.Settings";
constexpr auto Group = "org.freedesktop.appearance";
constexpr auto Key = "color-scheme";
constexpr int Patience = 150; // ms: the first picture waits for the answer, so that it does not flash

/// A portal wraps the value once more in the answer to "Read".
QVariant unwrapped(QVariant value)
{
    while (value.canConvert<QDBusVariant>())
        value = value.value<QDBusVariant>().variant();
    return value;
}

} // namespace

ColorScheme::ColorScheme(QDBusConnection bus)
{
    QGuiApplication::instance()->installEventFilter(this);
    if (!bus.isConnected())
        return;
    bus.connect(Service, Path, Interface, "SettingChanged", this, SLOT(settingDidChange(QDBusMessage)));
    QDBusMessage question = QDBusMessage::createMethodCall(Service, Path, Interface, "Read");
    question << Group << Key;
    const QDBusMessage answer = bus.call(question, QDBus::Block, Patience);
    if (answer.type() == QDBusMessage::ReplyMessage && !answer.arguments().isEmpty())
        setPreference(unwrapped(answer.arguments().constFirst()).toUInt());
}

bool ColorScheme::isDark() const
{
    if (_preference != Preference::None)
        return _preference == Preference::Dark;
    const QPalette palette = QGuiApplication::palette();
    return palette.color(QPalette::Window).lightness() < palette.color(QPalette::WindowText).lightness();
}

bool ColorScheme::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::ApplicationPaletteChange && watched == QGuiApplication::instance())
        emit changed();
    return false;
}

void ColorScheme::settingDidChange(const QDBusMessage& signal)
{
    const QVariantList arguments = signal.arguments(); // group, key, value
    if (arguments.size() == 3 && arguments[0].toString() == Group && arguments[1].toString() == Key)
        setPreference(unwrapped(arguments[2]).toUInt());
}

void ColorScheme::setPreference(uint number)
{
    const Preference preference = number == 1 ? Preference::Dark : number == 2 ? Preference::Light : Preference::None;
    if (std::exchange(_preference, preference) != preference)
        emit changed();
}

} // namespace spectrel

#include "UI/Quick/ColorScheme.h"

#include "Tests/Fakes/PrivateBus.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/UI/Quick/QuickFixture.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVariant>
#include <QDBusVirtualObject>
#include <QGuiApplication>
#include <QPalette>
#include <QSignalSpy>
#include <QTest>
#include <QThread>

namespace spectrel {
namespace {

constexpr auto PortalConnection = "portal";

/// The settings portal, which knows one setting. It answers from a thread of its own, as another process would.
class Portal final : public QDBusVirtualObject {
public:
    Portal(const std::string& address, uint scheme)
        : _scheme(scheme)
    {
        moveToThread(&_thread);
        _thread.start();
        QDBusConnection bus = QDBusConnection::connectToBus(QString::fromStdString(address), PortalConnection);
        EXPECT_TRUE(bus.registerVirtualObject("/org/freedesktop/portal/desktop", this));
        EXPECT_TRUE(bus.registerService("org.freedesktop.portal.Desktop"));
    }
    ~Portal() override
    {
        _thread.quit();
        _thread.wait();
        QDBusConnection::disconnectFromBus(PortalConnection);
    }
    /// Reports that a setting has another value now.
    static void tellChange(const QString& key, uint value)
    {
        QDBusMessage signal = QDBusMessage::createSignal(
            "/org/freedesktop/portal/desktop", "org.freedesktop.portal.Settings", "SettingChanged");
        signal << "org.freedesktop.appearance" << key << QVariant::fromValue(QDBusVariant(value));
        EXPECT_TRUE(QDBusConnection(PortalConnection).send(signal));
    }
    QString introspect(const QString&) const override
    {
        return {};
    }
    bool handleMessage(const QDBusMessage& question, const QDBusConnection& bus) override
    {
        const QVariant value = QVariant::fromValue(QDBusVariant(_scheme));
        return question.member() == "Read" && bus.send(question.createReply(QVariant::fromValue(QDBusVariant(value))));
    }

private:
    QThread _thread;
    uint _scheme;
};

class ColorSchemeTest : public QuickFixture {
protected:
    ~ColorSchemeTest() override
    {
        QGuiApplication::setPalette(QPalette());
        QDBusConnection::disconnectFromBus("desktop");
    }
    void startBus()
    {
        bus = std::make_unique<PrivateBus>(folder.path().string());
    }
    QDBusConnection desktop() const
    {
        return QDBusConnection::connectToBus(
            bus ? QString::fromStdString(bus->address()) : "unix:path=/nowhere", "desktop");
    }
    static void setPalette(Qt::GlobalColor window, Qt::GlobalColor text)
    {
        QPalette palette;
        palette.setColor(QPalette::Window, window);
        palette.setColor(QPalette::WindowText, text);
        QGuiApplication::setPalette(palette);
    }

    ScratchFolder folder;
    std::unique_ptr<PrivateBus> bus;
};

TEST_F(ColorSchemeTest, WithoutAPortalThePaletteTells)
{
    ColorScheme colors(desktop());
    QSignalSpy changes(&colors, &ColorScheme::changed);
    setPalette(Qt::white, Qt::black);
    EXPECT_FALSE(colors.isDark());
    setPalette(Qt::black, Qt::white);
    EXPECT_TRUE(waitFor([&changes] { return changes.count() > 0; }));
    EXPECT_TRUE(colors.isDark());
}

TEST_F(ColorSchemeTest, PortalOverrulesThePalette)
{
    startBus();
    const Portal portal(bus->address(), 1);
    setPalette(Qt::white, Qt::black);
    const ColorScheme colors(desktop());
    EXPECT_TRUE(colors.isDark());
}

TEST_F(ColorSchemeTest, FollowsThePortal)
{
    startBus();
    const Portal portal(bus->address(), 1);
    setPalette(Qt::white, Qt::black);
    const ColorScheme colors(desktop());
    QSignalSpy changes(&colors, &ColorScheme::changed);
    Portal::tellChange("accent-color", 2);
    Portal::tellChange("color-scheme", 2);
    EXPECT_TRUE(waitFor([&colors] { return !colors.isDark(); }));
    Portal::tellChange("color-scheme", 1);
    EXPECT_TRUE(waitFor([&colors] { return colors.isDark(); }));
    EXPECT_EQ(changes.count(), 2);
}

TEST_F(ColorSchemeTest, BusWithoutAPortalLeavesItToThePalette)
{
    startBus();
    setPalette(Qt::black, Qt::white);
    EXPECT_TRUE(ColorScheme(desktop()).isDark());
}

} // namespace
} // namespace spectrel

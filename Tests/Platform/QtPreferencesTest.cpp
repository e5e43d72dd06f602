#include "Platform/Qt/QtPreferences.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Tests/Fakes/PrivateBus.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QObject>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <string>

namespace spectrel {
namespace {

class QtPreferencesTest : public testing::Test {
protected:
    QtPreferencesTest()
    {
        ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
        ::setenv("XDG_RUNTIME_DIR", folder.path().string().c_str(), 1);
    }
    std::string content(const std::string& domain) const
    {
        std::ifstream file(folder.path().string() + "/" + domain + ".conf");
        return {std::istreambuf_iterator<char>(file), {}};
    }

    /// The same bus whenever the test is repeated: a process remembers the first session bus that it was given.
    static const std::string& sessionBus()
    {
        static const ScratchFolder place;
        static const PrivateBus bus(place.path().string());
        return bus.address();
    }

    ScratchFolder folder;
    QtPreferences preferences {folder.path().string()};
};

TEST_F(QtPreferencesTest, ValueIsInTheDomainsFileAfterSynchronizing)
{
    preferences.setBoolean("org.spectrel.Home", "THShowGSMRSSI", false);
    EXPECT_TRUE(preferences.synchronize("org.spectrel.Home"));
    EXPECT_EQ(content("org.spectrel.Home"), "[General]\nTHShowGSMRSSI=false\n");
}

TEST_F(QtPreferencesTest, OtherKeysOfTheFileStay)
{
    std::ofstream(folder.path().string() + "/app.conf") << "[General]\nOther=7\n";
    preferences.setBoolean("app", "Mine", true);
    EXPECT_TRUE(preferences.synchronize("app"));
    EXPECT_EQ(content("app"), "[General]\nMine=true\nOther=7\n");
}

TEST_F(QtPreferencesTest, FileThatCannotBeWrittenIsReported)
{
    QtPreferences nowhere("/proc/nowhere");
    nowhere.setBoolean("app", "key", true);
    EXPECT_FALSE(nowhere.synchronize("app"));
}

TEST_F(QtPreferencesTest, DomainThatIsNoFileNameIsRefused)
{
    preferences.setBoolean("../app", "key", true);
    EXPECT_FALSE(preferences.synchronize("../app"));
    EXPECT_FALSE(preferences.synchronize(""));
}

TEST_F(QtPreferencesTest, WithoutASessionBusNobodyIsTold)
{
    QtRunLoop loop;
    preferences.postChanged("app", "key");
    EXPECT_FALSE(QDBusConnection("spectrel-preferences").isConnected());
}

TEST_F(QtPreferencesTest, ChangeIsAnnouncedOnTheSessionBus)
{
    QtRunLoop loop;
    ASSERT_FALSE(sessionBus().empty());
    ::setenv("DBUS_SESSION_BUS_ADDRESS", sessionBus().c_str(), 1);
    const std::string command = "timeout 120 dbus-monitor --address " + sessionBus()
        + " \"type='signal',interface='org.spectrel.Preferences'\" & echo $!; wait";
    std::FILE* const monitor = ::popen(("exec 2>&1; " + command).c_str(), "r");
    char line[512] = "";
    ASSERT_TRUE(std::fgets(line, sizeof line, monitor));
    const pid_t process = std::atoi(line);
    // The monitor writes about its own coming on the bus first: from then on it listens.
    ASSERT_TRUE(std::fgets(line, sizeof line, monitor));
    preferences.postChanged("org.spectrel.Home", "THShowGSMRSSI");
    std::string told;
    while (told.find("THShowGSMRSSI") == std::string::npos && std::fgets(line, sizeof line, monitor))
        told += line;
    ::kill(process, SIGTERM);
    ::pclose(monitor);
    EXPECT_NE(told.find("path=/org/spectrel/Preferences; interface=org.spectrel.Preferences; member=Changed"),
        std::string::npos);
    EXPECT_NE(told.find("string \"org.spectrel.Home\"\n   string \"THShowGSMRSSI\""), std::string::npos) << told;
    ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
}

} // namespace
} // namespace spectrel

#include "Telephony/Modem/ModemManager/ModemManagerFacts.h"

#include <QDBusArgument>
#include <QDBusObjectPath>

#include <gtest/gtest.h>

namespace spectrel::ModemManager {
namespace {

QVariant u(uint number)
{
    return QVariant::fromValue(number);
}

Interfaces modemOf(uint technologies, int state = 8)
{
    return {
        {ModemInterface,
            {{"AccessTechnologies", u(technologies)}, {"State", state}, {"Model", "EM7455"},
                {"PrimaryPort", "cdc-wdm0"}}},
        {SignalInterface,
            {{"Rate", u(10)}, {"Lte", QVariantMap {{"rsrp", -91.5}, {"rssi", "-60"}}},
                {"Umts", QVariantMap {{"rscp", -85.0}}}, {"Gsm", QVariantMap {{"rssi", -71.0}}}}},
        {Modem3gppInterface, {{"OperatorCode", "00101"}}},
    };
}

ModemFacts factsOf(uint technologies, int state = 8)
{
    return modemFacts("/org/freedesktop/ModemManager1/Modem/0", modemOf(technologies, state));
}

TEST(ModemManagerFacts, TechnologyIsTheAccessTechnologys)
{
    struct Row {
        uint technologies;
        std::optional<Technology> technology;
        std::optional<CellKind> kind;
    };
    const Row rows[] = {
        {0, std::nullopt, std::nullopt}, {0xFFFFFFFF, std::nullopt, std::nullopt},
        {1u << 0, std::nullopt, std::nullopt}, // a telephone line
        {1u << 1, Technology::GSM, CellKind::GSM}, {1u << 3 | 1u << 4, Technology::GSM, CellKind::GSM}, // GPRS, EDGE
        {1u << 5, Technology::GSM, CellKind::UMTS}, {1u << 8, Technology::GSM, CellKind::UMTS}, // HSPA
        {1u << 9 | 1u << 4, Technology::GSM, CellKind::UMTS}, // the better of two
        {1u << 10, Technology::CDMA, std::nullopt}, {1u << 12, Technology::CDMA, std::nullopt}, // EV-DO
        {1u << 14, Technology::LTE, CellKind::LTE},
        {1u << 14 | 1u << 15, Technology::LTE, CellKind::LTE}, // 5G beside LTE
        {1u << 15, Technology::LTE, std::nullopt}, // 5G alone
        {1u << 16, Technology::LTE, CellKind::LTE}, // Cat-M
    };
    for (const Row& row : rows) {
        EXPECT_EQ(factsOf(row.technologies).technology, row.technology) << row.technologies;
        EXPECT_EQ(factsOf(row.technologies).cellKind, row.kind) << row.technologies;
    }
}

TEST(ModemManagerFacts, SignalIsOfTheTechnologyInUse)
{
    EXPECT_EQ(factsOf(1u << 14).signal.rsrp, -91.5);
    EXPECT_EQ(factsOf(1u << 14).signal.rssi, std::nullopt) << "of another type than documented";
    EXPECT_EQ(factsOf(1u << 5).signal.rscp, -85.0);
    EXPECT_EQ(factsOf(1u << 1).signal.rssi, -71.0);
    EXPECT_EQ(factsOf(0).signal, SignalFacts());
    EXPECT_EQ(factsOf(0).signalRate, 10u);
}

TEST(ModemManagerFacts, StateShowsEnabledAndRegistered)
{
    EXPECT_FALSE(factsOf(0, -1).isEnabled);
    EXPECT_FALSE(factsOf(0, 5).isEnabled);
    EXPECT_TRUE(factsOf(0, 6).isEnabled);
    EXPECT_FALSE(factsOf(0, 7).isRegistered);
    EXPECT_TRUE(factsOf(0, 8).isRegistered);
    EXPECT_TRUE(factsOf(0, 11).isRegistered);
}

TEST(ModemManagerFacts, NothingIsKnownOfAModemWithoutProperties)
{
    const ModemFacts facts = modemFacts("/modem", {});
    EXPECT_EQ(facts.technology, std::nullopt);
    EXPECT_EQ(facts.signalRate, std::nullopt);
    EXPECT_FALSE(facts.isEnabled);
    EXPECT_TRUE(simPath({}).isEmpty());
    EXPECT_TRUE(bearerPaths({}).isEmpty());
}

TEST(ModemManagerFacts, HexadecimalTextsOfACellAreRead)
{
    const QList<QVariantMap> reported {
        {{"cell-type", u(5)}, {"serving", true}, {"operator-id", "001001"}, {"tac", "6FFE"}, {"ci", "1CEAD80"},
            {"physical-ci", "1A0"}, {"earfcn", u(1300)}, {"rsrp", -93.0}},
    };
    const auto cells = cellFacts(reported);
    ASSERT_EQ(cells.size(), 1u);
    EXPECT_EQ(cells[0].kind, CellKind::LTE);
    EXPECT_TRUE(cells[0].isServing);
    EXPECT_EQ(cells[0].operatorId, "001001");
    EXPECT_EQ(cells[0].areaCode, 0x6FFEu);
    EXPECT_EQ(cells[0].cellId, 0x1CEAD80u);
    EXPECT_EQ(cells[0].physicalCellId, 0x1A0u);
    EXPECT_EQ(cells[0].channel, 1300u);
    EXPECT_EQ(cells[0].power, -93.0);
}

TEST(ModemManagerFacts, CellsOfOtherKindsAreLeftOut)
{
    const QList<QVariantMap> reported {{{"cell-type", u(0)}}, {{"cell-type", u(1)}}, {{"cell-type", u(4)}},
        {{"cell-type", u(6)}}, {{"cell-type", "5"}}, {}, {{"cell-type", u(2)}, {"rx-level", u(21)}},
        {{"cell-type", u(3)}, {"psc", u(302)}}};
    const auto cells = cellFacts(reported);
    ASSERT_EQ(cells.size(), 2u);
    EXPECT_EQ(cells[0].rxLevel, 21u);
    EXPECT_EQ(cells[1].psc, 302u);
    EXPECT_EQ(cells[1].power, std::nullopt);
}

TEST(ModemManagerFacts, SimAndBearersAreNamedByPaths)
{
    const auto paths = [](const char* path) { return QVariant::fromValue(QDBusObjectPath(path)); };
    Interfaces modem = modemOf(1u << 14);
    modem[ModemInterface]["Sim"] = paths("/");
    EXPECT_TRUE(simPath(modem).isEmpty()) << "no SIM";
    modem[ModemInterface]["Sim"] = paths("/sim/1");
    EXPECT_EQ(simPath(modem), "/sim/1");
    modem[ModemInterface]["Bearers"] =
        QVariant::fromValue(QList<QDBusObjectPath> {QDBusObjectPath("/bearer/1"), QDBusObjectPath("/bearer/0")});
    modem[Modem3gppInterface]["InitialEpsBearer"] = paths("/bearer/0");
    EXPECT_EQ(bearerPaths(modem), (QStringList {"/bearer/0", "/bearer/1"}));
}

TEST(ModemManagerFacts, BearerHasNoUserNameAndPassword)
{
    const QVariantMap bearer {
        {"Interface", "wwan0"},
        {"Connected", true},
        {"ProfileId", -1},
        {"Properties", QVariantMap {{"apn", "internet.test"}, {"ip-type", u(4)}, {"user", "u"}, {"password", "p"}}},
        {"Ip4Config", QVariantMap {{"address", "192.0.2.17"}, {"gateway", "192.0.2.1"}, {"dns1", "192.0.2.53"}}},
        {"Ip6Config", QVariantMap {{"address", "2001:db8::17"}, {"dns1", "2001:db8::53"}}},
        {"Stats", QVariantMap {{"rx-bytes", QVariant::fromValue<qulonglong>(5'000'000'000)}}},
    };
    const BearerFacts expected {"7", "internet.test", "IPv4v6", "Active", "wwan0", "192.0.2.17", "2001:db8::17",
        "192.0.2.1", {"192.0.2.53", "2001:db8::53"}, 5'000'000'000, std::nullopt};
    EXPECT_EQ(bearerFacts("/org/freedesktop/ModemManager1/Bearer/7", bearer), expected);
}

TEST(ModemManagerFacts, BearersStateAndType)
{
    EXPECT_EQ(bearerFacts("/b/0", {}).state, "Inactive");
    EXPECT_EQ(bearerFacts("/b/0", {{"Suspended", true}}).state, "Inactive");
    EXPECT_EQ(bearerFacts("/b/0", {{"Connected", true}, {"Suspended", true}}).state, "Suspended");
    EXPECT_EQ(bearerFacts("/b/0", {{"ProfileId", 3}}).id, "3");
    const auto type = [](uint family) {
        return bearerFacts("/b/0", {{"Properties", QVariantMap {{"ip-type", u(family)}}}}).type;
    };
    EXPECT_EQ(type(0), "");
    EXPECT_EQ(type(1), "IPv4");
    EXPECT_EQ(type(2), "IPv6");
    EXPECT_EQ(type(3), "IPv4v6");
    EXPECT_EQ(type(8), "") << "not IP";
}

TEST(ModemManagerFacts, TextsThatNoPropertyListCanHoldBecomeMarks)
{
    EXPECT_EQ(printable(QString::fromUtf8("T\xC3\xA9st & <1>")), "T\xC3\xA9st & <1>");
    EXPECT_EQ(printable(QStringLiteral("a\nb\x01")), "a?b?");
    EXPECT_EQ(printable(QString(QChar(0xFFFE)) + QChar(0xD800)), "??");
    EXPECT_EQ(printable(QString(1000, 'x')).size(), 256u);
}

} // namespace
} // namespace spectrel::ModemManager

#include "Telephony/Modem/ModemManager/ModemManagerFacts.h"

#include <QDBusArgument>
#include <QDBusObjectPath>

namespace spectrel::ModemManager {

namespace {

constexpr qsizetype MaxTextLength = 256;

// MMModemState
constexpr int StateEnabled = 6;
constexpr int StateRegistered = 8;

// MMModemAccessTechnology
constexpr std::uint32_t AnyTechnology = 0xFFFFFFFF; // how some modems report that they do not know
constexpr std::uint32_t TechnologiesOfLTE = 1u << 14 | 1u << 16 | 1u << 17; // LTE, its machine-type forms
constexpr std::uint32_t Technology5G = 1u << 15;
constexpr std::uint32_t TechnologiesOfUMTS = 1u << 5 | 1u << 6 | 1u << 7 | 1u << 8 | 1u << 9; // UMTS to HSPA+
constexpr std::uint32_t TechnologiesOfGSM = 1u << 1 | 1u << 2 | 1u << 3 | 1u << 4; // GSM to EDGE
constexpr std::uint32_t TechnologiesOfCDMA = 1u << 10 | 1u << 11 | 1u << 12 | 1u << 13; // 1xRTT, EV-DO

// MMCellType
constexpr std::uint32_t CellOfGSM = 2;
constexpr std::uint32_t CellOfUMTS = 3;
constexpr std::uint32_t CellOfLTE = 5;

std::string text(const QVariantMap& properties, const char* key)
{
    return printable(properties.value(QLatin1String(key)).toString());
}

std::optional<std::uint32_t> number(const QVariantMap& properties, const char* key)
{
    const QVariant value = properties.value(QLatin1String(key));
    return value.metaType() == QMetaType::fromType<uint>() ? std::optional(value.toUInt()) : std::nullopt;
}

std::optional<std::uint64_t> longNumber(const QVariantMap& properties, const char* key)
{
    const QVariant value = properties.value(QLatin1String(key));
    return value.metaType() == QMetaType::fromType<qulonglong>() ? std::optional<std::uint64_t>(value.toULongLong())
                                                                 : std::nullopt;
}

std::optional<double> real(const QVariantMap& properties, const char* key)
{
    const QVariant value = properties.value(QLatin1String(key));
    return value.metaType() == QMetaType::fromType<double>() ? std::optional(value.toDouble()) : std::nullopt;
}

std::optional<std::uint32_t> hexadecimalText(const QVariantMap& properties, const char* key)
{
    return hexadecimal(text(properties, key));
}

/// A variant that holds an object path; "/" is none.
QString objectPath(const QVariant& value)
{
    const QString path = value.value<QDBusObjectPath>().path();
    return path == QLatin1String("/") ? QString() : path;
}

std::optional<CellKind> cellKindOf(std::uint32_t technologies)
{
    if (technologies == AnyTechnology)
        return std::nullopt;
    if (technologies & TechnologiesOfLTE)
        return CellKind::LTE;
    if (technologies & TechnologiesOfUMTS)
        return CellKind::UMTS;
    if (technologies & TechnologiesOfGSM)
        return CellKind::GSM;
    return std::nullopt;
}

std::optional<Technology> technologyOf(std::uint32_t technologies)
{
    if (const auto kind = cellKindOf(technologies))
        return *kind == CellKind::LTE ? Technology::LTE : Technology::GSM;
    if (technologies == AnyTechnology)
        return std::nullopt;
    if (technologies & Technology5G)
        return Technology::LTE;
    return technologies & TechnologiesOfCDMA ? std::optional(Technology::CDMA) : std::nullopt;
}

SignalFacts signalFacts(const QVariantMap& properties, std::optional<CellKind> kind)
{
    if (!kind)
        return {};
    const char* key = *kind == CellKind::LTE ? "Lte" : *kind == CellKind::UMTS ? "Umts" : "Gsm";
    const QVariantMap measured = dictionary(properties.value(QLatin1String(key)));
    return {real(measured, "rssi"), real(measured, "rscp"), real(measured, "ecio"), real(measured, "rsrp"),
        real(measured, "rsrq"), real(measured, "snr")};
}

std::optional<CellFacts> cellFactsOf(const QVariantMap& map)
{
    CellFacts cell;
    cell.isServing = map.value(QStringLiteral("serving")).toBool();
    cell.operatorId = text(map, "operator-id");
    cell.cellId = hexadecimalText(map, "ci");
    switch (number(map, "cell-type").value_or(0)) {
    case CellOfGSM:
        cell.kind = CellKind::GSM;
        cell.areaCode = hexadecimalText(map, "lac");
        cell.channel = number(map, "arfcn");
        cell.rxLevel = number(map, "rx-level");
        return cell;
    case CellOfUMTS:
        cell.kind = CellKind::UMTS;
        cell.areaCode = hexadecimalText(map, "lac");
        cell.channel = number(map, "uarfcn");
        cell.psc = number(map, "psc");
        cell.power = real(map, "rscp");
        cell.quality = real(map, "ecio");
        return cell;
    case CellOfLTE:
        cell.kind = CellKind::LTE;
        cell.areaCode = hexadecimalText(map, "tac");
        cell.channel = number(map, "earfcn");
        cell.physicalCellId = hexadecimalText(map, "physical-ci");
        cell.power = real(map, "rsrp");
        cell.quality = real(map, "rsrq");
        return cell;
    default:
        return std::nullopt;
    }
}

/// From MMBearerIpFamily, a set of bits.
std::string contextType(std::uint32_t family)
{
    const bool isIPv4 = family & (1u << 0 | 1u << 2);
    const bool isIPv6 = family & (1u << 1 | 1u << 2);
    if (isIPv4)
        return isIPv6 ? "IPv4v6" : "IPv4";
    return isIPv6 ? "IPv6" : "";
}

std::string contextState(const QVariantMap& bearer)
{
    if (!bearer.value(QStringLiteral("Connected")).toBool())
        return "Inactive";
    return bearer.value(QStringLiteral("Suspended")).toBool() ? "Suspended" : "Active";
}

/// The number of the profile (the context), else the bearer's own, the last part of its path.
std::string contextId(const QString& path, const QVariantMap& bearer)
{
    const QVariant profile = bearer.value(QStringLiteral("ProfileId"));
    if (profile.isValid() && profile.toInt() >= 0)
        return std::to_string(profile.toInt());
    return printable(path.section(QLatin1Char('/'), -1));
}

} // namespace

std::string printable(const QString& text)
{
    QString shown = text.left(MaxTextLength);
    for (QChar& character : shown) {
        if (!character.isPrint())
            character = QLatin1Char('?');
    }
    return shown.toStdString();
}

QVariantMap dictionary(const QVariant& value)
{
    if (value.metaType() != QMetaType::fromType<QDBusArgument>())
        return value.toMap();
    const auto argument = value.value<QDBusArgument>();
    return argument.currentSignature() == QLatin1String("a{sv}") ? qdbus_cast<QVariantMap>(argument) : QVariantMap();
}

ModemFacts modemFacts(const QString& path, const Interfaces& modem)
{
    const QVariantMap& properties = modem.value(ModemInterface);
    const QVariantMap& signal = modem.value(SignalInterface);
    const int state = properties.value(QStringLiteral("State")).toInt();
    const std::uint32_t technologies = number(properties, "AccessTechnologies").value_or(0);
    ModemFacts facts;
    facts.id = path.toStdString();
    facts.model = text(properties, "Model");
    facts.port = text(properties, "PrimaryPort");
    facts.isEnabled = state >= StateEnabled;
    facts.isRegistered = state >= StateRegistered;
    facts.cellKind = cellKindOf(technologies);
    facts.technology = technologyOf(technologies);
    facts.operatorId = text(modem.value(Modem3gppInterface), "OperatorCode");
    facts.signal = signalFacts(signal, facts.cellKind);
    facts.signalRate = number(signal, "Rate");
    return facts;
}

SimFacts simFacts(const QVariantMap& sim, const Interfaces& modem)
{
    SimFacts facts {text(sim, "SimIdentifier"), text(sim, "OperatorIdentifier"), text(sim, "OperatorName"), {}};
    const QStringList numbers = modem.value(ModemInterface).value(QStringLiteral("OwnNumbers")).toStringList();
    for (const QString& own : numbers.first(qMin<qsizetype>(numbers.size(), 4)))
        facts.ownNumbers.push_back(printable(own));
    return facts;
}

BearerFacts bearerFacts(const QString& path, const QVariantMap& bearer)
{
    const QVariantMap wanted = dictionary(bearer.value(QStringLiteral("Properties")));
    const QVariantMap ipv4 = dictionary(bearer.value(QStringLiteral("Ip4Config")));
    const QVariantMap ipv6 = dictionary(bearer.value(QStringLiteral("Ip6Config")));
    const QVariantMap counted = dictionary(bearer.value(QStringLiteral("Stats")));
    BearerFacts facts;
    facts.id = contextId(path, bearer);
    facts.apn = text(wanted, "apn");
    facts.type = contextType(number(wanted, "ip-type").value_or(0));
    facts.state = contextState(bearer);
    facts.interface = text(bearer, "Interface");
    facts.address = text(ipv4, "address");
    facts.ipv6Address = text(ipv6, "address");
    facts.gateway = text(ipv4, "gateway");
    for (const QVariantMap& configuration : {ipv4, ipv6}) {
        for (const char* key : {"dns1", "dns2", "dns3"}) {
            if (std::string server = text(configuration, key); !server.empty())
                facts.dns.push_back(std::move(server));
        }
    }
    facts.bytesReceived = longNumber(counted, "rx-bytes");
    facts.bytesSent = longNumber(counted, "tx-bytes");
    return facts;
}

QString simPath(const Interfaces& modem)
{
    return objectPath(modem.value(ModemInterface).value(QStringLiteral("Sim")));
}

QStringList bearerPaths(const Interfaces& modem)
{
    QStringList paths;
    const QString initial = objectPath(modem.value(Modem3gppInterface).value(QStringLiteral("InitialEpsBearer")));
    if (!initial.isEmpty())
        paths << initial;
    const QVariant listed = modem.value(ModemInterface).value(QStringLiteral("Bearers"));
    QList<QDBusObjectPath> bearers;
    if (listed.metaType() == QMetaType::fromType<QList<QDBusObjectPath>>())
        bearers = listed.value<QList<QDBusObjectPath>>();
    else if (listed.metaType() == QMetaType::fromType<QDBusArgument>()
        && listed.value<QDBusArgument>().currentSignature() == QLatin1String("ao"))
        bearers = qdbus_cast<QList<QDBusObjectPath>>(listed.value<QDBusArgument>());
    for (const QDBusObjectPath& bearer : bearers) {
        if (!paths.contains(bearer.path()))
            paths << bearer.path();
    }
    return paths;
}

std::vector<CellFacts> cellFacts(const QList<QVariantMap>& cells)
{
    std::vector<CellFacts> facts;
    for (const QVariantMap& map : cells) {
        if (auto cell = cellFactsOf(map))
            facts.push_back(std::move(*cell));
    }
    return facts;
}

} // namespace spectrel::ModemManager

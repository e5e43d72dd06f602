#pragma once

#include "Telephony/Modem/ModemFacts.h"

#include <QList>
#include <QMap>
#include <QString>
#include <QStringList>
#include <QVariantMap>

#include <vector>

/// What ModemManager's properties and answers mean. Whatever they hold that is not of the documented type is not known.
namespace spectrel::ModemManager {

/// The properties of one object, by interface.
using Interfaces = QMap<QString, QVariantMap>;

inline const QString ServiceName = QStringLiteral("org.freedesktop.ModemManager1");
inline const QString ModemInterface = QStringLiteral("org.freedesktop.ModemManager1.Modem");
inline const QString Modem3gppInterface = QStringLiteral("org.freedesktop.ModemManager1.Modem.Modem3gpp");
inline const QString SignalInterface = QStringLiteral("org.freedesktop.ModemManager1.Modem.Signal");
inline const QString LocationInterface = QStringLiteral("org.freedesktop.ModemManager1.Modem.Location");
inline const QString SimInterface = QStringLiteral("org.freedesktop.ModemManager1.Sim");
inline const QString BearerInterface = QStringLiteral("org.freedesktop.ModemManager1.Bearer");

/// The modem's own facts; the SIM and the bearers are objects beside it.
ModemFacts modemFacts(const QString& path, const Interfaces& modem);
SimFacts simFacts(const QVariantMap& sim, const Interfaces& modem);
BearerFacts bearerFacts(const QString& path, const QVariantMap& bearer);

/// The path of the modem's SIM; empty when there is none.
QString simPath(const Interfaces& modem);
/// Its bearers' paths, the initial one of LTE first.
QStringList bearerPaths(const Interfaces& modem);

/// The answer of GetCellInfo. Cells of kinds that no record has (CDMA2000, TD-SCDMA, 5G) are left out.
std::vector<CellFacts> cellFacts(const QList<QVariantMap>& cells);

/// A text of at most 256 characters; what cannot be printed, and so might not fit into a property list, becomes "?".
std::string printable(const QString& text);

/// A variant that holds a{sv}; empty when it holds anything else.
QVariantMap dictionary(const QVariant& value);

} // namespace spectrel::ModemManager

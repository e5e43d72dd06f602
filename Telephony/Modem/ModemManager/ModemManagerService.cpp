#include "Telephony/Modem/ModemManager/ModemManagerService.h"

#include "Telephony/ServiceLine.h"

#include <QDBusArgument>
#include <QDBusError>
#include <QDBusMetaType>
#include <QDBusObjectPath>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QDBusVariant>
#include <QEventLoop>

#include <algorithm>
#include <utility>

namespace spectrel {

using namespace ModemManager;
using namespace std::chrono_literals;

namespace {

using ManagedObjects = QMap<QDBusObjectPath, Interfaces>;
using Locations = QMap<uint, QDBusVariant>;

const QString ConnectionName = QStringLiteral("spectrel-modem");
const QString ServicePath = QStringLiteral("/org/freedesktop/ModemManager1");
const QString PropertiesInterface = QStringLiteral("org.freedesktop.DBus.Properties");
const QString ObjectManagerInterface = QStringLiteral("org.freedesktop.DBus.ObjectManager");
const QString ErrorPrefix = QStringLiteral("org.freedesktop.ModemManager1.Error.Core.");

constexpr uint LocationOf3GPP = 1; // MMModemLocationSource: location area and cell identity
constexpr auto PropertiesLimit = 10s; // the daemon answers these by itself; it may be starting
constexpr auto ModemLimit = 30s; // the modem has to be asked
constexpr auto FirstAnswerLimit = 2s;
constexpr auto BusRetryInterval = 5s;
constexpr int FlushLimit = 1000; // milliseconds

void registerTypes()
{
    qDBusRegisterMetaType<Interfaces>();
    qDBusRegisterMetaType<ManagedObjects>();
    qDBusRegisterMetaType<Locations>();
    qDBusRegisterMetaType<QList<QVariantMap>>();
}

ModemOutcome outcomeOf(const QDBusMessage& answer)
{
    if (answer.type() == QDBusMessage::ReplyMessage)
        return ModemOutcome::Done;
    const QString name = answer.errorName();
    const QDBusError::ErrorType type = QDBusError(answer).type();
    if (type == QDBusError::AccessDenied || name == ErrorPrefix + QStringLiteral("Unauthorized"))
        return ModemOutcome::Denied;
    if (type == QDBusError::UnknownMethod || type == QDBusError::UnknownInterface || type == QDBusError::NotSupported
        || name == ErrorPrefix + QStringLiteral("Unsupported"))
        return ModemOutcome::Unsupported;
    return ModemOutcome::Failed;
}

/// An answer's only argument, when it is of the type that was asked for.
template <typename Content> std::optional<Content> contentOf(const QDBusMessage& answer, const char* signature)
{
    if (answer.type() != QDBusMessage::ReplyMessage || answer.signature() != QLatin1String(signature))
        return std::nullopt;
    return qdbus_cast<Content>(answer.arguments().constFirst());
}

/// The number at the end of an object path, by which modems come in order.
uint numberOf(const QString& path)
{
    return path.section(QLatin1Char('/'), -1).toUInt();
}

} // namespace

ModemManagerService::ModemManagerService()
    : _bus(ConnectionName)
{
    registerTypes();
    connect(&_busTimer, &QTimer::timeout, this, [this] {
        if (attach())
            _busTimer.stop();
    });
}

Result<std::unique_ptr<ModemManagerService>> ModemManagerService::open()
{
    std::unique_ptr<ModemManagerService> service(new ModemManagerService);
    if (const auto attached = service->attach(); !attached)
        return attached.failure();
    service->waitForModems(FirstAnswerLimit);
    return service;
}

ModemManagerService::~ModemManagerService()
{
    // The program may end right away: an answered call shows that those before it have left.
    if (_hasCalled && _bus.isConnected())
        _bus.call(QDBusMessage::createMethodCall(QStringLiteral("org.freedesktop.DBus"),
                      QStringLiteral("/org/freedesktop/DBus"), QStringLiteral("org.freedesktop.DBus.Peer"),
                      QStringLiteral("Ping")),
            QDBus::Block, FlushLimit);
    _watcher.reset();
    QDBusConnection::disconnectFromBus(ConnectionName);
}

/// Connects to the bus, follows ModemManager's coming, going and signals, and asks for what is there.
Outcome ModemManagerService::attach()
{
    _bus = QDBusConnection::connectToBus(QDBusConnection::SystemBus, ConnectionName);
    if (!_bus.isConnected()) {
        Failure failure {"there is no system bus to reach modems by: " + printable(_bus.lastError().message())};
        QDBusConnection::disconnectFromBus(ConnectionName);
        return failure;
    }
    _watcher = std::make_unique<QDBusServiceWatcher>(ServiceName, _bus, QDBusServiceWatcher::WatchForOwnerChange);
    connect(_watcher.get(), &QDBusServiceWatcher::serviceOwnerChanged, this,
        [this](const QString&, const QString&, const QString& owner) {
            forgetAll();
            if (!owner.isEmpty())
                listObjects();
        });
    _bus.connect(ServiceName, ServicePath, ObjectManagerInterface, QStringLiteral("InterfacesAdded"), this,
        SLOT(interfacesAdded(QDBusMessage)));
    _bus.connect(ServiceName, ServicePath, ObjectManagerInterface, QStringLiteral("InterfacesRemoved"), this,
        SLOT(interfacesRemoved(QDBusMessage)));
    _bus.connect(ServiceName, QString(), PropertiesInterface, QStringLiteral("PropertiesChanged"), this,
        SLOT(propertiesChanged(QDBusMessage)));
    _bus.connect(QString(), QStringLiteral("/org/freedesktop/DBus/Local"), QStringLiteral("org.freedesktop.DBus.Local"),
        QStringLiteral("Disconnected"), this, SLOT(busLost()));
    listObjects();
    return Done();
}

void ModemManagerService::waitForModems(std::chrono::milliseconds limit)
{
    QTimer patience;
    patience.setSingleShot(true);
    patience.start(limit);
    QEventLoop loop;
    while (patience.isActive() && !isComplete())
        loop.processEvents(QEventLoop::WaitForMoreEvents);
}

bool ModemManagerService::isComplete() const
{
    return _isFirstAnswerThere && _awaited.isEmpty();
}

void ModemManagerService::busLost()
{
    printServiceLine("the system bus is gone; looking for it every 5 seconds");
    _watcher.reset();
    QDBusConnection::disconnectFromBus(ConnectionName);
    forgetAll();
    _busTimer.start(BusRetryInterval);
}

/// Calls a method of an object of ModemManager's; the handler gets the answer, a reply or an error.
template <typename Handler>
void ModemManagerService::call(const QString& path, const QString& interface, const QString& method,
    const QVariantList& arguments, std::chrono::milliseconds limit, Handler handler)
{
    QDBusMessage message = QDBusMessage::createMethodCall(ServiceName, path, interface, method);
    message.setArguments(arguments);
    _hasCalled = true;
    auto* watcher = new QDBusPendingCallWatcher(_bus.asyncCall(message, static_cast<int>(limit.count())), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this,
        [handler = std::move(handler)](QDBusPendingCallWatcher* finished) {
            finished->deleteLater();
            handler(finished->reply());
        });
}

void ModemManagerService::listObjects()
{
    call(ServicePath, ObjectManagerInterface, QStringLiteral("GetManagedObjects"), {}, PropertiesLimit,
        [this](const QDBusMessage& answer) { takeObjects(answer); });
}

void ModemManagerService::takeObjects(const QDBusMessage& answer)
{
    const auto objects = contentOf<ManagedObjects>(answer, "a{oa{sa{sv}}}");
    _isFirstAnswerThere = true;
    _isRunning = objects.has_value();
    if (answer.type() == QDBusMessage::ErrorMessage && QDBusError(answer).type() != QDBusError::ServiceUnknown)
        printServiceLine("ModemManager does not answer: " + printable(answer.errorMessage()));
    if (objects) {
        for (auto object = objects->begin(); object != objects->end(); ++object)
            adopt(object.key().path(), object.value());
    }
    changed();
}

void ModemManagerService::adopt(const QString& path, const Interfaces& interfaces)
{
    Interfaces& held = _modems[path];
    for (auto interface = interfaces.begin(); interface != interfaces.end(); ++interface)
        held[interface.key()] = interface.value();
    if (!held.contains(ModemInterface)) {
        _modems.remove(path);
        return;
    }
    fetchRelated();
}

/// Asks for the SIMs and bearers that modems name and that are not known yet, and forgets those that none names.
void ModemManagerService::fetchRelated()
{
    QSet<QString> named;
    for (const Interfaces& modem : std::as_const(_modems)) {
        const QString sim = simPath(modem);
        if (!sim.isEmpty()) {
            named << sim;
            fetch(sim, SimInterface);
        }
        for (const QString& bearer : bearerPaths(modem)) {
            named << bearer;
            fetch(bearer, BearerInterface);
        }
    }
    _related.removeIf([&named](auto entry) { return !named.contains(entry.key()); });
    _awaited.intersect(named);
}

void ModemManagerService::fetch(const QString& path, const QString& interface)
{
    if (_related.contains(path) || _awaited.contains(path))
        return;
    _awaited << path;
    call(path, PropertiesInterface, QStringLiteral("GetAll"), {interface}, PropertiesLimit,
        [this, path](const QDBusMessage& answer) {
            if (!_awaited.remove(path))
                return; // forgotten meanwhile
            _related[path] = contentOf<QVariantMap>(answer, "a{sv}").value_or(QVariantMap());
            changed();
        });
}

void ModemManagerService::interfacesAdded(const QDBusMessage& message)
{
    if (message.signature() != QLatin1String("oa{sa{sv}}"))
        return;
    adopt(message.arguments().at(0).value<QDBusObjectPath>().path(), qdbus_cast<Interfaces>(message.arguments().at(1)));
    changed();
}

void ModemManagerService::interfacesRemoved(const QDBusMessage& message)
{
    if (message.signature() != QLatin1String("oas"))
        return;
    const QString path = message.arguments().at(0).value<QDBusObjectPath>().path();
    const auto modem = _modems.find(path);
    if (modem == _modems.end())
        return;
    for (const QString& interface : message.arguments().at(1).toStringList())
        modem->remove(interface);
    if (!modem->contains(ModemInterface))
        _modems.erase(modem);
    fetchRelated();
    changed();
}

void ModemManagerService::propertiesChanged(const QDBusMessage& message)
{
    if (message.signature() != QLatin1String("sa{sv}as"))
        return;
    const QString path = message.path();
    const QString interface = message.arguments().at(0).toString();
    const auto modem = _modems.find(path);
    const auto related = _related.find(path);
    if (modem == _modems.end() && related == _related.end())
        return;
    QVariantMap& held = modem != _modems.end() ? (*modem)[interface] : *related;
    held.insert(qdbus_cast<QVariantMap>(message.arguments().at(1)));
    for (const QString& invalid : message.arguments().at(2).toStringList())
        held.remove(invalid);
    if (modem != _modems.end())
        fetchRelated();
    changed();
}

void ModemManagerService::forgetAll()
{
    _isRunning = false;
    _modems.clear();
    _related.clear();
    _awaited.clear();
    changed();
}

/// Reports once all changes of one turn of the event loop.
void ModemManagerService::changed()
{
    if (std::exchange(_isChangeDue, true))
        return;
    QMetaObject::invokeMethod(
        this,
        [this] {
            _isChangeDue = false;
            if (_changeHandler)
                _changeHandler();
        },
        Qt::QueuedConnection);
}

void ModemManagerService::setChangeHandler(ChangeHandler handler)
{
    _changeHandler = std::move(handler);
}

bool ModemManagerService::isRunning() const
{
    return _isRunning;
}

std::vector<ModemFacts> ModemManagerService::modems() const
{
    QStringList paths = _modems.keys();
    std::sort(paths.begin(), paths.end(),
        [](const QString& left, const QString& right) { return numberOf(left) < numberOf(right); });
    std::vector<ModemFacts> all;
    for (const QString& path : std::as_const(paths)) {
        const Interfaces& modem = *_modems.find(path);
        ModemFacts facts = modemFacts(path, modem);
        if (const QString sim = simPath(modem); !sim.isEmpty())
            facts.sim = simFacts(_related.value(sim), modem);
        for (const QString& bearer : bearerPaths(modem)) {
            if (_related.contains(bearer))
                facts.bearers.push_back(bearerFacts(bearer, _related.value(bearer)));
        }
        all.push_back(std::move(facts));
    }
    return all;
}

void ModemManagerService::listCells(const std::string& modem, CellsHandler handler)
{
    call(QString::fromStdString(modem), ModemInterface, QStringLiteral("GetCellInfo"), {}, ModemLimit,
        [handler = std::move(handler)](const QDBusMessage& answer) {
            const auto cells = contentOf<QList<QVariantMap>>(answer, "aa{sv}");
            handler(outcomeOf(answer), cells ? cellFacts(*cells) : std::vector<CellFacts>());
        });
}

void ModemManagerService::locate(const std::string& modem, LocationHandler handler)
{
    call(QString::fromStdString(modem), LocationInterface, QStringLiteral("GetLocation"), {}, ModemLimit,
        [handler = std::move(handler)](const QDBusMessage& answer) {
            const auto locations = contentOf<Locations>(answer, "a{uv}").value_or(Locations());
            const QString place = locations.value(LocationOf3GPP).variant().toString();
            handler(outcomeOf(answer), parseLocation(printable(place)));
        });
}

void ModemManagerService::setSignalRate(const std::string& modem, std::uint32_t seconds, OutcomeHandler handler)
{
    call(QString::fromStdString(modem), SignalInterface, QStringLiteral("Setup"), {QVariant::fromValue<uint>(seconds)},
        ModemLimit, [handler = std::move(handler)](const QDBusMessage& answer) { handler(outcomeOf(answer)); });
}

} // namespace spectrel

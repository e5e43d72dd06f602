#pragma once

#include "Telephony/Modem/ModemManager/ModemManagerFacts.h"
#include "Telephony/Modem/ModemService.h"
#include "Values/Result.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCall>
#include <QDBusServiceWatcher>
#include <QObject>
#include <QSet>
#include <QTimer>

#include <chrono>
#include <memory>
#include <string>

namespace spectrel {

/// ModemManager on the system bus. Follows its signals; asks nothing by itself but once for each object that appears.
class ModemManagerService final : public QObject, public ModemService {
    Q_OBJECT

public:
    /// Fails when there is no system bus. ModemManager itself may come later. Waits a moment for its first answer,
    /// turning the event loop, so that the technology is known before anybody asks for it.
    static Result<std::unique_ptr<ModemManagerService>> open();
    ~ModemManagerService() override;

    void setChangeHandler(ChangeHandler handler) override;
    bool isRunning() const override;
    std::vector<ModemFacts> modems() const override;
    void listCells(const std::string& modem, CellsHandler handler) override;
    void locate(const std::string& modem, LocationHandler handler) override;
    void setSignalRate(const std::string& modem, std::uint32_t seconds, OutcomeHandler handler) override;

private Q_SLOTS:
    void interfacesAdded(const QDBusMessage& message);
    void interfacesRemoved(const QDBusMessage& message);
    void propertiesChanged(const QDBusMessage& message);
    void busLost();

private:
    ModemManagerService();
    Outcome attach();
    void waitForModems(std::chrono::milliseconds limit);
    void listObjects();
    void takeObjects(const QDBusMessage& answer);
    void adopt(const QString& path, const ModemManager::Interfaces& interfaces);
    void fetchRelated();
    void fetch(const QString& path, const QString& interface);
    void forgetAll();
    void changed();
    bool isComplete() const;
    template <typename Handler>
    void call(const QString& path, const QString& interface, const QString& method, const QVariantList& arguments,
        std::chrono::milliseconds limit, Handler handler);

    QDBusConnection _bus;
    std::unique_ptr<QDBusServiceWatcher> _watcher;
    QTimer _busTimer; // runs while there is no bus
    ChangeHandler _changeHandler;
    bool _isRunning = false;
    bool _isChangeDue = false;
    bool _hasCalled = false;
    bool _isFirstAnswerThere = false;
    QMap<QString, ModemManager::Interfaces> _modems; // by path
    QMap<QString, QVariantMap> _related; // SIMs and bearers that modems name, by path
    QSet<QString> _awaited; // paths of those that have not answered yet
};

} // namespace spectrel

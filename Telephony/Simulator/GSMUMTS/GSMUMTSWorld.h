#pragma once

#include "Telephony/Reports/GSMUMTSCellInformation.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Telephony/Simulator/Coverage.h"
#include "Telephony/Simulator/GSMUMTS/GSMReceiver.h"
#include "Telephony/Simulator/GSMUMTS/GSMUMTSRoad.h"
#include "Telephony/Simulator/GSMUMTS/MobilityManagement.h"
#include "Telephony/Simulator/GSMUMTS/UMTSReceiver.h"
#include "Telephony/Simulator/GSMUMTS/UMTSTraffic.h"
#include "Telephony/Simulator/Move.h"
#include "Telephony/Simulator/Usage.h"

#include <chrono>
#include <optional>
#include <span>

namespace spectrel {

/// What a phone reports as soon as it changes.
struct Situation {
    RadioSystem system = RadioSystem::None;
    MMReport mm;
    GMMReport gmm;
    RegistrationReport registration;
    NetworkReport network;
    Place knownLocation; // registered for calls
    Place knownRouting; // and for packets
    RRCState rrc = RRCState::Disconnected;
    bool isCiphering = false;
    RRReport rr;
    const UMTSCell* umtsCell = nullptr; // the serving one
    const GSMCell* gsmCell = nullptr;
    bool isOnDCH = false; // UMTS, a channel of its own
    bool isSending = false; // that, or a shared one
    bool isDedicated = false; // GSM
    bool usesDTX = false;
    HoppingReport hopping;
    std::optional<GPRSParameters> gprs; // on GSM
    bool measuresGSM = false;
    bool hasSession = false;
};

/// A phone that is driven along a ring road from power-on: it searches, registers, camps, is called and transfers data,
/// on UMTS where that reaches and on GSM in the valley where it does not.
///
/// The same seed gives the same drive.
class GSMUMTSWorld {
public:
    GSMUMTSWorld(Scene scene, std::uint32_t seed);
    GSMUMTSWorld(const GSMUMTSWorld&) = delete; // its parts look at one another
    GSMUMTSWorld& operator=(const GSMUMTSWorld&) = delete;

    /// By a step of 100 ms.
    void advance(std::chrono::milliseconds step);

    const Situation& now() const
    {
        return _now;
    }
    /// A step ago.
    const Situation& before() const
    {
        return _before;
    }
    RadioSystem system() const;
    /// What was decided in the last step.
    std::span<const Move> moves() const
    {
        return _moves.moves();
    }
    const UMTSReceiver& umts() const
    {
        return _umts;
    }
    const GSMReceiver& gsm() const
    {
        return _gsm;
    }
    const MobilityManagement& mobility() const
    {
        return _mobility;
    }
    const UMTSTraffic& traffic() const
    {
        return _traffic;
    }
    /// The neighbours ranked for reselection: on UMTS its cells, or where it gets weak the GSM cells, and both when the
    /// phone is about to leave.
    RankingReport ranking() const;
    /// The serving cell is so weak that GSM cells are measured, or serves on GSM.
    bool measuresGSM() const;
    /// The networks that the serving one declares equivalent to itself.
    std::span<const PLMN> equivalentNetworks() const;
    /// The serving cell and its neighbours on both systems.
    GSMUMTSCellInformation cellInformation() const;
    /// Of all packet data sessions.
    std::uint64_t bytesReceived() const
    {
        return static_cast<std::uint64_t>(_received);
    }
    /// None between sessions.
    std::optional<PacketTransfer> session() const;

    // On a journey between technologies, as `TechnologyPart` says.
    void advanceAway(std::chrono::milliseconds step);
    Coverage coverage() const;
    double servingMargin() const;
    CellName servingName() const;
    bool isOnOwnChannel() const;
    bool isSettled() const;
    void arrive(Technology from, MoveKind how);
    void leave();
    void setOthers(const Coverage& utran, const Coverage& gsm);

private:
    Demand demand() const;
    Place place() const;
    bool isRejecting() const;
    bool isConnected() const
    {
        return _umts.isConnected() || _gsm.isConnected();
    }
    void chooseSystem(std::chrono::milliseconds step);
    void searchSystem();
    void loseService(const CellName& last);
    void noteFound(const CellName& cell);
    void considerGSM(std::chrono::milliseconds step);
    void considerUMTS(std::chrono::milliseconds step);
    void moveToUMTS(std::chrono::milliseconds step);
    bool isUMTSSuitable() const;
    bool isUMTSTooWeak() const;
    MoveCause causeOfMoveToGSM() const;
    std::vector<RankedGSMCell> gsmRanking() const;
    void transfer(std::chrono::milliseconds step);
    Situation situation() const;
    NetworkReport network() const;

    Dice _dice;
    GSMUMTSRoad _road;
    Usage _usage;
    MoveLog _moves;
    UMTSReceiver _umts;
    GSMReceiver _gsm;
    MobilityManagement _mobility;
    UMTSTraffic _traffic;
    std::chrono::milliseconds _elapsed {0};
    std::chrono::milliseconds _leaving {0}; // for so long the other system has been the better one
    std::chrono::milliseconds _departing {0}; // on the way from GSM to UMTS
    std::chrono::milliseconds _fading {0}; // for so long there is no suitable cell on GSM
    std::optional<CellName> _lostCell; // the one before service was lost
    double _received = 0;
    double _sent = 0;
    Situation _now;
    Situation _before;
};

} // namespace spectrel

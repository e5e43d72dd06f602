#pragma once

#include "Telephony/Reports/GSMCell.h"
#include "Telephony/Reports/UMTSCell.h"
#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/Move.h"
#include "Telephony/Simulator/Propagation.h"

#include <chrono>
#include <vector>

namespace spectrel {

CellName nameOf(const UMTSCell& cell);
CellName nameOf(const GSMCell& cell);

/// A ring road past NodeBs and GSM base stations. Through one stretch, a valley, UMTS does not reach.
class GSMUMTSRoad {
public:
    GSMUMTSRoad(Scene scene, Dice& dice);

    /// Drives on, and hears every cell anew.
    void advance(std::chrono::milliseconds step, Dice& dice);

    Scene scene() const
    {
        return _journey.scene();
    }
    const std::vector<UMTSCell>& umts() const
    {
        return _umts;
    }
    const std::vector<GSMCell>& gsm() const
    {
        return _gsm;
    }
    /// dBm, everything on the UMTS carrier with the receiver's noise.
    double carrierRssi() const
    {
        return _carrierRssi;
    }
    /// Metres a second.
    double speed() const
    {
        return _journey.speed();
    }

private:
    void buildUMTS(Dice& dice);
    void buildGSM(Dice& dice);
    void addSectors(double position, Dice& dice);
    void addGSMCell(double position, bool is1800, Dice& dice);
    void measure();

    double _length; // metres
    Journey _journey;
    std::vector<UMTSCell> _umts;
    std::vector<GSMCell> _gsm;
    std::vector<Shadowing> _umtsShadowing; // one for each cell
    std::vector<Shadowing> _gsmShadowing;
    double _carrierRssi = 0;
};

} // namespace spectrel

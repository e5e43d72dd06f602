#pragma once

#include "Telephony/Reports/LTECell.h"
#include "Telephony/Reports/LTEReports.h"
#include "Telephony/Simulator/Coverage.h"
#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/Propagation.h"

#include <chrono>
#include <optional>
#include <span>
#include <vector>

namespace spectrel {

/// A cell of another radio technology, as far as an LTE phone cares.
struct OtherCell {
    ReselectionCandidate candidate;
    double position; // metres along the road
    std::optional<double> power; // dBm; none: another world measures it
    int qRxLevMin; // dBm
    double level = -140; // dBm, now

    int srxlev() const
    {
        return static_cast<int>(level) - qRxLevMin;
    }
};

/// A ring road past LTE sites. Over a stretch of it there are none, and a valley on top; sites of older technologies
/// stand there.
class LTERoad {
public:
    static constexpr double Length = 6000; // metres

    static constexpr double PacingPlace = 1250; // metres along it, between two sites
    static constexpr double PacingReach = 90;

    explicit LTERoad(Dice& dice);

    /// Measures every cell from where the phone is.
    void advance(std::chrono::milliseconds step, const Journey& journey, Dice& dice);

    const std::vector<LTECell>& cells() const
    {
        return _cells;
    }
    const std::vector<OtherCell>& otherCells() const
    {
        return _otherCells;
    }
    /// The best cells of other technologies, instead of those along the road.
    void setOtherCells(const Coverage& utran, const Coverage& gsm);
    /// The carriers of the network.
    static std::span<const LTELayer> layers();

private:
    void buildSite(std::uint32_t site, double position, Dice& dice);
    void receive(const Journey& journey, Dice& dice);
    double carrierPower(const LTELayer& layer) const;

    std::vector<LTECell> _cells;
    std::vector<Shadowing> _shadowing; // one for each cell
    std::vector<OtherCell> _otherCells;
};

} // namespace spectrel

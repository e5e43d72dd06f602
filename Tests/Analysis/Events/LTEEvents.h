#pragma once

#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Reports/LTEReports.h"
#include "Tests/Analysis/Events/EventFixture.h"

namespace spectrel {

/// An LTE phone whose records a test sends one by one.
class LTEEvents : public EventFixture {
protected:
    LTEEvents()
        : EventFixture(Technology::LTE)
    {
    }

    struct Named {
        std::uint16_t channel;
        std::uint16_t pci;
        std::uint8_t priority;
    };

    void serve(const Named& cell, std::uint32_t identity, std::uint16_t area = 1201)
    {
        LTECell served;
        served.identity = identity;
        served.physicalCellId = cell.pci;
        served.downlinkChannel = cell.channel;
        served.uplinkChannel = static_cast<std::uint16_t>(cell.channel + 18000);
        served.band = cell.channel == 6300 ? 20 : 3;
        served.resourceBlocks = 50;
        served.trackingArea = area;
        deliver(lteServingCellRecord(served, time));
    }
    void idle(const Named& cell, int srxlev, double rsrp = -100, unsigned cyclesBelowZero = 0)
    {
        LTEServingReport report;
        report.channel = cell.channel;
        report.physicalCellId = cell.pci;
        report.priority = cell.priority;
        report.measured = report.average = lteLevels(rsrp, rsrp + 30, 50);
        report.qRxLevMin = -122;
        report.srxlev = srxlev;
        report.cyclesBelowZero = cyclesBelowZero;
        report.sNonIntraSearch = 20;
        deliver(lteServingMeasurementRecord(report, time));
    }
    void connected(const Named& cell, double rsrp = -100)
    {
        LTEConnectedReport report;
        report.channel = cell.channel;
        report.physicalCellId = cell.pci;
        report.filtered = lteLevels(rsrp, rsrp + 30, 50);
        deliver(lteConnectedModeRecord(report, time));
    }
    void neighbour(const Named& cell, double rsrp)
    {
        LTEIdleNeighbour heard;
        heard.physicalCellId = cell.pci;
        heard.measured = heard.average = lteLevels(rsrp, rsrp + 30, 50);
        deliver(lteNeighbourMeasurementRecord({cell.channel, -122, {heard}}, time));
    }
    void candidate(const Named& from, const Named& to)
    {
        deliver(lteReselectionRecord(
            {from.channel, from.pci, {{ReselectionTechnology::LTE, to.priority, to.channel, to.pci, 0}}}, time));
    }

    static constexpr Named A {1300, 52, 5};
    static constexpr Named B {1300, 203, 5};
    static constexpr Named Low {6300, 17, 4}; // of a lower priority
};

} // namespace spectrel

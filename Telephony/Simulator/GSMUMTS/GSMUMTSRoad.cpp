#include "Telephony/Simulator/GSMUMTS/GSMUMTSRoad.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace spectrel {

namespace {

constexpr double OwnLength = 4000; // metres, a ring
constexpr double ValleyCentre = 3000;
constexpr double ValleyEdge = 600; // metres from the centre: here UMTS begins to fade
constexpr double ValleyFloor = 250; // and here it has gone
constexpr double ValleyLoss = 45; // dB
constexpr double OutOfReach = 100; // dB: on a journey this network has GSM alone

constexpr OpenWater Water {1250, 1700}; // in front of the first NodeB
constexpr double PacingPlace = 1000; // between two NodeBs
constexpr double PacingReach = 90;

constexpr double NodeBDistance = 500;
constexpr double PilotPower = 33; // dBm
constexpr double SectorBeam = 70; // degrees (3GPP TR 25.814, table A.2.1.1-2)
constexpr double SectorBackLoss = 15; // dB, what streets reflect included
constexpr double ReceiverNoise = -99; // dBm in 3.84 MHz, noise figure 9 dB

constexpr double BaseStationDistance = 800;
constexpr double BaseStationPower = 30; // dBm
constexpr double Advantage900 = 7; // dB of path loss less than at 2 GHz: 20 lg(2000 / 900)

double watts(double dBm)
{
    return std::pow(10, dBm / 10);
}

/// Loss in dB of a sector's antenna towards a phone; `ahead`: metres along the road from the phone to the mast.
double sectorLoss(double azimuth, double ahead, double offset)
{
    const double bearing = std::atan2(offset, -ahead) * 180 / std::numbers::pi;
    const double angle = std::remainder(bearing - azimuth, 360);
    return std::min(12 * std::pow(angle / SectorBeam, 2), SectorBackLoss);
}

double valleyLoss(double toCentre)
{
    return ValleyLoss * std::clamp((ValleyEdge - toCentre) / (ValleyEdge - ValleyFloor), 0.0, 1.0);
}

GPRSParameters gprsOfCell(std::size_t number, Dice& dice)
{
    GPRSParameters gprs;
    gprs.si13Position = number % 3 == 2 ? 1 : 0;
    gprs.networkControlOrder = number % 3 == 0 ? 2 : 0;
    gprs.packetFlowContexts = static_cast<std::uint8_t>(dice.below(2));
    gprs.priorityAccessThreshold = number % 4 == 1 ? 6 : 7;
    gprs.t3192 = static_cast<std::uint8_t>(dice.below(2));
    gprs.drxTimerMax = 2;
    gprs.elevenBitAccessBursts = number % 2 == 1;
    gprs.hasPBCCH = number % 5 == 4;
    gprs.psiStatus = gprs.hasPBCCH ? 1 : 0;
    gprs.countLR = static_cast<std::uint8_t>(dice.below(4));
    gprs.countHR = static_cast<std::uint8_t>(dice.below(8));
    gprs.extendedMeasurementOrder = gprs.networkControlOrder == 2 ? 1 : 0;
    gprs.packetSIStatus = !gprs.hasPBCCH;
    return gprs;
}

} // namespace

CellName nameOf(const UMTSCell& cell)
{
    return {"umts", cell.downlinkChannel, cell.scramblingCode, cell.identity};
}

CellName nameOf(const GSMCell& cell)
{
    return {"gsm", cell.arfcn, cell.bsic, cell.identity};
}

GSMUMTSRoad::GSMUMTSRoad(Scene scene, Dice& dice)
    : _length(scene == Scene::Journey ? Journey::SharedLength : OwnLength)
    , _journey(scene, _length, dice)
{
    buildUMTS(dice);
    buildGSM(dice);
    for (std::size_t cell = 0; cell < _umts.size(); ++cell)
        _umtsShadowing.emplace_back(dice);
    for (std::size_t cell = 0; cell < _gsm.size(); ++cell)
        _gsmShadowing.emplace_back(dice);
    if (scene == Scene::PingPong)
        _journey.stayAround(PacingPlace, PacingReach);
    measure();
}

void GSMUMTSRoad::buildUMTS(Dice& dice)
{
    for (double position = NodeBDistance / 2; position < _length; position += NodeBDistance) {
        if (std::fabs(position - ValleyCentre) >= ValleyEdge)
            addSectors(position, dice);
    }
}

void GSMUMTSRoad::addSectors(double position, Dice& dice)
{
    constexpr std::array<HSDPACarriers, 3> Equipment {HSDPACarriers::Single, HSDPACarriers::Dual, HSDPACarriers::MIMO};
    const std::size_t site = _umts.size() / 3;
    const double offset = dice.between(30, 90);
    const bool isEast = position < 1500;
    for (std::uint32_t sector = 0; sector < 3; ++sector) {
        UMTSCell cell;
        cell.identity = 0x0210000 | static_cast<std::uint32_t>(1000 + site * 10 + sector);
        cell.scramblingCode = static_cast<std::uint16_t>(24 + site * 40 + sector * 8 + dice.below(8)); // all different
        cell.downlinkChannel = 10612;
        cell.uplinkChannel = 9662;
        cell.locationArea = isEast ? 1201 : 1202;
        cell.routingArea = isEast ? 1 : 2;
        cell.registrationArea = isEast ? 301 : 302;
        cell.carriers = Equipment[site % Equipment.size()];
        cell.site = site;
        cell.position = position;
        cell.offset = offset;
        cell.azimuth = 120.0 * sector;
        cell.power = PilotPower;
        cell.load = dice.between(4, 7);
        _umts.push_back(cell);
    }
}

void GSMUMTSRoad::buildGSM(Dice& dice)
{
    bool has1800 = false;
    for (double position = BaseStationDistance / 4; position < _length; position += BaseStationDistance) {
        const double place = position + dice.between(-60, 60);
        addGSMCell(place, false, dice);
        if (has1800)
            addGSMCell(place, true, dice);
        has1800 = !has1800;
    }
}

void GSMUMTSRoad::addGSMCell(double position, bool is1800, Dice& dice)
{
    const std::size_t number = _gsm.size();
    constexpr std::size_t Carriers = 113; // to choose from in the band of 900 MHz
    const auto carrier = static_cast<std::uint16_t>(number * 11 % Carriers + dice.below(10));
    GSMCell cell;
    cell.identity = static_cast<std::uint16_t>(20000 + number * 10 + (is1800 ? 4 : 1));
    cell.arfcn = static_cast<std::uint16_t>((is1800 ? 520 : 2) + carrier);
    cell.bsic = static_cast<std::uint8_t>(dice.below(64));
    cell.locationArea = 1211;
    cell.routingArea = 11;
    cell.reselectOffset = static_cast<std::uint8_t>(is1800 ? 12 : 2 * (number % 4));
    cell.usesDTX = number % 3 != 2;
    if (number % 3 != 1) {
        cell.hopping.sequenceNumber = static_cast<std::uint8_t>(dice.below(64));
        for (std::uint16_t hop = 0; hop < 3 + number % 3; ++hop)
            cell.hopping.arfcns.push_back(static_cast<std::uint16_t>((is1800 ? 700 : 80) + number + 7 * hop));
    }
    cell.gprs = gprsOfCell(number, dice);
    cell.position = position;
    cell.offset = dice.between(30, 120);
    cell.power = BaseStationPower + (is1800 ? 0 : Advantage900);
    _gsm.push_back(cell);
}

void GSMUMTSRoad::advance(std::chrono::milliseconds step, Dice& dice)
{
    _journey.advance(step, dice);
    for (Shadowing& shadowing : _umtsShadowing)
        shadowing.advance(step, dice);
    for (Shadowing& shadowing : _gsmShadowing)
        shadowing.advance(step, dice);
    measure();
}

void GSMUMTSRoad::measure()
{
    const double tunnel = _journey.tunnelLoss();
    const double hills = scene() == Scene::Journey ? OutOfReach : valleyLoss(_journey.distanceTo(ValleyCentre, 0));
    double carrier = watts(ReceiverNoise);
    for (std::size_t index = 0; index < _umts.size(); ++index) {
        UMTSCell& cell = _umts[index];
        const double loss = pathLoss(_journey.distanceTo(cell.position, cell.offset)) + hills + tunnel
            + sectorLoss(cell.azimuth, _journey.ahead(cell.position), cell.offset);
        const double water = index == 0 ? Water.gainAt(_journey) : 0;
        cell.rscp = std::min(cell.power - loss + _umtsShadowing[index].decibels() + water, -25.0);
        carrier += watts(cell.rscp + cell.load);
    }
    _carrierRssi = 10 * std::log10(carrier);
    for (UMTSCell& cell : _umts)
        cell.ecno = cell.rscp - _carrierRssi;
    for (std::size_t index = 0; index < _gsm.size(); ++index) {
        GSMCell& cell = _gsm[index];
        const double loss = pathLoss(_journey.distanceTo(cell.position, cell.offset)) + tunnel;
        cell.rssi = std::min(cell.power - loss + _gsmShadowing[index].decibels(), -40.0);
    }
}

} // namespace spectrel

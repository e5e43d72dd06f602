#include "Telephony/Encoders/LTERecords.h"

#include "Telephony/Encoders/RecordWriter.h"
#include "Telephony/Simulator/LTEWorld.h"

namespace spectrel {

Bytes lteServingCellRecord(const LTECell& cell, Moment time)
{
    return RecordWriter(0xB0C2, time)
        .u8(2) // version
        .u16(cell.physicalCellId)
        .u16(cell.downlinkChannel)
        .u16(cell.uplinkChannel)
        .u8(cell.resourceBlocks)
        .u8(cell.resourceBlocks) // uplink
        .u32(cell.identity)
        .u16(cell.trackingArea)
        .u32(cell.band)
        .zeros(6) // allowed access, country and network codes: not shown
        .take();
}

Bytes lteAntennasRecord(const LTECell& cell, Moment time)
{
    return RecordWriter(0xB0C1, time)
        .u8(2) // version
        .u16(cell.downlinkChannel)
        .u16(cell.physicalCellId)
        .u16(0) // system frame number
        .u8(cell.antennas)
        .u8(cell.resourceBlocks)
        .take();
}

} // namespace spectrel

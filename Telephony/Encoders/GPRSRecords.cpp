#include "Telephony/Encoders/GPRSRecords.h"

#include "Telephony/Encoders/RecordWriter.h"

namespace spectrel {

Bytes gprsSystemInformationRecord(const GPRSParameters& parameters, Moment time)
{
    return RecordWriter(0x51F4, time).zeros(1).u8(parameters.si13Position).take();
}

Bytes gprsAccessRecord(const GPRSParameters& parameters, Moment time)
{
    return RecordWriter(0x51F5, time)
        .u8(parameters.packetFlowContexts)
        .u8(parameters.priorityAccessThreshold)
        .u8(parameters.networkControlOrder)
        .zeros(2)
        .take();
}

Bytes gprsTimersRecord(const GPRSParameters& parameters, Moment time)
{
    return RecordWriter(0x51F6, time)
        .zeros(2)
        .u8(parameters.t3192)
        .u8(parameters.drxTimerMax)
        .u8(parameters.elevenBitAccessBursts ? 1 : 0)
        .zeros(6)
        .take();
}

Bytes gprsBroadcastRecord(const GPRSParameters& parameters, Moment time)
{
    return RecordWriter(0x51FB, time).u8(parameters.hasPBCCH ? 1 : 0).zeros(20).take();
}

Bytes gprsStatusRecord(const GPRSParameters& parameters, Moment time)
{
    return RecordWriter(0x51FD, time)
        .u8(parameters.psiStatus)
        .u8(parameters.countLR)
        .u8(parameters.countHR)
        .u8(parameters.extendedMeasurementOrder)
        .zeros(16)
        .u8(parameters.packetSIStatus ? 1 : 0)
        .zeros(1)
        .take();
}

} // namespace spectrel

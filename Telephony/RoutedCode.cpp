#include "Telephony/RoutedCode.h"

#include "Records/Frame.h"

namespace spectrel {

bool routedCode(ByteView message, std::uint32_t& code)
{
    constexpr std::size_t HeaderSize = 13;
    if (message.size() < HeaderSize)
        return false;
    const RecordView record = recordInMessage(message);
    if (record.u8(0) != OrdinaryRecord && record.u8(0) != ExtraRecord)
        return false;
    code = routingCode(record);
    return true;
}

} // namespace spectrel

#include "Telephony/ChannelQueue.h"

#include "Telephony/ServiceLine.h"

namespace spectrel {

void ChannelQueue::send(ByteView message)
{
    if ((_waiting.empty() || !_sink.wants(message)) && _sink.deliver(message))
        return;
    _waiting.emplace_back(message.begin(), message.end());
    _bytes += message.size();
    while (_waiting.size() > MaxMessages || _bytes > MaxBytes)
        dropOldest();
}

void ChannelQueue::dropOldest()
{
    _bytes -= _waiting.front().size();
    _waiting.pop_front();
    ++_lost;
}

void ChannelQueue::drain()
{
    while (!_waiting.empty() && reportLoss() && _sink.deliver(_waiting.front())) {
        _bytes -= _waiting.front().size();
        _waiting.pop_front();
    }
    if (_waiting.empty() && _lost > _printedLost) {
        printServiceLine("a client was too slow and lost " + std::to_string(_lost - _printedLost) + " messages");
        _printedLost = _lost;
    }
}

/// The oldest are gone, so what is missing was before all that waits. False when the client has no room for it.
bool ChannelQueue::reportLoss()
{
    if (_lost == _reportedLost)
        return true;
    if (!_sink.reportLoss(_lost - _reportedLost))
        return false;
    _reportedLost = _lost;
    return true;
}

} // namespace spectrel

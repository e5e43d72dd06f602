#include "Telephony/ChannelQueue.h"

#include "Telephony/ServiceLine.h"

namespace spectrel {

void ChannelQueue::send(ByteView message)
{
    if (_waiting.empty() && _sink.deliver(message))
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
    while (!_waiting.empty() && _sink.deliver(_waiting.front())) {
        _bytes -= _waiting.front().size();
        _waiting.pop_front();
    }
    if (_waiting.empty() && _lost > _reportedLost) {
        printServiceLine("a client was too slow and lost " + std::to_string(_lost - _reportedLost) + " messages");
        _reportedLost = _lost;
    }
}

} // namespace spectrel

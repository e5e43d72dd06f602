// What a message costs from a remote port to a handler on the run loop, against the bare sockets underneath.

#include "Benchmarks/Yardstick.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <array>
#include <benchmark/benchmark.h>
#include <string>
#include <sys/socket.h>
#include <unistd.h>

namespace spectrel {
namespace {

constexpr int Messages = 64'000;
constexpr int Batch = 64; // in flight at once, well within the kernel's queue
constexpr std::size_t MessageSize = 200;

/// The same bytes through a bare pair of sequential-packet sockets, a batch written, a batch read.
void deliverRaw(const std::array<int, 2>& sockets)
{
    std::array<std::uint8_t, MessageSize> message {1};
    std::array<std::uint8_t, 2 * MessageSize> received;
    for (int sent = 0; sent < Messages; sent += Batch) {
        for (int count = 0; count < Batch; ++count)
            benchmark::DoNotOptimize(::send(sockets[0], message.data(), message.size(), MSG_NOSIGNAL));
        for (int count = 0; count < Batch; ++count)
            benchmark::DoNotOptimize(::recv(sockets[1], received.data(), received.size(), 0));
    }
}

/// A folder and two ends of one port in it.
class Ports {
public:
    explicit Ports(std::string folder)
        : _ports(folder, SystemLog::none())
    {
        local = _ports
                    .createLocal("benchmark",
                        [this](std::int32_t, ByteView body) -> std::optional<Bytes> {
                            ++received;
                            receivedBytes += body.size();
                            return std::nullopt;
                        })
                    .port;
        local->serve();
        remote = _ports.createRemote("benchmark");
    }

    bool deliver()
    {
        const Bytes message(MessageSize, 1);
        received = 0;
        receivedBytes = 0;
        for (int sent = 0; sent < Messages;) {
            for (int count = 0; count < Batch; ++count, ++sent)
                remote->sendRequest(0, message, {}, {}, ReplyMode::None, nullptr);
            if (!_loop.runUntil([&] { return received == sent; }, std::chrono::seconds(5)))
                return false;
        }
        return receivedBytes == Messages * MessageSize;
    }

private:
    QtRunLoop _loop;
    SocketMessagePorts _ports;
    std::shared_ptr<LocalMessagePort> local;
    std::shared_ptr<RemoteMessagePort> remote;
    int received = 0;
    std::size_t receivedBytes = 0;
};

void DeliverMessages(benchmark::State& run)
{
    const ScratchFolder folder;
    std::array<int, 2> sockets {};
    if (::socketpair(AF_UNIX, SOCK_SEQPACKET, 0, sockets.data()) != 0)
        return run.SkipWithError("no sockets");
    {
        Ports ports(folder.path().string());
        if (!ports.deliver())
            run.SkipWithError("messages were lost");
        const double floor = bestSeconds([&] { deliverRaw(sockets); });
        double seconds = 1e9;
        for (auto _ : run)
            seconds = std::min(seconds, bestSeconds([&] { ports.deliver(); }, 1));
        run.counters["messages/s"] = Messages / seconds;
        run.counters["x_raw_sockets"] = seconds / floor;
        run.counters["extra_ns"] = (seconds - floor) / Messages * 1e9;
    }
    ::close(sockets[0]);
    ::close(sockets[1]);
}
BENCHMARK(DeliverMessages)->Unit(benchmark::kMillisecond)->Iterations(9);

} // namespace
} // namespace spectrel

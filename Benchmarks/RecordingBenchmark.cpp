// What a technology's records cost: a whole simulated drive against a bare read of the same file, and each log code
// alone, with the allocations that a record takes in the steady state.

#include "Benchmarks/GoldenAnswer.h"
#include "Benchmarks/Yardstick.h"
#include "LogGenerator/LogGenerator.h"
#include "Platform/Resources.h"
#include "Records/Frame.h"
#include "Records/Recording.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Tests/Fakes/CountedAllocations.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <array>
#include <benchmark/benchmark.h>
#include <cstdio>
#include <map>
#include <string>
#include <vector>

namespace spectrel {
namespace {

constexpr std::chrono::minutes DriveLength {30};
constexpr std::size_t MessagesBetweenTicks = 1000;

/// A simulated drive in a file that goes away with it.
class Drive {
public:
    explicit Drive(Technology technology)
    {
        const auto baseband = makeBaseband(technology, Scene::Drive, 1);
        isWritten = baseband && writeSimulatedRecording(*baseband, path, DriveLength);
    }

    ScratchFolder folder;
    std::string path = folder.file("drive.pcap");
    bool isWritten = false;
};

template <typename Use> std::size_t forEachMessage(const std::string& path, Use use)
{
    const auto reader = *openRecording(path);
    RecordedMessage message;
    std::size_t count = 0;
    for (; reader->next(message); ++count)
        use(message.body);
    return count;
}

std::unique_ptr<LogGenerator> makeGenerator(Technology technology)
{
    static const DirectoryResources templates(SPECTREL_SOURCE_DIR "/Resources");
    return LogGenerator::generatorFromTechnology(Value(technologyConstant(technology)), {.resources = templates});
}

std::size_t readAll(const std::string& path)
{
    std::size_t sum = 0;
    forEachMessage(path, [&sum](ByteView body) { sum += body[0] + body[body.size() - 1]; });
    return sum;
}

void decodeAll(const std::string& path, Technology technology, Dictionary& state)
{
    const auto generator = makeGenerator(technology);
    std::size_t count = 0;
    forEachMessage(path, [&](ByteView body) {
        generator->updateState(state, body);
        if (++count % MessagesBetweenTicks == 0)
            generator->discardRawMessages();
    });
}

void decodeDrive(benchmark::State& run, Technology technology)
{
    const Drive drive(technology);
    if (!drive.isWritten)
        return run.SkipWithError("there is no such simulated baseband");
    if (!decodesGoldenRecordings(technologyName(technology),
            [technology](const std::string& path, Dictionary& state) { decodeAll(path, technology, state); }))
        return run.SkipWithError("wrong display of a golden recording");
    const std::size_t records = forEachMessage(drive.path, [](ByteView) {});
    const double floor = bestSeconds([&] { benchmark::DoNotOptimize(readAll(drive.path)); });
    double seconds = 1e9;
    for (auto _ : run)
        seconds = std::min(seconds,
            bestSeconds(
                [&] {
                    Dictionary state;
                    decodeAll(drive.path, technology, state);
                },
                1));
    run.counters["records/s"] = static_cast<double>(records) / seconds;
    run.counters["x_bare_read"] = seconds / floor;
}

using Messages = std::vector<Bytes>;

/// The messages of a drive by their log code; those without one (whole reports) stand under 0.
std::map<std::uint32_t, Messages> messagesByCode(Technology technology)
{
    std::map<std::uint32_t, Messages> byCode;
    const Drive drive(technology);
    if (!drive.isWritten)
        return byCode;
    forEachMessage(drive.path,
        [&byCode](ByteView body) { byCode[routedCode(body).value_or(0)].emplace_back(body.begin(), body.end()); });
    return byCode;
}

/// One log code's records over and over, in a display where they have all been seen before.
void decodeCode(benchmark::State& run, Technology technology, const Messages& messages)
{
    Dictionary state;
    const auto generator = makeGenerator(technology);
    const auto decodeOnce = [&] {
        for (const Bytes& message : messages)
            generator->updateState(state, message);
        generator->discardRawMessages();
    };
    decodeOnce();
    std::size_t records = 0;
    const std::size_t before = allocationCount();
    for (auto _ : run) {
        decodeOnce();
        records += messages.size();
    }
    const auto each = static_cast<double>(records);
    run.counters["allocations"] = static_cast<double>(allocationCount() - before) / each;
    run.counters["record"] =
        benchmark::Counter(each, benchmark::Counter::kIsRate | benchmark::Counter::kInvert); // seconds each
}

void registerTechnology(Technology technology)
{
    static std::map<Technology, std::map<std::uint32_t, Messages>> all;
    const std::string name(technologyName(technology));
    benchmark::RegisterBenchmark(("Drive/" + name).c_str(), decodeDrive, technology)
        ->Unit(benchmark::kMillisecond)
        ->Iterations(9);
    for (const auto& [code, messages] : all[technology] = messagesByCode(technology)) {
        char text[16];
        std::snprintf(text, sizeof text, "0x%X", code);
        benchmark::RegisterBenchmark(("Code/" + name + "/" + text).c_str(),
            [technology, &messages = messages](benchmark::State& run) { decodeCode(run, technology, messages); })
            ->MinTime(0.1);
    }
}

} // namespace
} // namespace spectrel

int main(int argc, char** argv)
{
    using namespace spectrel;
    for (const Technology technology :
        {Technology::LTE, Technology::GSM, Technology::UTRAN, Technology::CDMA, Technology::IFX})
        registerTechnology(technology);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
}

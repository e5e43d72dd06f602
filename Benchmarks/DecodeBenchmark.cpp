// How much decoding costs beyond reading the recording, and showing beyond printing the same values.

#include "Benchmarks/GoldenAnswer.h"
#include "Benchmarks/Yardstick.h"
#include "Monitor/SpectrelModelNode.h"
#include "Platform/Resources.h"
#include "Records/Recording.h"
#include "Sections/LTE/LTELogGenerator.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Values/PropertyList/PropertyList.h"

#include <array>
#include <benchmark/benchmark.h>
#include <charconv>
#include <string>

namespace spectrel {
namespace {

constexpr int Records = 200'000;
constexpr int ServingCellFieldCount = 8;
constexpr std::uint16_t LastCell = (Records - 1) % 504;

/// A capture of serving-cell records whose values differ from one to the next.
class Capture {
public:
    Capture()
    {
        const auto writer = *createRecording(path, Technology::LTE);
        for (int number = 0; number < Records; ++number)
            isWritten = writer->write(Moment(std::chrono::milliseconds(number)), servingCell(number)) && isWritten;
        isWritten = writer->flush() && isWritten;
    }

    ScratchFolder folder;
    std::string path = folder.file("cells.pcap");
    bool isWritten = true;

private:
    Bytes servingCell(int number)
    {
        Bytes record {0x01, 39, 0, 0xC2, 0xB0};
        record.resize(40);
        const auto put = [&record](std::size_t offset, unsigned value, std::size_t width) {
            for (std::size_t byte = 0; byte < width; ++byte)
                record[offset + byte] = static_cast<std::uint8_t>(value >> 8 * byte);
        };
        const auto unique = static_cast<unsigned>(number);
        put(14, unique % 504, 2);
        put(16, 1200 + unique % 600, 2);
        put(18, 19200 + unique % 600, 2);
        put(20, 100, 1);
        put(21, 50, 1);
        put(22, 0x1000000 + unique, 4);
        put(26, unique % 65536, 2);
        put(28, 3, 4);
        return record;
    }
};

const DirectoryResources& resources()
{
    static const DirectoryResources templates(SPECTREL_SOURCE_DIR "/Resources");
    return templates;
}

std::size_t readAll(const std::string& path)
{
    const auto reader = *openRecording(path);
    RecordedMessage message;
    std::size_t sum = 0;
    while (reader->next(message))
        sum += message.body[0] + message.body[message.body.size() - 1];
    return sum;
}

void decodeAll(const std::string& path, Dictionary& state)
{
    const auto reader = *openRecording(path);
    const auto generator = LTELogGenerator::generator({.resources = resources()});
    RecordedMessage message;
    for (int count = 0; reader->next(message); ++count) {
        generator->updateState(state, message.body);
        if (count % 10'000 == 0)
            generator->discardRawMessages();
    }
}

std::string shownCell(const Dictionary& state)
{
    PathIndex paths;
    SpectrelModelNode::makeTreeFromObject(state[StateKey::Display], paths);
    const auto node = paths.find("/Serving Cell Info/Physical Cell ID");
    return node == paths.end() ? "nothing" : *node->second->value();
}

void formatAll()
{
    char text[32];
    for (int number = 0; number < Records * ServingCellFieldCount; ++number) {
        std::to_chars(text, text + sizeof text, number);
        benchmark::DoNotOptimize(text);
    }
}

void DecodeServingCells(benchmark::State& run)
{
    const Capture capture;
    Dictionary proof;
    decodeAll(capture.path, proof);
    if (!capture.isWritten || shownCell(proof) != std::to_string(LastCell))
        return run.SkipWithError("wrong display");
    if (!decodesGoldenRecordings("lte", decodeAll))
        return run.SkipWithError("wrong display of a golden recording");

    const double floor = bestSeconds([&] { benchmark::DoNotOptimize(readAll(capture.path)); });
    const double formatting = bestSeconds(formatAll);
    double seconds = 1e9;
    for (auto _ : run) {
        seconds = std::min(seconds,
            bestSeconds(
                [&] {
                    Dictionary state;
                    decodeAll(capture.path, state);
                },
                1));
    }
    run.counters["records/s"] = Records / seconds;
    run.counters["x_bare_read"] = seconds / floor;
    run.counters["x_to_chars"] = (seconds - floor) / formatting;
}
BENCHMARK(DecodeServingCells)->Unit(benchmark::kMillisecond)->Iterations(9);

/// The display of a live LTE session, rebuilt as at every tick.
void RebuildDisplay(benchmark::State& run)
{
    const Capture capture;
    Dictionary state;
    decodeAll(capture.path, state);
    if (shownCell(state) != std::to_string(LastCell))
        return run.SkipWithError("wrong display");
    for (auto _ : run) {
        PathIndex paths;
        benchmark::DoNotOptimize(SpectrelModelNode::makeTreeFromObject(state[StateKey::Display], paths));
        run.counters["nodes"] = static_cast<double>(paths.size());
    }
}
BENCHMARK(RebuildDisplay)->Unit(benchmark::kMicrosecond);

} // namespace
} // namespace spectrel

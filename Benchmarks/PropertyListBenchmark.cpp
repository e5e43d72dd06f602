// What the property lists of records cost to read, against a bare scan of the same bytes.

#include "Benchmarks/Yardstick.h"
#include "Records/Frame.h"
#include "Records/Recording.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Tests/Fakes/CountedAllocations.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Values/PropertyList/PropertyList.h"
#include "Values/PropertyList/XMLPropertyListReader.h"

#include <algorithm>
#include <benchmark/benchmark.h>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {
namespace {

constexpr std::chrono::minutes DriveLength {30};
constexpr double Mega = 1e6;

struct Document {
    std::uint32_t code; // of its record
    std::string text;
};

/// The XML documents of a simulated LTE drive, in their order.
std::vector<Document> driveDocuments()
{
    const ScratchFolder folder;
    const std::string path = folder.file("drive.pcap");
    std::vector<Document> documents;
    const auto baseband = makeBaseband(Technology::LTE, Scene::Drive, 1);
    if (!baseband || !writeSimulatedRecording(*baseband, path, DriveLength))
        return documents;
    const auto reader = *openRecording(path);
    RecordedMessage message;
    while (reader->next(message)) {
        const RecordView record(recordInMessage(message.body));
        const ByteView payload = recordPayload(record);
        const std::string_view text(reinterpret_cast<const char*>(payload.data()), payload.size());
        if (text.starts_with("<?xml"))
            documents.push_back({routingCode(record), std::string(text)});
    }
    return documents;
}

ByteView bytesOf(const Document& document)
{
    return {reinterpret_cast<const std::uint8_t*>(document.text.data()), document.text.size()};
}

/// Whether each document is what the serialiser makes of what was read of it.
template <typename Read> bool readsRight(const std::vector<Document>& documents, Read read)
{
    return !documents.empty() && std::ranges::all_of(documents, [&read](const Document& document) {
        const Value value = read(document);
        return serialisePropertyList(value) == document.text;
    });
}

template <typename Read> void readDocuments(benchmark::State& run, Read read)
{
    const auto documents = driveDocuments();
    if (!readsRight(documents, read))
        return run.SkipWithError("wrong values");
    double megabytes = 0;
    for (const Document& document : documents)
        megabytes += static_cast<double>(document.text.size()) / Mega;
    const double scan = bestSeconds([&documents] {
        for (const Document& document : documents)
            benchmark::DoNotOptimize(std::ranges::count(document.text, '<'));
    });
    double seconds = 1e9;
    const std::size_t before = allocationCount();
    std::size_t lists = 0;
    for (auto _ : run) {
        seconds = std::min(seconds,
            bestSeconds(
                [&] {
                    for (const Document& document : documents)
                        benchmark::DoNotOptimize(read(document).isAbsent());
                },
                1));
        lists += documents.size();
    }
    run.counters["MB/s"] = megabytes / seconds;
    run.counters["x_bare_scan"] = seconds / scan;
    run.counters["allocations"] = static_cast<double>(allocationCount() - before) / static_cast<double>(lists);
}

void ReadXML(benchmark::State& run)
{
    readDocuments(run, [](const Document& document) { return parsePropertyList(bytesOf(document)).value_or(Value()); });
}
BENCHMARK(ReadXML)->Unit(benchmark::kMillisecond)->Iterations(9);

/// As the sections read: each list over the one before of its code.
void ReadXMLOverEarlier(benchmark::State& run)
{
    std::map<std::uint32_t, Value> latest;
    readDocuments(run, [&latest](const Document& document) -> const Value& {
        Value& value = latest[document.code];
        readPropertyList(bytesOf(document), value);
        return value;
    });
}
BENCHMARK(ReadXMLOverEarlier)->Unit(benchmark::kMillisecond)->Iterations(9);

/// What judges every other form.
void ReadXMLStrictly(benchmark::State& run)
{
    readDocuments(
        run, [](const Document& document) { return parseXMLPropertyList(bytesOf(document)).value_or(Value()); });
}
BENCHMARK(ReadXMLStrictly)->Unit(benchmark::kMillisecond)->Iterations(3);

} // namespace
} // namespace spectrel

#pragma once

#include "Monitor/SpectrelModel.h"
#include "Monitor/Viewing/ViewedFile.h"
#include "Records/Recording.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Values/Dictionary.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <gtest/gtest.h>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// Counts what the screens would have been told, and calls back where a test wants to look.
struct ScreenCounter final : SpectrelModelObserver {
    void updateViewControllerFromModel() override
    {
        ++reloads;
        if (atReload)
            atReload();
    }
    void playbackDidChange() override
    {
        ++playbackChanges;
        if (atPlaybackChange)
            atPlaybackChange();
    }
    int reloads = 0;
    int playbackChanges = 0;
    std::function<void()> atReload;
    std::function<void()> atPlaybackChange;
};

/// Files that are viewed in virtual time.
class ViewFixture : public testing::Test {
protected:
    static constexpr Moment Start {std::chrono::seconds(1'700'000'000)};

    ViewFixture()
    {
        resources.lists["LTE"] =
            Dictionary::make({{"Serving Cell Info", Dictionary::make()}, {"SIM Info", Dictionary::make()}});
    }
    /// A serving-cell record that shows this identity.
    static Bytes cell(std::uint32_t identity)
    {
        return RecordBuilder(0xB0C2, 38).u16(14, identity).bytes();
    }
    /// A record that raises an exception.
    static Bytes garbage()
    {
        const Bytes text {'g', 'a', 'r', 'b'};
        return RecordBuilder::withPayload(0xFF0000, text).bytes();
    }
    struct Timed {
        std::chrono::milliseconds time;
        Bytes body;
    };
    std::string writeRecording(const std::vector<Timed>& messages) const
    {
        const std::string path = scratch.file("a.pcap");
        const auto writer = *createRecording(path, Technology::LTE);
        for (const Timed& message : messages)
            EXPECT_TRUE(writer->write(Start + message.time, message.body));
        EXPECT_TRUE(writer->flush());
        return path;
    }
    /// Opens the file and shows its beginning; false, with `reason`, when that fails.
    bool view(const std::string& path, std::optional<Technology> technology = std::nullopt)
    {
        file = ViewedFile::open(path, technology, loop, reason);
        if (!file)
            return false;
        model = file->makeModel(loop, &LogGenerator::generatorFromTechnology, screens,
            [this](const std::string& line) { reported += line + "\n"; }, {loop, resources, log, log});
        model->restartMonitor();
        loop.runQueued();
        return true;
    }
    Playback& playback() const
    {
        return *model->playback();
    }
    /// The identity that the tree shows; "-" when it shows none.
    std::string identity() const
    {
        const NodeRef node = model->nodeAtPath("/Serving Cell Info/Physical Cell ID");
        return node && node->value() ? *node->value() : "-";
    }
    /// The time on the line in milliseconds, the messages applied, the identity shown.
    std::string place() const
    {
        return std::to_string(playback().time().count() / 1000) + " ms, " + std::to_string(playback().messagesApplied())
            + ": " + identity();
    }

    LogRecorder log;
    FakeRunLoop loop;
    FakeResources resources;
    const ScratchFolder scratch;
    ScreenCounter screens;
    std::string reason;
    std::string reported;
    std::unique_ptr<ViewedFile> file;
    std::unique_ptr<MonitorModel> model;
};

} // namespace spectrel

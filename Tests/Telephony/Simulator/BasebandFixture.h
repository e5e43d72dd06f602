#pragma once

#include "Records/Frame.h"
#include "Telephony/Encoders/RecordWriter.h"
#include "Telephony/Simulator/Baseband.h"
#include "Tests/Telephony/RecordBytes.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>
#include <map>
#include <memory>
#include <vector>

namespace spectrel {

/// A simulated baseband that is driven, and the records that it sends meanwhile.
class BasebandFixture : public testing::Test {
protected:
    explicit BasebandFixture(Technology technology)
        : _technology(technology)
    {
        start(Scene::Drive, 1);
    }
    void start(Scene scene, std::uint32_t seed)
    {
        _baseband = makeBaseband(_technology, scene, seed);
        _now = Epoch1980;
        records.clear();
    }
    void drive(std::chrono::milliseconds time)
    {
        for (auto step = time.zero(); step < time; step += Baseband::Step) {
            _now += Baseband::Step;
            _baseband->advance(_now, [this](ByteView record) { keep(record); });
        }
    }
    void greet()
    {
        _baseband->greet(_now, [this](ByteView record) { keep(record); });
    }
    std::size_t count(std::uint32_t code) const
    {
        return records.contains(code) ? records.at(code).size() : 0;
    }
    /// The last record of a code that has come.
    const Bytes& last(std::uint32_t code) const
    {
        return records.at(code).back();
    }
    static Value propertyList(const Bytes& record)
    {
        return parsePropertyList(ByteView(record).subspan(13)).value_or(Value());
    }

    std::map<std::uint32_t, std::vector<Bytes>> records; // by routed code, in order

private:
    void keep(ByteView record)
    {
        const auto code = routedCode(record);
        ASSERT_TRUE(code);
        records[*code].emplace_back(record.begin(), record.end());
    }

    Technology _technology;
    std::unique_ptr<Baseband> _baseband;
    Moment _now = Epoch1980;
};

} // namespace spectrel

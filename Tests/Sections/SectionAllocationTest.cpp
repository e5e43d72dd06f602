// What decoding costs in memory: nothing, once a scalar section's keys are there.

#include "Sections/GSMUMTS/ZPH_GSMClassIndex.h"
#include "Sections/LTE/LTEClassIndex.h"
#include "Sections/UTRAN/UTRANClassIndex.h"
#include "Tests/Fakes/CountedAllocations.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Values/Dictionary.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace spectrel {
namespace {

struct ScalarRecord {
    const char* section;
    std::uint32_t code;
    std::size_t size;
};

std::ostream& operator<<(std::ostream& stream, const ScalarRecord& record)
{
    return stream << record.section << ", code " << record.code;
}

class SectionAllocationTest : public testing::TestWithParam<ScalarRecord> {
protected:
    SectionAllocationTest()
    {
        section().updateSectionRef(node);
    }

    Base& section() const
    {
        for (const ClassIndex* index : {static_cast<const ClassIndex*>(&_gsm), static_cast<const ClassIndex*>(&_lte),
                 static_cast<const ClassIndex*>(&_utran)}) {
            if (index->getSubscribers(GetParam().code)) // the technologies share no binary record
                return *index->getClass(GetParam().section);
        }
        throw std::invalid_argument("nobody decodes the code");
    }
    /// The section's record with this value in every byte of the payload.
    static RecordBuilder record(std::uint32_t value)
    {
        RecordBuilder built(GetParam().code, GetParam().size);
        for (std::size_t offset = 13; offset < GetParam().size; ++offset)
            built.u8(offset, value);
        if (GetParam().code == 0x4221)
            built.u8(16, 0).u8(17, 0); // no lists
        if (GetParam().code == 0xD0E0)
            built.u8(13, 1); // the mode is valid
        return built;
    }
    /// How many allocations one update takes.
    std::size_t cost(const RecordBuilder& of) const
    {
        const RecordView view(of);
        const std::size_t before = allocationCount();
        section().updateWithData(view, GetParam().code);
        return allocationCount() - before;
    }

    Value node {Dictionary::make()};

private:
    ZPH_GSMClassIndex _gsm;
    LTEClassIndex _lte;
    UTRANClassIndex _utran;
};

TEST_P(SectionAllocationTest, RepeatedRecordAllocatesNothing)
{
    EXPECT_GT(cost(record(1)), 0u) << "the keys are made";
    EXPECT_EQ(cost(record(1)), 0u);
}

TEST_P(SectionAllocationTest, OtherValuesAllocateNothingOnceTheirTextsFit)
{
    for (const std::uint32_t value : {0u, 1u, 2u, 7u, 255u})
        cost(record(value));
    const std::string before = displayText(node);
    EXPECT_EQ(cost(record(0)), 0u);
    EXPECT_NE(displayText(node), before);
    for (const std::uint32_t value : {1u, 2u, 7u, 255u})
        EXPECT_EQ(cost(record(value)), 0u) << value;
}

constexpr ScalarRecord ScalarRecords[] = {
    {"Process CO", 0x7131, 16},
    {"Process CO", 0x7132, 16},
    {"Process CS", 0x7131, 16},
    {"Process CS", 0x7132, 16},
    {"Process PS", 0x7130, 16},
    {"Process PS", 0x7132, 16},
    {"Serving PLMN", 0x7132, 16},
    {"Serving PLMN", 0x7135, 32},
    {"GSM Serving Cell", 0x5076, 17},
    {"GSM Serving Cell", 0x5134, 26},
    {"GSM Serving Cell", 0x5137, 29},
    {"GSM RR Info", 0x5072, 20},
    {"GSM RR Info", 0x512C, 17},
    {"GSM RR Info", 0x5137, 29},
    {"GSM RR Info", 0x51F6, 24},
    {"GPRS Information", 0x5137, 29},
    {"GPRS Information", 0x51F4, 15},
    {"GPRS Information", 0x51F5, 18},
    {"GPRS Information", 0x51F6, 24},
    {"GPRS Information", 0x51FB, 34},
    {"GPRS Information", 0x51FD, 35},
    {"GPRS Information", 0x7135, 32},
    {"UMTS RR Info", 0x4031, 40},
    {"UMTS RR Info", 0x4125, 14},
    {"UMTS RR Info", 0x4127, 29},
    {"UMTS RR Info", 0x4157, 19},
    {"HSDPA Info", 0x4221, 18},
    {"Serving Cell Info", 0xB0C1, 22},
    {"Serving Cell Info", 0xB0C2, 38},
    {"Connected mode LTE Intra-frequency Measurement", 0xB179, 29},
    {"Serving Cell Measurements", 0xB17F, 33},
    {"Neighbor Measurements", 0xB180, 21},
    {"Reselection Candidates", 0xB186, 21},
    {"RRC Info", 0xD0E0, 15},
    {"Serving Cell Info", 0xD0E2, 26},
};

INSTANTIATE_TEST_SUITE_P(ScalarSections, SectionAllocationTest, testing::ValuesIn(ScalarRecords));

} // namespace
} // namespace spectrel

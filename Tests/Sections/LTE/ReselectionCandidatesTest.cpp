// The two sections of the reselection candidates, code 0xB186.

#include "Sections/LTE/ReselectionCandidates.h"
#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"
#include "Values/List.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xB186;

class ReselectionCandidatesMiscTest : public SectionFixture<ReselectionCandidatesMisc> {
protected:
    ReselectionCandidatesMiscTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

class ReselectionCandidatesListTest : public SectionFixture<ReselectionCandidatesList> {
protected:
    ReselectionCandidatesListTest()
        : SectionFixture(List::make())
    {
    }
    static RecordBuilder oneCandidate(std::uint32_t technology)
    {
        return RecordBuilder(Code, 40).u16(19, 1).u16(23, technology);
    }
    /// Sweeps everything after the candidate's technology.
    void sweepFurther(std::uint32_t technology, const char* name, std::vector<LaidOutField> further)
    {
        std::vector<LaidOutField> fields {
            {"Candidate Priority", 21, 0, 16, plain},
            {"Candidate RAT Type", 23, 0, 16, [name](unsigned) { return std::string(name); }},
        };
        fields.insert(fields.end(), further.begin(), further.end());
        const BitSweep sweep(fields, [this](const Bytes& record) {
            deliver(Code, record);
            return shownEntry(0);
        });
        sweep.run(oneCandidate(technology).bytes(), 25, 40);
    }
};

constexpr const char* MiscTrace = "<4>Reselection Candidates\n";
constexpr const char* ListTrace = "<4>Reselection Candidates List\n";

TEST_F(ReselectionCandidatesMiscTest, EveryBitShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Version", 13, 0, 8, plain},
            {"Serving EARFCN", 15, 0, 16, plain},
            {"Serving Cell ID", 17, 0, 16, plain},
        },
        [this](const Bytes& record) {
            deliver(Code, record);
            return display();
        });
    sweep.run(RecordBuilder(Code, 24).bytes(), 13, 24);
}

TEST_F(ReselectionCandidatesMiscTest, NoCandidatesStillSetTheThreeKeys)
{
    deliver(Code, RecordBuilder(Code, 21).u8(13, 1).u16(15, 1300).u16(17, 44));
    EXPECT_EQ(display(), "{\"Version\": \"1\", \"Serving EARFCN\": \"1300\", \"Serving Cell ID\": \"44\"}");
    EXPECT_EQ(log(), MiscTrace);
}

TEST_F(ReselectionCandidatesMiscTest, RecordOf20BytesIsIgnored)
{
    deliver(Code, RecordBuilder(Code, 20));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), MiscTrace);
}

TEST_F(ReselectionCandidatesMiscTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB180, RecordBuilder(0xB180, 60));
    EXPECT_EQ(log(), std::string(MiscTrace) + "<3>Received an unknown log message: 45440\n");
}

TEST_F(ReselectionCandidatesListTest, TwoCandidatesStandFourBytesApartAndOverlap)
{
    // The first is of UTRAN: its frequency is the second's priority, its code the second's technology.
    deliver(Code,
        RecordBuilder(Code, 33).u16(19, 2).u16(21, 3).u16(23, 1).u16(25, 10700).u16(27, 2).u16(29, 62).u8(31, 1).u8(
            32, 37));
    EXPECT_EQ(display(),
        "[{\"Candidate Priority\": \"3\", \"Candidate RAT Type\": \"UTRAN\", \"U ARFCN\": \"10700\", \"PSC\": \"2\"}, "
        "{\"Candidate Priority\": \"10700\", \"Candidate RAT Type\": \"GERAN\", \"ARFCN\": \"62\", \"Band\": \"1\", "
        "\"BSIC ID\": \"37\"}]");
    EXPECT_EQ(log(), ListTrace);
}

TEST_F(ReselectionCandidatesListTest, EveryBitOfThePriorityShows)
{
    const BitSweep sweep(
        {
            {"Candidate Priority", 21, 0, 16, plain},
            {"Candidate RAT Type", 23, 0, 16, [](unsigned) { return std::string("??"); }},
        },
        [this](const Bytes& record) {
            deliver(Code, record);
            return shownEntry(0);
        });
    sweep.run(oneCandidate(7).bytes(), 21, 23);
}

TEST_F(ReselectionCandidatesListTest, EveryBitOfAnLTECandidateShows)
{
    sweepFurther(0, "LTE", {{"E ARFCN", 25, 0, 16, plain}, {"Cell ID", 27, 7, 9, plain}});
}

TEST_F(ReselectionCandidatesListTest, EveryBitOfAUTRANCandidateShows)
{
    sweepFurther(1, "UTRAN", {{"U ARFCN", 25, 0, 16, plain}, {"PSC", 27, 0, 16, plain}});
}

TEST_F(ReselectionCandidatesListTest, EveryBitOfAGERANCandidateShows)
{
    sweepFurther(2, "GERAN", {{"ARFCN", 25, 0, 16, plain}, {"Band", 27, 0, 8, plain}, {"BSIC ID", 28, 0, 8, plain}});
}

TEST_F(ReselectionCandidatesListTest, EveryBitOfEitherCDMACandidateShows)
{
    const std::vector<LaidOutField> fields {
        {"Band", 25, 0, 8, plain}, {"Channel", 29, 0, 16, plain}, {"Pilot", 31, 0, 16, plain}};
    sweepFurther(3, "CDMA1XRTT", fields);
    sweepFurther(4, "CDMAHRPD", fields);
}

TEST_F(ReselectionCandidatesListTest, UnknownTechnologyHasTwoKeysOnly)
{
    for (const std::uint32_t technology : {5u, 7u, 256u, 65535u}) {
        deliver(Code, oneCandidate(technology).u16(21, 6).u16(25, 99));
        EXPECT_EQ(display(), "[{\"Candidate Priority\": \"6\", \"Candidate RAT Type\": \"??\"}]") << technology;
    }
}

TEST_F(ReselectionCandidatesListTest, CountOfZeroEmptiesTheList)
{
    deliver(Code, oneCandidate(0));
    deliver(Code, oneCandidate(0).u16(19, 0));
    EXPECT_EQ(display(), "[]");
}

TEST_F(ReselectionCandidatesListTest, OnlyTheLowByteOfTheCountCounts)
{
    deliver(Code, oneCandidate(0).u16(19, 0x0100));
    EXPECT_EQ(display(), "[]");
    deliver(Code, oneCandidate(0).u16(19, 0xFF02));
    EXPECT_EQ(shownCount(), 2u);
}

TEST_F(ReselectionCandidatesListTest, CountBeyondTheRecordReadsZeros)
{
    deliver(Code, RecordBuilder(Code, 21).u16(19, 255));
    EXPECT_EQ(shownCount(), 255u);
    EXPECT_EQ(shownEntry(254),
        "{\"Candidate Priority\": \"0\", \"Candidate RAT Type\": \"LTE\", \"E ARFCN\": \"0\", \"Cell ID\": \"0\"}");
}

TEST_F(ReselectionCandidatesListTest, RecordOf20BytesKeepsTheList)
{
    deliver(Code, oneCandidate(0));
    log();
    deliver(Code, oneCandidate(0).shrink(20));
    EXPECT_EQ(shownCount(), 1u);
    EXPECT_EQ(log(), ListTrace);
}

TEST_F(ReselectionCandidatesListTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB179, RecordBuilder(0xB179, 60));
    EXPECT_EQ(log(), std::string(ListTrace) + "<3>Received an unknown log message: 45433\n");
}

TEST(ReselectionRecordTest, IndexNotBelowTheWholeCountIsRaised)
{
    const RecordBuilder bytes = RecordBuilder(Code, 21).u16(19, 0x0101);
    const RecordView record = ByteView(bytes);
    EXPECT_EQ(ReselectionRecord::candidatesToRead(record), 1u);
    EXPECT_EQ(ReselectionRecord::candidates(record).entry(256), 21u + 4 * 256);
    EXPECT_THROW(ReselectionRecord::candidates(record).entry(257), ArrayOutOfBoundsException);
}

TEST(ReselectionRecordTest, ViewOfAnotherTechnologyIsRaised)
{
    constexpr std::pair<std::uint16_t, std::uint16_t> Views[] {{0, 0}, {1, 1}, {2, 2}, {3, 4}};
    for (std::uint16_t technology = 0; technology < 6; ++technology) {
        const RecordBuilder bytes = RecordBuilder(Code, 40).u16(19, 1).u16(23, technology);
        for (const auto& [first, last] : Views) {
            if (technology == first || technology == last)
                EXPECT_EQ(ReselectionRecord::candidateAs(ByteView(bytes), 0, first, last), 21u) << technology;
            else
                EXPECT_THROW(ReselectionRecord::candidateAs(ByteView(bytes), 0, first, last), ArrayOutOfBoundsException)
                    << technology << first;
        }
    }
}

} // namespace
} // namespace spectrel

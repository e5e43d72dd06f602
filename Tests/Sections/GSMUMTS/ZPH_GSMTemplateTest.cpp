// The shipped template and the sections, together.

#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/Resources.h"
#include "Sections/GSMUMTS/ZPH_GSMLogGenerator.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/SourceFolder.h"
#include "Tests/Sections/CellInformation.h"

#include <gtest/gtest.h>
#include <map>
#include <set>

namespace spectrel {
namespace {

constexpr const char* SimFiles[] = {"kSimFile_ICCID", "kSimFile_MSISDN", "kSimFile_MBDN", "kSimFile_HPPLMN",
    "kSimFile_LOCI", "kSimFile_PSLOCI", "kSimFile_ACC", "kSimFile_AD", "kSimFile_FPLMN", "kSimFile_AHPLMN",
    "kSimFile_RATMODE", "kSimFile_PNN", "kSimFile_OPL", "kSimFile_OPLMNAcT"};

class ZPH_GSMTemplateTest : public testing::Test {
protected:
    ZPH_GSMTemplateTest()
    {
        generator->getDisplayFromState(state); // builds it
    }

    Value display()
    {
        return generator->getDisplayFromState(state);
    }
    /// The texts that stand under keys, dictionaries within each other followed, lists not.
    std::map<std::string, std::string> leaves()
    {
        std::map<std::string, std::string> found;
        collect(display(), "", found);
        return found;
    }
    /// The labels of "UMTS RR Info" from the top down.
    std::string radioResourceRows()
    {
        std::string rows;
        const Value umts = (*display().dictionary())["UMTS"];
        for (const auto& row : (*umts.dictionary())["UMTS RR Info"].dictionary()->entries())
            rows += row.key + ", ";
        return rows;
    }
    /// One record of every code, all bytes 1: counts of one, and names of their own in every table.
    void receiveOneOfEach()
    {
        for (const std::uint32_t code : {0x4005u, 0x4031u, 0x4116u, 0x4125u, 0x4127u, 0x4157u, 0x417Au, 0x4221u,
                 0x5072u, 0x5076u, 0x512Cu, 0x5134u, 0x5137u, 0x51F4u, 0x51F5u, 0x51F6u, 0x51F8u, 0x51FBu, 0x51FDu,
                 0x51FFu, 0x7130u, 0x7131u, 0x7132u, 0x7135u, 0x7150u}) {
            RecordBuilder record(code, 240);
            for (std::size_t offset = 13; offset < 240; ++offset)
                record.u8(offset, 1);
            record.u8(16 + 8, 0); // an active cell, where the record is that of the cell sets
            generator->updateState(state, record);
        }
        auto files = Dictionary::make();
        for (const char* file : SimFiles)
            files->set(file, file);
        generator->updateState(state, RecordBuilder::withPropertyList(0xFF0000, files));
        for (const auto technology :
            {kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorRadioAccessTechnologyGSM}) {
            const auto cell = informationOfCell(technology, kRKCellMonitorCellTypeServing,
                {{kRKCellMonitorMCC, 262}, {kRKCellMonitorMNC, 1}, {kRKCellMonitorLAC, 2}, {kRKCellMonitorCellId, 3},
                    {kRKCellMonitorUARFCN, 4}, {kRKCellMonitorARFCN, 5}, {kRKCellMonitorSCN, 6}});
            generator->updateState(state, RecordBuilder::withPropertyList(0xFF0001, List::make({cell})));
        }
    }

    const DirectoryResources resources {sourcePath("Resources")};
    std::unique_ptr<ZPH_GSMLogGenerator> generator = ZPH_GSMLogGenerator::generator({.resources = resources});
    Dictionary state;

private:
    static void collect(const Value& value, const std::string& path, std::map<std::string, std::string>& found)
    {
        if (value.string())
            found[path] = *value.string();
        if (const auto& dictionary = value.dictionary()) {
            for (const auto& [key, inner] : dictionary->entries())
                collect(inner, path.empty() ? key : path + ": " + key, found);
        }
    }
};

std::multiset<std::string> keysOf(const Value& value)
{
    std::multiset<std::string> keys;
    if (const auto& dictionary = value.dictionary()) {
        for (const auto& [key, inner] : dictionary->entries()) {
            keys.insert(key);
            keys.merge(keysOf(inner));
        }
    }
    return keys;
}

TEST_F(ZPH_GSMTemplateTest, EverySectionStandsInItOnce)
{
    const auto keys = keysOf(display());
    for (const char* name : {"Active Set", "Coding Scheme", "GPRS Information", "GSM Serving Cell", "Mobile Allocation",
             "Neighboring Cells", "PDP Context Info", "Process PS", "UMTS RR Measurement", "Cell Change Counters",
             "Detected Set", "GSM Set", "Non-Ranked GSM Set", "Process CO", "Serving PLMN", "UMTS Set",
             "Equivalent PLMN List", "GSM RR Info", "Monitored Set", "Non-Ranked UMTS Set", "Process CS",
             "UMTS RR Info", "BLER", "Virtual Active Set", "SIM Info", "HSDPA Info"})
        EXPECT_EQ(keys.count(name), 1u) << name;
}

TEST_F(ZPH_GSMTemplateTest, EveryKeyShowsADashUntilSomethingArrives)
{
    for (const auto& [path, text] : leaves())
        EXPECT_EQ(text, "-") << path;
    EXPECT_EQ(leaves().size(), 78u);
}

TEST_F(ZPH_GSMTemplateTest, RecordsFillEveryKeyAndBringNoneOfTheirOwn)
{
    const auto keysBefore = keysOf(display());
    receiveOneOfEach();
    EXPECT_EQ(keysOf(display()), keysBefore);
    std::set<std::string> stillEmpty;
    for (const auto& [path, text] : leaves()) {
        if (text == "-")
            stillEmpty.insert(path);
    }
    EXPECT_EQ(stillEmpty,
        (std::set<std::string> {"GSM: Coding Scheme", "Network: Cell Change Counters", "UMTS: UMTS RR Measurement"}));
}

TEST_F(ZPH_GSMTemplateTest, ListsAreEmptyUntilSomethingArrivesAndThenFilled)
{
    const auto list = [this](const char* group, const char* name) {
        return displayText((*(*display().dictionary())[group].dictionary())[name]);
    };
    const std::pair<const char*, const char*> filled[] = {{"Network", "Equivalent PLMN List"}, {"UMTS", "Active Set"},
        {"UMTS", "UMTS Set"}, {"GSM", "Neighboring Cells"}, {"GSM", "GSM Set"}};
    const std::pair<const char*, const char*> empty[] = {{"UMTS", "Monitored Set"}, {"UMTS", "Detected Set"},
        {"UMTS", "Virtual Active Set"}, {"UMTS", "Non-Ranked UMTS Set"}, {"GSM", "Non-Ranked GSM Set"}};
    for (const auto& [group, name] : filled)
        EXPECT_EQ(list(group, name), "[]") << name;
    receiveOneOfEach();
    for (const auto& [group, name] : empty)
        EXPECT_EQ(list(group, name), "[]") << name;
    // The cell information came last and told of serving cells only, so the lists it shares are empty again.
    EXPECT_EQ(list("UMTS", "UMTS Set"), "[]");
    EXPECT_EQ(list("GSM", "Neighboring Cells"), "[]");
    EXPECT_EQ(list("UMTS", "Active Set"),
        "[{\"Scrambling Code\": \"1\", \"RSCP\": \"-30 dB\", \"Energy Per Chip\": \"0 dB\"}]");
    EXPECT_EQ(list("Network", "Equivalent PLMN List"),
        "[{\"Mobile Country Code\": \"111\", \"Mobile Network Code\": \"111\"}]");
    EXPECT_EQ(list("GSM", "GSM Set"),
        "[{\"ARFCN\": \"257\", \"BSIC\": \"257\", \"RSSI\": \"1 dBm\", \"Ranking Value\": \"257\"}]");
}

TEST_F(ZPH_GSMTemplateTest, RowThatComesAndGoesMovesNoOther)
{
    const std::string before = radioResourceRows();
    receiveOneOfEach(); // the last takes the channel away and brings it back
    EXPECT_EQ(radioResourceRows(), before);
    EXPECT_EQ(before,
        "RRC State, Cell ID, Downlink Frequency, Uplink Frequency, Scrambling Code, URA ID, Transmit Power, Ciphering, "
        "UARFCN, ");
}

TEST_F(ZPH_GSMTemplateTest, NextServingCellRecordTakesTheChannelOfTheCellInformationAway)
{
    receiveOneOfEach();
    generator->updateState(state, RecordBuilder(0x4127, 29));
    EXPECT_FALSE(leaves().contains("UMTS: UMTS RR Info: UARFCN"));
}

} // namespace
} // namespace spectrel

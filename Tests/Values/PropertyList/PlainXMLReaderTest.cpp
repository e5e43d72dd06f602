#include "Values/PropertyList/PlainXMLReader.h"

#include "Tests/Values/PropertyList/ValueText.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"
#include "Values/PropertyList/XMLPropertyListForm.h"
#include "Values/PropertyList/XMLPropertyListReader.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <set>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

namespace {

ByteView bytesOf(std::string_view text)
{
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

std::string strictly(std::string_view document)
{
    const auto value = parseXMLPropertyList(bytesOf(document));
    return value ? valueText(*value) : "does not parse";
}

std::string document(std::string_view content)
{
    return std::string(XMLPropertyListHead) + std::string(content) + std::string(XMLPropertyListFoot);
}

/// Every property list of the golden recordings, each once.
std::set<std::string> recordedDocuments()
{
    std::set<std::string> documents;
    for (const auto& entry : std::filesystem::directory_iterator(SPECTREL_SOURCE_DIR "/Tests/Golden")) {
        if (entry.path().extension() != ".pcap")
            continue;
        std::ifstream file(entry.path(), std::ios::binary);
        const std::string bytes {std::istreambuf_iterator<char>(file), {}};
        for (auto start = bytes.find(XMLPropertyListHead); start != std::string::npos;) {
            const auto end = bytes.find(XMLPropertyListFoot, start) + XMLPropertyListFoot.size();
            documents.insert(bytes.substr(start, end - start));
            start = bytes.find(XMLPropertyListHead, end);
        }
    }
    return documents;
}

/// The shortest recorded lists: contexts, SIM files, cells, a whole report; and one with every kind of value.
std::vector<std::string> documentsToChange()
{
    std::vector<std::string> documents;
    for (const std::string_view mark : {"Context ID", "kSimFile_PNN", "NeighborCell", "Packet D", "CellTypeServing"}) {
        std::string shortest;
        for (const std::string& each : recordedDocuments()) {
            if (each.find(mark) != std::string::npos && (shortest.empty() || each.size() < shortest.size()))
                shortest = each;
        }
        if (!shortest.empty())
            documents.push_back(shortest);
    }
    documents.push_back(*serialisePropertyList(Dictionary::make({
        {"a<&>b", "x & y < z > \xC3\xA9\xE2\x82\xAC\xF0\x9F\x93\xB6"},
        {"numbers", List::make({Value::integer(-5), Integer::fromUnsigned(~std::uint64_t(0)), Value::real(-0.5)})},
        {"more", List::make({Value::boolean(true), Value::boolean(false), Date {86400.0}, Dictionary::make()})},
        {"data", std::make_shared<const Bytes>(Bytes(70, 0xA5))},
    })));
    return documents;
}

/// What the plain reader reads, the strict one reads as the same; how many of the documents it reads.
class Comparison {
public:
    void compare(const std::string& changed)
    {
        if (!readPlainXML(changed, _value))
            return; // the strict reader will judge
        ++read;
        ASSERT_EQ(valueText(_value), strictly(changed)) << changed;
    }

    std::size_t read = 0;

private:
    Value _value; // each is read over the one before
};

} // namespace

TEST(PlainXMLReader, ReadsEveryListOfTheGoldenRecordingsAsTheStrictReaderDoes)
{
    const auto documents = recordedDocuments();
    Comparison comparison;
    for (const std::string& each : documents)
        comparison.compare(each);
    EXPECT_EQ(comparison.read, documents.size());
    EXPECT_GT(documents.size(), 100U);
}

TEST(PlainXMLReader, ReadsWhatTheSerialiserWritesOfEveryKind)
{
    for (const std::string& each : documentsToChange()) {
        Value value;
        ASSERT_TRUE(readPlainXML(each, value)) << each;
        EXPECT_EQ(valueText(value), strictly(each));
    }
}

TEST(PlainXMLReader, ReadsNoPrefixOfADocument)
{
    for (const std::string& each : documentsToChange()) {
        for (std::size_t length = 0; length < each.size(); ++length) {
            Value value;
            EXPECT_FALSE(readPlainXML(std::string_view(each).substr(0, length), value)) << length;
        }
    }
}

/// In short documents every byte becomes every other one; in long ones some of those that matter, others at each place.
TEST(PlainXMLReader, AgreesWithTheStrictReaderOnEverySingleByteChange)
{
    constexpr std::size_t LongestChangedInFull = 1000;
    constexpr std::string_view Telling("\0\t\n\r !\"#&'/059;<=>A]_al\x7F\x80\xC3\xEF\xFF", 29);
    Comparison comparison;
    std::size_t changes = 0;
    for (const std::string& original : documentsToChange()) {
        const bool inFull = original.size() <= LongestChangedInFull;
        std::string changed = original;
        for (std::size_t place = 0; place < changed.size(); ++place) {
            for (std::size_t byte = inFull ? 0 : place % 7; byte < (inFull ? 256 : Telling.size());
                 byte += inFull ? 1 : 7) {
                changed[place] = inFull ? static_cast<char>(byte) : Telling[byte];
                comparison.compare(changed);
                ++changes;
            }
            changed[place] = original[place];
        }
    }
    EXPECT_GT(changes, 100'000U);
    EXPECT_GT(comparison.read, 1000U);
}

TEST(PlainXMLReader, AgreesWithTheStrictReaderOnEveryByteLeftOutOrPutInTwice)
{
    Comparison comparison;
    for (const std::string& original : documentsToChange()) {
        for (std::size_t place = 0; place < original.size(); ++place) {
            comparison.compare(original.substr(0, place) + original.substr(place + 1));
            comparison.compare(original.substr(0, place) + original[place] + original.substr(place));
        }
    }
    EXPECT_GT(comparison.read, 100U);
}

TEST(PlainXMLReader, LeavesToTheStrictReaderWhatTheSerialiserDoesNotWrite)
{
    for (const std::string_view content : {"<string>a\rb</string>", "<string>a>b</string>", "<string>&#65;</string>",
             "<string>&quot;</string>", "<string/>", "<!-- --><true/>", "<dict ></dict>", "<string>]]></string>",
             "<string>\x7F</string>", " <true/>", "<string><![CDATA[a]]></string>", "<true></true>", ""}) {
        Value value;
        EXPECT_FALSE(readPlainXML(document(content), value)) << content;
    }
    Value value;
    EXPECT_FALSE(readPlainXML(document("<true/>") + "\n", value));
    EXPECT_FALSE(readPlainXML("<plist><true/></plist>", value));
}

TEST(PlainXMLReader, KeepsTheLastValueOfAKeyGivenTwice)
{
    const std::string twice = document("<dict><key>a</key><integer>1</integer><key>b</key><integer>2</integer>"
                                       "<key>a</key><dict><key>c</key><true/></dict></dict>");
    Value value;
    ASSERT_TRUE(readPlainXML(twice, value));
    EXPECT_EQ(valueText(value), strictly(twice));
    ASSERT_TRUE(readPlainXML(twice, value)); // over itself
    EXPECT_EQ(valueText(value), strictly(twice));
}

TEST(PlainXMLReader, AllowsAsManyContainersWithinContainersAsTheStrictReader)
{
    for (const std::size_t depth : {PropertyListLimits::Depth, PropertyListLimits::Depth + 1}) {
        std::string content;
        for (std::size_t i = 0; i < depth; ++i)
            content += "<array>";
        for (std::size_t i = 0; i < depth; ++i)
            content += "</array>";
        Value value;
        EXPECT_EQ(readPlainXML(document(content), value), parseXMLPropertyList(bytesOf(document(content))).has_value());
        EXPECT_EQ(readPlainXML(document(content), value), depth == PropertyListLimits::Depth);
    }
}

TEST(ReadPropertyList, UsesTheContainersAndTextsOfTheEarlierListAgain)
{
    const auto written = [](const char* text) {
        return *serialisePropertyList(List::make({Dictionary::make({{"Name", text}, {"Number", Value::integer(1)}})}));
    };
    Value value;
    ASSERT_TRUE(readPropertyList(bytesOf(written("a text too long to stand in the string itself")), value));
    const Dictionary* const cell = (*value.list())[0].dictionary().get();
    const char* const characters = (*cell)["Name"].string()->data();
    ASSERT_TRUE(readPropertyList(bytesOf(written("another text too long for that, and shorter")), value));
    EXPECT_EQ((*value.list())[0].dictionary().get(), cell);
    EXPECT_EQ((*cell)["Name"].string()->data(), characters);
    EXPECT_EQ(*(*cell)["Name"].string(), "another text too long for that, and shorter");
}

TEST(ReadPropertyList, LeavesAloneWhatSomebodyElseHoldsOfTheEarlierList)
{
    const auto written = [](int number) {
        return *serialisePropertyList(List::make({Dictionary::make({{"Number", Value::integer(number)}})}));
    };
    Value value;
    ASSERT_TRUE(readPropertyList(bytesOf(written(1)), value));
    const Value held = (*value.list())[0];
    ASSERT_TRUE(readPropertyList(bytesOf(written(2)), value));
    EXPECT_EQ(valueText(held), valueText(Dictionary::make({{"Number", Value::integer(1)}})));
    EXPECT_EQ(valueText((*value.list())[0]), valueText(Dictionary::make({{"Number", Value::integer(2)}})));
}

TEST(ReadPropertyList, DropsTheEntriesOfTheEarlierListThatTheNewOneLacks)
{
    Value value;
    const auto read = [&value](const Value& list) {
        EXPECT_TRUE(readPropertyList(bytesOf(*serialisePropertyList(list)), value));
        EXPECT_EQ(valueText(value), valueText(list));
    };
    read(Dictionary::make({{"a", "1"}, {"b", "2"}, {"c", "3"}}));
    read(Dictionary::make({{"a", "1"}, {"c", "3"}, {"d", "4"}}));
    EXPECT_EQ(*(*value.dictionary())["d"].string(), "4");
    EXPECT_FALSE(value.dictionary()->contains("b"));
    read(Dictionary::make({{"a", List::make({"x", "y", "z"})}}));
    read(Dictionary::make({{"a", List::make({"x"})}}));
    read(Dictionary::make());
    read(List::make());
}

TEST(ReadPropertyList, IsAbsentWhenTheListDoesNotParse)
{
    Value value = Dictionary::make({{"a", "1"}});
    EXPECT_FALSE(readPropertyList(bytesOf(document("<dict><key>a</key></dict>")), value));
    EXPECT_TRUE(value.isAbsent());
}

} // namespace spectrel

#include "Tests/Values/PropertyList/ValueText.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>
#include <string>
#include <string_view>

namespace spectrel {

namespace {

std::string parsed(std::string_view text)
{
    const auto value = parsePropertyList({reinterpret_cast<const std::uint8_t*>(text.data()), text.size()});
    return value ? valueText(*value) : "does not parse";
}

std::string inPlist(std::string_view content)
{
    return parsed("<plist>" + std::string(content) + "</plist>");
}

constexpr const char* Refused = "does not parse";

bool parses(std::string_view content)
{
    const std::string text = "<plist>" + std::string(content) + "</plist>";
    return parsePropertyList({reinterpret_cast<const std::uint8_t*>(text.data()), text.size()}).has_value();
}

std::string repeated(std::string_view text, std::size_t count)
{
    std::string all;
    for (std::size_t i = 0; i < count; ++i)
        all += text;
    return all;
}

/// ASCII as UTF-16 with a byte-order mark.
std::string asUTF16(std::string_view text, bool bigEndian)
{
    std::string units = bigEndian ? "\xFE\xFF" : "\xFF\xFE";
    for (const char character : text) {
        if (bigEndian)
            units += '\0';
        units += character;
        if (!bigEndian)
            units += '\0';
    }
    return units;
}

} // namespace

TEST(XMLPropertyListTest, EveryKindIsRead)
{
    EXPECT_EQ(inPlist("<string>a&lt;b</string>"), "s613c62");
    EXPECT_EQ(inPlist("<integer>-5</integer>"), "i-5");
    EXPECT_EQ(inPlist("<real>1.0</real>"), "r3ff0000000000000");
    EXPECT_EQ(inPlist("<true/>"), "T");
    EXPECT_EQ(inPlist("<false></false>"), "F");
    EXPECT_EQ(inPlist("<date>2001-01-01T00:00:01Z</date>"), "t1");
    EXPECT_EQ(inPlist("<data>AP8=</data>"), "d00ff");
    EXPECT_EQ(inPlist("<array><string/><array/></array>"), "[s,[]]");
    EXPECT_EQ(inPlist("<dict><key>b</key><true/><key>a</key><dict/></dict>"), "{62:T,61:{}}");
}

TEST(XMLPropertyListTest, StandardHeadIsAccepted)
{
    EXPECT_EQ(parsed("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                     "<!DOCTYPE plist PUBLIC \"-//Apple//DTD PLIST 1.0//EN\" "
                     "\"http://www.apple.com/DTDs/PropertyList-1.0.dtd\">\n"
                     "<!-- a comment --><plist version=\"1.0\">\n\t<true/>\n</plist>\n"),
        "T");
}

TEST(XMLPropertyListTest, EncodingsAreTakenAsDeclared)
{
    EXPECT_EQ(parsed("\xEF\xBB\xBF<plist><string>\xC3\xA4</string></plist>"), "sc3a4");
    EXPECT_EQ(parsed(asUTF16("<plist><string>a</string></plist>", true)), "s61");
    EXPECT_EQ(parsed(asUTF16("<plist><string>a</string></plist>", false)), "s61");
    EXPECT_EQ(parsed("<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><plist><string>\xE4</string></plist>"), "sc3a4");
    EXPECT_EQ(parsed("<?xml version=\"1.0\" encoding=\"EBCDIC\"?><plist><string>a</string></plist>"), Refused);
    EXPECT_EQ(inPlist("<string>\xC3</string>"), Refused);
    EXPECT_EQ(inPlist("<string>\xED\xA0\x80</string>"), Refused);
}

TEST(XMLPropertyListTest, TextIsTakenAsItStands)
{
    EXPECT_EQ(inPlist("<string> a <!-- cut -->b<![CDATA[<&>]]>&#x41;&#233;</string>"),
        "s2061"
        "20623c263e41c3a9");
    EXPECT_EQ(inPlist("<string>a&#13;\r\nb</string>"), "s610d0a62"); // XML reads the end of a line as one newline
}

TEST(XMLPropertyListTest, KeyGivenTwiceKeepsItsPlaceAndTheLastValue)
{
    EXPECT_EQ(inPlist("<dict><key>a</key><true/><key>b</key><true/><key>a</key><false/></dict>"), "{61:F,62:T}");
}

TEST(XMLPropertyListTest, IntegersAreDecimalOrHexadecimalWithinTheirRange)
{
    const auto integer = [](const std::string& text) { return inPlist("<integer>" + text + "</integer>"); };
    EXPECT_EQ(integer("0x1F"), "i31");
    EXPECT_EQ(integer("-0X10"), "i-16");
    EXPECT_EQ(integer("+7"), "i7");
    EXPECT_EQ(integer("-0"), "i0");
    EXPECT_EQ(integer("007"), "i7");
    EXPECT_EQ(integer(" \n12\t"), "i12");
    EXPECT_EQ(integer("18446744073709551615"), "i18446744073709551615");
    EXPECT_EQ(integer("-9223372036854775808"), "i-9223372036854775808");
    for (const char* malformed : {"", " ", "abc", "12abc", "1 2", "1.0", "1e3", "--1", "+-1", "- 1", "0x", "0xG",
             "1_000", "18446744073709551616", "-9223372036854775809", "0x10000000000000000"})
        EXPECT_EQ(integer(malformed), Refused) << malformed;
}

TEST(XMLPropertyListTest, RealsAreStrict)
{
    const auto real = [](const std::string& text) { return inPlist("<real>" + text + "</real>"); };
    EXPECT_EQ(real("1"), "r3ff0000000000000");
    EXPECT_EQ(real(" -1.5e0 "), "rbff8000000000000");
    EXPECT_EQ(real("+.5"), "r3fe0000000000000");
    EXPECT_EQ(real("5e-324"), "r0000000000000001");
    EXPECT_EQ(real("inf"), "r7ff0000000000000");
    EXPECT_EQ(real("-infinity"), "rfff0000000000000");
    EXPECT_EQ(real("nan"), "rnan");
    for (const char* malformed :
        {"", "abc", "1.0abc", "1,0", "0x10", "--1", "-+1", "1e", "1e999", "1e-999", "nan(1)", ".", "1 2"})
        EXPECT_EQ(real(malformed), Refused) << malformed;
}

TEST(XMLPropertyListTest, DatesAreStrict)
{
    const auto date = [](const std::string& text) { return inPlist("<date>" + text + "</date>"); };
    EXPECT_EQ(date("2024-03-05T14:07:31Z"), "t731340451");
    EXPECT_EQ(date("2000-12-31T23:59:59Z"), "t-1");
    EXPECT_EQ(date("2000-02-29T00:00:00Z"), "t-26524800");
    for (const char* malformed :
        {"", "2024-03-05", "2024-03-05T14:07:31", "2024-03-05 14:07:31Z", "2024-13-05T14:07:31Z",
            "2023-02-29T14:07:31Z", "2024-03-05T24:07:31Z", "2024-03-05T14:60:31Z", "2024-03-05T14:07:60Z",
            "2024-03-05T14:07:31.5Z", "2024-03-05T14:07:3 Z", "2024-03-05T14:07:-1Z", "2024-3-5T14:07:31Z"})
        EXPECT_EQ(date(malformed), Refused) << malformed;
}

TEST(XMLPropertyListTest, DataIsBase64WithWhiteSpaceAnywhere)
{
    const auto data = [](const std::string& text) { return inPlist("<data>" + text + "</data>"); };
    EXPECT_EQ(data(""), "d");
    EXPECT_EQ(data("\n\t AA ==\n"), "d00");
    EXPECT_EQ(data("AAECAwQF"), "d000102030405");
    EXPECT_EQ(data("+/+/"), "dfbffbf");
    for (const char* malformed : {"A", "AA", "AAA", "AA=", "AAA==", "=", "====", "AA==AA==", "AAAA=", "AA=A",
             "AB==", "AAB=", "A-_A", "AA\xC3\xA4"})
        EXPECT_EQ(data(malformed), Refused) << malformed;
}

TEST(XMLPropertyListTest, MissingValuesDoNotParse)
{
    EXPECT_EQ(parsed(""), Refused);
    EXPECT_EQ(parsed("<plist/>"), Refused);
    EXPECT_EQ(inPlist("<dict><key>a</key></dict>"), Refused);
    EXPECT_EQ(inPlist("<dict><key>a</key><key>b</key><true/></dict>"), Refused);
    EXPECT_EQ(inPlist("<dict><true/></dict>"), Refused);
    EXPECT_EQ(inPlist("<dict><key>a</key><true/><true/></dict>"), Refused);
}

TEST(XMLPropertyListTest, TrailingGarbageDoesNotParse)
{
    EXPECT_EQ(parsed("<plist><true/></plist>x"), Refused);
    EXPECT_EQ(parsed("<plist><true/></plist><plist><true/></plist>"), Refused);
    EXPECT_EQ(parsed(std::string_view("<plist><true/></plist>\0", 23)), Refused);
    EXPECT_EQ(inPlist("<true/><true/>"), Refused);
    EXPECT_EQ(inPlist("<true/>x"), Refused);
    EXPECT_EQ(inPlist("x<true/>"), Refused);
}

TEST(XMLPropertyListTest, UnknownAndMisplacedElementsDoNotParse)
{
    EXPECT_EQ(inPlist("<set/>"), Refused);
    EXPECT_EQ(inPlist("<array><null/></array>"), Refused);
    EXPECT_EQ(inPlist("<Array/>"), Refused);
    EXPECT_EQ(inPlist("<key>a</key>"), Refused);
    EXPECT_EQ(inPlist("<array><key>a</key></array>"), Refused);
    EXPECT_EQ(inPlist("<string><true/></string>"), Refused);
    EXPECT_EQ(inPlist("<plist><true/></plist>"), Refused);
    EXPECT_EQ(inPlist("<dict>x<key>a</key><true/></dict>"), Refused);
    EXPECT_EQ(inPlist("<true>x</true>"), Refused);
    EXPECT_EQ(parsed("<true/>"), Refused);
    EXPECT_EQ(parsed("<dict></dict>"), Refused);
}

TEST(XMLPropertyListTest, TruncationAnywhereDoesNotParse)
{
    const std::string whole =
        "<?xml version=\"1.0\"?><plist><dict><key>a</key><array><integer>1</integer></array></dict></plist>";
    ASSERT_EQ(parsed(whole), "{61:[i1]}");
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_EQ(parsed(whole.substr(0, length)), Refused) << length;
}

TEST(XMLPropertyListTest, DeclaredEntitiesDoNotParse)
{
    EXPECT_EQ(parsed("<!DOCTYPE plist [<!ENTITY a \"b\">]><plist><string>&a;</string></plist>"), Refused);
    EXPECT_EQ(parsed("<!DOCTYPE plist [<!ENTITY a \"b\">]><plist><string>x</string></plist>"), Refused);
    EXPECT_EQ(parsed("<!DOCTYPE plist [<!ENTITY a SYSTEM \"file:///etc/passwd\">]><plist><string>&a;</string></plist>"),
        Refused);
    EXPECT_EQ(
        parsed("<!DOCTYPE plist [<!ENTITY % a SYSTEM \"file:///etc/passwd\"> %a;]><plist><true/></plist>"), Refused);
    EXPECT_EQ(parsed("<!DOCTYPE plist SYSTEM \"file:///etc/passwd\"><plist><string>&a;</string></plist>"), Refused);
    EXPECT_EQ(inPlist("<string>&a;</string>"), Refused);
}

TEST(XMLPropertyListTest, EntitiesThatMultiplyDoNotParse)
{
    std::string text = "<!DOCTYPE plist [<!ENTITY a0 \"lollollol\">";
    for (int i = 1; i < 30; ++i)
        text += "<!ENTITY a" + std::to_string(i) + " \"" + repeated("&a" + std::to_string(i - 1) + ";", 10) + "\">";
    EXPECT_EQ(parsed(text + "]><plist><string>&a29;</string></plist>"), Refused);
}

TEST(XMLPropertyListTest, DepthIsBounded)
{
    const auto nested = [](std::size_t depth) {
        return inPlist(repeated("<array>", depth) + repeated("</array>", depth));
    };
    EXPECT_EQ(nested(128), std::string(128, '[') + std::string(128, ']'));
    EXPECT_EQ(nested(129), Refused);
    EXPECT_EQ(nested(100000), Refused);
}

TEST(XMLPropertyListTest, NumberOfValuesIsBounded)
{
    // The array itself is one of them.
    EXPECT_TRUE(parses("<array>" + repeated("<true/>", 999'999) + "</array>"));
    EXPECT_FALSE(parses("<array>" + repeated("<true/>", 1'000'000) + "</array>"));
}

TEST(XMLPropertyListTest, TextsAndDataTogetherAreBounded)
{
    const std::string half(32 * 1024 * 1024, 'x');
    EXPECT_TRUE(parses("<dict><key>" + half + "</key><string>" + half + "</string></dict>"));
    EXPECT_FALSE(parses("<dict><key>" + half + "</key><string>" + half + "x</string></dict>"));
    EXPECT_FALSE(parses("<array><string>" + half + half + "</string><data>AA==</data></array>"));
}

} // namespace spectrel

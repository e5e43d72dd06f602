#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Fakes/SourceFolder.h"
#include "Tests/Values/PropertyList/ValueText.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <bit>
#include <cmath>
#include <cstdlib>
#include <gtest/gtest.h>
#include <random>

namespace spectrel {

namespace {

constexpr int Lists = 200;

/// Runs PropertyListCorpus.py; true when it ends well.
bool runScript(const std::string& arguments)
{
    const std::string command =
        "/usr/bin/env python3 '" + sourcePath("Tests/Values/PropertyList/PropertyListCorpus.py") + "' " + arguments;
    return std::system(command.c_str()) == 0;
}

std::string parsed(const std::string& path)
{
    const auto value = readPropertyListFile(path);
    return value ? valueText(*value) : "does not parse";
}

class RandomValues {
public:
    explicit RandomValues(std::uint32_t seed)
        : _random(seed)
    {
    }

    Value value(int depth)
    {
        switch (_random() % (depth < 5 ? 9 : 7)) {
        case 0:
            return integer();
        case 1:
            return Value::real(real());
        case 2:
            return Value::boolean(_random() % 2 == 0);
        case 3:
            return Date {static_cast<double>(static_cast<std::int64_t>(_random() % 300'000'000'000) - 60'000'000'000)};
        case 4:
            return data();
        case 5:
        case 6:
            return text();
        case 7:
            return list(depth);
        default:
            return dictionary(depth);
        }
    }

private:
    std::string text()
    {
        static constexpr std::string_view Pieces[] = {"a", "Z", "9", " ", "\t", "\n", "\r", "<", ">", "&", "]]>", "\"",
            "\x7f", "\xC2\x80", "\xC3\xA4", "\xE2\x82\xAC", "\xEF\xBF\xBD", "\xF0\x9F\x93\xB6", "\xF4\x8F\xBF\xBF"};
        std::string text;
        for (auto count = _random() % 30; count > 0; --count)
            text += Pieces[_random() % std::size(Pieces)];
        return text;
    }
    Value integer()
    {
        const std::uint64_t bits = _random() >> _random() % 64;
        return _random() % 2 == 0 ? Integer::fromUnsigned(bits) : Integer::fromSigned(static_cast<std::int64_t>(bits));
    }
    double real()
    {
        return std::bit_cast<double>(_random());
    }
    Value data()
    {
        Bytes bytes(_random() % 200);
        for (auto& byte : bytes)
            byte = static_cast<std::uint8_t>(_random());
        return std::make_shared<const Bytes>(std::move(bytes));
    }
    Value list(int depth)
    {
        const auto list = List::make();
        for (auto count = _random() % 8; count > 0; --count)
            list->append(value(depth + 1));
        return list;
    }
    Value dictionary(int depth)
    {
        const auto dictionary = Dictionary::make();
        for (auto count = _random() % 8; count > 0; --count)
            dictionary->set(text(), value(depth + 1));
        return dictionary;
    }

    std::mt19937_64 _random;
};

} // namespace

TEST(PropertyListPythonTest, ListsThatPythonWroteReadAsWritten)
{
    const ScratchFolder folder;
    ASSERT_TRUE(runScript("make '" + folder.path().string() + "' 5 " + std::to_string(Lists)));
    for (int i = 0; i < Lists; ++i) {
        const std::string name = std::to_string(i);
        const std::string expected = folder.read(name + ".txt");
        ASSERT_EQ(parsed(folder.file(name + ".xml")), expected) << name;
        ASSERT_EQ(parsed(folder.file(name + ".bin")), expected) << name;
    }
}

TEST(PropertyListPythonTest, PythonReadsWhatWasWritten)
{
    const ScratchFolder folder;
    RandomValues values(11);
    for (int i = 0; i < Lists; ++i) {
        const Value value = values.value(0);
        const std::string name = std::to_string(i);
        ASSERT_TRUE(writePropertyListToFile(value, folder.file(name + ".plist")));
        folder.write(name + ".txt", valueText(value));
        ASSERT_EQ(parsed(folder.file(name + ".plist")), valueText(value));
    }
    EXPECT_TRUE(runScript("check '" + folder.path().string() + "'"));
}

} // namespace spectrel

#include "Values/Dictionary.h"

#include "Values/List.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <random>
#include <vector>

namespace spectrel {

namespace {

/// The keys in their order, each followed by a blank.
std::string keys(const Dictionary& dictionary)
{
    std::string text;
    for (const auto& entry : dictionary.entries())
        text += entry.key + " ";
    return text;
}

} // namespace

TEST(DictionaryTest, KeepsInsertionOrderAndOverwritingKeepsThePlace)
{
    Dictionary dictionary {{"c", "1"}, {"a", "2"}, {"b", "3"}};
    dictionary.set("a", "new");
    dictionary.setText("c", "also new");
    EXPECT_EQ(keys(dictionary), "c a b ");
    EXPECT_EQ(*dictionary["a"].string(), "new");
}

TEST(DictionaryTest, RemovingAndStoringAgainAppends)
{
    Dictionary dictionary {{"a", "1"}, {"b", "2"}, {"c", "3"}};
    dictionary.remove("a");
    dictionary.set("a", "4");
    EXPECT_EQ(keys(dictionary), "b c a ");
}

TEST(DictionaryTest, MissingKeyReadsAsAbsent)
{
    const Dictionary dictionary {{"a", "1"}};
    EXPECT_TRUE(dictionary["b"].isAbsent());
    EXPECT_FALSE(dictionary.contains("b"));
    EXPECT_TRUE(dictionary.contains("a"));
}

TEST(DictionaryTest, AbsentValueRemovesTheKey)
{
    Dictionary dictionary {{"a", "1"}, {"b", "2"}};
    dictionary.set("a", Value());
    dictionary.set("never there", Value());
    EXPECT_EQ(keys(dictionary), "b ");
}

TEST(DictionaryTest, TextOverAnotherKindReplacesIt)
{
    Dictionary dictionary {{"a", List::make()}};
    dictionary.setText("a", "text");
    EXPECT_EQ(*dictionary["a"].string(), "text");
}

TEST(DictionaryTest, CopySharesTheContainersInside)
{
    const Dictionary dictionary {{"inner", Dictionary::make()}, {"text", "x"}};
    const DictionaryRef copied = dictionary.copy();
    copied->setText("text", "y");
    (*copied)["inner"].dictionary()->setText("k", "v");
    EXPECT_EQ(*dictionary["text"].string(), "x");
    EXPECT_TRUE(dictionary["inner"].dictionary()->contains("k"));
}

TEST(DictionaryTest, RemoveAllEmptiesAndTakesNewKeys)
{
    Dictionary dictionary {{"a", "1"}, {"b", "2"}};
    dictionary.removeAll();
    EXPECT_EQ(dictionary.count(), 0u);
    dictionary.set("b", "3");
    EXPECT_EQ(keys(dictionary), "b ");
}

/// Any sequence of operations, small and large, behaves as a plain list of pairs would.
TEST(DictionaryTest, BehavesAsAListOfPairsAtEverySize)
{
    std::mt19937 random(20240305);
    Dictionary dictionary;
    std::vector<std::pair<std::string, std::string>> pairs;
    for (int step = 0; step < 20000; ++step) {
        const std::string key = std::to_string(random() % (step % 4000 < 2000 ? 20 : 300));
        const auto known =
            std::find_if(pairs.begin(), pairs.end(), [&](const auto& pair) { return pair.first == key; });
        ASSERT_EQ(dictionary.contains(key), known != pairs.end());
        if (random() % 4 == 0) {
            dictionary.remove(key);
            if (known != pairs.end())
                pairs.erase(known);
        } else {
            const std::string text = std::to_string(step);
            dictionary.setText(key, text);
            if (known != pairs.end())
                known->second = text;
            else
                pairs.emplace_back(key, text);
        }
        if (step == 9999)
            dictionary.removeAll(), pairs.clear();
    }
    ASSERT_EQ(dictionary.count(), pairs.size());
    for (std::size_t i = 0; i < pairs.size(); ++i) {
        EXPECT_EQ(dictionary.entries()[i].key, pairs[i].first);
        EXPECT_EQ(*dictionary[pairs[i].first].string(), pairs[i].second);
    }
}

} // namespace spectrel

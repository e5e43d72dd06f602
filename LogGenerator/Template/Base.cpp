#include "LogGenerator/Template/Base.h"

#include "LogGenerator/Template/ArrayLock.h"
#include "Platform/SystemLog.h"
#include "Values/Dictionary.h"

#include <algorithm>
#include <array>
#include <utility>

namespace spectrel {

namespace {

struct Rung {
    std::uint32_t above;
    std::int16_t decibels;
};

constexpr std::uint32_t FullScale = 524288;

// The last two rungs both give -31: there is no -32, and that stays so.
constexpr std::array<Rung, 32> EcnoLadder {{
    {417647, -1},
    {331808, -2},
    {263624, -3},
    {209463, -4},
    {166441, -5},
    {132268, -6},
    {105123, -7},
    {83562, -8},
    {66435, -9},
    {52830, -10},
    {42023, -11},
    {33440, -12},
    {26621, -13},
    {21205, -14},
    {16903, -15},
    {13486, -16},
    {10771, -17},
    {8615, -18},
    {6902, -19},
    {5542, -20},
    {4461, -21},
    {3603, -22},
    {2921, -23},
    {2240, -24},
    {1949, -25},
    {1607, -26},
    {1336, -27},
    {1120, -28},
    {949, -29},
    {813, -30},
    {756, -31},
    {705, -31},
}};
static_assert(std::ranges::is_sorted(EcnoLadder, std::ranges::greater(), &Rung::above));

} // namespace

void Base::enterInto(ClassDictionary& dict, CodeDictionary& codeDict)
{
    dict.insert_or_assign(std::string(getSectionName()), this);
    updateLogCodeDict(codeDict);
}

void Base::updateSectionRef(Value node)
{
    sectionRef = std::move(node);
    const std::string_view name = getSectionName();
    SPECTREL_LOG(log(), Priority::Warning, "%.*s", static_cast<int>(name.size()), name.data());
}

void Base::updateLogCodeDict(CodeDictionary& codeDict)
{
    const auto codes = getLogCodeArray();
    SPECTREL_LOG(log(), Priority::Warning, "Array Count: %d", static_cast<int>(codes.size()));
    for (const std::uint32_t code : codes)
        codeDict.subscribe(code, *this);
}

void Base::clearElementsInArray(List& array)
{
    ArrayLock::lockArray();
    array.removeAll();
    ArrayLock::unlockArray();
}

void Base::replaceArray(List& array, const List& elements)
{
    ArrayLock::lockArray();
    array.removeAll();
    for (const Value& element : elements.elements())
        array.append(element);
    ArrayLock::unlockArray();
}

std::int16_t Base::lookUpECNO(std::uint32_t ratio)
{
    if (ratio >= FullScale)
        return 0;
    const auto rung = std::ranges::find_if(EcnoLadder, [ratio](const Rung& each) { return ratio > each.above; });
    return rung == EcnoLadder.end() ? std::int16_t(0) : rung->decibels;
}

void Base::storeText(std::string_view key, std::string_view text)
{
    if (const auto& section = sectionRef.dictionary())
        section->setText(key, text);
}

void Base::store(std::string_view key, const Value& value)
{
    if (const auto& section = sectionRef.dictionary())
        section->set(key, value);
}

void Base::removeKey(std::string_view key)
{
    if (const auto& section = sectionRef.dictionary())
        section->remove(key);
}

void Base::storeFields(RecordView record, std::span<const Field> fields)
{
    if (const auto& section = sectionRef.dictionary())
        spectrel::storeFields(record, fields, *section);
}

void Base::storeCellFields(const Dictionary& cell, std::span<const CellField> fields)
{
    Dictionary lost; // takes the values of a section that has no dictionary
    const auto& section = sectionRef.dictionary();
    storeCell(log(), cell, fields, section ? *section : lost);
}

void Base::clearList()
{
    if (const auto& list = sectionRef.list())
        clearElementsInArray(*list);
}

void Base::replaceList(const List& elements)
{
    if (const auto& list = sectionRef.list())
        replaceArray(*list, elements);
}

void Base::logUnknownMessage(std::uint32_t logCode) const
{
    SPECTREL_LOG(log(), Priority::Error, "Received an unknown log message: %d", static_cast<int>(logCode));
}

} // namespace spectrel

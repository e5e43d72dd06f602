#include "CommandLine/Output/DisplayChanges.h"

#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Values/List.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <functional>
#include <iterator>
#include <optional>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace spectrel {

namespace {

/// Calls `visit(name, value)` for each child of a container, in the order in which it is shown.
template <typename Visit> void forEachShownChild(const Value& container, Visit visit)
{
    if (const auto& dictionary = container.dictionary())
        return forEachDisplayChild(*dictionary, visit);
    char name[24];
    std::size_t position = 0;
    for (const Value& element : container.list()->elements()) {
        const auto end = std::to_chars(name, name + sizeof name, position++).ptr;
        visit(std::string_view(name, static_cast<std::size_t>(end - name)), element);
    }
}

} // namespace

/// The shadows of children that do not stand where they stood, taken out by name, namesakes in their order.
class DisplayChanges::FormerChildren {
public:
    FormerChildren(ShadowList children, std::uint64_t& comparisons)
        : _children(std::move(children))
        , _firstOf(0, {}, {&comparisons})
        , _namesakeBehind(_children.size(), None)
    {
        for (std::size_t position = _children.size(); position-- > 0;) {
            const auto [first, isNew] = _firstOf.try_emplace(_children[position]->name, position);
            if (!isNew)
                _namesakeBehind[position] = std::exchange(first->second, position);
        }
    }

    /// Null when there is none of the name left.
    ShadowRef take(std::string_view name)
    {
        const auto found = _firstOf.find(name);
        if (found == _firstOf.end() || found->second == None)
            return nullptr;
        const std::size_t position = std::exchange(found->second, _namesakeBehind[found->second]);
        return std::move(_children[position]);
    }
    /// Appends what is left, in its order.
    void appendRest(ShadowList& to)
    {
        for (ShadowRef& child : _children) {
            if (child)
                to.push_back(std::move(child));
        }
    }

private:
    static constexpr std::size_t None = static_cast<std::size_t>(-1);

    struct CountedEquality {
        std::uint64_t* count;
        bool operator()(std::string_view left, std::string_view right) const
        {
            ++*count;
            return left == right;
        }
    };

    ShadowList _children;
    std::unordered_map<std::string_view, std::size_t, std::hash<std::string_view>, CountedEquality>
        _firstOf; // the names belong to the shadows, wherever they are
    std::vector<std::size_t> _namesakeBehind;
};

/// Makes the path that of a child, and the container's again when it goes.
class DisplayChanges::Step {
public:
    Step(std::string& path, std::string_view name)
        : _path(path)
        , _length(path.size())
    {
        appendPathComponent(path, name);
    }
    Step(const Step&) = delete;
    Step& operator=(const Step&) = delete;
    ~Step()
    {
        _path.resize(_length);
    }

private:
    std::string& _path;
    std::size_t _length;
};

void DisplayChanges::update(const Value& display, Journal& journal, const Report& report)
{
    _path = "/";
    if (!display.isAbsent()) {
        updateNode(_root, !std::exchange(_isShown, true), display, report);
    } else if (std::exchange(_isShown, false)) {
        reportGone(_root, report);
        _root = {};
        _root.position = _paths.root();
    }
    _period = journal.beginPeriod();
}

DisplayChanges::Shadow DisplayChanges::shadowBelow(const Shadow& parent, std::string_view name) const
{
    Shadow shadow;
    shadow.name = name;
    shadow.position = _paths.below(parent.position, name);
    return shadow;
}

void DisplayChanges::updateNode(Shadow& shadow, bool isNew, const Value& value, const Report& report)
{
    if (!_paths.reaches(shadow.position))
        return;
    if (value.dictionary() || value.list())
        return updateContainer(shadow, isNew, value, report);
    if (!isNew && !shadow.isLeaf) {
        reportGone(shadow, report);
        shadow.children.clear();
        shadow.container = 0;
    }
    if (!_paths.takesLeaf(shadow.position))
        return;
    const std::string_view text = value.string() ? std::string_view(*value.string()) : UnknownText;
    shadow.isReported = isNew || !shadow.isLeaf || shadow.value != text;
    shadow.isLeaf = true;
    if (shadow.isReported) {
        shadow.value = text;
        report(_path, &shadow.value);
    }
}

void DisplayChanges::updateContainer(Shadow& shadow, bool isNew, const Value& value, const Report& report)
{
    const Journal::Stamp stamp = Journal::stampOf(value);
    const bool isKnown = std::exchange(shadow.container, stamp.number) == stamp.number && stamp.number != 0;
    if (isKnown && stamp.changed < _period) {
        if (stamp.changedWithin >= _period)
            updateBelow(shadow, value, report);
        return;
    }
    if (!isNew && shadow.isLeaf)
        reportGone(shadow, report);
    shadow.isLeaf = false;
    shadow.isReported = false;
    updateChildren(shadow, value, report);
}

/// The children are those that were there, but some of them have changed inside.
void DisplayChanges::updateBelow(Shadow& shadow, const Value& value, const Report& report)
{
    std::size_t position = 0;
    forEachShownChild(value, [&](std::string_view name, const Value& child) {
        Shadow& childShadow = *shadow.children[position++];
        ++_comparisons;
        if (Journal::stampOf(child).changedWithin < _period)
            return;
        const Step step(_path, name);
        updateNode(childShadow, false, child, report);
    });
}

void DisplayChanges::updateChildren(Shadow& shadow, const Value& value, const Report& report)
{
    ShadowList& children = shadow.children;
    std::size_t count = 0; // of the children that are there
    std::optional<FormerChildren> former; // from the first one on that does not stand where it stood
    forEachShownChild(value, [&](std::string_view name, const Value& child) {
        const Step step(_path, name);
        if (!former && count < children.size()) {
            ++_comparisons;
            if (children[count]->name == name)
                return updateNode(*children[count++], false, child, report);
            former.emplace(takeFrom(children, count), _comparisons);
        }
        ShadowRef childShadow = former ? former->take(name) : nullptr;
        const bool isNew = !childShadow;
        if (isNew)
            childShadow = std::make_unique<Shadow>(shadowBelow(shadow, name));
        updateNode(*childShadow, isNew, child, report);
        children.push_back(std::move(childShadow));
        ++count;
    });
    if (former)
        former->appendRest(children);
    if (value.dictionary() && value.dictionary()->contains(SortedMarker))
        settleNamesakes(shadow, count, report);
    for (std::size_t gone = count; gone < children.size(); ++gone) {
        const Step step(_path, children[gone]->name);
        reportGone(*children[gone], report);
    }
    children.resize(count);
}

/// Takes the shadows from the position on out of the list.
DisplayChanges::ShadowList DisplayChanges::takeFrom(ShadowList& children, std::size_t position)
{
    const auto first = children.begin() + static_cast<std::ptrdiff_t>(position);
    ShadowList taken(std::make_move_iterator(first), std::make_move_iterator(children.end()));
    children.resize(position);
    return taken;
}

/// Children under different keys may share a name, and so a path, where the last of them stands. That one is reported
/// once more behind an earlier one's change, and none is gone while a namesake stays. The first `count` are there.
void DisplayChanges::settleNamesakes(Shadow& parent, std::size_t count, const Report& report)
{
    std::vector<std::size_t> byName(parent.children.size());
    for (std::size_t position = 0; position < byName.size(); ++position)
        byName[position] = position;
    const auto child = [&parent](std::size_t position) -> Shadow& { return *parent.children[position]; };
    std::ranges::stable_sort(byName, {}, [&](std::size_t position) -> std::string& { return child(position).name; });
    for (auto first = byName.begin(); first != byName.end();) {
        const auto behind = std::find_if(
            first, byName.end(), [&](std::size_t position) { return child(position).name != child(*first).name; });
        const auto gone = std::find_if(first, behind, [count](std::size_t position) { return position >= count; });
        if (gone != first && child(gone[-1]).isLeaf) {
            Shadow& last = child(gone[-1]);
            const bool isDisturbed = gone != behind
                || std::any_of(first, gone - 1, [&](std::size_t position) { return child(position).isReported; });
            for (auto lost = gone; lost != behind; ++lost)
                child(*lost).isLeaf = false; // so that it goes without a word
            if (isDisturbed && !last.isReported)
                report(pathByAppending(_path, last.name), &last.value);
        }
        first = behind;
    }
}

void DisplayChanges::reportGone(const Shadow& shadow, const Report& report)
{
    if (shadow.isLeaf)
        return report(_path, nullptr);
    for (const ShadowRef& child : shadow.children) {
        const Step step(_path, child->name);
        reportGone(*child, report);
    }
}

} // namespace spectrel

#include "CommandLine/Output/DisplayChanges.h"

#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Values/List.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <functional>
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

/// The shadows of a container's children as they stood, taken out by name, namesakes in their order.
///
/// While the names come in the same order, the next one is at hand; from the first that does not they are looked up.
class DisplayChanges::FormerChildren {
public:
    FormerChildren(ShadowList children, std::uint64_t& comparisons)
        : _children(std::move(children))
        , _isSame {&comparisons}
        , _firstOf(0, {}, _isSame)
    {
    }

    /// Null when there is none of the name left.
    ShadowRef take(std::string_view name)
    {
        if (!_isIndexed) {
            if (_next < _children.size() && _isSame(_children[_next]->name, name))
                return std::move(_children[_next++]);
            makeIndex();
        }
        const auto found = _firstOf.find(name);
        if (found == _firstOf.end() || found->second == None)
            return nullptr;
        const std::size_t position = std::exchange(found->second, _namesakeBehind[found->second]);
        return std::move(_children[position]);
    }
    /// Appends what is left, in its order.
    void appendRest(ShadowList& to)
    {
        for (; _next < _children.size(); ++_next) {
            if (_children[_next])
                to.push_back(std::move(_children[_next]));
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

    void makeIndex()
    {
        _isIndexed = true;
        _namesakeBehind.resize(_children.size(), None);
        for (std::size_t position = _children.size(); position-- > _next;) {
            const auto [first, isNew] = _firstOf.try_emplace(_children[position]->name, position);
            if (!isNew)
                _namesakeBehind[position] = std::exchange(first->second, position);
        }
    }

    ShadowList _children;
    CountedEquality _isSame;
    std::size_t _next = 0; // those before were taken
    bool _isIndexed = false;
    std::unordered_map<std::string_view, std::size_t, std::hash<std::string_view>, CountedEquality>
        _firstOf; // the names belong to the shadows, wherever they are
    std::vector<std::size_t> _namesakeBehind;
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
    const std::string parentPath = _path;
    std::size_t position = 0;
    forEachShownChild(value, [&](std::string_view name, const Value& child) {
        Shadow& childShadow = *shadow.children[position++];
        ++_comparisons;
        if (Journal::stampOf(child).changedWithin < _period)
            return;
        _path = pathByAppending(parentPath, name);
        updateNode(childShadow, false, child, report);
    });
    _path = parentPath;
}

void DisplayChanges::updateChildren(Shadow& shadow, const Value& value, const Report& report)
{
    const std::string parentPath = _path;
    FormerChildren former(std::exchange(shadow.children, {}), _comparisons);
    forEachShownChild(value, [&](std::string_view name, const Value& child) {
        ShadowRef childShadow = former.take(name);
        const bool isNew = !childShadow;
        if (isNew)
            childShadow = std::make_unique<Shadow>(shadowBelow(shadow, name));
        _path = pathByAppending(parentPath, name);
        updateNode(*childShadow, isNew, child, report);
        shadow.children.push_back(std::move(childShadow));
    });
    _path = parentPath;
    const std::size_t count = shadow.children.size();
    former.appendRest(shadow.children);
    if (value.dictionary() && value.dictionary()->contains(SortedMarker))
        settleNamesakes(shadow, count, report);
    for (std::size_t gone = count; gone < shadow.children.size(); ++gone) {
        _path = pathByAppending(parentPath, shadow.children[gone]->name);
        reportGone(*shadow.children[gone], report);
    }
    shadow.children.resize(count);
    _path = parentPath;
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
    const std::string parentPath = _path;
    for (const ShadowRef& child : shadow.children) {
        _path = pathByAppending(parentPath, child->name);
        reportGone(*child, report);
    }
    _path = parentPath;
}

} // namespace spectrel

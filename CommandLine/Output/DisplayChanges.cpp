#include "CommandLine/Output/DisplayChanges.h"

#include "CommandLine/Output/DisplayPrinter.h"
#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Values/List.h"

#include <algorithm>
#include <charconv>
#include <functional>
#include <utility>

namespace spectrel {

void DisplayChanges::update(const Value& display, const Report& report)
{
    _path = "/";
    if (!display.isAbsent()) {
        updateNode(_root, !std::exchange(_isShown, true), display, report);
    } else if (std::exchange(_isShown, false)) {
        reportGone(_root, report);
        _root = {};
    }
}

void DisplayChanges::updateNode(Shadow& shadow, bool isNew, const Value& value, const Report& report)
{
    if (value.dictionary() || value.list()) {
        if (!isNew && shadow.isLeaf)
            reportGone(shadow, report);
        shadow.isLeaf = false;
        shadow.isTold = false;
        return updateChildren(shadow, value, report);
    }
    if (!isNew && !shadow.isLeaf) {
        reportGone(shadow, report);
        shadow.children.clear();
    }
    const std::string_view text = value.string() ? std::string_view(*value.string()) : std::string_view(UnknownText);
    shadow.isTold = isNew || !shadow.isLeaf || shadow.value != text;
    shadow.isLeaf = true;
    if (shadow.isTold) {
        shadow.value = text;
        report(_path, &shadow.value);
    }
}

void DisplayChanges::updateChildren(Shadow& shadow, const Value& value, const Report& report)
{
    const std::string parentPath = _path;
    std::size_t position = 0;
    const auto visit = [&](std::string_view name, const Value& child) {
        bool isNew = false;
        Shadow& childShadow = shadowOf(shadow, position++, name, isNew);
        _path = pathByAppending(parentPath, name);
        updateNode(childShadow, isNew, child, report);
    };
    if (const auto& dictionary = value.dictionary()) {
        forEachDisplayChild(*dictionary, visit);
    } else {
        char name[24];
        for (const Value& element : value.list()->elements()) {
            const auto end = std::to_chars(name, name + sizeof name, position).ptr;
            visit({name, static_cast<std::size_t>(end - name)}, element);
        }
    }
    if (value.dictionary() && value.dictionary()->contains(SortedMarker))
        settleNamesakes(shadow, position, parentPath, report);
    for (std::size_t gone = position; gone < shadow.children.size(); ++gone) {
        _path = pathByAppending(parentPath, shadow.children[gone].name);
        reportGone(shadow.children[gone], report);
    }
    shadow.children.resize(position);
    _path = parentPath;
}

/// The shadow of the child now at `position`: usually there already, otherwise found further on or made.
DisplayChanges::Shadow& DisplayChanges::shadowOf(
    Shadow& parent, std::size_t position, std::string_view name, bool& isNew)
{
    auto& children = parent.children;
    const auto place = children.begin() + static_cast<std::ptrdiff_t>(position);
    const auto found = std::find_if(place, children.end(), [name](const Shadow& child) { return child.name == name; });
    if (found == children.end()) {
        isNew = true;
        return *children.insert(place, Shadow {std::string(name), {}, false, false, {}});
    }
    std::rotate(place, found, found + 1);
    return *place;
}

/// Children under different keys may share a name, and so a path, where the last of them stands. That one is told once
/// more behind an earlier one's change, and none is gone while a namesake stays. The first `count` children are there.
void DisplayChanges::settleNamesakes(
    Shadow& parent, std::size_t count, const std::string& parentPath, const Report& report)
{
    std::vector<Shadow*> byName;
    byName.reserve(parent.children.size());
    for (Shadow& child : parent.children)
        byName.push_back(&child);
    std::ranges::stable_sort(byName, {}, &Shadow::name);
    const Shadow* const end = parent.children.data() + count;
    for (auto first = byName.begin(); first != byName.end();) {
        const auto behind =
            std::find_if(first, byName.end(), [first](const Shadow* child) { return child->name != (*first)->name; });
        const auto gone = std::find_if(first, behind, [end](const Shadow* child) { return child >= end; });
        if (gone != first && gone[-1]->isLeaf) {
            Shadow& last = *gone[-1];
            const bool isDisturbed = gone != behind || std::any_of(first, gone - 1, std::mem_fn(&Shadow::isTold));
            for (auto lost = gone; lost != behind; ++lost)
                (*lost)->isLeaf = false; // so that it goes without a word
            _path = pathByAppending(parentPath, last.name);
            if (isDisturbed && !last.isTold)
                report(_path, &last.value);
        }
        first = behind;
    }
}

void DisplayChanges::reportGone(const Shadow& shadow, const Report& report)
{
    if (shadow.isLeaf)
        return report(_path, nullptr);
    const std::string parentPath = _path;
    for (const Shadow& child : shadow.children) {
        _path = pathByAppending(parentPath, child.name);
        reportGone(child, report);
    }
    _path = parentPath;
}

} // namespace spectrel

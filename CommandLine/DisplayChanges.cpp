#include "CommandLine/DisplayChanges.h"

#include "CommandLine/DisplayPrinter.h"
#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Platform/List.h"

#include <algorithm>
#include <charconv>
#include <span>
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
        return updateChildren(shadow, value, report);
    }
    if (!isNew && !shadow.isLeaf) {
        reportGone(shadow, report);
        shadow.children.clear();
    }
    const std::string_view text = value.string() ? std::string_view(*value.string()) : std::string_view(UnknownText);
    if (isNew || !shadow.isLeaf || shadow.value != text) {
        shadow.value = text;
        report(_path, &shadow.value);
    }
    shadow.isLeaf = true;
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
    reportGoneChildren(shadow, position, parentPath, report);
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
        return *children.insert(place, Shadow {std::string(name), {}, false, {}});
    }
    std::rotate(place, found, found + 1);
    return *place;
}

/// Of the children from `position` on. Sorted entries may be displayed under one name: where one of them stays, what
/// is at their path has not gone.
void DisplayChanges::reportGoneChildren(
    const Shadow& parent, std::size_t position, const std::string& parentPath, const Report& report)
{
    const auto stay = std::span(parent.children).first(position);
    for (const Shadow& child : std::span(parent.children).subspan(position)) {
        const bool isStillThere = child.isLeaf && std::ranges::any_of(stay, [&child](const Shadow& other) {
            return other.isLeaf && other.name == child.name;
        });
        if (isStillThere)
            continue;
        _path = pathByAppending(parentPath, child.name);
        reportGone(child, report);
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

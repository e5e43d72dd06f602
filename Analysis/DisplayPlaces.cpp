#include "Analysis/DisplayPlaces.h"

#include "Monitor/DisplayOrder.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

/// Containers that come and go (reports that are dictionaries anew each time) are let go of beyond this number.
constexpr std::size_t MaxKnown = 256;
constexpr std::size_t MaxSeenKeys = 128;

} // namespace

int DisplayPlaces::watchLeaf(std::string_view container, std::string_view key)
{
    Node& node = *nodeAt(container);
    const auto known = std::ranges::find(node.watched, key, &KnownKey::key);
    if (known != node.watched.end())
        return known->leaf;
    const int leaf = static_cast<int>(_leaves.size());
    _leaves.push_back(std::string(container) + "/" + std::string(key));
    node.watched.push_back({std::string(key), leaf});
    return leaf;
}

int DisplayPlaces::watchList(std::string_view container)
{
    Node& node = *nodeAt(container);
    if (node.list == None)
        node.list = _lists++;
    return node.list;
}

DisplayPlaces::Node* DisplayPlaces::nodeAt(std::string_view container)
{
    Node* node = &_nodes.front();
    while (!container.empty()) {
        container.remove_prefix(1); // the slash
        const std::string_view name = container.substr(0, container.find('/'));
        container.remove_prefix(name.size());
        Node* child = childOf(*node, name);
        if (!child) {
            child = &_nodes.emplace_back();
            node->children.emplace_back(name, child);
        }
        node = child;
    }
    return node;
}

DisplayPlaces::Node* DisplayPlaces::childOf(Node& node, std::string_view name)
{
    const auto child =
        std::ranges::find(node.children, name, [](const auto& one) -> const std::string& { return one.first; });
    return child == node.children.end() ? nullptr : child->second;
}

DisplayPlaces::Found DisplayPlaces::find(const Journal::Change& change, std::string_view key)
{
    if (!change.place)
        return {};
    Node& node = *nodeOf(change.place);
    if (node.list != None)
        return {None, node.list};
    if (node.watched.empty() && node.children.empty())
        return {};
    const int leaf = leafOf(node, key, change.place->isSorted);
    if (leaf != None)
        return {leaf, None};
    const Node* const child = childOf(node, change.place->isSorted ? sortedKeyName(key) : key);
    return {None, child ? child->list : None}; // a list that stands as a text, such as "(none)"
}

DisplayPlaces::Node* DisplayPlaces::nodeOf(const Journal::PlaceRef& place)
{
    if (place == _last.place)
        return _last.node;
    _last = {place, lookUp(place)};
    return _last.node;
}

DisplayPlaces::Node* DisplayPlaces::lookUp(const Journal::PlaceRef& place)
{
    if (!place->parent)
        return &_nodes.front();
    if (const auto known = _known.find(place.get()); known != _known.end())
        return known->second.node;
    Node* const parent = lookUp(place->parent);
    if (parent->list != None || parent == &_nowhere)
        return parent; // an entry: it and what is in it belong to the list
    const std::string_view name = place->parent->isSorted ? sortedKeyName(place->key) : std::string_view(place->key);
    Node* const child = childOf(*parent, name);
    if (_known.size() >= MaxKnown)
        _known.clear();
    Node* const node = child ? child : &_nowhere;
    _known.emplace(place.get(), Known {place, node});
    return node;
}

/// Keys come in the same order from one record to the next.
int DisplayPlaces::leafOf(Node& node, std::string_view key, bool isSorted)
{
    auto& seen = node.seen;
    if (node.next < seen.size() && seen[node.next].key == key)
        return seen[node.next++].leaf;
    const auto known = std::ranges::find(seen, key, &KnownKey::key);
    if (known != seen.end()) {
        node.next = static_cast<std::size_t>(known - seen.begin()) + 1;
        return known->leaf;
    }
    const auto watched = std::ranges::find(node.watched, isSorted ? sortedKeyName(key) : key, &KnownKey::key);
    const int leaf = watched == node.watched.end() ? None : watched->leaf;
    if (seen.size() < MaxSeenKeys)
        seen.push_back({std::string(key), leaf});
    node.next = seen.size();
    return leaf;
}

} // namespace spectrel

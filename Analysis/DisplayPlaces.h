#pragma once

#include "Monitor/Journal.h"

#include <cstddef>
#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace spectrel {

/// Which of the display's leaves and lists are watched, and which of them a change in the journal is about.
///
/// A place's path is looked at once for as long as its container stands there, entries of lists never.
class DisplayPlaces {
public:
    static constexpr int None = -1;

    /// Both give numbers counting from 0, the same for the same place. Containers are named by their paths.
    int watchLeaf(std::string_view container, std::string_view key);
    int watchList(std::string_view container);

    std::size_t leafCount() const
    {
        return _leaves.size();
    }
    /// The path of a leaf in the display tree.
    const std::string& leafPath(int leaf) const
    {
        return _leaves[static_cast<std::size_t>(leaf)];
    }

    /// What a change is about: a leaf, or a list in which something changed, or neither.
    struct Found {
        int leaf = None;
        int list = None;
    };
    Found find(const Journal::Change& change, std::string_view key);

private:
    struct KnownKey {
        std::string key;
        int leaf;
    };
    struct Node {
        std::vector<std::pair<std::string, Node*>> children;
        std::vector<KnownKey> watched; // by the names shown
        std::vector<KnownKey> seen; // keys as they came, in their order
        std::size_t next = 0; // where the next key is expected
        int list = None;
    };

    Node* nodeAt(std::string_view container);
    Node* childOf(Node& node, std::string_view name);
    Node* nodeOf(const Journal::PlaceRef& place);
    Node* lookUp(const Journal::PlaceRef& place);
    static int leafOf(Node& node, std::string_view key, bool isSorted);

    std::deque<Node> _nodes {1}; // the root first
    Node _nowhere;
    std::vector<std::string> _leaves;
    int _lists = 0;
    struct Known {
        Journal::PlaceRef place; // so that no other place has its address
        Node* node;
    };
    std::unordered_map<const Journal::Place*, Known> _known;
    Known _last {nullptr, nullptr};
};

} // namespace spectrel

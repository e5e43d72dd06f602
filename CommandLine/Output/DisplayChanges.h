#pragma once

#include "Monitor/Journal.h"
#include "Monitor/PathChoice.h"
#include "Values/Value.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace spectrel {

/// Reports which leaves of the display have changed since it was looked at last.
///
/// Keeps a shadow of the display, and looks again only into the containers that the journal has seen change. The cost
/// grows with what they and those above them hold, whatever the order of their keys.
class DisplayChanges {
public:
    /// A leaf's path as in the display tree, and its value; null for a leaf that went away.
    using Report = std::function<void(const std::string& path, const std::string* value)>;

    explicit DisplayChanges(PathChoice paths = {})
        : _paths(std::move(paths))
    {
        _root.position = _paths.root();
    }

    /// Reports new and changed leaves in display order, and within each container then those that went away.
    /// Only the chosen leaves are looked at. Where leaves share a path (two fingers on one pilot), each change is
    /// reported, and what the last one holds is reported last. An absent display has no leaves. The journal follows the
    /// display.
    void update(const Value& display, Journal& journal, const Report& report);

    /// How many names were compared to find the shadows of containers' children so far: what the updates cost.
    std::uint64_t comparisons() const
    {
        return _comparisons;
    }

private:
    struct Shadow;
    using ShadowRef = std::unique_ptr<Shadow>;
    using ShadowList = std::vector<ShadowRef>;

    struct Shadow {
        std::string name;
        std::string value; // of a leaf
        bool isLeaf = false;
        bool isReported = false; // in this update
        std::uint64_t container = 0; // the journal's number of the container it was made from
        ShadowList children;
        PathChoice::Position position; // of its path in those that were asked for
    };
    class FormerChildren;
    class Step;

    Shadow shadowBelow(const Shadow& parent, std::string_view name) const;
    void updateNode(Shadow& shadow, bool isNew, const Value& value, const Report& report);
    void updateContainer(Shadow& shadow, bool isNew, const Value& value, const Report& report);
    void updateBelow(Shadow& shadow, const Value& value, const Report& report);
    void updateChildren(Shadow& shadow, const Value& value, const Report& report);
    static ShadowList takeFrom(ShadowList& children, std::size_t position);
    void settleNamesakes(Shadow& parent, std::size_t count, const Report& report);
    void reportGone(const Shadow& shadow, const Report& report);

    PathChoice _paths;
    Shadow _root;
    bool _isShown = false;
    std::string _path; // of the node being looked at
    std::uint64_t _period = 0; // of the journal, since the last update
    std::uint64_t _comparisons = 0;
};

} // namespace spectrel

#pragma once

#include "Values/Value.h"

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// Tells which leaves of the display have changed since it was looked at last.
///
/// Keeps a shadow of the display and walks both at once, so that an unchanged leaf costs a comparison and no path.
class DisplayChanges {
public:
    /// A leaf's path as in the display tree, and its value; null for a leaf that went away.
    using Report = std::function<void(const std::string& path, const std::string* value)>;

    /// Reports new and changed leaves in display order, and within each container then those that went away.
    /// Where leaves share a path (two fingers on one pilot), each change is told, and what the last one holds is told
    /// last. An absent display has no leaves.
    void update(const Value& display, const Report& report);

private:
    struct Shadow {
        std::string name;
        std::string value; // of a leaf
        bool isLeaf = false;
        bool isTold = false; // in this update
        std::vector<Shadow> children;
    };

    void updateNode(Shadow& shadow, bool isNew, const Value& value, const Report& report);
    void updateChildren(Shadow& shadow, const Value& value, const Report& report);
    Shadow& shadowOf(Shadow& parent, std::size_t position, std::string_view name, bool& isNew);
    void settleNamesakes(Shadow& parent, std::size_t count, const std::string& parentPath, const Report& report);
    void reportGone(const Shadow& shadow, const Report& report);

    Shadow _root;
    bool _isShown = false;
    std::string _path; // of the container being walked
};

} // namespace spectrel

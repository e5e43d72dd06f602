#pragma once

#include "Values/Value.h"

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace spectrel {

class SpectrelModelNode;
using NodeRef = std::shared_ptr<const SpectrelModelNode>;
using NodeList = std::vector<NodeRef>;

/// Path → node. "/" is the root; a child's path is its parent's path joined with its displayed name.
using PathIndex = std::unordered_map<std::string, NodeRef>;

/// The node at the path exactly as given; null when there is none.
NodeRef nodeInIndex(const PathIndex& index, std::string_view path);

/// A path with one more component, joined by exactly one "/".
std::string pathByAppending(std::string_view path, std::string_view component);
/// The same to the path itself.
void appendPathComponent(std::string& path, std::string_view component);

/// What a leaf that is no text shows.
inline constexpr std::string_view UnknownText = "(unknown)";

/// One node of the display tree. Nodes never change; a rebuild makes a new tree.
class SpectrelModelNode {
public:
    explicit SpectrelModelNode(std::string name)
        : _name(std::move(name))
    {
    }
    virtual ~SpectrelModelNode() = default;

    virtual const std::string& displayName() const
    {
        return _name;
    }
    /// None (null) for a leaf; an inner node's list may be empty.
    virtual const NodeList* childNodes() const
    {
        return nullptr;
    }
    /// None (null) for an inner node.
    virtual const std::string* value() const
    {
        return nullptr;
    }

    /// The tree of a display value in the format that every generator produces: strings are leaves, dictionaries and
    /// lists inner nodes, anything else a leaf "(unknown)". The root is named "Spectrel"; the index gains every node.
    static NodeRef makeTreeFromObject(const Value& display, PathIndex& pathDictionary);

private:
    std::string _name;
};

class SpectrelModelLeafNode final : public SpectrelModelNode {
public:
    SpectrelModelLeafNode(std::string name, std::string value)
        : SpectrelModelNode(std::move(name))
        , _string(std::move(value))
    {
    }
    const std::string* value() const override
    {
        return &_string;
    }

private:
    std::string _string;
};

class SpectrelModelTreeNode final : public SpectrelModelNode {
public:
    SpectrelModelTreeNode(std::string name, NodeList children)
        : SpectrelModelNode(std::move(name))
        , _childNodes(std::move(children))
    {
    }
    const NodeList* childNodes() const override
    {
        return &_childNodes;
    }

private:
    NodeList _childNodes;
};

} // namespace spectrel

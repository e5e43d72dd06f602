#include "Monitor/SpectrelModelNode.h"

#include "LogGenerator/Template/ArrayLock.h"
#include "Monitor/DisplayOrder.h"
#include "Values/List.h"

namespace spectrel {

namespace {

constexpr const char* RootName = "Spectrel";
constexpr const char* RootPath = "/";

/// Builds the node of one value after all its descendants, so that of two nodes with one path the later stays.
class TreeBuilder {
public:
    explicit TreeBuilder(PathIndex& index)
        : _index(index)
    {
    }

    NodeRef build(std::string name, const Value& value, const std::string& path)
    {
        NodeRef node;
        if (const auto* text = value.string())
            node = std::make_shared<SpectrelModelLeafNode>(std::move(name), *text);
        else if (const auto& dictionary = value.dictionary())
            node = std::make_shared<SpectrelModelTreeNode>(std::move(name), childrenOf(*dictionary, path));
        else if (const auto& list = value.list())
            node = std::make_shared<SpectrelModelTreeNode>(std::move(name), childrenOf(*list, path));
        else
            node = std::make_shared<SpectrelModelLeafNode>(std::move(name), std::string(UnknownText));
        _index[path] = node;
        return node;
    }

private:
    NodeList childrenOf(const Dictionary& dictionary, const std::string& path)
    {
        NodeList children;
        children.reserve(dictionary.count());
        forEachDisplayChild(dictionary, [&](std::string_view name, const Value& value) {
            children.push_back(build(std::string(name), value, pathByAppending(path, name)));
        });
        return children;
    }

    NodeList childrenOf(const List& list, const std::string& path)
    {
        NodeList children;
        children.reserve(list.count());
        ArrayLock::lockArray(); // sections may be filling the same list
        for (const Value& element : list.elements()) {
            std::string name = std::to_string(children.size());
            const std::string childPath = pathByAppending(path, name);
            children.push_back(build(std::move(name), element, childPath));
        }
        ArrayLock::unlockArray();
        return children;
    }

    PathIndex& _index;
};

} // namespace

NodeRef nodeInIndex(const PathIndex& index, std::string_view path)
{
    const auto found = index.find(std::string(path));
    return found == index.end() ? nullptr : found->second;
}

std::string pathByAppending(std::string_view path, std::string_view component)
{
    std::string joined;
    joined.reserve(path.size() + 1 + component.size());
    joined = path;
    appendPathComponent(joined, component);
    return joined;
}

void appendPathComponent(std::string& path, std::string_view component)
{
    component.remove_prefix(std::min(component.find_first_not_of('/'), component.size()));
    if (component.empty())
        return;
    if (!path.ends_with('/'))
        path += '/';
    path += component;
}

NodeRef SpectrelModelNode::makeTreeFromObject(const Value& display, PathIndex& pathDictionary)
{
    return TreeBuilder(pathDictionary).build(RootName, display, RootPath);
}

} // namespace spectrel

#include "CommandLine/Output/TableColumns.h"

#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Values/List.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <utility>

namespace spectrel {

namespace {

constexpr std::string_view ServingCell = "cells";

void removeSlashes(std::string_view& text)
{
    text.remove_prefix(std::min(text.find_first_not_of('/'), text.size()));
}

/// Looks below a value for the leaf whose path from there is `path`, without a slash at its beginning. A name may hold
/// slashes itself.
void findLeaf(const Value& value, std::string_view path, std::optional<std::string_view>& found)
{
    const auto& dictionary = value.dictionary();
    const auto& list = value.list();
    if (!dictionary && !list) {
        if (path.empty())
            found = value.string() ? std::string_view(*value.string()) : UnknownText;
        return;
    }
    if (list) {
        std::size_t index = 0;
        const auto end = std::from_chars(path.data(), path.data() + path.size(), index);
        const auto rest = path.substr(static_cast<std::size_t>(end.ptr - path.data()));
        const bool isPlain = end.ec == std::errc() && !(path.starts_with('0') && end.ptr - path.data() > 1);
        if (isPlain && index < list->count() && (rest.empty() || rest.starts_with('/')))
            findLeaf((*list)[index], rest.empty() ? rest : rest.substr(1), found);
        return;
    }
    forEachDisplayChild(*dictionary, [&](std::string_view name, const Value& child) {
        removeSlashes(name);
        if (name.empty())
            return findLeaf(child, path, found);
        if (!path.starts_with(name))
            return;
        const std::string_view rest = path.substr(name.size());
        if (rest.empty() || rest.starts_with('/') || name.ends_with('/'))
            findLeaf(child, rest.starts_with('/') ? rest.substr(1) : rest, found);
    });
}

} // namespace

std::optional<std::vector<TableColumn>> parseTableColumns(std::string_view text)
{
    std::vector<TableColumn> columns(1);
    bool isName = false;
    const auto finish = [&] {
        TableColumn& column = columns.back();
        if (column.path.empty())
            return false;
        if (column.path == ServingCell && !isName) {
            column.isServingCell = true;
            return true;
        }
        if (!column.path.starts_with('/'))
            column.path.insert(0, "/");
        if (!std::exchange(isName, false))
            column.name = column.path;
        return true;
    };
    for (std::size_t at = 0; at < text.size(); ++at) {
        const bool isEscape = text[at] == '\\' && at + 1 < text.size() && text.find_first_of(",=\\", at + 1) == at + 1;
        if (!isEscape && text[at] == ',') {
            if (!finish())
                return std::nullopt;
            columns.emplace_back();
        } else if (!isEscape && text[at] == '=' && !isName) {
            isName = true;
        } else {
            at += isEscape ? 1 : 0;
            (isName ? columns.back().name : columns.back().path) += text[at];
        }
    }
    return finish() ? std::optional(columns) : std::nullopt;
}

std::optional<std::string_view> leafAtPath(const Value& display, std::string_view path)
{
    removeSlashes(path);
    std::optional<std::string_view> found;
    if (display.dictionary() || display.list())
        findLeaf(display, path, found);
    return found;
}

} // namespace spectrel

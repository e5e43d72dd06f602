#pragma once

#include "Values/Value.h"

#include <cstddef>
#include <string_view>
#include <vector>

namespace spectrel {

/// Hears of each change of the one container that owns it, just before it happens. A container without an observer pays
/// one null check for each change.
///
/// No operation may change that container or take its observer away.
class ContainerObserver {
public:
    virtual ~ContainerObserver() = default;

    /// Of a dictionary. `old` is what the key holds, absent for a new key; it may equal what is stored.
    virtual void willStore(std::string_view key, const Value& old, const Value& value) = 0;
    virtual void willStoreText(std::string_view key, const Value& old, std::string_view text) = 0;
    virtual void willRemove(std::string_view key, const Value& old) = 0;

    /// Of a list. Elements removed from the front count as: all are removed, and those that stay are appended again.
    virtual void willAppend(std::size_t position, const Value& value) = 0;
    virtual void willRemoveAll(const std::vector<Value>& elements) = 0;
};

} // namespace spectrel

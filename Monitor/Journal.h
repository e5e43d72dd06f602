#pragma once

#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/Value.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The journal of a display's changes: each leaf that was stored, stored again with an equal value or removed, in
/// order.
///
/// Follows whatever the state holds under "Display", also when the display is built, taken away or replaced by another.
/// Each container of it knows its places while a journal follows it, and nothing otherwise. A container that stands at
/// two places changes at both. A container stored over another is compared with it, leaf by leaf: what is equal counts
/// as stored again, what is missing as removed. So is a list that is emptied and filled again, at the latest when the
/// message is finished.
class Journal {
public:
    enum class Kind : std::uint8_t { Stored, StoredAgain, Removed };

    /// Where a container stands in the display: one object for as long as it stands there, so that a reader may
    /// remember what it made of a place.
    struct Place {
        std::shared_ptr<const Place> parent; // null for the display's root
        std::string key; // in the parent: a dictionary's key or a list's position
        bool isSorted = false; // whether the container has the marker that sorts, which shortens its keys' names
    };
    using PlaceRef = std::shared_ptr<const Place>;

    /// One leaf's change. The texts are read with `keyOf` and `valueOf`, the path is put together by `pathOf`.
    struct Change {
        Kind kind;
        PlaceRef place; // of the container that holds the leaf; null when the display itself is the leaf
        std::size_t key; // where the texts stand in the journal's store
        std::size_t value;
        std::size_t end;
    };

    /// What a journal knows of a container that it follows.
    struct Stamp {
        std::uint64_t number = 0; // unlike every other container's; 0 for none
        std::uint64_t changed = 0; // the period of the latest change of its own
        std::uint64_t changedWithin = 0; // the same for it and all below
    };

    /// Follows the display of the state. What it holds already counts as stored.
    explicit Journal(DictionaryRef state);
    ~Journal();
    Journal(const Journal&) = delete;
    Journal& operator=(const Journal&) = delete;

    /// A message has been applied, or has failed: lists that were emptied and not filled again lose their elements.
    void finishMessage();
    /// The changes since they were forgotten last.
    const std::vector<Change>& changes() const
    {
        return _changes;
    }
    void forgetChanges();

    /// The container's key of the leaf: a dictionary's key, or a list's position in decimal.
    std::string_view keyOf(const Change& change) const;
    /// The leaf's text: what was stored, or what was removed. "(unknown)" for what is no text.
    std::string_view valueOf(const Change& change) const;
    /// The leaf's path as in the display tree.
    std::string pathOf(const Change& change) const;

    /// For readers that look at containers rather than changes: begins a period. Containers stored into from now on
    /// have its number or a later one in their stamps. Equal values stored again leave no stamp.
    std::uint64_t beginPeriod()
    {
        return ++_period;
    }
    static Stamp stampOf(const Value& container);

private:
    class Root;
    class Follower;
    struct FollowedPlace;
    using FollowedPlaceRef = std::shared_ptr<FollowedPlace>;

    static Follower* followerOf(const Value& container);
    static FollowedPlaceRef placeOf(const Value& container, const Place* parent, std::string_view key);
    void attach(const Value& container, const FollowedPlaceRef& parent, std::string_view key);
    void detach(const Value& container, const Place* parent, std::string_view key);
    void exchange(const FollowedPlaceRef& place, std::string_view key, const Value& old, const Value& now);
    void compare(const FollowedPlaceRef& place, std::string_view key, const Value& old, const Value& now);
    void compareContainers(const FollowedPlaceRef& place, std::string_view key, const Value& old, const Value& now);
    void noteLeaves(const FollowedPlaceRef& place, std::string_view key, const Value& value, Kind kind);
    void note(const FollowedPlaceRef& place, std::string_view key, std::string_view text, Kind kind);
    static void settleWithin(const Value& container);
    void touch(const FollowedPlaceRef& place);

    DictionaryRef _state;
    std::vector<Change> _changes;
    std::string _texts; // of the changes: key and value in turns
    std::vector<Follower*> _refilled; // lists emptied in this message
    std::uint64_t _containers = 0; // followed so far
    std::uint64_t _period = 1;
};

} // namespace spectrel

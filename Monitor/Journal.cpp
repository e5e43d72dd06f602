#include "Monitor/Journal.h"

#include "LogGenerator/LogGenerator.h"
#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Values/ContainerObserver.h"

#include <algorithm>
#include <charconv>
#include <utility>

namespace spectrel {

namespace {

const Value NoValue;

bool isContainer(const Value& value)
{
    return value.dictionary() || value.list();
}

bool isLeaf(const Value& value)
{
    return !value.isAbsent() && !isContainer(value);
}

bool isSameContainer(const Value& left, const Value& right)
{
    return isContainer(left) && left.dictionary() == right.dictionary() && left.list() == right.list();
}

std::string_view textOf(const Value& leaf)
{
    return leaf.string() ? std::string_view(*leaf.string()) : UnknownText;
}

/// A list's position as the key of its element.
class PositionKey {
public:
    explicit PositionKey(std::size_t position)
        : _end(std::to_chars(_digits, _digits + sizeof _digits, position).ptr)
    {
    }
    operator std::string_view() const
    {
        return {_digits, static_cast<std::size_t>(_end - _digits)};
    }

private:
    char _digits[24];
    char* _end;
};

template <typename Visit> void forEachChild(const Value& container, Visit visit)
{
    if (const auto& dictionary = container.dictionary()) {
        for (const auto& [key, value] : dictionary->entries())
            visit(std::string_view(key), value);
    } else if (const auto& list = container.list()) {
        for (std::size_t position = 0; position < list->count(); ++position)
            visit(std::string_view(PositionKey(position)), (*list)[position]);
    }
}

std::string pathOfPlace(const Journal::Place* place)
{
    if (!place || !place->parent)
        return "/";
    const std::string_view key = place->key;
    return pathByAppending(pathOfPlace(place->parent.get()), place->parent->isSorted ? sortedKeyName(key) : key);
}

} // namespace

/// A place that has not been left: it leads to what is known of its container.
struct Journal::FollowedPlace : Place {
    FollowedPlaceRef above; // the parent again
    Follower* follower = nullptr;
};

/// What the journal keeps with each container that it follows.
class Journal::Follower final : public ContainerObserver {
public:
    explicit Follower(Journal& owner)
        : journal(owner)
        , stamp {++owner._containers, owner._period, owner._period}
    {
    }
    ~Follower() override
    {
        // Also when it has settled before the message is finished, and holds nothing any more.
        if (!journal._refilled.empty())
            std::erase(journal._refilled, this);
    }

    void willStore(std::string_view key, const Value& old, const Value& value) override
    {
        if (key == SortedMarker)
            setSorted(true);
        for (const auto& place : places)
            journal.exchange(place, key, old, value);
    }
    void willStoreText(std::string_view key, const Value& old, std::string_view text) override
    {
        if (key == SortedMarker || isContainer(old))
            return willStore(key, old, text);
        const bool isEqual = old.string() && *old.string() == text;
        for (const auto& place : places)
            journal.note(place, key, text, isEqual ? Kind::StoredAgain : Kind::Stored);
    }
    void willRemove(std::string_view key, const Value& old) override
    {
        for (const auto& place : places)
            journal.exchange(place, key, old, NoValue);
        if (key == SortedMarker)
            setSorted(false);
    }
    void willAppend(std::size_t position, const Value& value) override
    {
        const Value old = position < emptied.size() ? std::exchange(emptied[position], NoValue) : NoValue;
        for (const auto& place : places)
            journal.exchange(place, PositionKey(position), old, value);
    }
    void willRemoveAll(const std::vector<Value>& elements) override
    {
        if (emptied.empty())
            journal._refilled.push_back(this);
        emptied.resize(std::max(emptied.size(), elements.size()));
        std::ranges::copy(elements, emptied.begin());
    }
    /// What was removed and did not come again is gone.
    void settle()
    {
        const std::vector<Value> gone = std::exchange(emptied, {});
        for (std::size_t position = 0; position < gone.size(); ++position) {
            for (const auto& place : places)
                journal.exchange(place, PositionKey(position), gone[position], NoValue);
        }
    }

    Journal& journal;
    Stamp stamp;
    std::vector<FollowedPlaceRef> places;
    std::vector<Value> emptied; // what a list held before it was emptied, until it is filled again

private:
    /// All the names change, and so all the leaves below.
    void setSorted(bool isSorted)
    {
        for (const auto& place : places) {
            if (std::exchange(place->isSorted, isSorted) != isSorted)
                journal.touch(place);
        }
    }
};

/// Hears of the display itself.
class Journal::Root final : public ContainerObserver {
public:
    explicit Root(Journal& journal)
        : _journal(journal)
    {
    }
    void willStore(std::string_view key, const Value& old, const Value& value) override
    {
        if (key == StateKey::Display)
            _journal.exchange(nullptr, {}, old, value);
    }
    void willStoreText(std::string_view key, const Value& old, std::string_view text) override
    {
        if (key == StateKey::Display)
            _journal.exchange(nullptr, {}, old, text);
    }
    void willRemove(std::string_view key, const Value& old) override
    {
        if (key == StateKey::Display)
            _journal.exchange(nullptr, {}, old, NoValue);
    }
    void willAppend(std::size_t, const Value&) override { }
    void willRemoveAll(const std::vector<Value>&) override { }

private:
    Journal& _journal;
};

Journal::Journal(DictionaryRef state)
    : _state(std::move(state))
{
    exchange(nullptr, {}, NoValue, (*_state)[StateKey::Display]);
    _state->setObserver(std::make_unique<Root>(*this));
}

Journal::~Journal()
{
    _state->setObserver(nullptr);
    if (const Value& display = (*_state)[StateKey::Display]; isContainer(display))
        detach(display, nullptr, {});
}

void Journal::finishMessage()
{
    while (!_refilled.empty()) {
        Follower* const follower = _refilled.back();
        _refilled.pop_back();
        follower->settle();
    }
}

void Journal::forgetChanges()
{
    _changes.clear();
    _texts.clear();
}

std::string_view Journal::keyOf(const Change& change) const
{
    return std::string_view(_texts).substr(change.key, change.value - change.key);
}

std::string_view Journal::valueOf(const Change& change) const
{
    return std::string_view(_texts).substr(change.value, change.end - change.value);
}

std::string Journal::pathOf(const Change& change) const
{
    const std::string_view key = keyOf(change);
    if (!change.place)
        return "/";
    return pathByAppending(pathOfPlace(change.place.get()), change.place->isSorted ? sortedKeyName(key) : key);
}

Journal::Stamp Journal::stampOf(const Value& container)
{
    const Follower* const follower = followerOf(container);
    return follower ? follower->stamp : Stamp();
}

/// Containers of a display have observers of this kind only.
Journal::Follower* Journal::followerOf(const Value& container)
{
    ContainerObserver* observer = nullptr;
    if (const auto& dictionary = container.dictionary())
        observer = dictionary->observer();
    else if (const auto& list = container.list())
        observer = list->observer();
    return static_cast<Follower*>(observer);
}

Journal::FollowedPlaceRef Journal::placeOf(const Value& container, const Place* parent, std::string_view key)
{
    const Follower* const follower = followerOf(container);
    if (!follower)
        return nullptr;
    const auto found = std::ranges::find_if(
        follower->places, [&](const auto& place) { return place->above.get() == parent && place->key == key; });
    return found == follower->places.end() ? nullptr : *found;
}

void Journal::attach(const Value& container, const FollowedPlaceRef& parent, std::string_view key)
{
    if (!followerOf(container)) {
        auto follower = std::make_unique<Follower>(*this);
        if (const auto& dictionary = container.dictionary())
            dictionary->setObserver(std::move(follower));
        else
            container.list()->setObserver(std::move(follower));
    }
    auto place = std::make_shared<FollowedPlace>();
    place->parent = parent;
    place->above = parent;
    place->key = key;
    place->isSorted = container.dictionary() && container.dictionary()->contains(SortedMarker);
    place->follower = followerOf(container);
    place->follower->places.push_back(place);
    forEachChild(container, [&](std::string_view childKey, const Value& child) {
        if (isContainer(child))
            attach(child, place, childKey);
    });
}

void Journal::detach(const Value& container, const Place* parent, std::string_view key)
{
    const FollowedPlaceRef place = placeOf(container, parent, key);
    if (!place)
        return;
    Follower& follower = *place->follower;
    const auto leave = [&](std::string_view childKey, const Value& child) {
        if (isContainer(child))
            detach(child, place.get(), childKey);
    };
    forEachChild(container, leave);
    for (std::size_t position = 0; position < follower.emptied.size(); ++position)
        leave(PositionKey(position), follower.emptied[position]);
    std::erase(follower.places, place);
    place->follower = nullptr;
    if (!follower.places.empty())
        return;
    if (const auto& dictionary = container.dictionary())
        dictionary->setObserver(nullptr);
    else
        container.list()->setObserver(nullptr);
}

/// Something takes the place of something else; either may be absent.
void Journal::exchange(const FollowedPlaceRef& place, std::string_view key, const Value& old, const Value& now)
{
    if (isSameContainer(old, now))
        return noteLeaves(place, key, now, Kind::StoredAgain);
    if (isContainer(now))
        attach(now, place, key);
    if (isContainer(now) || isContainer(old))
        touch(place);
    if (!_refilled.empty())
        settleWithin(old);
    compare(place, key, old, now);
    if (isContainer(old))
        detach(old, place.get(), key);
}

void Journal::compare(const FollowedPlaceRef& place, std::string_view key, const Value& old, const Value& now)
{
    if (isContainer(old) && isContainer(now) && old.kind() == now.kind())
        return compareContainers(place, key, old, now);
    if (isLeaf(now) && isLeaf(old))
        return note(place, key, textOf(now), old == now ? Kind::StoredAgain : Kind::Stored);
    noteLeaves(place, key, old, Kind::Removed);
    noteLeaves(place, key, now, Kind::Stored);
}

void Journal::compareContainers(const FollowedPlaceRef& place, std::string_view key, const Value& old, const Value& now)
{
    const FollowedPlaceRef oldPlace = placeOf(old, place.get(), key);
    const FollowedPlaceRef newPlace = placeOf(now, place.get(), key);
    const auto& oldDictionary = old.dictionary();
    const auto& newDictionary = now.dictionary();
    std::size_t count = 0;
    forEachChild(now, [&](std::string_view childKey, const Value& child) {
        const std::size_t position = count++;
        if (oldDictionary)
            compare(newPlace, childKey, (*oldDictionary)[childKey], child);
        else
            compare(newPlace, childKey, position < old.list()->count() ? (*old.list())[position] : NoValue, child);
    });
    std::size_t oldCount = 0;
    forEachChild(old, [&](std::string_view childKey, const Value& child) {
        const std::size_t position = oldCount++;
        if (newDictionary ? !newDictionary->contains(childKey) : position >= count)
            noteLeaves(oldPlace, childKey, child, Kind::Removed);
    });
}

void Journal::noteLeaves(const FollowedPlaceRef& place, std::string_view key, const Value& value, Kind kind)
{
    if (isLeaf(value))
        return note(place, key, textOf(value), kind);
    if (!isContainer(value))
        return;
    const FollowedPlaceRef inside = placeOf(value, place.get(), key);
    forEachChild(
        value, [&](std::string_view childKey, const Value& child) { noteLeaves(inside, childKey, child, kind); });
}

void Journal::note(const FollowedPlaceRef& place, std::string_view key, std::string_view text, Kind kind)
{
    if (key == SortedMarker)
        return; // no leaf
    const std::size_t start = _texts.size();
    _texts += key;
    const std::size_t value = _texts.size();
    _texts += text;
    _changes.push_back({kind, place, start, value, _texts.size()});
    if (kind != Kind::StoredAgain)
        touch(place);
}

/// Lists that go away are not filled again.
void Journal::settleWithin(const Value& container)
{
    if (Follower* const follower = followerOf(container))
        follower->settle();
    forEachChild(container, [](std::string_view, const Value& child) { settleWithin(child); });
}

/// Stamps the container at the place, and all those above wherever it stands.
void Journal::touch(const FollowedPlaceRef& place)
{
    if (!place || !place->follower)
        return;
    place->follower->stamp.changed = _period;
    if (place->follower->stamp.changedWithin == _period)
        return;
    std::vector<FollowedPlace*> open {place.get()};
    while (!open.empty()) {
        FollowedPlace* const next = open.back();
        open.pop_back();
        if (std::exchange(next->follower->stamp.changedWithin, _period) == _period)
            continue;
        for (const auto& standing : next->follower->places) {
            if (standing->above)
                open.push_back(standing->above.get());
        }
    }
}

} // namespace spectrel

#include "Analysis/ContextRates.h"

#include "Analysis/CellLists.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <algorithm>
#include <charconv>
#include <string>
#include <string_view>
#include <utility>

namespace spectrel {

namespace {

std::string_view textOf(const Value& entry, std::string_view key)
{
    const auto& dictionary = entry.dictionary();
    const std::string* const text = dictionary ? (*dictionary)[key].string() : nullptr;
    return text && !saysNothing(*text) ? std::string_view(*text) : std::string_view();
}

std::optional<std::uint64_t> counterOf(const Value& entry, std::string_view key)
{
    const std::string_view text = textOf(entry, key);
    std::uint64_t count = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), count);
    if (text.empty() || error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return count;
}

/// In kilobits a second.
std::optional<double> rate(
    std::optional<std::uint64_t> before, std::optional<std::uint64_t> now, Moment from, Moment to)
{
    const double seconds = std::chrono::duration<double>(to - from).count();
    if (!before || !now || *now < *before || seconds <= 0)
        return std::nullopt;
    return static_cast<double>(*now - *before) * 8 / 1000 / seconds;
}

} // namespace

void ContextRates::update(const Value& display, std::uint64_t message, Moment time, PathTable& paths)
{
    const Value* const container = valueAt(display, _row->container);
    const std::vector<DataContext> before = std::exchange(_contexts, {});
    const std::vector<Counters> countersBefore = std::exchange(_counters, {});
    if (!container || !container->list())
        return;
    const Origin stored {0, message, time};
    for (const Value& entry : container->list()->elements()) {
        const std::size_t position = _contexts.size();
        DataContext context = read(entry, position, stored, paths);
        if (const Value* const state =
                _row->stateContainer.empty() ? nullptr : valueAt(display, _row->stateContainer)) {
            context.state = textOf(*state, _row->state);
            context.stateOrigin = stored;
            context.stateOrigin.path =
                paths.numberOf(std::string(_row->stateContainer) + "/" + std::string(_row->state));
        }
        const Counters counters = countersOf(entry, time);
        const auto same = std::ranges::find(before, context.name, &DataContext::name);
        if (same != before.end()) {
            const Counters& last = countersBefore[static_cast<std::size_t>(same - before.begin())];
            context.downlinkKbps = rate(last.received, counters.received, last.time, time);
            context.uplinkKbps = rate(last.sent, counters.sent, last.time, time);
        }
        _contexts.push_back(std::move(context));
        _counters.push_back(counters);
    }
}

DataContext ContextRates::read(const Value& entry, std::size_t position, const Origin& stored, PathTable& paths) const
{
    const std::string path = std::string(_row->container) + "/" + std::to_string(position);
    DataContext context;
    context.name = textOf(entry, _row->name);
    context.nameOrigin = context.stateOrigin = stored;
    context.nameOrigin.path = paths.numberOf(path + "/" + std::string(_row->name));
    if (context.name.empty())
        context.name = std::to_string(position);
    if (_row->stateContainer.empty()) {
        context.state = textOf(entry, _row->state);
        context.stateOrigin.path = paths.numberOf(path + "/" + std::string(_row->state));
    }
    return context;
}

ContextRates::Counters ContextRates::countersOf(const Value& entry, Moment time) const
{
    return {counterOf(entry, _row->received), counterOf(entry, _row->sent), time};
}

} // namespace spectrel

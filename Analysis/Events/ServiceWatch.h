#pragma once

#include "Values/Moment.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace spectrel {

/// Knows whether a cell serves: service is lost when the display shows that no cell does, or when nothing has been
/// stored of a serving cell for `Patience` while other messages come. A pause between messages counts for nothing.
class ServiceWatch {
public:
    static constexpr std::chrono::seconds Patience {10};
    static constexpr std::chrono::seconds LongestStep {5}; // between two messages; what is longer is a pause

    enum class News : std::uint8_t { None, Lost, Back };

    /// What a message shows.
    enum class Shown : std::uint8_t {
        Cell, // it stored something of a serving cell
        Nothing, // it did not
        NoService, // the display says that no cell serves
    };
    News messageCame(Moment time, Shown shown);
    bool isLost() const
    {
        return _lostAt.has_value();
    }
    /// How long the service was away that has just come back.
    std::chrono::microseconds away() const
    {
        return _away;
    }

private:
    bool _wasThere = false; // a cell has served in this session
    std::optional<Moment> _latest; // message
    std::chrono::microseconds _silence {0}; // since the serving cell was heard of, pauses left out
    std::optional<Moment> _lastShown; // when something of the cell was stored
    std::optional<Moment> _lostAt;
    std::chrono::microseconds _away {0};
};

} // namespace spectrel

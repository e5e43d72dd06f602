#pragma once

#include <memory>
#include <utility>

namespace spectrel {

/// How long an object lives, as jobs that wait on a queue need to know. A member of that object.
class Lifetime {
public:
    Lifetime() = default;
    Lifetime(const Lifetime&) = delete;
    Lifetime& operator=(const Lifetime&) = delete;

    /// An action that does nothing once this lifetime has ended.
    template <typename Action> auto guard(Action action) const
    {
        return [token = std::weak_ptr(_token), action = std::move(action)](auto&&... arguments) {
            if (!token.expired())
                action(std::forward<decltype(arguments)>(arguments)...);
        };
    }

private:
    struct Token { };
    std::shared_ptr<const Token> _token = std::make_shared<Token>();
};

} // namespace spectrel

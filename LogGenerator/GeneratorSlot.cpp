#include "LogGenerator/GeneratorSlot.h"

#include <utility>

namespace spectrel {

void GeneratorSlot::replace(std::unique_ptr<LogGenerator> successor, Dictionary& state, bool hasUnbuiltMessages)
{
    const bool goesOn = successor && successor->className() == _displayBuilder;
    if (_generator && hasUnbuiltMessages && !goesOn)
        _generator->generateLogUsingState(state);
    if (goesOn) {
        successor->takeOver(_generator.get(), state);
    } else if (successor) {
        for (const std::string_view key : {StateKey::Template, StateKey::Display, StateKey::Lookup})
            state.remove(key);
    }
    if (successor)
        _displayBuilder = successor->className();
    _generator = std::move(successor);
}

} // namespace spectrel

#include "Monitor/DisplayState.h"

#include <utility>

namespace spectrel {

void DisplayState::useTechnology(const Value& technology, SameClass same)
{
    auto successor = _makeGenerator(technology, _context);
    if (same == SameClass::GoesOn && _generator && successor && successor->className() == _generator->className())
        return;
    _generator.replace(std::move(successor), *_state, _hasNews);
}

const Value& DisplayState::display() const
{
    return (*_state)[StateKey::Display];
}

void DisplayState::apply(ByteView body, Moment time)
{
    _hasNews = true;
    _message = {_messages++, time, body};
    if (_generator)
        _generator->updateState(*_state, body);
    finishMessage();
}

void DisplayState::finishMessage()
{
    if (_journal) {
        _journal->finishMessage();
        for (JournalReader* const reader : _readers)
            reader->messageApplied(_message, *_journal);
        _journal->forgetChanges();
    }
    _message.body = {};
}

bool DisplayState::takeNews()
{
    return std::exchange(_hasNews, false);
}

Value DisplayState::build()
{
    return _generator->generateLogUsingState(*_state);
}

ListRef DisplayState::saveContents() const
{
    return _generator ? _generator->getSaveContentsFromState(*_state) : nullptr;
}

ListRef DisplayState::lastContents()
{
    if (!_generator)
        return nullptr;
    if (!_message.body.empty())
        _generator->keepRawMessage(_message.body);
    build();
    return saveContents();
}

Journal& DisplayState::followChanges()
{
    if (!_journal)
        _journal = std::make_unique<Journal>(_state);
    return *_journal;
}

void DisplayState::addReader(JournalReader& reader)
{
    followChanges();
    _readers.push_back(&reader);
}

void DisplayState::removeReader(JournalReader& reader)
{
    std::erase(_readers, &reader);
}

} // namespace spectrel

#pragma once

#include "LogGenerator/Template/Fields.h"
#include "Records/RecordView.h"
#include "Values/Dictionary.h"
#include "Values/Value.h"

#include <span>
#include <string_view>

/// The lookup: a dictionary from a display variable's name to the list of positions where its value is shown. A
/// position is a dictionary of two entries: "key", the label, and "dict", the display dictionary that holds the label.
namespace spectrel {

/// One more position of the variable, behind those that it has.
void addLookupPosition(
    Dictionary& lookup, std::string_view variable, std::string_view key, const DictionaryRef& dictionary);

/// Shows the value at each position of the variable; all share a value that is a container. Lost for a variable that
/// the lookup does not have; ends at the first position that is none.
void setLookupValue(std::string_view variable, const Value& value, const Value& lookup);
/// The same for a text, without making a value of it.
void setLookupText(std::string_view variable, std::string_view text, const Value& lookup);

/// Shows the fields in table order; their keys are variables. `start` is where the offsets count from.
void publishFields(RecordView record, std::span<const Field> fields, const Value& lookup, std::size_t start = 0);

} // namespace spectrel

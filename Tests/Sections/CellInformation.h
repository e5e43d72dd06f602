#pragma once

#include "Records/TelephonyConstants.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>

namespace spectrel {

/// One cell of a cell-information record.
inline DictionaryRef informationOfCell(std::string_view technology, std::string_view type,
    std::initializer_list<std::pair<std::string_view, std::int64_t>> numbers)
{
    auto cell = Dictionary::make({
        {std::string(kRKCellMonitorCellRadioAccessTechnology), technology},
        {std::string(kRKCellMonitorCellType), type},
    });
    for (const auto& [key, number] : numbers)
        cell->set(key, Value::integer(number));
    return cell;
}

} // namespace spectrel

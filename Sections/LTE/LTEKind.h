#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Platform/SystemLog.h"

namespace spectrel {

/// A section of one LTE physical-layer record: it traces its own name and logs a code that it does not know.
constexpr RecordKind lteKind(std::string_view sectionName, std::uint32_t code, std::size_t minimumLength)
{
    return {sectionName, code, minimumLength, sectionName, Priority::Warning, UnknownCode::Logged};
}

} // namespace spectrel

#pragma once

#include "LogGenerator/Template/CodeDictionary.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/Context.h"

namespace spectrel {

/// What the sections of one generator share: who is there, who wants which codes, and the parsed payload that several
/// of them read one after the other.
struct SectionRegistry {
    explicit SectionRegistry(const Context& given = {})
        : context(given)
    {
    }

    const Context context;
    ClassDictionary classDict;
    CodeDictionary codeDictionary;
    PropertyListPayloads payloads;
};

} // namespace spectrel

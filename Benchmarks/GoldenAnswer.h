#pragma once

#include "LogGenerator/LogGenerator.h"
#include "Monitor/SpectrelModelNode.h"
#include "Monitor/TreeText.h"
#include "Values/Dictionary.h"

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <string_view>

namespace spectrel {

inline std::string displayText(const Dictionary& state)
{
    PathIndex paths;
    std::string text;
    appendTreeText(*SpectrelModelNode::makeTreeFromObject(state[StateKey::Display], paths), text);
    return text;
}

/// Whether `decode` (a recording's path, the state to decode into) makes of each golden recording of a technology,
/// "lte", the display that is kept beside it. False, too, where there is no such recording. What is measured is proven
/// with it.
template <typename Decode> bool decodesGoldenRecordings(std::string_view technology, Decode decode)
{
    int proven = 0;
    for (const auto& entry : std::filesystem::directory_iterator(SPECTREL_SOURCE_DIR "/Tests/Golden")) {
        std::filesystem::path path = entry.path();
        if (path.extension() != ".pcap" || !path.filename().string().starts_with(std::string(technology) + '-'))
            continue;
        Dictionary state;
        decode(path.string(), state);
        std::ifstream golden(path.replace_extension(".tree"));
        const std::string wanted((std::istreambuf_iterator<char>(golden)), std::istreambuf_iterator<char>());
        if (displayText(state) != wanted)
            return false;
        ++proven;
    }
    return proven > 0;
}

} // namespace spectrel

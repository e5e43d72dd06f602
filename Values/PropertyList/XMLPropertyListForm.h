#pragma once

#include <string_view>

namespace spectrel {

/// What stands around the value in the XML form as this system and the telephony service write it.
inline constexpr std::string_view XMLPropertyListHead =
    "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
    "<!DOCTYPE plist PUBLIC \"-//Apple//DTD PLIST 1.0//EN\" \"http://www.apple.com/DTDs/PropertyList-1.0.dtd\">\n"
    "<plist version=\"1.0\">\n";
inline constexpr std::string_view XMLPropertyListFoot = "</plist>\n";

} // namespace spectrel

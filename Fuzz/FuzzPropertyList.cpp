// A property list in either form. What can be read and written reads back as the same.
#include "Values/PropertyList/PropertyList.h"

#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size)
{
    using namespace spectrel;
    const auto value = parsePropertyList({bytes, size});
    const auto written = value ? serialisePropertyList(*value) : std::nullopt;
    if (!written)
        return 0;
    const auto again = parsePropertyList({reinterpret_cast<const std::uint8_t*>(written->data()), written->size()});
    if (!again || serialisePropertyList(*again) != written)
        std::abort();
    return 0;
}

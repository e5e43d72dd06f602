#pragma once

#include "Analysis/Cell.h"
#include "Analysis/Report/Report.h"

#include <cstdint>
#include <string>

namespace spectrel {

/// The short name by which charts and tables refer to a recording's cell: "A", "B", ... "Z", "AA", ...
std::string cellLetters(std::uint32_t number);
/// The class of its colour in the page's style. Colours come round again; the letters do not.
std::string cellColour(std::uint32_t number);
/// "PCI 52", "PSC 9", "BSIC 3-5", "PN 12", as the technology calls it; "–" when it is not known.
std::string cellIdText(const Cell& cell);
/// "LTE", "UMTS", ...
std::string radioTitle(RadioTechnology technology);
/// "4101-1" (site and sector, RNC and sector), else the identity; "–" when it is not known.
std::string cellIdentityText(const Cell& cell);

} // namespace spectrel

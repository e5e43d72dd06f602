#include "Sections/LTE/ReselectionRecord.h"

#include "LogGenerator/Template/ArrayOutOfBoundsException.h"

namespace spectrel {

namespace {

bool suits(ReselectionRecord::View view, std::uint16_t technology)
{
    switch (view) {
    case ReselectionRecord::View::LTE:
        return technology == 0;
    case ReselectionRecord::View::UTRAN:
        return technology == 1;
    case ReselectionRecord::View::GERAN:
        return technology == 2;
    case ReselectionRecord::View::CDMA:
        return technology == 3 || technology == 4;
    }
    return false;
}

} // namespace

std::size_t ReselectionRecord::candidate(std::size_t index) const
{
    constexpr std::size_t FirstCandidate = 21;
    constexpr std::size_t Stride = 4;
    if (index >= _record.u16(19))
        throw ArrayOutOfBoundsException();
    return FirstCandidate + Stride * index;
}

std::uint16_t ReselectionRecord::technology(std::size_t index) const
{
    return _record.u16(candidate(index) + 2);
}

std::size_t ReselectionRecord::candidateAs(View view, std::size_t index) const
{
    if (!suits(view, technology(index)))
        throw ArrayOutOfBoundsException();
    return candidate(index);
}

} // namespace spectrel

#include "Sections/GSMUMTS/ZPH_GSMClassIndex.h"

#include "Platform/Console.h"

namespace spectrel {

ZPH_GSMClassIndex::~ZPH_GSMClassIndex()
{
    consoleLine("Deallocing ZPH_GSMClassIndex");
}

} // namespace spectrel

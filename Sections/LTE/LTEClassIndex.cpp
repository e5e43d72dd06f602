#include "Sections/LTE/LTEClassIndex.h"

#include "Platform/Console.h"

namespace spectrel {

LTEClassIndex::~LTEClassIndex()
{
    consoleLine("Deallocing LTEClassIndex");
}

} // namespace spectrel

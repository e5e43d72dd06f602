#include "Sections/GSMUMTS/ZPH_GSMClassIndex.h"

namespace spectrel {

ZPH_GSMClassIndex::~ZPH_GSMClassIndex()
{
    context.console.line("Deallocing ZPH_GSMClassIndex");
}

} // namespace spectrel

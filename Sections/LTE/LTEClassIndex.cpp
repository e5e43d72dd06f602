#include "Sections/LTE/LTEClassIndex.h"

namespace spectrel {

LTEClassIndex::~LTEClassIndex()
{
    context.console.line("Deallocing LTEClassIndex");
}

} // namespace spectrel

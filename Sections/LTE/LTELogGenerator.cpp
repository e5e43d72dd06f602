#include "Sections/LTE/LTELogGenerator.h"

#include "Platform/SystemLog.h"
#include "Sections/LTE/LTEClassIndex.h"

namespace spectrel {

LTELogGenerator::LTELogGenerator(const Context& context)
    : ZPHLogGenerator2(context)
{
    SPECTREL_LOG(log(), Priority::Error, "Creating LTELogGenerator object");
    initWithPListName("LTE", std::make_shared<LTEClassIndex>(context));
}

LTELogGenerator::~LTELogGenerator()
{
    SPECTREL_LOG(log(), Priority::Warning, "LTELogGenerator is destructed %p", static_cast<void*>(this));
}

std::unique_ptr<LTELogGenerator> LTELogGenerator::generator(const Context& context)
{
    return std::make_unique<LTELogGenerator>(context);
}

std::string_view LTELogGenerator::className() const
{
    return "LTELogGenerator";
}

} // namespace spectrel

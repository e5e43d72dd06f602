#include "Sections/LTE/LTELogGenerator.h"

#include "Platform/SystemLog.h"
#include "Sections/LTE/LTEClassIndex.h"

namespace spectrel {

LTELogGenerator::LTELogGenerator()
{
    SPECTREL_LOG(Priority::Error, "Creating LTELogGenerator object");
    initWithPListName("LTE", std::make_shared<LTEClassIndex>());
}

LTELogGenerator::~LTELogGenerator()
{
    SPECTREL_LOG(Priority::Warning, "LTELogGenerator is destructed %p", static_cast<void*>(this));
}

std::unique_ptr<LTELogGenerator> LTELogGenerator::generator()
{
    return std::make_unique<LTELogGenerator>();
}

std::string_view LTELogGenerator::className() const
{
    return "LTELogGenerator";
}

} // namespace spectrel

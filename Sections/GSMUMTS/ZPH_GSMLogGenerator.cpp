#include "Sections/GSMUMTS/ZPH_GSMLogGenerator.h"

#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/ZPH_GSMClassIndex.h"

namespace spectrel {

ZPH_GSMLogGenerator::ZPH_GSMLogGenerator()
{
    SPECTREL_LOG(Priority::Error, "Creating ZPH_GSMLogGenerator object");
    initWithPListName("ZPH_GSM", std::make_shared<ZPH_GSMClassIndex>());
}

ZPH_GSMLogGenerator::~ZPH_GSMLogGenerator()
{
    SPECTREL_LOG(Priority::Warning, "ZPH_GSMLogGenerator is destructed %p", static_cast<void*>(this));
}

std::unique_ptr<ZPH_GSMLogGenerator> ZPH_GSMLogGenerator::generator()
{
    return std::make_unique<ZPH_GSMLogGenerator>();
}

std::string_view ZPH_GSMLogGenerator::className() const
{
    return "ZPH_GSMLogGenerator";
}

} // namespace spectrel

#include "Sections/GSMUMTS/ZPH_GSMLogGenerator.h"

#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/ZPH_GSMClassIndex.h"

namespace spectrel {

ZPH_GSMLogGenerator::ZPH_GSMLogGenerator(const Context& context)
    : ZPHLogGenerator2(context)
{
    SPECTREL_LOG(log(), Priority::Error, "Creating ZPH_GSMLogGenerator object");
    initWithPListName("ZPH_GSM", std::make_shared<ZPH_GSMClassIndex>(context));
}

ZPH_GSMLogGenerator::~ZPH_GSMLogGenerator()
{
    SPECTREL_LOG(log(), Priority::Warning, "ZPH_GSMLogGenerator is destructed %p", static_cast<void*>(this));
}

std::unique_ptr<ZPH_GSMLogGenerator> ZPH_GSMLogGenerator::generator(const Context& context)
{
    return std::make_unique<ZPH_GSMLogGenerator>(context);
}

std::string_view ZPH_GSMLogGenerator::className() const
{
    return "ZPH_GSMLogGenerator";
}

} // namespace spectrel

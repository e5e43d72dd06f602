#include "LogGenerator/LogGenerator.h"
#include "Platform/TelephonyConstants.h"
#include "Sections/AwaitedLogGenerator.h"
#include "Sections/GSMUMTS/ZPH_GSMLogGenerator.h"
#include "Sections/LTE/LTELogGenerator.h"
#include "Sections/UTRAN/UTRANLogGenerator.h"

namespace spectrel {

std::unique_ptr<LogGenerator> LogGenerator::generatorFromTechnology(const Value& technology)
{
    const std::string* constant = technology.string();
    if (!constant)
        return nullptr;
    if (*constant == kRKLogChannelTechnology_IFX)
        return std::make_unique<AwaitedLogGenerator>(*constant);
    if (*constant == kRKLogChannelTechnology_Zephyr_GSM)
        return ZPH_GSMLogGenerator::generator();
    if (*constant == kRKLogChannelTechnology_Zephyr_CDMA)
        return std::make_unique<AwaitedLogGenerator>(*constant);
    if (*constant == kRKLogChannelTechnology_Zephyr_LTE)
        return LTELogGenerator::generator();
    if (*constant == kRKLogChannelTechnology_Zephyr_UTRAN2)
        return UTRANLogGenerator::generator();
    return nullptr;
}

} // namespace spectrel

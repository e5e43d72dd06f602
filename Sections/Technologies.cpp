#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "LogGenerator/LogGenerator.h"
#include "Records/TelephonyConstants.h"
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
        return GSMLogGenerator::generator();
    if (*constant == kRKLogChannelTechnology_Zephyr_GSM)
        return ZPH_GSMLogGenerator::generator();
    if (*constant == kRKLogChannelTechnology_Zephyr_CDMA)
        return C2KLogGenerator::generator();
    if (*constant == kRKLogChannelTechnology_Zephyr_LTE)
        return LTELogGenerator::generator();
    if (*constant == kRKLogChannelTechnology_Zephyr_UTRAN2)
        return UTRANLogGenerator::generator();
    return nullptr;
}

} // namespace spectrel

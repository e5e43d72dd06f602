#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "LogGenerator/LogGenerator.h"
#include "Records/TelephonyConstants.h"
#include "Sections/GSMUMTS/ZPH_GSMLogGenerator.h"
#include "Sections/LTE/LTELogGenerator.h"
#include "Sections/UTRAN/UTRANLogGenerator.h"

namespace spectrel {

std::unique_ptr<LogGenerator> LogGenerator::generatorFromTechnology(const Value& technology, const Context& context)
{
    const std::string* constant = technology.string();
    if (!constant)
        return nullptr;
    if (*constant == kRKLogChannelTechnology_IFX)
        return GSMLogGenerator::generator(context);
    if (*constant == kRKLogChannelTechnology_Zephyr_GSM)
        return ZPH_GSMLogGenerator::generator(context);
    if (*constant == kRKLogChannelTechnology_Zephyr_CDMA)
        return C2KLogGenerator::generator(context);
    if (*constant == kRKLogChannelTechnology_Zephyr_LTE)
        return LTELogGenerator::generator(context);
    if (*constant == kRKLogChannelTechnology_Zephyr_UTRAN2)
        return UTRANLogGenerator::generator(context);
    return nullptr;
}

} // namespace spectrel

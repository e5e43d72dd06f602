#include "Records/Recording.h"

#include <gtest/gtest.h>

namespace spectrel {

TEST(TechnologyTest, NamesAndConstantsLeadBothWays)
{
    const struct {
        Technology technology;
        const char* name;
        const char* constant;
    } rows[] = {
        {Technology::IFX, "ifx", "kRKLogChannelTechnology_IFX"},
        {Technology::GSM, "gsm", "kRKLogChannelTechnology_Zephyr_GSM"},
        {Technology::CDMA, "cdma", "kRKLogChannelTechnology_Zephyr_CDMA"},
        {Technology::LTE, "lte", "kRKLogChannelTechnology_Zephyr_LTE"},
        {Technology::UTRAN, "utran", "kRKLogChannelTechnology_Zephyr_UTRAN2"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(technologyName(row.technology), row.name);
        EXPECT_EQ(technologyConstant(row.technology), row.constant);
        EXPECT_EQ(technologyNamed(row.name), row.technology);
        EXPECT_EQ(technologyOfConstant(row.constant), row.technology);
    }
}

TEST(TechnologyTest, OtherNamesAreNone)
{
    for (const char* name : {"", "LTE", "lte ", "5g", "kRKLogChannelTechnology_Zephyr_LTE"})
        EXPECT_FALSE(technologyNamed(name)) << name;
    for (const char* constant : {"", "lte", "kRKLogChannelTechnology_Zephyr_UTRAN"})
        EXPECT_FALSE(technologyOfConstant(constant)) << constant;
}

} // namespace spectrel

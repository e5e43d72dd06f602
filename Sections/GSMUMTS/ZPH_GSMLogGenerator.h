#pragma once

#include "LogGenerator/Template/ZPHLogGenerator2.h"

namespace spectrel {

/// GSM/UMTS: template "ZPH_GSM".
class ZPH_GSMLogGenerator final : public ZPHLogGenerator2 {
public:
    explicit ZPH_GSMLogGenerator(const Context& context);
    ~ZPH_GSMLogGenerator() override;

    static std::unique_ptr<ZPH_GSMLogGenerator> generator(const Context& context);
    std::string_view className() const override;
};

} // namespace spectrel

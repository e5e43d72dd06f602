#pragma once

#include "LogGenerator/Template/ZPHLogGenerator2.h"

namespace spectrel {

/// LTE: template "LTE".
class LTELogGenerator final : public ZPHLogGenerator2 {
public:
    LTELogGenerator();
    ~LTELogGenerator() override;

    static std::unique_ptr<LTELogGenerator> generator();
    std::string_view className() const override;
};

} // namespace spectrel

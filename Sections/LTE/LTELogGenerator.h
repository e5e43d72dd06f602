#pragma once

#include "LogGenerator/Template/ZPHLogGenerator2.h"

namespace spectrel {

/// LTE: template "LTE".
class LTELogGenerator final : public ZPHLogGenerator2 {
public:
    explicit LTELogGenerator(const Context& context);
    ~LTELogGenerator() override;

    static std::unique_ptr<LTELogGenerator> generator(const Context& context);
    std::string_view className() const override;
};

} // namespace spectrel

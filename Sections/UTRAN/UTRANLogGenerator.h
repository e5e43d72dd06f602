#pragma once

#include "LogGenerator/Template/ZPHLogGenerator2.h"

namespace spectrel {

/// UTRAN: the template is the first property-list resource whose path contains "UTRAN", in any case. Without one the
/// generator stays uninitialised: it asks for no codes, routes no record and builds no display.
class UTRANLogGenerator final : public ZPHLogGenerator2 {
public:
    explicit UTRANLogGenerator(const Context& context);

    static std::unique_ptr<UTRANLogGenerator> generator(const Context& context);
    std::string_view className() const override;
};

} // namespace spectrel

#pragma once

#include <string>
#include <string_view>

namespace spectrel {

/// Where operators' names come from.
class OperatorNames {
public:
    virtual ~OperatorNames() = default;
    /// The name of the operator with the PLMN ("001-01"); empty where none is known.
    virtual std::string nameOf(std::string_view plmn) = 0;
};

} // namespace spectrel

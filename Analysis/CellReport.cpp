#include "Analysis/CellReport.h"

namespace spectrel {

std::string_view connectionName(Connection connection)
{
    return connection == Connection::Idle ? "idle" : "connected";
}

} // namespace spectrel

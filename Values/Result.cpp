#include "Values/Result.h"

#include <cstring>

namespace spectrel {

namespace {

Failure::Code codeOf(int error)
{
    switch (error) {
    case EEXIST:
        return Failure::Code::Exists;
    case ENOENT:
        return Failure::Code::Missing;
    case EACCES:
    case EPERM:
    case EISDIR:
    case ENOTDIR:
        return Failure::Code::Refused;
    case ENOSPC:
    case EDQUOT:
    case EFBIG:
    case EMFILE:
    case ENFILE:
        return Failure::Code::NoRoom;
    default:
        return Failure::Code::Failed;
    }
}

} // namespace

Failure Failure::ofSystem(int error)
{
    return {std::strerror(error), codeOf(error)};
}

} // namespace spectrel

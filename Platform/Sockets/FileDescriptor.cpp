#include "Platform/Sockets/FileDescriptor.h"

#include <unistd.h>

namespace spectrel {

void FileDescriptor::close()
{
    if (_number >= 0)
        ::close(std::exchange(_number, -1));
}

} // namespace spectrel

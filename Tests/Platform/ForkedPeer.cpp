#include "Tests/Platform/ForkedPeer.h"

#include <csignal>
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

ForkedPeer::ForkedPeer(const std::function<int(ForkedPeer&)>& body)
{
    int toChild[2];
    int toParent[2];
    if (::pipe2(toChild, O_CLOEXEC) != 0 || ::pipe2(toParent, O_CLOEXEC) != 0)
        return;
    _child = ::fork();
    const bool isChild = _child == 0;
    _reading = isChild ? toChild[0] : toParent[0];
    _writing = isChild ? toParent[1] : toChild[1];
    ::close(isChild ? toChild[1] : toParent[1]);
    ::close(isChild ? toParent[0] : toChild[0]);
    if (isChild)
        ::_exit(body(*this));
}

ForkedPeer::~ForkedPeer()
{
    kill();
    ::close(_reading);
    ::close(_writing);
}

void ForkedPeer::signal()
{
    const char mark = '.';
    [[maybe_unused]] const auto written = ::write(_writing, &mark, 1);
}

bool ForkedPeer::await()
{
    char mark = 0;
    return ::read(_reading, &mark, 1) == 1;
}

int ForkedPeer::finish()
{
    int status = -1;
    const pid_t child = std::exchange(_child, -1);
    return child > 0 && ::waitpid(child, &status, 0) == child && WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

void ForkedPeer::kill()
{
    if (_child > 0) {
        ::kill(_child, SIGKILL);
        finish();
    }
}

} // namespace spectrel

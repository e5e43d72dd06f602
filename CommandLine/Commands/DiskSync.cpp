#include "CommandLine/Commands/DiskSync.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

bool isSameFile(int one, int other)
{
    struct stat first { };
    struct stat second { };
    return ::fstat(one, &first) == 0 && ::fstat(other, &second) == 0 && first.st_dev == second.st_dev
        && first.st_ino == second.st_ino;
}

/// Devices and pipes have no disk.
std::optional<Failure> syncAndClose(int descriptor)
{
    const bool isDone = ::fsync(descriptor) == 0 || errno == EINVAL || errno == EROFS;
    const auto failure = isDone ? std::nullopt : std::optional(Failure::ofSystem());
    ::close(descriptor);
    return failure;
}

} // namespace

DiskSync::~DiskSync()
{
    if (!_thread.joinable())
        return;
    {
        const std::lock_guard lock(_mutex);
        _isEnding = true;
    }
    _changed.notify_all();
    _thread.join();
}

void DiskSync::file(int descriptor)
{
    add(::fcntl(descriptor, F_DUPFD_CLOEXEC, 3));
}

void DiskSync::folder(const std::string& path)
{
    add(::open(path.empty() ? "." : path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
}

void DiskSync::add(int descriptor)
{
    if (descriptor < 0)
        return;
    {
        const std::lock_guard lock(_mutex);
        if (std::ranges::any_of(_wanted, [&](int each) { return isSameFile(each, descriptor); })) {
            ::close(descriptor);
            return;
        }
        _wanted.push_back(descriptor);
    }
    if (!_thread.joinable()) {
        // Signals are for the main thread.
        sigset_t all;
        sigset_t before;
        ::sigfillset(&all);
        ::pthread_sigmask(SIG_SETMASK, &all, &before);
        _thread = std::thread([this] { run(); });
        ::pthread_sigmask(SIG_SETMASK, &before, nullptr);
    }
    _changed.notify_all();
}

void DiskSync::run()
{
    std::unique_lock lock(_mutex);
    for (;;) {
        _changed.wait(lock, [this] { return !_wanted.empty() || _isEnding; });
        if (_wanted.empty())
            return;
        const auto wanted = std::exchange(_wanted, {});
        _isBusy = true;
        lock.unlock();
        std::optional<Failure> failure;
        for (const int each : wanted) {
            if (const auto failed = syncAndClose(each); failed && !failure)
                failure = failed;
        }
        lock.lock();
        _isBusy = false;
        if (!_failure)
            _failure = failure;
        _changed.notify_all();
    }
}

Outcome DiskSync::finish()
{
    std::unique_lock lock(_mutex);
    _changed.wait(lock, [this] { return _wanted.empty() && !_isBusy; });
    return _failure ? Outcome(*_failure) : Done();
}

} // namespace spectrel

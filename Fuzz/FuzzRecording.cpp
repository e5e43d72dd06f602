// A recording file of any kind. Every message is read, byte by byte, and none is longer than the file allows.
#include "Records/Recording.h"

#include <cstdlib>
#include <sys/mman.h>
#include <unistd.h>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size)
{
    using namespace spectrel;
    const int file = ::memfd_create("recording", MFD_CLOEXEC);
    if (file < 0 || ::write(file, bytes, size) != static_cast<ssize_t>(size))
        std::abort();
    const auto opened = openRecording("/proc/self/fd/" + std::to_string(file));
    ::close(file);
    if (!opened && opened.failure().text.empty())
        std::abort();
    unsigned sum = 0;
    for (RecordedMessage message; opened && (*opened)->next(message);) {
        for (const std::uint8_t byte : message.body)
            sum += byte;
    }
    volatile unsigned kept = sum;
    static_cast<void>(kept);
    return 0;
}

#include "CommandLine/Commands/GapFile.h"

#include "Records/Beside/Gaps.h"
#include "Values/OwnFile.h"

#include <chrono>
#include <cstdio>
#include <unistd.h>

namespace spectrel {

GapFile::GapFile(const std::string& recording)
    : _path(gapsPath(recording))
{
}

GapFile::~GapFile()
{
    if (_file >= 0)
        ::close(_file);
}

Outcome GapFile::add(Moment time, std::uint64_t lost)
{
    if (_lost == 0)
        _time = time;
    _lost += lost;
    return flush();
}

Outcome GapFile::flush()
{
    if (_lost == 0)
        return Done();
    if (_file < 0) {
        const auto opened = openOwnFile(_path, IfThere::Refuse);
        if (!opened)
            return opened.failure().of(_path);
        _file = *opened;
    }
    const auto seconds = std::chrono::floor<std::chrono::seconds>(_time);
    char line[96];
    const int length = std::snprintf(line, sizeof line, "{\"time\": %lld.%06lld, \"lost\": %llu}\n",
        static_cast<long long>(seconds.time_since_epoch().count()), static_cast<long long>((_time - seconds).count()),
        static_cast<unsigned long long>(_lost));
    const off_t before = ::lseek(_file, 0, SEEK_CUR);
    if (::write(_file, line, static_cast<std::size_t>(length)) != length) {
        const Failure failure = Failure::ofSystem().of(_path);
        [[maybe_unused]] const int cut = ::ftruncate(_file, before);
        ::lseek(_file, before, SEEK_SET);
        return failure;
    }
    _lost = 0;
    return Done();
}

} // namespace spectrel

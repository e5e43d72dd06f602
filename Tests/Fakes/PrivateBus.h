#pragma once

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <sys/types.h>

namespace spectrel {

/// A message bus of the test's own.
class PrivateBus {
public:
    explicit PrivateBus(const std::string& folder)
    {
        const std::string command =
            "dbus-daemon --session --fork --print-address=1 --print-pid=1 --address=unix:path=" + folder + "/bus";
        std::FILE* const output = ::popen(command.c_str(), "r");
        char line[512] = "";
        if (std::fgets(line, sizeof line, output))
            _address = std::string(line, std::char_traits<char>::length(line) - 1);
        if (std::fgets(line, sizeof line, output))
            _process = std::atoi(line);
        ::pclose(output);
    }
    ~PrivateBus()
    {
        if (_process > 0)
            ::kill(_process, SIGTERM);
    }
    const std::string& address() const
    {
        return _address;
    }

private:
    std::string _address;
    pid_t _process = 0;
};

} // namespace spectrel

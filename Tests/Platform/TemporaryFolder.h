#pragma once

#include <cstdlib>
#include <filesystem>
#include <string>

namespace spectrel {

/// A folder of one test's own, with a short path; gone with its end.
class TemporaryFolder {
public:
    TemporaryFolder()
    {
        char name[] = "/tmp/spectrel-test-XXXXXX";
        _path = ::mkdtemp(name) ? name : "";
    }
    ~TemporaryFolder()
    {
        std::error_code error;
        if (!_path.empty())
            std::filesystem::remove_all(_path, error);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    const std::string& path() const
    {
        return _path;
    }

private:
    std::string _path;
};

} // namespace spectrel

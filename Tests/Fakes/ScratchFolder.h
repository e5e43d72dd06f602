#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <stdlib.h>
#include <string>
#include <string_view>

namespace spectrel {

/// A folder of one test's own, removed at its end.
class ScratchFolder {
public:
    ScratchFolder()
    {
        std::string name = (std::filesystem::temp_directory_path() / "spectrel-test-XXXXXX").string();
        if (!::mkdtemp(name.data()))
            throw std::runtime_error("no temporary folder can be made");
        _path = name;
    }
    ScratchFolder(const ScratchFolder&) = delete;
    ScratchFolder& operator=(const ScratchFolder&) = delete;
    ~ScratchFolder()
    {
        std::error_code ignored;
        std::filesystem::remove_all(_path, ignored);
    }

    const std::filesystem::path& path() const
    {
        return _path;
    }
    std::string file(std::string_view name) const
    {
        return (_path / name).string();
    }
    /// Writes a file and gives its path.
    std::string write(std::string_view name, std::string_view content) const
    {
        std::ofstream(_path / name, std::ios::binary)
            .write(content.data(), static_cast<std::streamsize>(content.size()));
        return file(name);
    }
    std::string read(std::string_view name) const
    {
        std::ifstream in(_path / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(in), {}};
    }

private:
    std::filesystem::path _path;
};

} // namespace spectrel

// Runs a fuzz target over files, and over all files of folders, as an ordinary program.
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size);

namespace {

void replay(const std::filesystem::path& path)
{
    std::ifstream file(path, std::ios::binary);
    const std::string input {std::istreambuf_iterator<char>(file), {}};
    LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(input.data()), input.size());
}

} // namespace

int main(int count, char** arguments)
{
    namespace fs = std::filesystem;
    int replayed = 0;
    for (int i = 1; i < count; ++i) {
        if (!fs::is_directory(arguments[i])) {
            replay(arguments[i]);
            ++replayed;
            continue;
        }
        for (const auto& entry : fs::directory_iterator(arguments[i])) {
            replay(entry.path());
            ++replayed;
        }
    }
    std::printf("%d inputs replayed\n", replayed);
    return replayed > 0 ? 0 : 1;
}

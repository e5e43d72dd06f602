#include "Platform/Syslog/FileLog.h"

#include "Values/OwnFile.h"

#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace {

/// The letter after the backslash; 0 for a character that has none.
char escapeLetter(char character)
{
    switch (character) {
    case '\n':
        return 'n';
    case '\t':
        return 't';
    case '\r':
        return 'r';
    case '\a':
        return 'a';
    case '\b':
        return 'b';
    case '\f':
        return 'f';
    case '\v':
        return 'v';
    default:
        return 0;
    }
}

void appendEscaped(std::string& line, char character)
{
    const auto code = static_cast<unsigned char>(character);
    if (const char letter = escapeLetter(character)) {
        line += '\\';
        line += letter;
    } else if (code < 0x20 || code == 0x7F) {
        line += '\\';
        line += static_cast<char>('0' + (code >> 6));
        line += static_cast<char>('0' + (code >> 3 & 7));
        line += static_cast<char>('0' + (code & 7));
    } else {
        line += character;
    }
}

} // namespace

Result<std::unique_ptr<FileLog>> FileLog::create(const std::string& path, Writing writing)
{
    const auto opened = openOwnFile(path, IfThere::Overwrite);
    if (!opened)
        return opened.failure();
    struct stat status { };
    const bool isFile = ::fstat(*opened, &status) == 0 && S_ISREG(status.st_mode);
    std::FILE* const file = isFile && ::ftruncate(*opened, 0) != 0 ? nullptr : ::fdopen(*opened, "w");
    if (file)
        return std::unique_ptr<FileLog>(new FileLog(file, writing));
    const Failure failure = Failure::ofSystem();
    ::close(*opened);
    return failure;
}

void FileLog::write(int priority, std::string_view text)
{
    _line = '<';
    _line += std::to_string(priority);
    _line += '>';
    for (const char character : text)
        appendEscaped(_line, character);
    _line += '\n';
    std::fwrite(_line.data(), 1, _line.size(), _file.get());
    if (_writing == Writing::EachLine)
        std::fflush(_file.get());
}

bool FileLog::flush()
{
    return std::fflush(_file.get()) == 0 && std::ferror(_file.get()) == 0;
}

} // namespace spectrel

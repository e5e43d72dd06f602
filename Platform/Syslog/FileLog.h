#pragma once

#include "Platform/SystemLog.h"
#include "Values/Result.h"

#include <cstdint>
#include <cstdio>
#include <memory>
#include <string>

namespace spectrel {

/// The system log as a file: one line "<PRIORITY>TEXT" each, control characters escaped as in C.
///
/// \n \t \r \a \b \f \v have their letters; every other control character is three octal digits (\033), which no
/// following digit can change. All else stands as it is, a backslash of the text and bytes from 0x80 on, too.
class FileLog final : public SystemLog {
public:
    /// Whether each line is in the file at once, or whenever the buffer is full and at the end.
    enum class Writing : std::uint8_t { EachLine, Buffered };

    /// An existing file is replaced where it is this user's own and no link (`openOwnFile`); its mode is 0600.
    static Result<std::unique_ptr<FileLog>> create(const std::string& path, Writing writing);

    void write(int priority, std::string_view text) override;
    /// False when a line could not be written since the log began.
    bool flush();

private:
    struct Close {
        void operator()(std::FILE* file) const
        {
            std::fclose(file);
        }
    };
    FileLog(std::FILE* file, Writing writing)
        : SystemLog(EveryPriority)
        , _file(file)
        , _writing(writing)
    {
    }

    std::unique_ptr<std::FILE, Close> _file;
    Writing _writing;
    std::string _line; // kept for its memory
};

} // namespace spectrel

#pragma once

#include "Values/Bytes.h"
#include "Values/Result.h"

#include <cstddef>
#include <cstdio>
#include <memory>
#include <string>

namespace spectrel {

/// A file opened for reading, closed at the end.
class RecordingFile {
public:
    /// Fails when it is missing, unreadable or a folder.
    static Result<RecordingFile> open(const std::string& path);

    /// The first bytes, at most 4, without taking them: works on pipes, too.
    Bytes peek();
    /// The rest of the file; fails when it cannot be read or is larger than that.
    Result<Bytes> readAll(std::size_t largest);

    std::FILE* get() const
    {
        return _file.get();
    }
    /// Hands the file over to somebody who closes it.
    std::FILE* release()
    {
        return _file.release();
    }

private:
    struct Closer {
        void operator()(std::FILE* file) const
        {
            std::fclose(file);
        }
    };

    std::unique_ptr<std::FILE, Closer> _file;
};

} // namespace spectrel

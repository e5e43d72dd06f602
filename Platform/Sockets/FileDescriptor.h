#pragma once

#include <utility>

namespace spectrel {

/// Owns a file descriptor.
class FileDescriptor {
public:
    FileDescriptor() = default;
    explicit FileDescriptor(int number)
        : _number(number)
    {
    }
    FileDescriptor(FileDescriptor&& other) noexcept
        : _number(std::exchange(other._number, -1))
    {
    }
    FileDescriptor& operator=(FileDescriptor&& other) noexcept
    {
        std::swap(_number, other._number);
        return *this;
    }
    ~FileDescriptor()
    {
        close();
    }

    int number() const
    {
        return _number;
    }
    explicit operator bool() const
    {
        return _number >= 0;
    }
    void close();

private:
    int _number = -1;
};

} // namespace spectrel

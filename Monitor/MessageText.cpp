#include "Monitor/MessageText.h"

#include "Records/RecordView.h"

#include <cstdio>
#include <cstdlib>
#include <cxxabi.h>
#include <memory>
#include <typeinfo>

namespace spectrel {

std::string codeText(ByteView message)
{
    const RecordView record(
        !message.empty() && message[0] == 0x81 && message.size() > 2 ? message.subspan(2) : message);
    if (record.size() < 5)
        return "no code";
    char text[32];
    std::snprintf(text, sizeof text, "code 0x%04X", record.u16(3) | (record.u8(0) == 0xFF ? 0xFF0000u : 0u));
    return text;
}

std::string exceptionName(const std::exception& exception)
{
    int status = 0;
    const std::unique_ptr<char, decltype(&std::free)> readable(
        abi::__cxa_demangle(typeid(exception).name(), nullptr, nullptr, &status), &std::free);
    const std::string name = status == 0 ? readable.get() : typeid(exception).name();
    const std::string what = exception.what();
    return what == "std::exception" || what == name ? name : name + " (" + what + ")";
}

std::string hexadecimal(ByteView bytes)
{
    static constexpr char Digits[] = "0123456789abcdef";
    std::string text;
    text.reserve(2 * bytes.size());
    for (const std::uint8_t byte : bytes) {
        text += Digits[byte >> 4];
        text += Digits[byte & 15];
    }
    return text;
}

} // namespace spectrel

#include "Monitor/MessageText.h"

#include "Records/Frame.h"

#include <cstdio>
#include <cstdlib>
#include <cxxabi.h>
#include <memory>
#include <typeinfo>

namespace spectrel {

std::string codeText(ByteView message)
{
    const RecordView record(recordInMessage(message));
    if (record.size() < RecordTypeSize + ItemLengthSize + ItemCodeSize)
        return "no code";
    char text[32];
    std::snprintf(text, sizeof text, "code 0x%04X", routingCode(record));
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

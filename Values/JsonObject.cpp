#include "Values/JsonObject.h"

#include <algorithm>
#include <cstdint>
#include <rapidjson/reader.h>

namespace spectrel {

/// Hears of the values as RapidJSON's reader comes to them; the members of the outermost object are kept.
class JsonObject::Reading : public rapidjson::BaseReaderHandler<rapidjson::UTF8<>, Reading> {
public:
    explicit Reading(JsonObject& object)
        : _object(object)
    {
    }

    bool Default() // null, true or false
    {
        return _depth > 0;
    }
    bool Int(int value)
    {
        return Double(value);
    }
    bool Uint(unsigned value)
    {
        return Double(value);
    }
    bool Int64(std::int64_t value)
    {
        return Double(static_cast<double>(value));
    }
    bool Uint64(std::uint64_t value)
    {
        return Double(static_cast<double>(value));
    }
    bool Double(double value)
    {
        return keep(value);
    }
    bool String(const char* text, rapidjson::SizeType length, bool)
    {
        return keep(std::string(text, length));
    }
    bool Key(const char* text, rapidjson::SizeType length, bool)
    {
        if (_depth == 1)
            _key.assign(text, length);
        return true;
    }
    bool StartObject()
    {
        return ++_depth <= DeepestContainer;
    }
    bool EndObject(rapidjson::SizeType)
    {
        --_depth;
        return true;
    }
    bool StartArray()
    {
        return _depth > 0 && StartObject();
    }
    bool EndArray(rapidjson::SizeType)
    {
        return EndObject(0);
    }

private:
    static constexpr int DeepestContainer = 17; // the object itself is the first

    template <typename Kept> bool keep(Kept value)
    {
        if (_depth == 1)
            _object._members.emplace_back(_key, std::move(value));
        return _depth > 0;
    }

    JsonObject& _object;
    int _depth = 0;
    std::string _key;
};

/// Texts are decoded where they stand: otherwise the reader gathers them on a stack for which it adds to a null
/// pointer.
std::optional<JsonObject> JsonObject::parse(std::string text)
{
    if (text.find('\0') != std::string::npos) // where the reader would end
        return std::nullopt;
    JsonObject object;
    Reading reading(object);
    rapidjson::Reader reader;
    rapidjson::InsituStringStream stream(text.data());
    constexpr unsigned Flags = rapidjson::kParseInsituFlag | rapidjson::kParseValidateEncodingFlag;
    if (reader.Parse<Flags>(stream, reading).IsError())
        return std::nullopt;
    return object;
}

const JsonObject::Member* JsonObject::member(std::string_view key) const
{
    const auto found =
        std::find_if(_members.rbegin(), _members.rend(), [key](const Member& member) { return member.first == key; });
    return found == _members.rend() ? nullptr : &*found;
}

std::optional<double> JsonObject::number(std::string_view key) const
{
    const Member* const found = member(key);
    const double* const number = found ? std::get_if<double>(&found->second) : nullptr;
    return number ? std::optional(*number) : std::nullopt;
}

const std::string* JsonObject::text(std::string_view key) const
{
    const Member* const found = member(key);
    return found ? std::get_if<std::string>(&found->second) : nullptr;
}

} // namespace spectrel

#include "LogGenerator/CDMA/C2KLogGenerator.h"

#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/Lookup.h"
#include "Platform/SystemLog.h"
#include "Platform/TelephonyProtocol.h"
#include "Records/Frame.h"
#include "Records/RecordView.h"
#include "Values/List.h"

#include <algorithm>
#include <array>
#include <utility>

namespace spectrel {

namespace {

/// A display dictionary that holds this entry, key and text, shows its children sorted by key.
constexpr std::string_view SortedMark = "_sorted";

struct Decoder {
    std::uint32_t code;
    void (*decode)(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);
};

/// In the order in which the start command asks for the codes.
constexpr std::array<Decoder, 8> Decoders {{
    {0x108A, decodeFingers},
    {0x1183, decodeAirLinkSummary},
    {0x1192, decodeForwardLinkData},
    {0x12B6, decodeActiveSetPilots},
    {0x119C, decodeSearcher},
    {0x119D, decodeFrameErrors},
    {0x127E, decodeReverseLinkData},
    {0x134F, decodeSystemInformation},
}};

} // namespace

C2KLogGenerator::C2KLogGenerator(const Context& context)
    : ZPHLogGenerator(context)
{
    init();
}

std::unique_ptr<C2KLogGenerator> C2KLogGenerator::generator(const Context& context)
{
    return std::make_unique<C2KLogGenerator>(context);
}

std::string_view C2KLogGenerator::className() const
{
    return "C2KLogGenerator";
}

DictionaryRef C2KLogGenerator::getStartCommand()
{
    auto codes = List::make();
    for (const Decoder& decoder : Decoders)
        codes->append(Value::integer(decoder.code));
    return Dictionary::make({{TelephonyProtocol::SetStateKey, TelephonyProtocol::StreamingState},
        {TelephonyProtocol::OrdinaryCodesKey, codes}});
}

void C2KLogGenerator::updateState(Dictionary& state, ByteView data)
{
    getDisplayFromState(state);
    const Value lookup = state[StateKey::Lookup]; // held: the decoders add to the state
    updateFromLog(data, lookup, state);
}

void C2KLogGenerator::updateFromLog(ByteView data, const Value& usingLookup, Dictionary& usingState)
{
    if (data.size() < RecordHeaderSize)
        return;
    const ByteView bytes = recordInMessage(data);
    const RecordView record(bytes);
    if (record.u8(0) != OrdinaryRecord)
        SPECTREL_LOG(log(), Priority::Error, InvalidTypeLine, record.u8(0)); // not dropped all the same, on purpose
    const auto decoder = std::ranges::find(Decoders, routingCode(record), &Decoder::code);
    if (decoder == Decoders.end())
        return;
    decoder->decode(log(), record, usingState, usingLookup);
    keepRawMessage(bytes);
}

Value C2KLogGenerator::generateLogUsingState(Dictionary& state)
{
    Value display = getDisplayFromState(state);
    handOverRawMessages(state);
    updateHistoryInState(state, context().clock);
    return display;
}

Value C2KLogGenerator::getDisplayFromState(Dictionary& state)
{
    if (const Value& display = state[StateKey::Display]; !display.isAbsent())
        return display;
    if (state[StateKey::Template].isAbsent()) {
        auto loaded = context().resources.propertyList("C2KTemplate");
        if (!loaded || !loaded->dictionary()) {
            SPECTREL_LOG(log(), Priority::Error, "Cannot load C2K template for display");
            return {};
        }
        state.set(StateKey::Template, std::move(*loaded));
    }
    auto lookup = Dictionary::make();
    auto display = Dictionary::make();
    processTemplate(*state[StateKey::Template].dictionary(), display, *lookup);
    state.set(StateKey::Display, display);
    state.set(StateKey::Lookup, lookup);
    state.set(StateKey::ExtraInfo, Dictionary::make());
    return display;
}

void C2KLogGenerator::processTemplate(const Dictionary& templateDictionary, const DictionaryRef& storeDisplayIntoDict,
    Dictionary& storeLookupIntoDict) const
{
    for (const auto& [key, value] : templateDictionary.entries()) {
        if (const auto& dictionary = value.dictionary()) {
            auto node = Dictionary::make();
            processTemplate(*dictionary, node, storeLookupIntoDict);
            storeDisplayIntoDict->set(key, node);
        } else if (const std::string* variable = value.string()) {
            const bool isMark = *variable == SortedMark;
            storeDisplayIntoDict->set(key, isMark ? SortedMark : "");
            if (!isMark)
                addLookupPosition(storeLookupIntoDict, *variable, key, storeDisplayIntoDict);
        }
    }
    SPECTREL_LOG(log(), Priority::Warning, "Processing the template");
}

} // namespace spectrel

#include "LogGenerator/Template/ZPHLogGenerator2.h"

#include "LogGenerator/Template/Base.h"
#include "Platform/SystemLog.h"
#include "Platform/TelephonyProtocol.h"
#include "Records/Frame.h"

#include <algorithm>
#include <charconv>
#include <utility>

namespace spectrel {

void ZPHLogGenerator2::initWithPListName(std::string newPListName, std::shared_ptr<ClassIndex> cIndexObj)
{
    SPECTREL_LOG(
        log(), Priority::Error, "Creating ZPHLogGenerator2 object with %p", static_cast<void*>(cIndexObj.get()));
    ZPHLogGenerator::init();
    pListName = std::move(newPListName);
    cIndex = std::move(cIndexObj);
    SPECTREL_LOG(log(), Priority::Error, "Class Index: %ld", cIndex.use_count());
}

ZPHLogGenerator2::~ZPHLogGenerator2()
{
    // The same text whatever the class, on purpose.
    SPECTREL_LOG(log(), Priority::Warning, "ZPH_GSMLogGenerator is destructed %p", static_cast<void*>(this));
}

void ZPHLogGenerator2::updateState(Dictionary& state, ByteView data)
{
    getDisplayFromState(state);
    updateWithData(data);
    keepRawMessage(data);
}

void ZPHLogGenerator2::updateWithData(ByteView data)
{
    if (data.size() < RecordHeaderSize)
        return;
    const RecordView record(recordInMessage(data));
    const std::uint8_t type = record.u8(0);
    if (!isRecordType(type)) {
        SPECTREL_LOG(log(), Priority::Error, InvalidTypeLine, type);
        return;
    }
    const std::uint32_t code = routingCode(record);
    const Subscribers* subscribers = cIndex ? cIndex->getSubscribers(code) : nullptr;
    if (!subscribers)
        return;
    for (Base* section : *subscribers)
        section->updateWithData(record, code);
}

Value ZPHLogGenerator2::getDisplayFromState(Dictionary& state)
{
    if (const Value& display = state[StateKey::Display]; !display.isAbsent())
        return display;
    if (state[StateKey::Template].isAbsent()) {
        auto loaded = context().resources.propertyList(pListName);
        if (!loaded || !loaded->dictionary()) {
            SPECTREL_LOG(log(), Priority::Error, "Cannot load template for display");
            return {};
        }
        state.set(StateKey::Template, std::move(*loaded));
    }
    SPECTREL_LOG(log(), Priority::Warning, "Initialized class index: %p, Self: %p", static_cast<void*>(cIndex.get()),
        static_cast<void*>(this));
    if (cIndex)
        cIndex->status();
    const Value display = processTemplate(state[StateKey::Template]);
    printDict(display);
    state.set(StateKey::Display, display);
    state.set(StateKey::ExtraInfo, Dictionary::make());
    return {};
}

Value ZPHLogGenerator2::generateLogUsingState(Dictionary& state)
{
    Value display = getDisplayFromState(state);
    handOverRawMessages(state);
    updateHistoryInState(state, context().clock);
    return display;
}

Value ZPHLogGenerator2::processTemplate(const Value& object)
{
    if (object.string())
        return object;
    if (const auto& dictionary = object.dictionary()) {
        auto copy = Dictionary::make();
        for (const auto& [key, value] : dictionary->entries()) {
            Value node = processTemplate(value);
            if (Base* section = cIndex ? cIndex->getClass(key) : nullptr)
                section->updateSectionRef(node);
            copy->set(key, std::move(node));
        }
        return copy;
    }
    if (const auto& list = object.list()) {
        auto copy = List::make();
        for (const Value& element : list->elements())
            copy->append(processTemplate(element));
        return copy;
    }
    SPECTREL_LOG(log(), Priority::Error, "Received an object of unknown type");
    SPECTREL_LOG(log(), Priority::Warning, "Processing the template");
    return {};
}

void ZPHLogGenerator2::printDict(const Value& object) const
{
    if (object.string())
        return;
    if (const auto& dictionary = object.dictionary()) {
        for (const auto& entry : dictionary->entries())
            printDict(entry.value);
    } else if (const auto& list = object.list()) {
        for (const Value& element : list->elements())
            printDict(element);
    } else {
        SPECTREL_LOG(log(), Priority::Error, "Received an object of unknown type");
    }
}

DictionaryRef ZPHLogGenerator2::getStartCommand()
{
    auto ordinary = List::make();
    auto extra = List::make();
    for (const std::string& text : cIndex ? cIndex->getAllLogCodes() : std::vector<std::string>()) {
        std::int32_t code = 0;
        std::from_chars(text.data(), text.data() + text.size(), code);
        if (code >= static_cast<std::int32_t>(ExtraStream))
            extra->append(Value::integer(code - static_cast<std::int32_t>(ExtraStream)));
        else
            ordinary->append(Value::integer(code));
    }
    return Dictionary::make({
        {TelephonyProtocol::SetStateKey, TelephonyProtocol::StreamingState},
        {TelephonyProtocol::OrdinaryCodesKey, ordinary},
        {TelephonyProtocol::ExtraCodesKey, extra},
    });
}

void ZPHLogGenerator2::takeOver(LogGenerator* predecessor, Dictionary& state)
{
    ZPHLogGenerator::takeOver(predecessor, state);
    bindSections(state[StateKey::Template], state[StateKey::Display]);
}

/// Walks the template beside the display built from it and binds the sections to the nodes that the display holds.
void ZPHLogGenerator2::bindSections(const Value& templateObject, const Value& displayObject)
{
    const auto& layout = templateObject.dictionary();
    const auto& display = displayObject.dictionary();
    if (layout && display) {
        for (const auto& [key, value] : layout->entries()) {
            const Value& node = (*display)[key];
            bindSections(value, node);
            if (Base* section = cIndex ? cIndex->getClass(key) : nullptr)
                section->updateSectionRef(node);
        }
    }
    const auto& layoutList = templateObject.list();
    const auto& displayList = displayObject.list();
    if (layoutList && displayList) {
        const std::size_t count = std::min(layoutList->count(), displayList->count());
        for (std::size_t position = 0; position < count; ++position)
            bindSections((*layoutList)[position], (*displayList)[position]);
    }
}

} // namespace spectrel

#pragma once

#include "LogGenerator/Template/ZPHLogGenerator.h"

#include <memory>

namespace spectrel {

/// CDMA2000, 1x and EV-DO: template "C2KTemplate", eight log codes, no sections.
///
/// The template's leaves name display variables ("kChannel"). Its copy is the display; the lookup made beside it tells
/// each variable's positions, into which the decoders put their texts.
class C2KLogGenerator final : public ZPHLogGenerator {
public:
    explicit C2KLogGenerator(const Context& context);

    static std::unique_ptr<C2KLogGenerator> generator(const Context& context);
    std::string_view className() const override;

    DictionaryRef getStartCommand() override;
    void updateState(Dictionary& state, ByteView data) override;
    Value generateLogUsingState(Dictionary& state) override;

    /// Frames one message, hands its record to the code's decoder and keeps the record, unless the code is none of the
    /// eight. A record of a wrong type is logged and decoded all the same. `usingLookup`: absent without a template.
    void updateFromLog(ByteView data, const Value& usingLookup, Dictionary& usingState);

    /// The state's display, built at need; absent when there is no template.
    Value getDisplayFromState(Dictionary& state);
    /// Fills the display in the template's shape with an empty text for each variable, and the lookup with its
    /// positions. "_sorted" is copied, what is neither text nor dictionary is left out.
    void processTemplate(const Dictionary& templateDictionary, const DictionaryRef& storeDisplayIntoDict,
        Dictionary& storeLookupIntoDict) const;
};

} // namespace spectrel

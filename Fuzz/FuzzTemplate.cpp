// A display template, as the resources hold it: copied, bound to the sections, written to and drawn as a tree.

#include "LogGenerator/Template/ZPHLogGenerator2.h"
#include "Monitor/SpectrelModelNode.h"
#include "Platform/Resources.h"
#include "Sections/LTE/LTELogGenerator.h"
#include "Values/PropertyList/PropertyList.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace {

class OneTemplate final : public spectrel::Resources {
public:
    explicit OneTemplate(spectrel::ByteView bytes)
        : _template(spectrel::parsePropertyList(bytes))
    {
    }
    std::optional<spectrel::Value> propertyList(std::string_view) const override
    {
        return _template;
    }
    std::vector<std::string> propertyListPaths() const override
    {
        return {};
    }

private:
    std::optional<spectrel::Value> _template;
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size)
{
    using namespace spectrel;
    const OneTemplate resources({bytes, size});
    const auto generator = LTELogGenerator::generator({.resources = resources});
    Dictionary state;
    std::array<std::uint8_t, 40> servingCell {0x01, 39, 0, 0xC2, 0xB0};
    generator->updateState(state, servingCell);
    generator->updateState(state, servingCell);
    PathIndex paths;
    SpectrelModelNode::makeTreeFromObject(generator->generateLogUsingState(state), paths);

    const auto successor = LTELogGenerator::generator({.resources = resources});
    successor->takeOver(generator.get(), state);
    successor->updateState(state, servingCell);
    return 0;
}

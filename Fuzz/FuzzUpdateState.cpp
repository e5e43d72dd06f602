// One inbound message body, as the message port delivers it, applied to a technology's display; then a refresh.

#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Monitor/SpectrelModelNode.h"
#include "Platform/Resources.h"
#include "Records/Recording.h"
#include "Values/Dictionary.h"

#include <cstddef>
#include <cstdint>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size)
{
    using namespace spectrel;
    static const DirectoryResources resources(SPECTREL_SOURCE_DIR "/Resources");

    const auto technology = technologyConstant(*technologyNamed(SPECTREL_FUZZ_TECHNOLOGY));
    const auto generator = LogGenerator::generatorFromTechnology(Value(technology), {.resources = resources});
    Dictionary state;
    try {
        generator->updateState(state, {bytes, size});
    } catch (const ArrayOutOfBoundsException&) {
        // An index beyond its own count raises this by design; whatever else escapes is a finding.
    } catch (const LogCode_0xFF0000::UnknownDataException&) {
        // So does a SIM record that is no property list.
    }
    PathIndex paths;
    SpectrelModelNode::makeTreeFromObject(generator->generateLogUsingState(state), paths);
    generator->getSaveContentsFromState(state);
    return 0;
}

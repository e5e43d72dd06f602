#pragma once

#include "LogGenerator/LogGenerator.h"
#include "Values/Bytes.h"

#include <memory>

namespace spectrel {

/// The base of the generators whose baseband speaks the binary diagnostic-log stream: keeps the raw messages and makes
/// a DLF binary log of them when a snapshot is saved.
class ZPHLogGenerator : public LogGenerator {
public:
    ListRef getSaveContentsFromState(const Dictionary& state) override;
    void takeOver(LogGenerator* predecessor, Dictionary& state) override;
    void discardRawMessages() override;
    void keepRawMessage(ByteView data) override;

    /// The version-report record, then every history entry's raw messages without their very first byte. Null when the
    /// history holds raw material of another kind.
    DataRef generateDlfFromState(const Dictionary& state) const;

protected:
    using LogGenerator::LogGenerator;
    void init();
    /// Stores the raw messages under "DisplayState" and starts anew.
    void handOverRawMessages(Dictionary& state);

private:
    std::shared_ptr<Bytes> _binData; // raw messages since the last refresh; null while uninitialised
};

} // namespace spectrel

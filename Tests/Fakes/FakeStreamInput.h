#pragma once

#include "Platform/StreamInput.h"

#include <string>
#include <utility>

namespace spectrel {

/// An input whose writer is the test.
class FakeStreamInput final : public StreamInput {
public:
    const std::string& name() const override
    {
        return _name;
    }
    bool takesFurtherWriters() const override
    {
        return furtherWriters;
    }
    bool isOpenToOthers() const override
    {
        return openToOthers;
    }
    void start(Listener& listener) override
    {
        _listener = &listener;
    }
    void setPaused(bool paused) override
    {
        isPaused = paused;
    }
    void dropWriter() override
    {
        ++dropped;
    }

    void come()
    {
        _listener->writerCame();
    }
    void write(ByteView bytes)
    {
        _listener->bytesCame(bytes);
    }
    void end(const std::string& reason = "")
    {
        _listener->writerEnded(reason);
    }

    bool furtherWriters = true;
    bool openToOthers = false;
    bool isPaused = false;
    int dropped = 0;

private:
    std::string _name = "fake";
    Listener* _listener = nullptr;
};

} // namespace spectrel

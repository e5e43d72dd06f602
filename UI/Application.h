#pragma once

#include <string>

namespace spectrel {

/// What the controllers of the screens ask of the application. It outlives them.
class Application {
public:
    /// Why there is no session; empty while there is one or nothing is known.
    virtual const std::string& lostReason() const = 0;
    virtual bool allowSaveButton() const = 0;
    /// Opens the save screen; nothing while it is open.
    virtual void showSaveView() = 0;
    /// The save screen has nothing left to do: it closes once the current job has ended.
    virtual void saveViewDidFinish() = 0;

protected:
    ~Application() = default;
};

} // namespace spectrel

#pragma once

#include "Tests/Fakes/FakeModel.h"
#include "Tests/Fakes/FakePreferences.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/FakeToolkit.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "UI/SpectrelApp.h"
#include "UI/SpectrelCell.h"
#include "UI/SpectrelPaneController.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace spectrel {

/// A temporary device root, with or without the marker that allows saving.
class DeviceRoot {
public:
    DeviceRoot()
    {
        ::setenv("SPECTREL_DEVICE_ROOT", _folder.path().c_str(), 1);
    }
    ~DeviceRoot()
    {
        ::unsetenv("SPECTREL_DEVICE_ROOT");
    }
    DeviceRoot(const DeviceRoot&) = delete;
    DeviceRoot& operator=(const DeviceRoot&) = delete;
    void addMarker() const
    {
        std::filesystem::create_directories(_folder.path().string() + SpectrelApp::SaveMarker);
    }

private:
    ScratchFolder _folder;
};

/// One save as the writer was asked for it.
struct WrittenSnapshot {
    DictionaryRef snapshot;
    std::string path;
};

inline DictionaryRef entries(std::initializer_list<Dictionary::Entry> list)
{
    return Dictionary::make(list);
}

/// What a controller asks for where there is no whole application.
class FakeApplication final : public Application {
public:
    const std::string& lostReason() const override
    {
        return reason;
    }
    bool allowSaveButton() const override
    {
        return allowsSaving;
    }
    void showSaveView() override
    {
        ++saveViews;
    }
    void saveViewDidFinish() override { }

    std::string reason;
    bool allowsSaving = false;
    int saveViews = 0; // asked for
};

/// A launched application over a fake model.
class AppFixture : public testing::Test {
protected:
    /// `toolkit` may be a front end of the test's own.
    std::unique_ptr<SpectrelApp> makeApp(ScreenToolkit& chosen)
    {
        return std::make_unique<SpectrelApp>(SpectrelApp::Services {loop, loop, recorder, preferences, chosen,
            [this](SpectrelModelObserver& given) {
                observer = &given;
                auto made = std::make_unique<FakeModel>();
                model = made.get();
                model->playing = playing;
                return made;
            },
            [this](const DictionaryRef& snapshot, const std::string& path, std::string& reason) {
                written.push_back({snapshot, path});
                reason = canWrite ? "" : "no room";
                return canWrite;
            },
            "/crash", offersSaving});
    }
    void launch()
    {
        app = makeApp(toolkit);
        app->applicationDidFinishLaunching();
        loop.runQueued();
    }
    void launchAllowingSave()
    {
        root.addMarker();
        launch();
    }
    void connect()
    {
        model->connected = true;
        model->reason.clear();
        app->sessionDidChange();
    }
    void lose(const std::string& reason)
    {
        model->connected = false;
        model->reason = reason;
        app->sessionDidChange();
    }
    void show(const Value& display)
    {
        model->setDisplay(display);
        app->updateViewControllerFromModel();
    }
    const NavigationController::Panes& panes() const
    {
        return app->navController()->viewControllers();
    }
    SpectrelPaneController& top() const
    {
        return *app->navController()->topViewController();
    }
    /// Gives every row of the pane room on the screen.
    static void display(SpectrelPaneController& pane, double width = 320)
    {
        pane.tableView().setVisibleRows(0, 100, {0, 0, width, 50});
    }
    void tap(std::size_t row) const
    {
        top().tableView().selectRow(row);
    }
    std::string openPaths() const
    {
        std::string text;
        for (const auto& pane : panes())
            text += pane->path() + " ";
        return text;
    }
    static std::string toolbar(const SpectrelPaneController& pane)
    {
        std::string text;
        for (const ToolbarItem& item : pane.toolbarItems()) {
            switch (item.kind) {
            case ToolbarItem::Kind::LoadingIndicator:
                text += item.isSpinning ? "(spinning)" : "(stopped)";
                break;
            case ToolbarItem::Kind::Label:
                text += "|" + item.text;
                break;
            case ToolbarItem::Kind::FlexibleSpace:
                text += "|...";
                break;
            case ToolbarItem::Kind::SaveButton:
                text += "|[save]";
                break;
            }
        }
        return text;
    }

    DeviceRoot root;
    FakeRunLoop loop;
    LogRecorder recorder;
    FakePreferences preferences;
    FakeToolkit toolkit;
    FakeModel* model = nullptr;
    SpectrelModelObserver* observer = nullptr;
    std::vector<WrittenSnapshot> written;
    bool canWrite = true;
    bool offersSaving = true;
    Playback* playing = nullptr; // of the model to be made
    std::unique_ptr<SpectrelApp> app;
};

} // namespace spectrel

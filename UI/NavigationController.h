#pragma once

#include "UI/ScreenToolkit.h"

#include <cstddef>
#include <memory>
#include <vector>

namespace spectrel {

class NavigationController;
class SpectrelPaneController;

/// Who hears before a pane comes to the top.
class NavigationControllerDelegate {
public:
    virtual ~NavigationControllerDelegate() = default;
    virtual void navigationControllerWillShowViewController(
        NavigationController& navigationController, SpectrelPaneController& pane, Animation animated) = 0;
};

/// The stack of panes, the root pane at index 0; it is never empty, and the top pane is the one in sight.
class NavigationController {
public:
    using Panes = std::vector<std::shared_ptr<SpectrelPaneController>>;

    NavigationController(ScreenToolkit& toolkit, std::shared_ptr<SpectrelPaneController> root);
    ~NavigationController();
    NavigationController(const NavigationController&) = delete;
    NavigationController& operator=(const NavigationController&) = delete;

    void setDelegate(NavigationControllerDelegate* delegate)
    {
        _delegate = delegate;
    }
    /// Bottom first.
    const Panes& viewControllers() const
    {
        return _viewControllers;
    }
    const std::shared_ptr<SpectrelPaneController>& topViewController() const
    {
        return _viewControllers.back();
    }
    void pushViewController(std::shared_ptr<SpectrelPaneController> pane, Animation animated);
    /// Closes the top pane; the root pane stays.
    void popViewController(Animation animated);
    /// Closes every pane above the one at `index`; nothing when it is the top one or there is no such pane.
    void popToViewControllerAtIndex(std::size_t index, Animation animated);

    bool isToolbarHidden() const
    {
        return _isToolbarHidden;
    }
    void setToolbarHidden(bool isHidden)
    {
        _isToolbarHidden = isHidden;
    }

private:
    ScreenToolkit& _toolkit;
    NavigationControllerDelegate* _delegate = nullptr;
    Panes _viewControllers;
    bool _isToolbarHidden = true;
};

} // namespace spectrel

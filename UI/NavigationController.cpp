#include "UI/NavigationController.h"

#include "UI/SpectrelPaneController.h"

#include <utility>

namespace spectrel {

NavigationController::NavigationController(ScreenToolkit& toolkit, std::shared_ptr<SpectrelPaneController> root)
    : _toolkit(toolkit)
{
    root->setNavigationController(this);
    _viewControllers.push_back(std::move(root));
}

NavigationController::~NavigationController()
{
    for (const auto& pane : _viewControllers)
        pane->setNavigationController(nullptr);
}

void NavigationController::pushViewController(std::shared_ptr<SpectrelPaneController> pane, Animation animated)
{
    topViewController()->viewWillDisappear();
    pane->setNavigationController(this);
    _viewControllers.push_back(std::move(pane));
    const auto shown = topViewController();
    if (_delegate)
        _delegate->navigationControllerWillShowViewController(*this, *shown, animated);
    shown->viewWillAppear();
    _toolkit.screenDidChange(ScreenPart::Navigation, animated);
}

void NavigationController::popViewController(Animation animated)
{
    if (_viewControllers.size() > 1)
        popToViewControllerAtIndex(_viewControllers.size() - 2, animated);
}

void NavigationController::popToViewControllerAtIndex(std::size_t index, Animation animated)
{
    if (index + 1 >= _viewControllers.size())
        return;
    topViewController()->viewWillDisappear();
    while (_viewControllers.size() > index + 1) {
        topViewController()->setNavigationController(nullptr);
        _viewControllers.pop_back();
    }
    const auto shown = topViewController();
    if (_delegate)
        _delegate->navigationControllerWillShowViewController(*this, *shown, animated);
    shown->viewWillAppear();
    _toolkit.screenDidChange(ScreenPart::Navigation, animated);
}

} // namespace spectrel

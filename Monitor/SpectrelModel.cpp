#include "Monitor/SpectrelModel.h"

#include <utility>

namespace spectrel {

SpectrelModel::SpectrelModel(
    Services services, GeneratorFactory makeGenerator, SpectrelModelObserver& observer, std::string portPrefix)
    : _runLoop(services.runLoop)
    , _clock(services.context.clock)
    , _observer(observer)
    , _display(std::move(makeGenerator), services.context)
    , _session(services, *this, std::move(portPrefix))
{
}

void SpectrelModel::useTechnology(const Value& technology)
{
    _display.useTechnology(technology);
}

void SpectrelModel::updateWithData(ByteView data)
{
    _display.apply(data, _clock.now());
    _intake += data.size();
    if (_intake >= LargestIntake)
        _session.pause();
}

void SpectrelModel::sessionDidTick()
{
    _intake = 0;
    if (!_display.takeNews())
        return;
    _nodes.reset();
    _nodesByPath.reset();
    _runLoop.async(_lifetime.guard([this] { _observer.updateViewControllerFromModel(); }));
}

NodeRef SpectrelModel::topLevelNodes()
{
    if (_nodes || !_display.generator())
        return _nodes;
    const Value display = _display.build();
    _nodesByPath = std::make_unique<PathIndex>();
    _nodes = SpectrelModelNode::makeTreeFromObject(display, *_nodesByPath);
    return _nodes;
}

NodeRef SpectrelModel::nodeAtPath(std::string_view path)
{
    if (!_nodesByPath)
        topLevelNodes();
    return _nodesByPath ? nodeInIndex(*_nodesByPath, path) : nullptr;
}

} // namespace spectrel

#include "UI/Quick/QuickFrontEnd.h"

#include "UI/Quick/ColorScheme.h"
#include "UI/Quick/QuickScreen.h"

#include <QOpenGLContext>
#include <QQmlApplicationEngine>
#include <QQuickWindow>
#include <QUrl>
#include <QVariantMap>

#include <algorithm>
#include <array>
#include <unistd.h>

void qml_register_types_Spectrel_Quick(); // made from the module's types at build time

namespace spectrel {

namespace {

/// Where no graphics processor is, the graphics library draws on the processor, slowly and in much memory.
bool hasGraphicsProcessor()
{
    static constexpr std::array Devices {"/dev/dri", "/dev/nvidiactl", "/dev/mali0", "/dev/kgsl-3d0", "/dev/pvr_sync"};
    return std::ranges::any_of(Devices, [](const char* device) { return ::access(device, F_OK) == 0; });
}

/// Draws without a graphics processor where there is none; by itself the toolkit would end the process.
void chooseRenderer()
{
    if (qEnvironmentVariableIsSet("QT_QUICK_BACKEND") || qEnvironmentVariableIsSet("QSG_RHI_BACKEND"))
        return;
    if (!hasGraphicsProcessor() || !QOpenGLContext().create())
        QQuickWindow::setGraphicsApi(QSGRendererInterface::Software);
}

} // namespace

/// What exists for as long as the front end; the engine only while started.
class QuickFrontEnd::Session {
public:
    explicit Session(QuickFrontEnd& frontEnd)
        : screen([&frontEnd] {
            if (frontEnd.onQuit)
                frontEnd.onQuit();
        })
    {
        if (frontEnd._appearance) {
            screen.setDark(*frontEnd._appearance == Appearance::Dark);
        } else {
            QObject::connect(&colors, &ColorScheme::changed, &screen, [this] { screen.setDark(colors.isDark()); });
            screen.setDark(colors.isDark());
        }
    }

    ColorScheme colors;
    QuickScreen screen;
    std::unique_ptr<QQmlApplicationEngine> engine;
};

QuickFrontEnd::QuickFrontEnd(std::optional<Appearance> appearance)
    : _appearance(appearance)
    , _session(std::make_unique<Session>(*this))
{
}

QuickFrontEnd::~QuickFrontEnd()
{
    stop();
}

ScreenToolkit& QuickFrontEnd::toolkit()
{
    return _session->screen;
}

Outcome QuickFrontEnd::start()
{
    std::string reason;
    chooseRenderer();
    qml_register_types_Spectrel_Quick();
    auto engine = std::make_unique<QQmlApplicationEngine>();
    const auto listening =
        QObject::connect(engine.get(), &QQmlEngine::warnings, [&reason](const QList<QQmlError>& errors) {
            if (reason.empty() && !errors.isEmpty())
                reason = errors.constFirst().toString().toStdString();
        });
    engine->addImportPath("qrc:/qt/qml");
    engine->setInitialProperties({{"screen", QVariant::fromValue(&_session->screen)}});
    engine->load(QUrl("qrc:/qt/qml/Spectrel/Quick/Main.qml"));
    QObject::disconnect(listening);
    if (engine->rootObjects().isEmpty())
        return Failure {reason};
    _session->engine = std::move(engine);
    return Done {};
}

void QuickFrontEnd::stop()
{
    _session->engine.reset();
}

QQuickWindow* QuickFrontEnd::window() const
{
    return _session->engine ? qobject_cast<QQuickWindow*>(_session->engine->rootObjects().constFirst()) : nullptr;
}

void QuickFrontEnd::raise(const std::string& activationToken)
{
    QQuickWindow* const shown = window();
    if (!shown)
        return;
    if (!activationToken.empty())
        qputenv("XDG_ACTIVATION_TOKEN", QByteArray::fromStdString(activationToken)); // the toolkit takes it from there
    if (shown->windowStates() & Qt::WindowMinimized)
        shown->showNormal();
    shown->raise();
    shown->requestActivate();
}

} // namespace spectrel

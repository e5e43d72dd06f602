#include "Tests/UI/Quick/QuickFixture.h"

#include <QGuiApplication>
#include <QQuickItem>
#include <QQuickWindow>
#include <QTest>

#include <algorithm>

namespace spectrel {

namespace {

constexpr int Patience = 60'000; // ms until a test gives up on something that is bound to come

std::vector<std::string>& complaints()
{
    static std::vector<std::string> lines;
    return lines;
}

void takeLine(QtMsgType type, const QMessageLogContext&, const QString& line)
{
    if (type != QtDebugMsg && type != QtInfoMsg)
        complaints().push_back(line.toStdString());
}

QPointF middleOf(const QQuickItem& item)
{
    return item.mapToScene({item.width() / 2, item.height() / 2});
}

/// The toolkit's application object, without a screen. It goes before the toolkit's own statics do, as in a program.
class ToolkitEnvironment final : public testing::Environment {
public:
    void SetUp() override
    {
        qputenv("QT_QPA_PLATFORM", "offscreen");
        qputenv("QT_QUICK_BACKEND", "software");
        _application = std::make_unique<QGuiApplication>(_count, _arguments);
    }
    void TearDown() override
    {
        _application.reset();
    }

private:
    int _count = 1;
    char _name[11] = "test_quick";
    char* _arguments[2] = {_name, nullptr};
    std::unique_ptr<QGuiApplication> _application;
};

const testing::Environment* const Toolkit = testing::AddGlobalTestEnvironment(new ToolkitEnvironment);

} // namespace

QuickFixture::QuickFixture()
{
    static QPointingDevice* const finger = QTest::createTouchDevice();
    _finger = finger;
}

QuickFixture::~QuickFixture()
{
    app.reset();
}

void QuickFixture::SetUp()
{
    complaints().clear();
    qInstallMessageHandler(takeLine);
    frontEnd = std::make_unique<QuickFrontEnd>(Appearance::Light);
    frontEnd->onQuit = [this] { ++quits; };
}

void QuickFixture::TearDown()
{
    if (app)
        app->applicationWillTerminate();
    frontEnd->stop();
    app.reset();
    frontEnd.reset();
    qInstallMessageHandler(nullptr);
    EXPECT_THAT(complaints(), testing::IsEmpty());
}

void QuickFixture::open(int width, int height)
{
    const Outcome started = frontEnd->start();
    ASSERT_TRUE(started) << started.failure().text;
    window().resize(width, height);
    app = makeApp(frontEnd->toolkit());
    app->applicationDidFinishLaunching();
    loop.runQueued();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&window(), Patience));
    window().requestActivate();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&window(), Patience));
}

void QuickFixture::openAllowingSave()
{
    root.addMarker();
    open();
}

bool QuickFixture::waitFor(const std::function<bool()>& condition)
{
    return QTest::qWaitFor(
        [this, &condition] {
            loop.runQueued();
            return condition();
        },
        Patience);
}

void QuickFixture::waitForFrame()
{
    bool isDrawn = false;
    const auto drawing = QObject::connect(&window(), &QQuickWindow::frameSwapped, [&isDrawn] { isDrawn = true; });
    window().update();
    EXPECT_TRUE(waitFor([&isDrawn] { return isDrawn; }));
    QObject::disconnect(drawing);
}

void QuickFixture::settle()
{
    EXPECT_TRUE(waitFor([this] {
        const auto* stack = itemIn(*window().contentItem(), "stack");
        return !stack->property("busy").toBool() && !list()->property("moving").toBool();
    }));
}

// ---- What is shown

QQuickWindow& QuickFixture::window() const
{
    return *frontEnd->window();
}

QQuickItem* QuickFixture::itemIn(const QQuickItem& parent, const char* name)
{
    for (QQuickItem* child : parent.childItems()) {
        if (!child->isVisible())
            continue;
        if (child->objectName() == QLatin1String(name))
            return child;
        if (QQuickItem* found = itemIn(*child, name))
            return found;
    }
    return nullptr;
}

QQuickItem* QuickFixture::page() const
{
    return itemIn(*window().contentItem(), "stack")->property("currentItem").value<QQuickItem*>();
}

QQuickItem* QuickFixture::item(const char* name) const
{
    if (QQuickItem* found = itemIn(*page(), name))
        return found;
    return itemIn(*window().contentItem(), name); // the sheets are beside the stack
}

QQuickItem* QuickFixture::list() const
{
    return itemIn(*page(), "rows");
}

QQuickItem* QuickFixture::row(int index) const
{
    QQuickItem* found = nullptr;
    QMetaObject::invokeMethod(list(), "itemAtIndex", Q_RETURN_ARG(QQuickItem*, found), Q_ARG(int, index));
    return found;
}

std::vector<std::string> QuickFixture::shownRows() const
{
    std::vector<std::string> rows;
    for (int index = 0; index < list()->property("count").toInt(); ++index) {
        const QQuickItem* shown = row(index);
        if (!shown)
            continue;
        std::string text = itemIn(*shown, "name")->property("text").toString().toStdString();
        if (itemIn(*shown, "disclosure"))
            text += " >";
        if (const QQuickItem* value = itemIn(*shown, "value"))
            text += ": " + value->property("text").toString().toStdString();
        rows.push_back(std::move(text));
    }
    return rows;
}

std::vector<std::string> QuickFixture::treeRows() const
{
    std::vector<std::string> rows;
    for (std::size_t index = 0; const NodeRef child = top().childAtRow(index); ++index)
        rows.push_back(child->displayName() + (child->childNodes() ? " >" : ": " + *child->value()));
    return rows;
}

std::string QuickFixture::shownText(const char* name) const
{
    const QQuickItem* shown = item(name);
    return shown ? shown->property("text").toString().toStdString() : "(not shown)";
}

// ---- Fingers and keys

QPointF QuickFixture::press(QQuickItem* target)
{
    const QPointF at = target ? middleOf(*target) : QPointF();
    EXPECT_NE(target, nullptr);
    press(at);
    return at;
}

void QuickFixture::press(QPointF at)
{
    QTest::touchEvent(&window(), _finger).press(0, at.toPoint(), &window());
}

void QuickFixture::moveFinger(QPointF from, QPointF to)
{
    constexpr int Steps = 10;
    for (int step = 1; step <= Steps; ++step) {
        QTest::touchEvent(&window(), _finger).move(0, (from + (to - from) * step / Steps).toPoint(), &window());
        QTest::qWait(1); // a finger takes its time, or it would be a flick
    }
}

void QuickFixture::release(QPointF at)
{
    QTest::touchEvent(&window(), _finger).release(0, at.toPoint(), &window());
}

/// What a window system does that takes the finger for a gesture of its own.
void QuickFixture::cancelTouch()
{
    QTouchEvent cancelling(QEvent::TouchCancel, _finger);
    QCoreApplication::sendEvent(&window(), &cancelling);
}

void QuickFixture::touch(QQuickItem* target)
{
    release(press(target));
}

void QuickFixture::drag(QQuickItem* target, QPointF by)
{
    ASSERT_NE(target, nullptr);
    drag(middleOf(*target), by);
}

void QuickFixture::drag(QPointF from, QPointF by)
{
    press(from);
    moveFinger(from, from + by);
    release(from + by);
}

void QuickFixture::key(int key, int modifiers)
{
    QTest::keyClick(&window(), static_cast<Qt::Key>(key), Qt::KeyboardModifiers(modifiers));
}

void QuickFixture::type(const std::string& text)
{
    for (const char character : text)
        QTest::keyClick(&window(), character);
}

Value manyLeaves(int count, const std::string& prefix)
{
    DictionaryRef display = Dictionary::make({});
    for (int number = 0; number < count; ++number)
        display->set("Leaf " + std::to_string(number), Value(prefix + std::to_string(number)));
    return display;
}

} // namespace spectrel

#pragma once

#include "Tests/UI/AppFixture.h"
#include "UI/Quick/QuickFrontEnd.h"

#include <QPointF>
#include <QString>
#include <functional>
#include <memory>
#include <string>
#include <vector>

class QPointingDevice;
class QQuickItem;
class QQuickWindow;

namespace spectrel {

/// A launched application in a real window, which nobody sees, over a fake model; driven by fingers and keys.
///
/// The controllers run on virtual time, the window on the toolkit's own; a test waits for what it expects. A line that
/// the toolkit or the QML complains with fails the test.
class QuickFixture : public AppFixture {
protected:
    QuickFixture();
    ~QuickFixture() override;
    void SetUp() override;
    void TearDown() override;

    /// Launches in a window of that size and waits until it is drawn.
    void open(int width = 400, int height = 700);
    void openAllowingSave();
    /// Turns the event loop, and what the controllers have queued, until the condition holds.
    bool waitFor(const std::function<bool()>& condition);
    /// The window is drawn once more: what was placed before has its place then.
    void waitForFrame();
    /// Nothing slides or flicks any more.
    void settle();

    QQuickWindow& window() const;
    /// The first shown item of that name, in the top page or over it; null when there is none.
    QQuickItem* item(const char* name) const;
    static QQuickItem* itemIn(const QQuickItem& parent, const char* name);
    QQuickItem* page() const;
    QQuickItem* list() const;
    /// The row's item in the top page; null while it is not in sight.
    QQuickItem* row(int index) const;
    /// What the top page shows, row by row: "Name >" or "Name: value".
    std::vector<std::string> shownRows() const;
    /// The same as the display tree has it.
    std::vector<std::string> treeRows() const;
    std::string shownText(const char* name) const;

    void touch(QQuickItem* target);
    QPointF press(QQuickItem* target);
    void press(QPointF at);
    void moveFinger(QPointF from, QPointF to);
    void release(QPointF at);
    void cancelTouch();
    /// A finger drags from the middle of the item.
    void drag(QQuickItem* target, QPointF by);
    /// A finger drags from that point of the window.
    void drag(QPointF from, QPointF by);
    void key(int key, int modifiers = 0);
    void type(const std::string& text);

    std::unique_ptr<QuickFrontEnd> frontEnd;
    int quits = 0;

private:
    QPointingDevice* _finger;
};

/// A display of that many leaves, each value beginning with `prefix`.
Value manyLeaves(int count, const std::string& prefix);

} // namespace spectrel

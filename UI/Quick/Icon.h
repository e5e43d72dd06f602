#pragma once

#include <QColor>
#include <QPainterPath>
#include <QQuickPaintedItem>
#include <QtQml/qqmlregistration.h>

namespace spectrel {

/// A small sign in one colour, drawn as lines on a square of 24 by 24 units: crisp at any size and scale.
class Icon : public QQuickPaintedItem {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(Shape shape READ shape WRITE setShape NOTIFY changed)
    Q_PROPERTY(QColor color READ color WRITE setColor NOTIFY changed)

public:
    enum class Shape {
        Back,
        Disclosure,
        Checkmark,
        More,
        Save,
        Search,
        Clear,
        Arc, // of the loading indicator
        Mark, // the application's own
        Plus,
        Minus,
        Play,
        Pause,
        StepBack,
        StepForward,
        SkipBack,
        SkipForward,
    };
    Q_ENUM(Shape)

    explicit Icon(QQuickItem* parent = nullptr);

    Shape shape() const
    {
        return _shape;
    }
    void setShape(Shape shape);
    QColor color() const
    {
        return _color;
    }
    void setColor(const QColor& color);
    void paint(QPainter* painter) override;

signals:
    void changed();

private:
    Shape _shape = Shape::Back;
    QColor _color;
};

} // namespace spectrel

#include "UI/Quick/Icon.h"

#include <QPainter>
#include <QPolygonF>

#include <initializer_list>

namespace spectrel {

namespace {

constexpr double Units = 24; // the square that the shapes are drawn on

using Line = std::initializer_list<QPointF>;

/// What a shape consists of: strokes, and areas that are filled.
struct Drawing {
    QPainterPath strokes;
    QPainterPath areas;

    Drawing& line(Line points)
    {
        strokes.addPolygon(QPolygonF(QList<QPointF>(points)));
        return *this;
    }
    Drawing& area(Line points)
    {
        areas.addPolygon(QPolygonF(QList<QPointF>(points)));
        areas.closeSubpath();
        return *this;
    }
    Drawing& dot(double x, double y, double radius)
    {
        areas.addEllipse(QPointF(x, y), radius, radius);
        return *this;
    }
    Drawing& circle(double x, double y, double radius)
    {
        strokes.addEllipse(QPointF(x, y), radius, radius);
        return *this;
    }
    /// Angles in degrees, against the clock from three o'clock.
    Drawing& arc(double x, double y, double radius, double start, double sweep)
    {
        const QRectF box(x - radius, y - radius, 2 * radius, 2 * radius);
        strokes.arcMoveTo(box, start);
        strokes.arcTo(box, start, sweep);
        return *this;
    }
    Drawing& bar(double x, double y, double width, double height)
    {
        areas.addRoundedRect(x, y, width, height, width / 2, width / 2);
        return *this;
    }
};

Drawing drawingOf(Icon::Shape shape)
{
    using Shape = Icon::Shape;
    Drawing drawing;
    switch (shape) {
    case Shape::Back:
        return drawing.line({{15, 4.5}, {7.5, 12}, {15, 19.5}});
    case Shape::Disclosure:
        return drawing.line({{9, 5}, {16, 12}, {9, 19}});
    case Shape::Checkmark:
        return drawing.line({{5, 12.5}, {10, 17.5}, {19.5, 7}});
    case Shape::More:
        return drawing.dot(12, 5, 1.9).dot(12, 12, 1.9).dot(12, 19, 1.9);
    case Shape::Save:
        return drawing.line({{12, 3.5}, {12, 15}})
            .line({{7, 10.5}, {12, 15.5}, {17, 10.5}})
            .line({{4.5, 16}, {4.5, 20}, {19.5, 20}, {19.5, 16}});
    case Shape::Search:
        return drawing.circle(10.5, 10.5, 6.5).line({{15.5, 15.5}, {20.5, 20.5}});
    case Shape::Clear:
        return drawing.line({{6.5, 6.5}, {17.5, 17.5}}).line({{17.5, 6.5}, {6.5, 17.5}});
    case Shape::Arc:
        return drawing.arc(12, 12, 9, 90, -270);
    case Shape::Mark:
        return drawing.bar(2.5, 14, 3.4, 7).bar(7.7, 9.5, 3.4, 11.5).bar(12.9, 3, 3.4, 18).bar(18.1, 11.5, 3.4, 9.5);
    case Shape::Plus:
        return drawing.line({{12, 5}, {12, 19}}).line({{5, 12}, {19, 12}});
    case Shape::Minus:
        return drawing.line({{5, 12}, {19, 12}});
    case Shape::Play:
        return drawing.area({{7, 4}, {20, 12}, {7, 20}});
    case Shape::Pause:
        return drawing.bar(6.5, 4, 4, 16).bar(13.5, 4, 4, 16);
    case Shape::StepBack:
        return drawing.area({{17, 5}, {17, 19}, {7, 12}}).bar(4, 5, 2.4, 14);
    case Shape::StepForward:
        return drawing.area({{7, 5}, {7, 19}, {17, 12}}).bar(17.6, 5, 2.4, 14);
    case Shape::SkipBack:
        return drawing.area({{12, 5.5}, {12, 18.5}, {3, 12}}).area({{21, 5.5}, {21, 18.5}, {12, 12}});
    case Shape::SkipForward:
        return drawing.area({{3, 5.5}, {3, 18.5}, {12, 12}}).area({{12, 5.5}, {12, 18.5}, {21, 12}});
    }
    return drawing;
}

} // namespace

Icon::Icon(QQuickItem* parent)
    : QQuickPaintedItem(parent)
{
    setAntialiasing(true);
}

void Icon::setShape(Shape shape)
{
    if (shape == _shape)
        return;
    _shape = shape;
    emit changed();
    update();
}

void Icon::setColor(const QColor& color)
{
    if (color == _color)
        return;
    _color = color;
    emit changed();
    update();
}

void Icon::paint(QPainter* painter)
{
    const Drawing drawing = drawingOf(_shape);
    painter->setRenderHint(QPainter::Antialiasing);
    painter->scale(width() / Units, height() / Units);
    painter->fillPath(drawing.areas, _color);
    painter->strokePath(drawing.strokes, QPen(_color, 2.2, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
}

} // namespace spectrel

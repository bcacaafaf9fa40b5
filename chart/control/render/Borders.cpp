#include "chart/control/render/Borders.h"

#include <QPainter>
#include <QPolygonF>
#include <algorithm>

namespace kg::control {

namespace {
constexpr double kMostBorder = 50;

double widthOf(const Border& b) { return std::clamp(double(b.width), 0.0, kMostBorder); }

// Light band on the top and left, dark band on the bottom and right (swapped for "in").
void paintBevel(QPainter& p, const QRectF& r, double w, const QColor& face, bool raised)
{
    const QColor light = face.lighter(135);
    const QColor dark = face.darker(160);
    const QPolygonF topLeft({r.topLeft(), r.topRight(), r.topRight() + QPointF(-w, w), r.topLeft() + QPointF(w, w),
                             r.bottomLeft() + QPointF(w, -w), r.bottomLeft()});
    const QPolygonF bottomRight({r.bottomRight(), r.bottomLeft(), r.bottomLeft() + QPointF(w, -w),
                                 r.bottomRight() + QPointF(-w, -w), r.topRight() + QPointF(-w, w), r.topRight()});
    p.setPen(Qt::NoPen);
    p.setBrush(raised ? light : dark);
    p.drawPolygon(topLeft);
    p.setBrush(raised ? dark : light);
    p.drawPolygon(bottomRight);
}

void paintEtched(QPainter& p, const QRectF& r, bool in)
{
    const QColor dark(0x80, 0x80, 0x80), light(Qt::white);
    p.setBrush(Qt::NoBrush);
    p.setPen(QPen(in ? dark : light, 1));
    p.drawRect(r.adjusted(0.5, 0.5, -1.5, -1.5));
    p.setPen(QPen(in ? light : dark, 1));
    p.drawRect(r.adjusted(1.5, 1.5, -0.5, -0.5));
}
}  // namespace

double borderInset(const Border& border)
{
    switch (border.style) {
    case kBorderPlain:
    case kBorderBevelIn:
    case kBorderBevelOut: return widthOf(border);
    case kBorderEtchedIn:
    case kBorderEtchedOut: return 2;
    case kBorderShadow: return widthOf(border) + 1;
    default: return 0;
    }
}

QRectF paintBorder(QPainter& p, const QRectF& outer, const Border& border, const QColor& fill, const QColor& face)
{
    const double inset = std::min(borderInset(border), std::min(outer.width(), outer.height()) / 2);
    const double w = std::min(widthOf(border), inset);
    const QRectF inner = outer.adjusted(inset, inset, -inset, -inset);
    p.save();
    switch (border.style) {
    case kBorderPlain:
        if (fill.isValid()) p.fillRect(outer, fill);
        if (w > 0) {
            p.setPen(QPen(Qt::black, w, Qt::SolidLine, Qt::SquareCap, Qt::MiterJoin));
            p.setBrush(Qt::NoBrush);
            p.drawRect(outer.adjusted(w / 2, w / 2, -w / 2, -w / 2));
        }
        break;
    case kBorderEtchedIn:
    case kBorderEtchedOut:
        if (fill.isValid()) p.fillRect(outer, fill);
        paintEtched(p, outer, border.style == kBorderEtchedIn);
        break;
    case kBorderShadow: {
        // A drop shadow to the lower right of a framed box.
        const QRectF box = outer.adjusted(0, 0, -w, -w);
        if (w > 0) p.fillRect(box.translated(w, w), QColor(0, 0, 0, 110));
        if (fill.isValid()) p.fillRect(box, fill);
        p.setPen(QPen(QColor(0x40, 0x40, 0x40), 1));
        p.setBrush(Qt::NoBrush);
        p.drawRect(box.adjusted(0.5, 0.5, -0.5, -0.5));
        break;
    }
    case kBorderBevelIn:
    case kBorderBevelOut:
        if (fill.isValid()) p.fillRect(outer, fill);
        if (w > 0) paintBevel(p, outer, w, face, border.style == kBorderBevelOut);
        break;
    default:
        if (fill.isValid()) p.fillRect(outer, fill);
        break;
    }
    p.restore();
    return inner;
}

}  // namespace kg::control

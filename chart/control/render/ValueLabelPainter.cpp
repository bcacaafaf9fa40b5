// Value labels: a box with the label's text, border and background, offset from its data point
// and joined to it by a line. A label that would cover one already drawn is left out, so that
// large tables stay readable (and quick).
#include <QPainter>
#include <algorithm>
#include <cmath>

#include "chart/control/render/Borders.h"
#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

namespace {
constexpr double kMostOffset = 200;
constexpr double kMostBorderWidth = 10;
constexpr double kShadow = 3;

// Boxes already drawn, filed in a coarse grid so that each test looks at a few neighbours only.
class Occupancy {
public:
    explicit Occupancy(const QRectF& area) : area_(area)
    {
        cols_ = std::clamp(int(area.width() / kCell) + 1, 1, 256);
        rows_ = std::clamp(int(area.height() / kCell) + 1, 1, 256);
        cells_.resize(size_t(cols_ * rows_));
    }

    bool covers(const QPointF& pt) const
    {
        for (int i : cell(col(pt.x()), row(pt.y())))
            if (boxes_[size_t(i)].contains(pt)) return true;
        return false;
    }

    bool overlaps(const QRectF& r) const
    {
        for (int y = row(r.top()); y <= row(r.bottom()); ++y)
            for (int x = col(r.left()); x <= col(r.right()); ++x)
                for (int i : cell(x, y))
                    if (boxes_[size_t(i)].intersects(r)) return true;
        return false;
    }

    void add(const QRectF& r)
    {
        const int index = int(boxes_.size());
        boxes_.push_back(r);
        for (int y = row(r.top()); y <= row(r.bottom()); ++y)
            for (int x = col(r.left()); x <= col(r.right()); ++x) cells_[size_t(y * cols_ + x)].push_back(index);
    }

private:
    static constexpr double kCell = 48;
    int col(double x) const { return std::clamp(int((x - area_.left()) / kCell), 0, cols_ - 1); }
    int row(double y) const { return std::clamp(int((y - area_.top()) / kCell), 0, rows_ - 1); }
    const std::vector<int>& cell(int x, int y) const { return cells_[size_t(y * cols_ + x)]; }

    QRectF area_;
    int cols_ = 1, rows_ = 1;
    std::vector<std::vector<int>> cells_;
    std::vector<QRectF> boxes_;
};

std::optional<LabelAnchor> anchorOf(const PaintContext& ctx, const ChartLabel& label)
{
    switch (ctx.layout.kind) {
    case ChartKind::Pie: return pieAnchor(ctx, label.series, label.point);
    case ChartKind::Bar: return barAnchor(ctx, label.series, label.point);
    default: return lineAnchor(ctx, label.series, label.point);
    }
}

QPointF nearestOn(const QRectF& r, const QPointF& pt)
{
    return {std::clamp(pt.x(), r.left(), r.right()), std::clamp(pt.y(), r.top(), r.bottom())};
}

void paintBox(const PaintContext& ctx, const ChartLabel& label, const QRectF& box, double borderWidth)
{
    QPainter& p = ctx.painter;
    const QColor fill = toQColor(label.backgroundColor);
    if (label.border == kBorderShadow || label.border == kBorderPlain || label.border == kBorderNone) {
        if (label.border == kBorderShadow) p.fillRect(box.translated(kShadow, kShadow), QColor(0, 0, 0, 90));
        p.fillRect(box, fill);
        if (label.border != kBorderNone && borderWidth > 0) {
            QPen pen(Qt::black, borderWidth);
            pen.setJoinStyle(Qt::MiterJoin);
            p.setPen(pen);
            p.setBrush(Qt::NoBrush);
            p.drawRect(box.adjusted(borderWidth / 2, borderWidth / 2, -borderWidth / 2, -borderWidth / 2));
        }
    } else {
        paintBorder(p, box, Border{label.border, int(borderWidth)}, fill, fill);
    }
}
}  // namespace

void paintValueLabels(const PaintContext& ctx)
{
    const ChartLayout& L = ctx.layout;
    if (ctx.chart.chartLabels.empty()) return;
    QPainter& p = ctx.painter;
    const MeasuredFont& f = ctx.fonts.label;
    // Points hidden by an axis zoom have no label.
    const QRectF shown = L.kind == ChartKind::Pie ? L.chartContent : L.seriesArea();
    Occupancy drawn(L.chartContent);
    // What the view shows of the chart (all of it unless scaled, moved or zoomed), in the chart's
    // own coordinates. Labels outside it still take their room, so that moving the chart never
    // changes which labels are shown; they are only not drawn.
    bool invertible = false;
    const QTransform back = L.view.inverted(&invertible);
    const QRectF inView = invertible ? back.mapRect(L.chartContent) : L.chartContent;
    for (const ChartLabel& label : ctx.chart.chartLabels) {
        if (label.attachMethod != kAttachToDataPoint) continue;
        const std::optional<LabelAnchor> anchor = anchorOf(ctx, label);
        if (!anchor || !shown.adjusted(-1, -1, 1, 1).contains(anchor->point)) continue;
        const double offset = std::clamp(double(label.offset), 0.0, kMostOffset);
        const double bw = std::clamp(double(label.borderWidth), 0.0, kMostBorderWidth);
        const double h = f.height + 2 * kLabelPadY + 2 * bw;
        const QPointF dir = anchor->direction;
        const bool vertical = dir.x() == 0;
        // Labels above or below a point: the box's centre is known before its text is measured.
        if (vertical && drawn.covers(anchor->point + dir * (offset + h / 2))) continue;
        const QString text = displayText(label.text);
        const double w = f.width(text) + 2 * kLabelPadX + 2 * bw;
        const QPointF centre = anchor->point + dir * offset + QPointF(dir.x() * w / 2, dir.y() * h / 2);
        const QRectF box(centre.x() - w / 2, centre.y() - h / 2, w, h);
        const QRectF taken = label.border == kBorderShadow ? box.adjusted(0, 0, kShadow, kShadow) : box;
        if (drawn.overlaps(taken)) continue;
        drawn.add(taken);
        if (!taken.united(QRectF(anchor->point, QSizeF(0, 0))).adjusted(-2, -2, 2, 2).intersects(inView)) continue;
        if (label.isConnected) {
            p.setPen(ctx.thinPen(QColor(0x30, 0x30, 0x30)));
            p.drawLine(anchor->point, nearestOn(box, anchor->point));
        }
        paintBox(ctx, label, box, bw);
        p.setPen(Qt::black);
        drawTextAt(p, f, box.left() + bw + kLabelPadX, box.top() + bw + kLabelPadY, text);
    }
}

}  // namespace kg::control

#include "chart/control/model/ChartControl.h"

#include <string>

#include "core/Error.h"

namespace kg::control {

namespace {
std::string pointName(int32_t series, int32_t point)
{
    return "chart data (series " + std::to_string(series) + ", point " + std::to_string(point) + ")";
}
}  // namespace

void ChartData::setBatched(bool on)
{
    batched_ = on;
    if (!on && owner_.pending_) owner_.changed();
}

void ChartData::setSeriesCount(int32_t n)
{
    if (n < 0 || n > kMaxSeries)
        throw Error::invalidCall("series count " + std::to_string(n) + " (the chart holds 0 to " +
                                 std::to_string(kMaxSeries) + " series)");
    for (size_t i = size_t(n); i < series_.size(); ++i) totalPoints_ -= int64_t(series_[i].y.size());
    series_.resize(size_t(n));
    owner_.group1.seriesStyles.resize(size_t(n));
    owner_.changed();
}

ChartData::Series& ChartData::at(int32_t series)
{
    if (series < 1 || series > seriesCount()) throw Error::subscript("chart data series " + std::to_string(series));
    return series_[size_t(series - 1)];
}

const ChartData::Series& ChartData::at(int32_t series) const
{
    return const_cast<ChartData*>(this)->at(series);
}

int32_t ChartData::pointCount(int32_t series) const { return int32_t(at(series).y.size()); }

void ChartData::setPointCount(int32_t series, int32_t n)
{
    Series& s = at(series);
    // A zero or negative count is the control's to interpret: it holds no points.
    const size_t count = n > 0 ? size_t(n) : 0;
    const int64_t total = totalPoints_ - int64_t(s.y.size()) + int64_t(count);
    if (total > kMaxPoints)
        throw Error(errc::OutOfMemory, "Out of memory: the chart data would hold " + std::to_string(total) +
                                           " points (at most " + std::to_string(kMaxPoints) + ")");
    totalPoints_ = total;
    s.x.resize(count, 0.0);
    s.y.resize(count, 0.0);
    owner_.changed();
}

double ChartData::x(int32_t series, int32_t point) const
{
    const Series& s = at(series);
    if (point < 1 || point > int32_t(s.x.size())) throw Error::subscript(pointName(series, point));
    return s.x[size_t(point - 1)];
}

double ChartData::y(int32_t series, int32_t point) const
{
    const Series& s = at(series);
    if (point < 1 || point > int32_t(s.y.size())) throw Error::subscript(pointName(series, point));
    return s.y[size_t(point - 1)];
}

void ChartData::setX(int32_t series, int32_t point, double v)
{
    Series& s = at(series);
    if (point < 1 || point > int32_t(s.x.size())) throw Error::subscript(pointName(series, point));
    s.x[size_t(point - 1)] = v;
    owner_.changed();
}

void ChartData::setY(int32_t series, int32_t point, double v)
{
    Series& s = at(series);
    if (point < 1 || point > int32_t(s.y.size())) throw Error::subscript(pointName(series, point));
    s.y[size_t(point - 1)] = v;
    owner_.changed();
}

ChartControl::ChartControl() : data_(*this) {}

ChartLabel& ChartControl::addChartLabel()
{
    if (chartLabels.size() >= kMaxLabels)
        throw Error(errc::OutOfMemory, "Out of memory: the chart holds at most " + std::to_string(kMaxLabels) +
                                           " labels");
    chartLabels.emplace_back();
    changed();
    return chartLabels.back();
}

void ChartControl::clearChartLabels()
{
    chartLabels.clear();
    changed();
}

void ChartControl::print(const PrintRequest& request) const
{
    if (!printHandler_) throw Error(errc::PrinterError, "Printer error: no printer is available");
    printHandler_(*this, request);
}

void ChartControl::changed()
{
    if (data_.isBatched()) {
        pending_ = true;
        return;
    }
    pending_ = false;
    if (listener_) listener_();
}

void ChartControl::resetView()
{
    view = ViewState{};
    chartArea.x.hasFixedRange = false;
    chartArea.y.hasFixedRange = false;
    changed();
}

}  // namespace kg::control

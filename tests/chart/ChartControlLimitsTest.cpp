// The control's limits on counts that come from the host's figures: a wild count must be refused
// with a clear error before anything is allocated for it, and the control must stay as it was.
#include "ChartSupport.h"
#include "chart/control/model/ChartControl.h"

namespace kg::control {
namespace {

struct LimitCase {
    const char* name;
    std::function<void(ChartControl&)> prepare;  // brings the control up to the limit
    std::function<void(ChartControl&)> overstep;
    int32_t number;
    const char* detail;
    std::function<size_t(const ChartControl&)> measure;  // what must not change on refusal
};

class ControlLimits : public ::testing::TestWithParam<LimitCase> {};

TEST_P(ControlLimits, RefusesBeyondTheLimitAndKeepsTheControl)
{
    const LimitCase& c = GetParam();
    auto control = makeRef<ChartControl>();
    c.prepare(*control);
    const size_t before = c.measure(*control);
    test::expectError([&] { c.overstep(*control); }, c.number, c.detail);
    EXPECT_EQ(c.measure(*control), before);
}

size_t seriesCount(const ChartControl& c) { return size_t(c.data().seriesCount()); }
size_t labelCount(const ChartControl& c) { return c.chartLabels.size(); }
size_t pointsOfSeries2(const ChartControl& c) { return size_t(c.data().pointCount(2)); }

INSTANTIATE_TEST_SUITE_P(
    Table, ControlLimits,
    ::testing::Values(
        LimitCase{"seriesBeyondTheMost", [](ChartControl& c) { c.data().setSeriesCount(3); },
                  [](ChartControl& c) { c.data().setSeriesCount(ChartData::kMaxSeries + 1); },
                  errc::InvalidProcedureCall, "1048577", seriesCount},
        // The points of all series together count: the second series may not take what the
        // first left over plus one.
        LimitCase{"pointsOfAllSeriesTogether",
                  [](ChartControl& c) {
                      c.data().setSeriesCount(2);
                      c.data().setPointCount(1, int32_t(ChartData::kMaxPoints / 2));
                      c.data().setPointCount(2, 4);
                  },
                  [](ChartControl& c) { c.data().setPointCount(2, int32_t(ChartData::kMaxPoints / 2) + 1); },
                  errc::OutOfMemory, "16777217 points", pointsOfSeries2},
        LimitCase{"labelBeyondTheMost",
                  [](ChartControl& c) {
                      for (size_t i = 0; i < ChartControl::kMaxLabels; ++i) c.addChartLabel();
                  },
                  [](ChartControl& c) { c.addChartLabel(); }, errc::OutOfMemory, "at most 65536 labels",
                  labelCount}),
    [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg::control

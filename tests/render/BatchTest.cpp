// The data batch switch holds the views' repaints: one announcement when it is switched off.
#include <gtest/gtest.h>

#include <functional>

#include "render/RenderSamples.h"

namespace kg::control {
namespace {

struct BatchCase {
    const char* name;
    std::function<void(ChartControl&)> change;
    int afterBatch;  // none while batched
};

class BatchRepaintTest : public ::testing::TestWithParam<BatchCase> {};

TEST_P(BatchRepaintTest, ListenerHearsOnceAfterTheBatch)
{
    ChartControl chart;
    samples::fillTable(chart, 2, 3, kBar);
    int calls = 0;
    chart.setChangeListener([&calls] { ++calls; });
    chart.data().setBatched(true);
    GetParam().change(chart);
    EXPECT_EQ(calls, 0);
    chart.data().setBatched(false);
    EXPECT_EQ(calls, GetParam().afterBatch);
}

INSTANTIATE_TEST_SUITE_P(
    Changes, BatchRepaintTest,
    ::testing::Values(BatchCase{"nothingChanged", [](ChartControl&) {}, 0},
                      BatchCase{"oneValue", [](ChartControl& c) { c.data().setY(1, 1, 5); }, 1},
                      BatchCase{"wholeTable",
                                [](ChartControl& c) {
                                    c.data().setSeriesCount(4);
                                    for (int s = 1; s <= 4; ++s) {
                                        c.data().setPointCount(s, 10);
                                        for (int p = 1; p <= 10; ++p) c.data().setY(s, p, s * p);
                                    }
                                },
                                1},
                      BatchCase{"labels",
                                [](ChartControl& c) {
                                    c.clearChartLabels();
                                    samples::addValueLabel(c, 1, 1, " 1");
                                },
                                1}),
    samples::rowName);

}  // namespace
}  // namespace kg::control

// SVG export: every text of the chart is a real text element, exactly as stored and escaped so
// that the file stays well-formed XML; the header is also the document's title.
#include <gtest/gtest.h>

#include <QFile>
#include <QXmlStreamReader>
#include <functional>

#include "chart/control/render/ChartExport.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

struct SvgContent {
    QStringList texts;
    QString title;
    QString error;  // empty when the file parsed
};

SvgContent readSvg(const QString& path)
{
    SvgContent out;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        out.error = QStringLiteral("cannot open ") + path;
        return out;
    }
    QXmlStreamReader xml(&file);
    while (!xml.atEnd()) {
        if (xml.readNext() != QXmlStreamReader::StartElement) continue;
        if (xml.name() == QLatin1String("text"))
            out.texts << xml.readElementText(QXmlStreamReader::IncludeChildElements);
        else if (xml.name() == QLatin1String("title"))
            out.title = xml.readElementText();
    }
    if (xml.hasError()) out.error = xml.errorString();
    return out;
}

SvgContent exportSvg(const ChartControl& chart, QSize size = {800, 600})
{
    QTemporaryDir dir = samples::scratchDir();
    const QString path = dir.filePath(QStringLiteral("chart.svg"));
    exportChart(chart, path.toStdString(), size);
    return readSvg(path);
}

// A bar chart of 3 series x 4 points with one text set by the case.
struct TextCase {
    const char* name;
    std::function<void(ChartControl&, const std::string&)> place;
    const char* text;
};

class SvgTextTest : public ::testing::TestWithParam<TextCase> {};

TEST_P(SvgTextTest, TextAppearsExactlyAndTheFileParses)
{
    ChartControl chart;
    samples::styleLikeTheChartObject(chart, "Header");
    samples::fillTable(chart, 3, 4, kBar);
    samples::addSeriesLabels(chart, 3);
    samples::addPointLabels(chart, 4);
    GetParam().place(chart, GetParam().text);

    const SvgContent svg = exportSvg(chart);
    ASSERT_TRUE(svg.error.isEmpty()) << svg.error.toStdString();
    EXPECT_TRUE(svg.texts.contains(QString::fromUtf8(GetParam().text)))
        << "texts: " << svg.texts.join(QStringLiteral(" | ")).toStdString();
    EXPECT_EQ(svg.title.toStdString(), chart.header.text);  // the document's title is the header
}

const auto kFooter = [](ChartControl& c, const std::string& t) { c.footer.text = t; };
const auto kXTitle = [](ChartControl& c, const std::string& t) { c.chartArea.x.title = t; };
const auto kYTitle = [](ChartControl& c, const std::string& t) { c.chartArea.y.title = t; };
const auto kPointLabel = [](ChartControl& c, const std::string& t) { c.group1.pointLabels[1] = t; };
const auto kValueLabel = [](ChartControl& c, const std::string& t) { samples::addValueLabel(c, 2, 3, t); };
// A pie whose legend names the slices after the point labels.
const auto kPieSlice = [](ChartControl& c, const std::string& t) {
    samples::fillPie(c, {5, 3, 8});
    c.group1.seriesLabels.clear();
    c.group1.pointLabels = {"Booked", t, "Done"};
};

INSTANTIATE_TEST_SUITE_P(Texts, SvgTextTest,
                         ::testing::Values(TextCase{"footer", kFooter, "Printed by Tavix"},
                                           TextCase{"xTitle", kXTitle, "Hour of day"},
                                           TextCase{"yTitleTurned", kYTitle, "Quantity & Value"},
                                           TextCase{"pointLabelNumberText", kPointLabel, " 5"},
                                           TextCase{"valueLabelLeadingBlank", kValueLabel, " 12.5"},
                                           TextCase{"valueLabelNegative", kValueLabel, "-3"},
                                           TextCase{"pieSliceCaptionInLegend", kPieSlice, "Quoted"}),
                         samples::rowName);

// Labels that would cover a label already drawn are left out; the first one stays.
struct OverlapCase {
    const char* name;
    int32_t secondSeries, secondPoint;
    bool secondShown;
};

class ValueLabelOverlapTest : public ::testing::TestWithParam<OverlapCase> {};

TEST_P(ValueLabelOverlapTest, FirstComeLabelsStay)
{
    ChartControl chart;
    samples::styleLikeTheChartObject(chart);
    samples::fillTable(chart, 2, 6, kPlot);
    for (int p = 1; p <= 6; ++p) chart.data().setY(2, p, 50);
    chart.data().setY(1, 1, 50);
    samples::addValueLabel(chart, 1, 1, "first");
    samples::addValueLabel(chart, GetParam().secondSeries, GetParam().secondPoint, "second");
    const SvgContent svg = exportSvg(chart);
    EXPECT_TRUE(svg.texts.contains(QLatin1String("first")));
    EXPECT_EQ(svg.texts.contains(QLatin1String("second")), GetParam().secondShown);
}

INSTANTIATE_TEST_SUITE_P(Labels, ValueLabelOverlapTest,
                         ::testing::Values(OverlapCase{"samePlace", 2, 1, false}, OverlapCase{"farAway", 2, 6, true},
                                           OverlapCase{"noSuchPoint", 2, 9, false},
                                           OverlapCase{"noSuchSeries", 5, 1, false}),
                         samples::rowName);

}  // namespace
}  // namespace kg::control

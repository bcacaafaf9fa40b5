// Bad input at the edges, end to end through the dispatch ids with forms built from JSON text:
// grids of 0, 1 and 10 000 columns and of 100 000 rows, cells of 1 MB, captions with control
// characters and non-Latin scripts (drawn, exported to SVG and escaped), dates at the limits of
// the date type, and lNumSeries of -1, 0 and 2^31-1. Each either charts or fails with a clear
// error, and none takes memory from a count it has not checked.
#include <sqlite3.h>

#include <QFile>
#include <QImage>
#include <QJsonArray>
#include <QJsonDocument>
#include <QTemporaryDir>
#include <QXmlStreamReader>
#include <fstream>
#include <optional>
#include <sys/resource.h>

#include "chart/control/render/ChartExport.h"
#include "support/RequestFixture.h"

namespace kg {
namespace {

namespace stand = teststand;


// ---- Form text -------------------------------------------------------------------------------

// A text as a JSON string, control characters escaped.
std::string quoted(const std::string& text)
{
    const QByteArray list = QJsonDocument(QJsonArray{QString::fromStdString(text)}).toJson(QJsonDocument::Compact);
    return list.mid(1, list.size() - 2).toStdString();
}

// A grid: one caption row ("" then "C1".."Cn-1"), then `dataRows` rows "Row k" with values; any
// cell may be replaced by the case.
struct GridShape {
    int dataRows;
    int cols;
    std::function<std::optional<std::string>(int row, int col)> cell;  // JSON text of a cell, or nothing
};

std::string gridJson(const GridShape& g)
{
    std::string s = "{\"fixedRows\": 1, \"cells\": [";
    s.reserve(size_t(g.dataRows + 1) * size_t(g.cols) * 8 + 64);
    for (int r = 0; r <= g.dataRows; ++r) {
        s += r ? ",[" : "[";
        for (int c = 0; c < g.cols; ++c) {
            if (c) s += ',';
            if (g.cell)
                if (std::optional<std::string> own = g.cell(r, c)) {
                    s += *own;
                    continue;
                }
            if (r == 0)
                s += c == 0 ? std::string("\"\"") : "\"C" + std::to_string(c) + "\"";
            else if (c == 0)
                s += "\"Row " + std::to_string(r) + "\"";
            else
                s += std::to_string(r % 97 + c % 13);
        }
        s += ']';
    }
    return s + "]}";
}

std::string settingsGridJson(int rows)
{
    std::string s = "{\"fixedRows\": 1, \"cells\": [[\"Quote type\", \"Qty\", \"Value\", \"Avg Value\", \"% Jobs\", "
                    "\"% Value\"]";
    for (int r = 1; r <= rows; ++r)
        s += ",[\"T" + std::to_string(r) + "\"," + std::to_string(r % 50) + ",10.5,2,1,1]";
    return s + "]}";
}

// ---- Peak memory -----------------------------------------------------------------------------

// The peak resident set of what runs between construction and growthMb(): Linux resets the
// high-water mark on request, so earlier tests do not hide a request's own peak.
class PeakMemory {
public:
    PeakMemory()
    {
        std::ofstream("/proc/self/clear_refs") << "5";
        baseline_ = highWaterKb();
    }
    long long growthMb() const { return (highWaterKb() - baseline_) / 1024; }
    static long long highWaterKb()
    {
        std::ifstream status("/proc/self/status");
        std::string line;
        while (std::getline(status, line))
            if (line.rfind("VmHWM:", 0) == 0) return std::stoll(line.substr(6));
        rusage usage{};
        getrusage(RUSAGE_SELF, &usage);
        return usage.ru_maxrss;
    }

private:
    long long baseline_ = 0;
};

// ---- Outcomes --------------------------------------------------------------------------------

struct Expected {
    int32_t error = 0;        // 0: the request charts
    const char* detail = "";  // a text the error's description must hold
};
constexpr Expected kCharts{};

struct EdgeFixture : test::RequestFixture {
    // Runs a request and checks its outcome: a chart shown, or the error with its detail.
    void expectOutcome(DispId id, Args args, const Expected& e)
    {
        const int32_t number = request(id, std::move(args));
        EXPECT_EQ(number, e.error) << lastError;
        if (e.error == 0) {
            EXPECT_TRUE(prompts.messages.empty()) << prompts.messages.back();
            ASSERT_TRUE(modMain::gfChart && modMain::gfChart->isShown()) << "no chart shown";
        } else {
            EXPECT_NE(lastError.find(e.detail), std::string::npos) << lastError;
            EXPECT_LT(lastError.size(), 400u) << "a description must stay readable";
        }
        EXPECT_EQ(mousePointer(), kPointerDefault);
    }
    // The request on a form of one grid charts (and paints) or fails as expected, within `mb` MB.
    void expectOnGrid(const std::string& grid, DispId id, Args args, const Expected& e, long long mb = 512)
    {
        setForm("{\"grid1\": " + grid + "}");
        PeakMemory peak;
        expectOutcome(id, std::move(args), e);
        if (e.error == 0) expectPaints();
        EXPECT_LT(peak.growthMb(), mb) << "MB taken by the request";
    }
    // The chart shown paints, and the picture is not blank.
    void expectPaints()
    {
        const QImage image = control::renderImage(chart1(), QSize(640, 480));
        ASSERT_FALSE(image.isNull());
        const QRgb corner = image.pixel(0, 0);
        bool varied = false;
        for (int y = 0; y < image.height() && !varied; y += 7)
            for (int x = 0; x < image.width() && !varied; x += 7) varied = image.pixel(x, y) != corner;
        EXPECT_TRUE(varied) << "the chart image is blank";
    }
};

// ---- Grid shapes -----------------------------------------------------------------------------

struct ShapeCase {
    const char* name;
    DispId id;
    int dataRows, cols;
    int32_t lNumSeries;
    Expected expected;
};

class GridShapes : public EdgeFixture, public ::testing::WithParamInterface<ShapeCase> {};

TEST_P(GridShapes, ChartOrFailCleanlyWithinBoundedMemory)
{
    const ShapeCase& c = GetParam();
    expectOnGrid(gridJson({c.dataRows, c.cols, nullptr}), c.id, {Variant(c.lNumSeries), Variant(10.0)}, c.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Table, GridShapes,
    ::testing::Values(
        // Hourly charts columns 1..cols-2: with fewer than 3 columns there is no point to chart.
        ShapeCase{"zeroColumnsHourly", KG_DISPID_GENERATECHART_HOURLYGRAPH1, 2, 0, 2, {errc::SubscriptOutOfRange,
                  "0 To -2"}},
        ShapeCase{"zeroColumnsProp", KG_DISPID_GENERATECHART_PROPGRAPH1, 2, 0, 2, {errc::SubscriptOutOfRange,
                  "grid1.textmatrix(1, 0)"}},
        ShapeCase{"oneColumnHourly", KG_DISPID_GENERATECHART_HOURLYGRAPH1, 2, 1, 2, {errc::SubscriptOutOfRange,
                  "0 To -1"}},
        ShapeCase{"oneColumnYearly", KG_DISPID_GENERATECHART_YEARLYRPT1, 2, 1, 2, {errc::SubscriptOutOfRange,
                  "grid1.textmatrix(0, 1)"}},
        ShapeCase{"tenThousandColumnsHourly", KG_DISPID_GENERATECHART_HOURLYGRAPH1, 2, 10000, 2, kCharts},
        ShapeCase{"hundredThousandRowsAsSeries", KG_DISPID_GENERATECHART_HOURLYGRAPH1, 100000, 3, 100000, kCharts},
        // More rows than lNumSeries: the row beyond the table is out of its range.
        ShapeCase{"hundredThousandRowsTwoSeries", KG_DISPID_GENERATECHART_HOURLYGRAPH1, 100000, 3, 2,
                  {errc::SubscriptOutOfRange, "(3, 1)"}}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(EdgeFixture, HundredThousandRowsOfQuoteTypesChartAsPoints)
{
    setForm("{\"gridsettings1\": " + settingsGridJson(100000) +
            ", \"dtpFromDate\": \"2026-01-01\", \"dtpToDate\": \"2026-01-31\"}");
    prompts.choices = {0};
    PeakMemory peak;
    expectOutcome(KG_DISPID_GENERATECHART_BOOKINGSREPORT, {}, kCharts);
    EXPECT_EQ(modMain::goChart->NumPoints(), 100000);
    expectPaints();
    EXPECT_LT(peak.growthMb(), 512);
}

TEST_F(EdgeFixture, GridWithoutRowsIsNoData)
{
    setForm(R"({"grid1": {"cells": []}})");
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, {Variant(int32_t(2)), Variant(1.0)}), 0) << lastError;
    EXPECT_EQ(prompts.messages, std::vector<std::string>{"There is no data to work with"});
    EXPECT_EQ(mousePointer(), kPointerDefault);
}

// ---- Cells of 1 MB ---------------------------------------------------------------------------

struct BigCellCase {
    const char* name;
    int row, col;       // the cell that holds the megabyte (row 0: captions)
    std::string text;   // its JSON text
    Expected expected;
};

const std::string kMegabyteWord = quoted(std::string(1 << 20, 'x'));
const std::string kMegabyteDigits = quoted("1" + std::string((1 << 20) - 1, '0'));
const std::string kMegabyteSmall = quoted("0." + std::string((1 << 20) - 3, '0') + "1");

class BigCells : public EdgeFixture, public ::testing::WithParamInterface<BigCellCase> {};

TEST_P(BigCells, ChartOrFailWithAShortDescription)
{
    const BigCellCase& c = GetParam();
    const std::string grid = gridJson({2, 14, [&](int r, int col) -> std::optional<std::string> {
                                           if (r == c.row && col == c.col) return c.text;
                                           return std::nullopt;
                                       }});
    expectOnGrid(grid, KG_DISPID_GENERATECHART_HOURLYGRAPH1, {Variant(int32_t(2)), Variant(10.0)}, c.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Table, BigCells,
    ::testing::Values(BigCellCase{"seriesCaption", 1, 0, kMegabyteWord, kCharts},
                      BigCellCase{"pointCaption", 0, 3, kMegabyteWord, kCharts},
                      BigCellCase{"valueWord", 2, 5, kMegabyteWord, {errc::TypeMismatch, "is not a number"}},
                      BigCellCase{"valueHugeNumber", 1, 1, kMegabyteDigits, {errc::Overflow, "beyond the range"}},
                      BigCellCase{"valueTinyNumber", 1, 2, kMegabyteSmall, kCharts}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(EdgeFixture, MegabyteTotalFailsWithAShortDescription)
{
    setForm("{\"grid1\": " + test::gridJson(1, 2, 14) + "}");
    expectOutcome(KG_DISPID_GENERATECHART_HOURLYGRAPH1, {Variant(int32_t(2)), Variant(std::string(1 << 20, '7') + "x")},
                  {errc::TypeMismatch, "is not a number"});
}

// ---- Captions: control characters and scripts -----------------------------------------------

struct SvgTexts {
    QStringList texts;
    QString error;
};

SvgTexts readSvg(const QString& path)
{
    SvgTexts out;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        out.error = "cannot open " + path;
        return out;
    }
    QXmlStreamReader xml(&file);
    while (!xml.atEnd())
        if (xml.readNext() == QXmlStreamReader::StartElement && xml.name() == QLatin1String("text"))
            out.texts << xml.readElementText(QXmlStreamReader::IncludeChildElements);
    if (xml.hasError()) out.error = xml.errorString() + " at line " + QString::number(xml.lineNumber());
    return out;
}

// A caption as it can be seen: without the control characters (XML cannot hold most of them, a
// picture shows none) and without blanks, which a painter may put in their place.
QString visible(const QString& text)
{
    QString out;
    for (QChar ch : text)
        if (ch.unicode() >= 0x20 && ch != QChar(0x7F) && ch != QChar::ReplacementCharacter && !ch.isSpace()) out += ch;
    return out;
}

struct CaptionCase {
    const char* name;
    const char* caption;  // UTF-8
};

class Captions : public EdgeFixture, public ::testing::WithParamInterface<CaptionCase> {};

TEST_P(Captions, AreDrawnExportedAndEscaped)
{
    const std::string caption = GetParam().caption;
    const std::string grid = gridJson({2, 6, [&](int r, int c) -> std::optional<std::string> {
                                           if ((r == 1 && c == 0) || (r == 0 && c == 2)) return quoted(caption);
                                           return std::nullopt;
                                       }});
    setForm("{\"grid1\": " + grid + "}");
    expectOutcome(KG_DISPID_GENERATECHART_HOURLYGRAPH1, {Variant(int32_t(2)), Variant(10.0)}, kCharts);
    EXPECT_EQ(chart1().group1.seriesLabels.at(0), caption);  // the caption reaches the chart as it is
    EXPECT_EQ(chart1().group1.pointLabels.at(1), caption);
    expectPaints();

    const QString svg = dir.filePath("chart.svg");
    control::exportChart(chart1(), svg.toStdString(), QSize(800, 600));
    const SvgTexts read = readSvg(svg);
    ASSERT_TRUE(read.error.isEmpty()) << "the SVG is not well-formed: " << read.error.toStdString();
    // A caption of several scripts may be written as one text element per run of a script.
    const QString expected = visible(QString::fromUtf8(caption.c_str()));
    EXPECT_GE(visible(read.texts.join(QString())).count(expected), 2)
        << "the caption is not a text of the SVG (legend and X axis); texts: " << read.texts.join(" | ").toStdString();

    const QString pdf = dir.filePath("chart.pdf");
    control::exportChart(chart1(), pdf.toStdString(), QSize(800, 600));
    EXPECT_GT(QFileInfo(pdf).size(), 0);
}

INSTANTIATE_TEST_SUITE_P(
    Table, Captions,
    ::testing::Values(CaptionCase{"controlCharacters", "Line\x01One\x07Two\x1B"},
                      CaptionCase{"deleteCharacter", "Del\x7F" "ete"},
                      CaptionCase{"markup", "<b>&amp; \"q\" 'a'</b>"},
                      CaptionCase{"chinese", "\u5e74\u5ea6\u62a5\u544a"},
                      CaptionCase{"arabic", "\u0627\u0644\u062d\u062c\u0648\u0632\u0627\u062a"},
                      CaptionCase{"devanagari", "\u092c\u0941\u0915\u093f\u0902\u0917"},
                      CaptionCase{"emoji", "Bookings \U0001F4C8"},
                      CaptionCase{"combining", "e\u0301te\u0301"}),
    [](const auto& info) { return std::string(info.param.name); });

// ---- Dates at the limits of the date type ------------------------------------------------------

struct DateCase {
    const char* name;
    const char* from;
    const char* to;
    const char* xTitle;
    double confirmedJobs;  // of the two jobs at the limits, those inside the range
};

class DateLimits : public EdgeFixture, public ::testing::WithParamInterface<DateCase> {};

// One confirmed job on each of the first and the last day of the date type.
void writeJobsAtTheLimits(const std::string& path)
{
    sqlite3* db = nullptr;
    ASSERT_EQ(sqlite3_open(path.c_str(), &db), SQLITE_OK);
    ASSERT_EQ(sqlite3_exec(db,
                           "CREATE TABLE jobs(id INTEGER PRIMARY KEY, job_date TEXT NOT NULL, f26 TEXT, f44, f45, f46,"
                           " f52, f59, f64);"
                           "INSERT INTO jobs(job_date, f26) VALUES ('0100-01-01', 'Confirmed'),"
                           " ('9999-12-31', 'Confirmed');",
                           nullptr, nullptr, nullptr),
              SQLITE_OK);
    sqlite3_close(db);
}

TEST_P(DateLimits, JobStatusCountsTheJobsAtTheLimits)
{
    const DateCase& c = GetParam();
    const std::string database = dir.filePath("jobs.db").toStdString();
    writeJobsAtTheLimits(database);
    standConfig.jobsDatabase = database;
    standChanged();
    setForm(std::string("{\"dtpFromDate\": \"") + c.from + "\", \"dtpToDate\": \"" + c.to +
            "\", \"cboFields\": {\"1\": [\"a\", \"b\"]}}");
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_JOBSTATUSREPORT), 0) << lastError;
    EXPECT_EQ(mousePointer(), kPointerDefault);
    ASSERT_TRUE(prompts.messages.empty()) << prompts.messages.front();
    EXPECT_EQ(chart1().chartArea.x.title, c.xTitle);
    EXPECT_EQ(chart1().data().y(1, 5), c.confirmedJobs) << "Confirmed";
}

INSTANTIATE_TEST_SUITE_P(Table, DateLimits,
                         ::testing::Values(DateCase{"wholeRange", "0100-01-01", "9999-12-31", "01/01/0100 - 31/12/9999", 2},
                                           DateCase{"firstDay", "0100-01-01", "0100-01-01", "01/01/0100 - 01/01/0100", 1},
                                           DateCase{"lastDay", "9999-12-31", "9999-12-31", "31/12/9999 - 31/12/9999", 1}),
                         [](const auto& info) { return std::string(info.param.name); });

// ---- lNumSeries at the limits ----------------------------------------------------------------

struct SeriesCase {
    const char* name;
    DispId id;
    Variant lNumSeries;
    Expected expected;
};

class SeriesCounts : public EdgeFixture, public ::testing::WithParamInterface<SeriesCase> {};

TEST_P(SeriesCounts, ChartOrFailWithoutAllocatingTheCount)
{
    const SeriesCase& c = GetParam();
    expectOnGrid(test::gridJson(1, 2, 14), c.id, {c.lNumSeries, Variant(10.0)}, c.expected, 64);
    EXPECT_LT(PeakMemory::highWaterKb() / 1024, 1024) << "MB resident";
}

const int32_t kLongMax = 2147483647;

INSTANTIATE_TEST_SUITE_P(
    Table, SeriesCounts,
    ::testing::Values(
        SeriesCase{"minusOneYearly", KG_DISPID_GENERATECHART_YEARLYRPT1, Variant(int32_t(-1)),
                   {errc::InvalidProcedureCall, "series count -1"}},
        // No series in the table: the first row's values have nowhere to go.
        SeriesCase{"zeroHourly", KG_DISPID_GENERATECHART_HOURLYGRAPH1, Variant(int32_t(0)),
                   {errc::SubscriptOutOfRange, "(1, 1)"}},
        SeriesCase{"zeroProp", KG_DISPID_GENERATECHART_PROPGRAPH1, Variant(int32_t(0)), {errc::SubscriptOutOfRange,
                   "(1, 1)"}},
        SeriesCase{"longMaxHourly", KG_DISPID_GENERATECHART_HOURLYGRAPH1, Variant(kLongMax),
                   {errc::InvalidProcedureCall, "series count 2147483647"}},
        SeriesCase{"beyondLong", KG_DISPID_GENERATECHART_HOURLYGRAPH1, Variant(2147483648.0), {errc::Overflow,
                   "2147483648"}},
        SeriesCase{"null", KG_DISPID_GENERATECHART_HOURLYGRAPH1, Variant::null(), {errc::InvalidUseOfNull, "Null"}},
        SeriesCase{"text", KG_DISPID_GENERATECHART_HOURLYGRAPH1, Variant("many"), {errc::TypeMismatch, "\"many\""}}),
    [](const auto& info) { return std::string(info.param.name); });

// With value labels on by default every cell of the table gets a label, so a series count far
// beyond the grid's rows (the host's lNumSeries) decides what the labels take. 65 536 series of
// 12 points over a grid of 2 rows must fail cleanly or chart without taking memory by the label.
// (At 2^20 series, the most the chart takes, the labels alone come to 12.6 million.)
TEST_F(EdgeFixture, SeriesCountFarBeyondTheRowsWithValueLabelsStaysBounded)
{
    writeSetting("LabelsOnDefault", "1");
    setForm("{\"grid1\": " + test::gridJson(1, 2, 14) + "}");
    PeakMemory peak;
    const int32_t number = request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, {Variant(int32_t(1 << 16)), Variant(10.0)});
    EXPECT_TRUE(number == 0 || number == errc::OutOfMemory) << number << ": " << lastError;
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_LT(peak.growthMb(), 100) << "MB for a grid of 2 rows (value labels: "
                                    << (modMain::gfChart ? chart1().chartLabels.size() : 0) << ")";
}

}  // namespace
}  // namespace kg

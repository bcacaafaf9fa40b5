// Printing: one landscape page, to a PDF file when one is set; no printer is Error 482.
#include <gtest/gtest.h>

#include <QFile>
#include <QPrinterInfo>
#include <QRegularExpression>

#include "chart/control/render/ChartPrinting.h"
#include "core/Error.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

class PrintTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        samples::styleLikeTheChartObject(chart, "Printed");
        samples::fillTable(chart, 3, 5, kBar);
        installPrinting(chart);
    }
    void TearDown() override { setPrintToPdfFile({}); }
    ChartControl chart;
};

QByteArray readAll(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

struct PrintCase {
    const char* name;
    PrintRequest request;
    int shownWidth, shownHeight;
};

class PrintToPdfTest : public PrintTest, public ::testing::WithParamInterface<PrintCase> {};

TEST_P(PrintToPdfTest, PrintsOneLandscapePage)
{
    QTemporaryDir dir = samples::scratchDir();
    const QString path = dir.filePath(QStringLiteral("printed.pdf"));
    setPrintToPdfFile(path.toStdString());
    chart.shownWidth = GetParam().shownWidth;
    chart.shownHeight = GetParam().shownHeight;
    chart.print(GetParam().request);
    const QByteArray pdf = readAll(path);
    ASSERT_TRUE(pdf.startsWith("%PDF"));
    EXPECT_EQ(pdf.count("/Type /Page\n") + pdf.count("/Type /Page "), 1);
    const QRegularExpressionMatch box =
        QRegularExpression(QStringLiteral("/MediaBox \\[\\s*0\\s+0\\s+([0-9.]+)\\s+([0-9.]+)"))
            .match(QString::fromLatin1(pdf));
    ASSERT_TRUE(box.hasMatch());
    EXPECT_GT(box.captured(1).toDouble(), box.captured(2).toDouble());
}

INSTANTIATE_TEST_SUITE_P(Requests, PrintToPdfTest,
                         ::testing::Values(PrintCase{"chartWindowCodes", {3, 4, 0, 0, 0, 0}, 0, 0},
                                           PrintCase{"otherCodes", {-1, 99, 7, 7, 7, 7}, 0, 0},
                                           PrintCase{"shownWide", {3, 4, 0, 0, 0, 0}, 1200, 300},
                                           PrintCase{"shownTall", {3, 4, 0, 0, 0, 0}, 300, 900}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST_F(PrintTest, PrintingTwiceLeavesTheChartUnchanged)
{
    QTemporaryDir dir = samples::scratchDir();
    setPrintToPdfFile(dir.filePath(QStringLiteral("twice.pdf")).toStdString());
    const uint64_t revision = chart.revision();
    chart.print({3, 4, 0, 0, 0, 0});
    chart.print({3, 4, 0, 0, 0, 0});
    EXPECT_EQ(chart.revision(), revision);
    EXPECT_TRUE(readAll(dir.filePath(QStringLiteral("twice.pdf"))).startsWith("%PDF"));
}

TEST_F(PrintTest, UnwritablePdfFileIsAPrinterErrorNamingIt)
{
    setPrintToPdfFile("/no/such/folder/printed.pdf");
    try {
        chart.print({3, 4, 0, 0, 0, 0});
        FAIL() << "no error";
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), errc::PrinterError);
        EXPECT_NE(e.description().find("/no/such/folder/printed.pdf"), std::string::npos) << e.description();
    }
}

TEST_F(PrintTest, NoPrinterInstalledIsAPrinterError)
{
    if (!QPrinterInfo::defaultPrinter().isNull()) GTEST_SKIP() << "this machine has a default printer";
    try {
        chart.print({3, 4, 0, 0, 0, 0});
        FAIL() << "no error";
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), errc::PrinterError);
        EXPECT_EQ(e.description(), "Printer error: no printer is installed");
    }
}

}  // namespace
}  // namespace kg::control

// Printing: one landscape page, to a PDF file when one is set; no printer is Error 482.
#include <gtest/gtest.h>

#include <QPrinterInfo>
#include <QRegularExpression>

#include "chart/control/render/ChartPrinting.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

class PrintTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        samples::styleLikeTheChartObject(chart, "Printed");
        samples::fillTable(chart, 3, 5, kBar);
        installPrinting(chart, [this] { return pdfFile; });
    }
    ChartControl chart;
    std::string pdfFile;  // empty: the default printer
};

struct PrintCase {
    const char* name;
    PrintRequest request;
    int shownWidth, shownHeight;
};

class PrintToPdfTest : public PrintTest, public ::testing::WithParamInterface<PrintCase> {};

// Printed twice, the second replacing the first file.
TEST_P(PrintToPdfTest, PrintsOneLandscapePage)
{
    QTemporaryDir dir = samples::scratchDir();
    const QString path = dir.filePath(QStringLiteral("printed.pdf"));
    pdfFile = path.toStdString();
    chart.shownWidth = GetParam().shownWidth;
    chart.shownHeight = GetParam().shownHeight;
    chart.print(GetParam().request);
    chart.print(GetParam().request);
    const QByteArray pdf = samples::readAll(path);
    ASSERT_TRUE(pdf.startsWith("%PDF"));
    EXPECT_EQ(pdf.count("/Type /Page\n") + pdf.count("/Type /Page "), 1);
    const QRegularExpressionMatch box =
        QRegularExpression(QStringLiteral("/MediaBox \\[\\s*0\\s+0\\s+([0-9.]+)\\s+([0-9.]+)"))
            .match(QString::fromLatin1(pdf));
    ASSERT_TRUE(box.hasMatch());
    EXPECT_GT(box.captured(1).toDouble(), box.captured(2).toDouble());
}

INSTANTIATE_TEST_SUITE_P(Requests, PrintToPdfTest,
                         ::testing::Values(PrintCase{"otherCodes", {-1, 99, 7, 7, 7, 7}, 0, 0},
                                           PrintCase{"shownWide", {3, 4, 0, 0, 0, 0}, 1200, 300},
                                           PrintCase{"shownTall", {3, 4, 0, 0, 0, 0}, 300, 900}),
                         samples::rowName);

struct FailureCase {
    const char* name;
    const char* pdfFile;  // empty: to the default printer
    const char* named;    // part of the description
};

class PrintFailureTest : public PrintTest, public ::testing::WithParamInterface<FailureCase> {};

TEST_P(PrintFailureTest, IsAPrinterError)
{
    if (!*GetParam().pdfFile && !QPrinterInfo::defaultPrinter().isNull())
        GTEST_SKIP() << "this machine has a default printer";
    pdfFile = GetParam().pdfFile;
    samples::expectError([&] { chart.print({3, 4, 0, 0, 0, 0}); }, errc::PrinterError, GetParam().named);
}

INSTANTIATE_TEST_SUITE_P(
    Failures, PrintFailureTest,
    ::testing::Values(FailureCase{"unwritablePdfFile", "/no/such/folder/printed.pdf", "/no/such/folder/printed.pdf"},
                      FailureCase{"noPrinterInstalled", "", "Printer error: no printer is installed"}),
    samples::rowName);

}  // namespace
}  // namespace kg::control

// Files: the format follows the extension, and a failed export leaves nothing behind.
#include <gtest/gtest.h>

#include <QDir>
#include <QImage>

#include "chart/control/render/ChartExport.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

void sampleChart(ChartControl& c)
{
    samples::styleLikeTheChartObject(c, "Export");
    samples::fillTable(c, 3, 5, kBar);
    samples::addSeriesLabels(c, 3);
    samples::addPointLabels(c, 5);
}

struct FormatCase {
    const char* name;
    const char* file;
    const char* signature;  // how the file starts
};

class ExportFormatTest : public ::testing::TestWithParam<FormatCase> {};

TEST_P(ExportFormatTest, WritesTheFormatTheExtensionNames)
{
    ChartControl chart;
    sampleChart(chart);
    QTemporaryDir dir = samples::scratchDir();
    const QString path = dir.filePath(QString::fromUtf8(GetParam().file));
    EXPECT_TRUE(isExportFormat(path.toStdString()));  // what the window and the tool ask before exporting
    exportChart(chart, path.toStdString(), QSize(640, 480));
    const QByteArray bytes = samples::readAll(path);
    EXPECT_TRUE(bytes.startsWith(GetParam().signature)) << bytes.left(64).toStdString();
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden).size(), 1);  // no temporary file left over
}

INSTANTIATE_TEST_SUITE_P(Formats, ExportFormatTest,
                         ::testing::Values(FormatCase{"pngUpperCase", "chart.PNG", "\x89PNG"},
                                           FormatCase{"svg", "chart.svg", "<?xml"}),
                         samples::rowName);

// The file holds the in-memory picture (whose content the render tests check) at its size.
TEST(ExportFileTest, PngIsTheRenderedPicture)
{
    ChartControl chart;
    sampleChart(chart);
    QTemporaryDir dir = samples::scratchDir();
    const QString path = dir.filePath(QStringLiteral("chart.png"));
    exportChart(chart, path.toStdString(), QSize(800, 600));
    const QImage image(path);
    ASSERT_EQ(image.size(), QSize(800, 600));
    EXPECT_EQ(image.convertToFormat(QImage::Format_RGB32), renderImage(chart, QSize(800, 600)));
}

TEST(ExportFileTest, OtherExtensionsAreNoExportFormat)
{
    for (const char* file : {"chart.bmp", "chart", "chart.png.txt", "/tmp/png/chart"})
        EXPECT_FALSE(isExportFormat(file)) << file;
}

struct FailureCase {
    const char* name;
    const char* file;  // inside the scratch folder
    QSize size;
    int32_t number;
    const char* named;  // part of the description
};

class ExportFailureTest : public ::testing::TestWithParam<FailureCase> {};

TEST_P(ExportFailureTest, FailsWithoutLeavingAFile)
{
    ChartControl chart;
    sampleChart(chart);
    QTemporaryDir dir = samples::scratchDir();
    QDir(dir.path()).mkdir(QStringLiteral("taken.png"));  // a folder where the file would go
    QFile keep(dir.filePath(QStringLiteral("keep.png")));
    ASSERT_TRUE(keep.open(QIODevice::WriteOnly));
    keep.write("old");
    keep.close();
    const QStringList before = QDir(dir.path()).entryList(QDir::AllEntries | QDir::Hidden | QDir::NoDotAndDotDot);

    const std::string path = dir.filePath(QString::fromUtf8(GetParam().file)).toStdString();
    samples::expectError([&] { exportChart(chart, path, GetParam().size); }, GetParam().number, GetParam().named);
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::AllEntries | QDir::Hidden | QDir::NoDotAndDotDot), before);
    EXPECT_EQ(samples::readAll(dir.filePath(QStringLiteral("keep.png"))), QByteArray("old"));
}

INSTANTIATE_TEST_SUITE_P(
    Failures, ExportFailureTest,
    ::testing::Values(
        FailureCase{"unknownExtension", "chart.bmp", {800, 600}, errc::InvalidProcedureCall, "\".bmp\""},
        FailureCase{"noExtension", "chart", {800, 600}, errc::InvalidProcedureCall, "chart"},
        FailureCase{
            "missingFolder", "no/such/folder/chart.png", {800, 600}, errc::PathFileAccess, "no/such/folder/chart.png"},
        FailureCase{"folderInTheWay", "taken.png", {800, 600}, errc::PathFileAccess, "taken.png"},
        FailureCase{"badSizeKeepsTheOldFile", "keep.png", {0, 600}, errc::InvalidProcedureCall, "size"}),
    samples::rowName);

}  // namespace
}  // namespace kg::control

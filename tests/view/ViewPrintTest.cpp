// Printing and pictures keep the chart as the view shows it: a zoom made with the mouse is
// printed and exported, and "r" prints the plain chart again.
#include <QFile>
#include <QRegularExpression>

#include "chart/control/render/ChartExport.h"
#include "chart/control/render/ChartPrinting.h"
#include "chart/control/render/Colors.h"
#include "view/ViewFixture.h"

namespace kg::control::test {
namespace {

class PrintZoomTest : public ViewFixture {
protected:
    void SetUp() override
    {
        fillMonthlyBars(*chart, kBar);
        chart->chartArea.view3D.depth = 0;
        installPrinting(*chart, [this] { return pdfFile_; });
        makeView(QSize(800, 500));
    }
    // The printed page without the moment it was printed.
    QByteArray printedPage(const QString& path)
    {
        pdfFile_ = path.toStdString();
        chart->print({3, 4, 0, 0, 0, 0});
        QFile f(path);
        if (!f.open(QIODevice::ReadOnly)) return {};
        return QString::fromLatin1(f.readAll()).remove(QRegularExpression(QStringLiteral("/CreationDate \\([^)]*\\)"))).toLatin1();
    }
    // A graphics zoom into the middle of the tall bar of series 1 at June, right of the centre.
    void zoomIntoTheBar()
    {
        const ChartLayout l = layout();
        const QPoint c = l.view.map(l.barRect(*chart, 1, 6).center()).toPoint();
        drag({Qt::LeftButton}, Qt::ControlModifier, c - QPoint(6, 6), c + QPoint(6, 6));
    }
    std::string pdfFile_;
};

TEST_F(PrintZoomTest, PrintedPageFollowsTheZoom)
{
    QTemporaryDir dir = samples::scratchDir();
    const QByteArray plain = printedPage(dir.filePath(QStringLiteral("plain.pdf")));
    ASSERT_TRUE(plain.startsWith("%PDF"));
    zoomIntoTheBar();
    ASSERT_FALSE(chart->view.isIdentity());
    const QByteArray zoomed = printedPage(dir.filePath(QStringLiteral("zoomed.pdf")));
    key(Qt::Key_R);
    const QByteArray reset = printedPage(dir.filePath(QStringLiteral("reset.pdf")));
    zoomIntoTheBar();
    const QByteArray zoomedAgain = printedPage(dir.filePath(QStringLiteral("again.pdf")));

    EXPECT_NE(zoomed, plain);
    EXPECT_EQ(reset, plain);
    EXPECT_EQ(zoomedAgain, zoomed);
    // Printing changes nothing of the view.
    EXPECT_FALSE(chart->view.isIdentity());
}

// The picture of the zoomed chart shows the bar's inside across the middle of the chart area.
TEST_F(PrintZoomTest, PictureShowsTheSelectionEnlarged)
{
    const ChartLayout before = layout();
    const QColor bar = seriesColor(1);
    const QPoint centre = before.chartContent.center().toPoint();
    const QImage plain = renderImage(*chart, view->size());
    ASSERT_NE(plain.pixelColor(centre), bar);
    zoomIntoTheBar();
    const QImage zoomed = renderImage(*chart, view->size());
    // 20 times enlarged: 60 pixels either way of the centre were 3 pixels of the bar's face.
    for (QPoint by : {QPoint(0, 0), QPoint(-60, 0), QPoint(60, 0), QPoint(0, -60), QPoint(0, 60)})
        EXPECT_EQ(zoomed.pixelColor(centre + by), bar) << by.x() << "," << by.y();
    // Titles and legend are where they were.
    const QRect header = before.header.toAlignedRect();
    EXPECT_EQ(zoomed.copy(header), plain.copy(header));
    const QRect legend = before.legend.toAlignedRect();
    EXPECT_EQ(zoomed.copy(legend), plain.copy(legend));
}

}  // namespace
}  // namespace kg::control::test

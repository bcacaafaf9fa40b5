// Each window as the offscreen platform draws it: the expected size and something drawn on it.
// No pixel comparison: fonts and styles differ between machines.
#include <QCoreApplication>
#include <QImage>
#include <QPixmap>
#include <functional>
#include <memory>

#include "ui/frmChartHelp.h"
#include "ui/frmChartSetup.h"
#include "ui/UiFixture.h"

namespace kg::test {
namespace {

// Share of pixels that differ from the top-left corner's colour.
double drawnShare(const QImage& image)
{
    const QRgb background = image.pixel(0, 0);
    long differing = 0;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x) differing += image.pixel(x, y) != background;
    return double(differing) / (double(image.width()) * image.height());
}

struct ShotCase {
    const char* name;
    std::function<QWidget*()> open;  // the window, shown
    QSize size;
};

const ShotCase kShots[] = {
    {"ChartStyleDialog",
     [] {
         auto* d = new ui::frmChartSetup;
         d->setAttribute(Qt::WA_DeleteOnClose);
         d->show();
         return static_cast<QWidget*>(d);
     },
     {376, 227}},
    {"ChartHelpWindow",
     [] {
         ui::showChartHelp();
         return static_cast<QWidget*>(ui::chartHelpWindow());
     },
     {656, 353}},
};

struct Screenshot : UiFixture, ::testing::WithParamInterface<ShotCase> {};

TEST_P(Screenshot, HasTheDesignedSizeAndIsNotBlank)
{
    QWidget* window = GetParam().open();
    ASSERT_NE(window, nullptr);
    const QImage image = window->grab().toImage();
    window->close();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_EQ(image.size() / image.devicePixelRatio(), GetParam().size);
    // Frames, texts and buttons cover far more than a few stray pixels.
    EXPECT_GT(drawnShare(image), 0.02);
}

INSTANTIATE_TEST_SUITE_P(Windows, Screenshot, ::testing::ValuesIn(kShots), byName);

}  // namespace
}  // namespace kg::test

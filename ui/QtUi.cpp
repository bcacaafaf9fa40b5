#include "ui/QtUi.h"

#include <QApplication>

#include "ui/Prompter.h"

namespace kg::ui {

namespace {

// The builders' view of frmChart. It keeps the control alive even after the window is gone,
// so a chart object still bound to it fails no worse than drawing into nothing.
class FrmChartPort : public ChartWindowPort {
public:
    FrmChartPort(frmChart* window, Ref<control::ChartControl> chart) : window_(window), chart_(std::move(chart)) {}
    control::ChartControl& Chart1() override { return *chart_; }
    void setRedrawVisible(bool v) override
    {
        if (window_) window_->mnuRedraw->setVisible(v);
    }
    bool isRedrawVisible() const override { return window_ && window_->mnuRedraw->isVisible(); }
    void Show() override
    {
        if (!window_) return;
        window_->show();
        window_->raise();
    }
    bool isShown() const override { return window_ && window_->isVisible(); }

private:
    QPointer<frmChart> window_;
    Ref<control::ChartControl> chart_;
};

}  // namespace

Ref<ChartWindowPort> QtUi::loadChartWindow()
{
    if (window_ && port_) return port_;
    auto chart = makeRef<control::ChartControl>();
    auto* window = new frmChart(chart);
    window_ = window;
    port_ = makeRef<FrmChartPort>(window, chart);
    window->onUnloaded = [this] { port_.reset(); };
    window->Form_Load();
    return port_;
}

void QtUi::setMousePointer(int pointer)
{
    // Not nested: one default pointer clears any number of hourglasses.
    if (pointer == kPointerHourglass && pointer_ != kPointerHourglass)
        QApplication::setOverrideCursor(Qt::WaitCursor);
    if (pointer != kPointerHourglass && pointer_ == kPointerHourglass) QApplication::restoreOverrideCursor();
    pointer_ = pointer;
}

void installQtUi()
{
    services().windows = std::make_shared<QtUi>();
    services().prompter = std::make_shared<QtPrompter>();
}

void installQtUiForApplication()
{
    static bool installed = false;
    if (installed || !qobject_cast<QApplication*>(QCoreApplication::instance())) return;
    installed = true;
    installQtUi();
}

}  // namespace kg::ui

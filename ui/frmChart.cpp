#include "ui/frmChart.h"

#include <QAction>
#include <QClipboard>
#include <QCloseEvent>
#include <QGuiApplication>
#include <QMenuBar>

#include "chart/control/render/ChartExport.h"
#include "chart/control/render/ChartPrinting.h"
#include "chart/control/view/ChartView.h"
#include "requests/Requests.h"
#include "requests/modMain.h"
#include "core/Error.h"
#include "ui/AdvancedHelp.h"
#include "ui/Prompter.h"
#include "ui/WindowObject.h"
#include "ui/frmChartHelp.h"
#include "ui/frmChartSetup.h"

namespace kg::ui {

using namespace modMain;

frmChart::frmChart(Ref<control::ChartControl> chart) : chart_(std::move(chart))
{
    setObjectName("frmChart");
    setWindowTitle("Tavix Charting");
    setAttribute(Qt::WA_DeleteOnClose);
    view_ = new control::ChartView(chart_, this);
    view_->setObjectName("Chart1");
    // The control fills the client area and follows its size, with no margin.
    setCentralWidget(view_);
    control::installPrinting(*chart_, [] { return services().printToPdf; });
    buildMenu();
    resize(6756 / kTwipsPerPixel, 3732 / kTwipsPerPixel + menuBar()->sizeHint().height());
}

void frmChart::buildMenu()
{
    auto item = [this](QMenu* menu, const char* name, const char* caption, QKeySequence key, auto handler) {
        QAction* a = menu->addAction(caption);
        a->setObjectName(name);
        a->setShortcut(key);
        connect(a, &QAction::triggered, this, [this, handler] { runCommand([this, handler] { (this->*handler)(); }); });
        return a;
    };
    mnuTop[0] = menuBar()->addMenu("File");
    mnuTop[1] = menuBar()->addMenu("Chart Control");
    mnuTop[2] = menuBar()->addMenu("Help");
    for (int i = 0; i < 3; ++i) mnuTop[i]->setObjectName(QString("mnuTop_%1").arg(i));

    mnuSetup = item(mnuTop[0], "mnuSetup", "Chart Settings", Qt::Key_F2, &frmChart::mnuSetup_Click);
    mnuPrint = item(mnuTop[0], "mnuPrint", "Print Chart", Qt::Key_F8, &frmChart::mnuPrint_Click);
    mnuClose = mnuTop[0]->addAction("Close");
    mnuClose->setObjectName("mnuClose");
    mnuClose->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_X));
    connect(mnuClose, &QAction::triggered, this, &QWidget::close);

    mnuLabels1 = item(mnuTop[1], "mnuLabels1", "Labels On", Qt::Key_F3, &frmChart::mnuLabels1_Click);
    mnuLabels2 = item(mnuTop[1], "mnuLabels2", "Labels Off", Qt::Key_F4, &frmChart::mnuLabels2_Click);
    mnuRedraw = item(mnuTop[1], "mnuRedraw", "Redraw", Qt::Key_F5, &frmChart::mnuRedraw_Click);

    mnuHelp = item(mnuTop[2], "mnuHelp", "Mouse and Keys Help", QKeySequence(Qt::CTRL | Qt::Key_F1),
                   &frmChart::mnuHelp_Click);
    mnuAdvHelp = item(mnuTop[2], "mnuAdvHelp", "Advanced Chart Help", Qt::Key_F1, &frmChart::mnuAdvHelp_Click);

    // After the host's items, so their captions, order and keys stay as the host knows them.
    mnuTop[0]->addSeparator();
    mnuSaveAs = item(mnuTop[0], "mnuSaveAs", "Save As...", QKeySequence::SaveAs, &frmChart::mnuSaveAs_Click);
    mnuCopy = item(mnuTop[0], "mnuCopy", "Copy", QKeySequence::Copy, &frmChart::mnuCopy_Click);
}

void frmChart::Form_Load()
{
    call(goAppServices, "LogFormEvent", {Variant("FormLoad"), Variant("frmChart")});
    call(goAppServices, "RestoreFormState", {Variant(makeRef<WindowObject>(this, "frmChart")), Variant("Chart")});
}

void frmChart::Form_QueryUnload()
{
    if (unloaded_) return;
    unloaded_ = true;
    try {
        call(goAppServices, "LogFormEvent", {Variant("FormQueryUnload"), Variant("frmChart")});
        call(goAppServices, "SaveFormState", {Variant(makeRef<WindowObject>(this, "frmChart")), Variant("Chart")});
    } catch (const Error& e) {
        // The close is never cancelled; a placement that could not be saved is only reported.
        prompter().showMessage("Error " + std::to_string(e.number()) + ": " + e.description());
    }
    releaseSharedObjects();
    if (onUnloaded) onUnloaded();
}

void frmChart::closeEvent(QCloseEvent* event)
{
    Form_QueryUnload();
    event->accept();
}

void frmChart::runCommand(const std::function<void()>& command)
{
    try {
        command();
    } catch (const Error& e) {
        HourglassOff();  // a failed Redraw must hand the pointer back, as a failed request does
        prompter().showMessage("Error " + std::to_string(e.number()) + ": " + e.description());
    } catch (const std::exception& e) {
        HourglassOff();
        prompter().showMessage(std::string("Error: ") + e.what());
    }
}

void frmChart::mnuPrint_Click() { chart().PrintChart(); }

void frmChart::setLabels(bool on)
{
    chart().setPointLabels(on);
    chart().DrawChart(gvArray);
}

void frmChart::mnuLabels1_Click() { setLabels(true); }
void frmChart::mnuLabels2_Click() { setLabels(false); }

void frmChart::mnuRedraw_Click()
{
    if (giChartKind == kBookingsRequest || giChartKind == kCategoryRequest) requests::chooseAndDrawMeasure(giChartKind);
}

void frmChart::mnuSetup_Click()
{
    showChartSetup();
    // Redrawn after OK and after Cancel alike.
    chart().DrawChart(gvArray);
}

void frmChart::mnuHelp_Click() { showChartHelp(); }
void frmChart::mnuAdvHelp_Click() { openAdvancedHelp(); }

namespace {
// The size the chart is shown at: exports look like the window.
QSize shownSize(const control::ChartView* view) { return view->size().expandedTo(QSize(16, 16)); }
}  // namespace

void frmChart::mnuSaveAs_Click()
{
    const std::string path =
        prompter().askSaveFile("Save Chart As", "PNG image (*.png);;SVG drawing (*.svg);;PDF document (*.pdf)");
    if (path.empty()) return;
    control::exportChart(*chart_, control::isExportFormat(path) ? path : path + ".png", shownSize(view_));
}

void frmChart::mnuCopy_Click()
{
    QGuiApplication::clipboard()->setImage(control::renderImage(*chart_, shownSize(view_)));
}

}  // namespace kg::ui

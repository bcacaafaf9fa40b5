#include "ui/frmChartHelp.h"

#include <QCloseEvent>
#include <QPointer>
#include <QTextBrowser>

#include "requests/modMain.h"
#include "core/Error.h"
#include "ui/HelpText.h"
#include "ui/Prompter.h"
#include "ui/WindowObject.h"

namespace kg::ui {

namespace {

constexpr const char* kName = "frmChartHelp";
constexpr const char* kPlacementKey = "ChartHelp";

QPointer<frmChartHelp>& helpWindow()
{
    static QPointer<frmChartHelp> window;
    return window;
}

Variant windowObject(frmChartHelp* window) { return Variant(makeRef<WindowObject>(window, kName)); }

}  // namespace

frmChartHelp::frmChartHelp()
{
    setObjectName(kName);
    setWindowTitle("Chart Mouse and Keyboard Functions");
    setAttribute(Qt::WA_DeleteOnClose);
    Text1 = new QTextBrowser(this);
    Text1->setObjectName("Text1");
    Text1->setReadOnly(true);
    Text1->setOpenLinks(false);
    buildChartHelp(*Text1->document());
    Text1->moveCursor(QTextCursor::Start);  // open at the title, not where the building ended
    Text1->move(0, 0);
    resize(9852 / kTwipsPerPixel, 5304 / kTwipsPerPixel);
    Form_Resize();
}

void frmChartHelp::Form_Load()
{
    call(modMain::goAppServices, "LogFormEvent", {Variant("FormLoad"), Variant(kName)});
    call(modMain::goAppServices, "RestoreFormState", {windowObject(this), Variant(kPlacementKey)});
}

void frmChartHelp::Form_Resize()
{
    // The text box fills the window from its top-left corner: width first, then height.
    Text1->resize(width(), Text1->height());
    Text1->resize(Text1->width(), height());
}

void frmChartHelp::resizeEvent(QResizeEvent* event)
{
    QWidget::resizeEvent(event);
    Form_Resize();
}

void frmChartHelp::Form_QueryUnload()
{
    if (unloaded_) return;
    unloaded_ = true;
    if (modMain::goAppServices.isObject() && modMain::goAppServices.object()) {
        call(modMain::goAppServices, "LogFormEvent", {Variant("FormQueryUnload"), Variant(kName)});
        call(modMain::goAppServices, "SaveFormState", {windowObject(this), Variant(kPlacementKey)});
    }
}

void frmChartHelp::closeEvent(QCloseEvent* event)
{
    // The close is never refused; a placement that cannot be saved is only reported, since an
    // error may not cross Qt's event loop.
    try {
        Form_QueryUnload();
    } catch (const Error& e) {
        prompter().showMessage("Error " + std::to_string(e.number()) + ": " + e.description());
    }
    event->accept();
}

void showChartHelp()
{
    QPointer<frmChartHelp>& window = helpWindow();
    if (!window || window->isUnloaded()) {
        auto* created = new frmChartHelp;
        try {
            created->Form_Load();
        } catch (...) {
            delete created;
            throw;
        }
        window = created;
    }
    window->show();
    window->raise();
    window->activateWindow();
}

frmChartHelp* chartHelpWindow()
{
    frmChartHelp* window = helpWindow();
    return window && !window->isUnloaded() ? window : nullptr;
}

}  // namespace kg::ui

#pragma once
// The chart window: the chart control `Chart1` filling the client area, and the menu that prints,
// switches value labels, redraws a measure-choice chart and opens the style dialog and help.
#include <QMainWindow>
#include <functional>

#include "chart/control/model/ChartControl.h"

class QAction;
class QMenu;

namespace kg::control {
class ChartView;
}

namespace kg::ui {

class frmChart : public QMainWindow {
    Q_OBJECT
public:
    explicit frmChart(Ref<control::ChartControl> chart);

    control::ChartControl& Chart1() { return *chart_; }
    control::ChartView* chartView() const { return view_; }

    QMenu* mnuTop[3] = {};
    QAction* mnuSetup = nullptr;
    QAction* mnuPrint = nullptr;
    QAction* mnuClose = nullptr;
    QAction* mnuLabels1 = nullptr;
    QAction* mnuLabels2 = nullptr;
    QAction* mnuRedraw = nullptr;
    QAction* mnuHelp = nullptr;
    QAction* mnuAdvHelp = nullptr;
    // Beyond the host's menu: put the chart into a report.
    QAction* mnuSaveAs = nullptr;
    QAction* mnuCopy = nullptr;

    void Form_Load();
    // The window's commands, callable as the menu calls them.
    void mnuPrint_Click();
    void mnuLabels1_Click();
    void mnuLabels2_Click();
    void mnuRedraw_Click();
    void mnuSetup_Click();
    void mnuHelp_Click();
    void mnuAdvHelp_Click();
    void mnuSaveAs_Click();
    void mnuCopy_Click();

    // Called once the window has unloaded (after its shared objects were released).
    std::function<void()> onUnloaded;

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    void buildMenu();
    void Form_QueryUnload();
    // A failing command must not end the host: the error is shown and the chart left as it was.
    void runCommand(const std::function<void()>& command);
    void setLabels(bool on);

    Ref<control::ChartControl> chart_;
    control::ChartView* view_ = nullptr;
    bool unloaded_ = false;
};

}  // namespace kg::ui

#pragma once
// The component's UI on screen: the chart window frmChart, and the mouse pointer as the
// application's override cursor. Its prompts are the Qt dialogs (ui/Prompter.h).
#include <QPointer>

#include "requests/Services.h"
#include "ui/frmChart.h"

namespace kg::ui {

class QtUi : public WindowService {
public:
    Ref<ChartWindowPort> loadChartWindow() override;
    void setMousePointer(int pointer) override;
    int mousePointer() const override { return pointer_; }

    // The loaded chart window, or null.
    frmChart* chartWindow() const { return window_; }

private:
    QPointer<frmChart> window_;
    Ref<ChartWindowPort> port_;
    int pointer_ = kPointerDefault;
};

// Installs the Qt windows and the Qt dialogs into the services in use (needs a QApplication).
void installQtUi();
// Installs them once when the process has a QApplication (a widget host); otherwise does nothing.
void installQtUiForApplication();

}  // namespace kg::ui

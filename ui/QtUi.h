#pragma once
// The component's UI on screen: the chart window frmChart, message boxes and the data choice dialogs
// through the prompter, and the mouse pointer as the application's override cursor.
#include <QPointer>

#include "requests/UiServices.h"
#include "ui/frmChart.h"

namespace kg::ui {

class QtUi : public UiServices {
public:
    Ref<ChartWindowPort> loadChartWindow() override;
    void messageBox(const std::string& text) override;
    int16_t chooseData(ChoiceDialog dialog) override;
    void setMousePointer(int pointer) override;
    int mousePointer() const override { return pointer_; }

    // The loaded chart window, or null.
    frmChart* chartWindow() const { return window_; }

private:
    QPointer<frmChart> window_;
    Ref<ChartWindowPort> port_;
    int pointer_ = kPointerDefault;
};

// Installs the Qt windows as the component's UI (needs a QApplication).
void installQtUi();
// Installs them once when the process has a QApplication (a widget host); otherwise does nothing.
void installQtUiForApplication();

}  // namespace kg::ui

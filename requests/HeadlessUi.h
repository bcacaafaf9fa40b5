#pragma once
// The component without a screen, for hosts that have no Qt application: a chart window that only
// holds its control, the mouse pointer as a value, and a prompter that cannot ask anyone.
#include <string>

#include "requests/Services.h"

namespace kg {

class HeadlessChartWindow : public ChartWindowPort {
public:
    HeadlessChartWindow() : chart_(makeRef<control::ChartControl>()) {}
    control::ChartControl& Chart1() override { return *chart_; }
    void setRedrawVisible(bool v) override { redrawVisible_ = v; }
    bool isRedrawVisible() const override { return redrawVisible_; }
    void Show() override { shown_ = true; }
    bool isShown() const override { return shown_; }

private:
    Ref<control::ChartControl> chart_;
    bool redrawVisible_ = true;
    bool shown_ = false;
};

class HeadlessUi : public WindowService {
public:
    Ref<ChartWindowPort> loadChartWindow() override;
    void setMousePointer(int pointer) override { pointer_ = pointer; }
    int mousePointer() const override { return pointer_; }

private:
    Ref<ChartWindowPort> window_;
    int pointer_ = kPointerDefault;
};

// No one to ask: a message goes nowhere visible, a data choice fails.
class NoScreenPrompter : public Prompter {
public:
    void showMessage(const std::string&) override {}
    int16_t chooseData(ChoiceDialog dialog) override;
};

}  // namespace kg

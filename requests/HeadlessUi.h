#pragma once
// The UI without a screen: a chart window that only holds its control, message boxes and dialog
// answers that are recorded and scripted. The default until the windows install themselves, and the
// one the model tests use.
#include <deque>
#include <string>
#include <vector>

#include "requests/UiServices.h"

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

class HeadlessUi : public UiServices {
public:
    Ref<ChartWindowPort> loadChartWindow() override;
    void messageBox(const std::string& text) override { messages.push_back(text); }
    int16_t chooseData(ChoiceDialog dialog) override;
    void setMousePointer(int pointer) override { pointer_ = pointer; }
    int mousePointer() const override { return pointer_; }

    // Closing the window: the next load creates a new one.
    void unloadChartWindow() { window_.reset(); }

    std::vector<std::string> messages;
    std::deque<int16_t> choices;           // answers of the data choice dialogs, in order
    std::vector<ChoiceDialog> dialogsShown;
    int windowLoads = 0;

private:
    Ref<ChartWindowPort> window_;
    int pointer_ = kPointerDefault;
};

}  // namespace kg

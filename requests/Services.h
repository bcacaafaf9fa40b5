#pragma once
// The component's road to the screen: the chart window, message boxes, the data choice dialogs and
// the mouse pointer. The windows' implementation installs itself here; tests install a scripted one.
#include <memory>
#include <string>

#include "chart/ChartWindowPort.h"

namespace kg {

// Mouse pointer values of the screen.
constexpr int kPointerDefault = 0;
constexpr int kPointerHourglass = 11;

// Which data choice dialog: quote types (frmChoose1) or categories (frmChoose2).
enum class ChoiceDialog { QuoteType = 1, Category = 2 };
constexpr int16_t kChoiceCancelled = -99;

class UiServices {
public:
    virtual ~UiServices() = default;
    // Loads the chart window if it is not loaded (its load handler runs); a loaded one is returned as is.
    virtual Ref<ChartWindowPort> loadChartWindow() = 0;
    // Fixed text, OK only, no icon, the component's title.
    virtual void messageBox(const std::string& text) = 0;
    // Shows the dialog modally and returns its iChoice (0..6, or -99 when cancelled).
    virtual int16_t chooseData(ChoiceDialog dialog) = 0;
    virtual void setMousePointer(int pointer) = 0;
    virtual int mousePointer() const = 0;
};

UiServices& uiServices();
// Installs the UI in use (the component keeps it); nullptr returns to the headless default.
void setUiServices(std::unique_ptr<UiServices> services);

}  // namespace kg

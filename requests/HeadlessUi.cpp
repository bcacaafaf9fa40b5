#include "requests/HeadlessUi.h"

#include "core/Error.h"

namespace kg {

Ref<ChartWindowPort> HeadlessUi::loadChartWindow()
{
    if (!window_) {
        window_ = makeRef<HeadlessChartWindow>();
        ++windowLoads;
    }
    return window_;
}

int16_t HeadlessUi::chooseData(ChoiceDialog dialog)
{
    dialogsShown.push_back(dialog);
    if (choices.empty()) throw Error::invalidCall("no answer was scripted for the data choice dialog");
    const int16_t choice = choices.front();
    choices.pop_front();
    return choice;
}

namespace {
std::unique_ptr<UiServices>& installed()
{
    static std::unique_ptr<UiServices> services;
    return services;
}
}  // namespace

UiServices& uiServices()
{
    if (!installed()) installed() = std::make_unique<HeadlessUi>();
    return *installed();
}

void setUiServices(std::unique_ptr<UiServices> services) { installed() = std::move(services); }

}  // namespace kg

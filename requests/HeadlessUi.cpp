#include "requests/HeadlessUi.h"

#include "core/Error.h"

namespace kg {

Ref<ChartWindowPort> HeadlessUi::loadChartWindow()
{
    if (!window_) window_ = makeRef<HeadlessChartWindow>();
    return window_;
}

int16_t NoScreenPrompter::chooseData(ChoiceDialog)
{
    throw Error::invalidCall("no answer was scripted for the data choice dialog");
}

std::shared_ptr<WindowService> headlessWindows() { return std::make_shared<HeadlessUi>(); }
std::shared_ptr<Prompter> noScreenPrompter() { return std::make_shared<NoScreenPrompter>(); }

}  // namespace kg

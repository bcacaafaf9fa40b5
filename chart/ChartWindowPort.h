#pragma once
// What the builders and the chart model need of the chart window: its chart control `Chart1`,
// the visibility of its Redraw menu item and a modeless show. The window class itself lives above.
#include "chart/control/model/ChartControl.h"
#include "core/Ref.h"

namespace kg {

class ChartWindowPort : public RefCounted {
public:
    virtual control::ChartControl& Chart1() = 0;
    virtual void setRedrawVisible(bool visible) = 0;
    virtual bool isRedrawVisible() const = 0;
    // Modeless, no owner.
    virtual void Show() = 0;
    virtual bool isShown() const = 0;
};

}  // namespace kg

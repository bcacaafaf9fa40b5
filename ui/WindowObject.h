#pragma once
// A window as the host's application services see it: late-bound Name, Left, Top, Width, Height
// (twips) and WindowState (0 normal, 1 minimised, 2 maximised), for saving and restoring placement.
#include <QPointer>
#include <QWidget>

#include "core/Dispatch.h"

namespace kg::ui {

constexpr int kTwipsPerPixel = 15;  // at 96 dots per inch

class WindowObject : public TableObject {
public:
    WindowObject(QWidget* window, std::string name) : window_(window), name_(std::move(name)) {}
    Variant invoke(DispId id, uint16_t kind, Args& args) override;
    std::string objectName() const override { return name_; }

protected:
    const std::vector<MemberInfo>& members() const override;

private:
    QPointer<QWidget> window_;
    std::string name_;
};

}  // namespace kg::ui

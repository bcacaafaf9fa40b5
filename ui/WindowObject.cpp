#include "ui/WindowObject.h"

#include "core/Convert.h"
#include "core/Error.h"

namespace kg::ui {

namespace {
enum : DispId { mName = 1, mLeft, mTop, mWidth, mHeight, mWindowState };
}

const std::vector<MemberInfo>& WindowObject::members() const
{
    static const std::vector<MemberInfo> table = {{"Name", mName},     {"Left", mLeft},     {"Top", mTop},
                                                  {"Width", mWidth},   {"Height", mHeight}, {"WindowState", mWindowState}};
    return table;
}

Variant WindowObject::invoke(DispId id, uint16_t kind, Args& args)
{
    if (!window_) throw Error::objectNotSet(name_ + " is unloaded");
    const bool put = kind & (kPropertyPut | kPropertyPutRef);
    expectArgs(args, put ? 1 : 0, name_.c_str());
    QWidget& w = *window_;
    const QRect g = w.normalGeometry().isValid() ? w.normalGeometry() : w.geometry();
    if (id == mName) {
        if (put) throw Error::invalidCall("Name is read-only");
        return Variant(name_);
    }
    if (id == mWindowState) {
        if (!put) return Variant(int16_t(w.isMaximized() ? 2 : w.isMinimized() ? 1 : 0));
        const int16_t state = toInteger(args[0]);
        if (state == 2) w.setWindowState(Qt::WindowMaximized);
        else if (state == 1) w.setWindowState(Qt::WindowMinimized);
        else w.setWindowState(Qt::WindowNoState);
        return {};
    }
    int* field = nullptr;
    int left = g.x(), top = g.y(), width = g.width(), height = g.height();
    switch (id) {
    case mLeft: field = &left; break;
    case mTop: field = &top; break;
    case mWidth: field = &width; break;
    case mHeight: field = &height; break;
    default: throw Error::memberNotFound(name_ + " member id " + std::to_string(id));
    }
    if (!put) return Variant(int32_t(*field * kTwipsPerPixel));
    *field = toLong(args[0]) / kTwipsPerPixel;
    w.setGeometry(left, top, std::max(width, 1), std::max(height, 1));
    return {};
}

}  // namespace kg::ui

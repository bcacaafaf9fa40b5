#include "chart/control/render/Colors.h"

#include <array>

namespace kg::control {

namespace {
// Twenty colours that stay apart from each other and from the cream plot background; the
// darker ones come first so that small charts get the strongest contrast.
constexpr std::array<QRgb, 20> kPalette = {
    0x4E79A7, 0xF28E2B, 0xE15759, 0x59A14F, 0x76B7B2, 0xB07AA1, 0x9C755F, 0xD4A017, 0x2F4B7C, 0xFF9DA7,
    0x7F7F7F, 0x8CD17D, 0xA0CBE8, 0xB6992D, 0xD37295, 0x499894, 0xFFBE7D, 0x6B3E9A, 0x86BCB6, 0xC0392B,
};
}  // namespace

QColor toQColor(OleColor c) { return QColor(redOf(c), greenOf(c), blueOf(c)); }

int seriesPaletteSize() { return int(kPalette.size()); }

QColor seriesColor(int index)
{
    const int n = seriesPaletteSize();
    const int i = ((index - 1) % n + n) % n;
    return QColor::fromRgb(kPalette[size_t(i)]);
}

QColor sideShade(const QColor& c) { return c.darker(140); }
QColor topShade(const QColor& c) { return c.lighter(125); }

}  // namespace kg::control

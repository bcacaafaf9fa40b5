#pragma once
// PNG encoding for chart pictures: 8-bit RGB, zlib level 1, no row filter. Charts are large flat
// areas and thin lines; for them this is both the quickest and the smallest of the fast settings
// (measured on the report bars and the large plot: the SUB or UP filter gave 5 to 25 % larger
// files and took longer, Z_RLE was quicker on the plot but 1.2 to 3.7 times larger on the bars),
// at a third of the time of the usual level 6 with adaptive filters.
#include <QByteArray>
#include <QImage>

namespace kg::control {

// The PNG file bytes of `image` (alpha dropped); throws kg::Error when libpng fails.
QByteArray encodePng(const QImage& image);

}  // namespace kg::control

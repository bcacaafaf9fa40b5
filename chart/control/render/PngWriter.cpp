#include "chart/control/render/PngWriter.h"

#include <png.h>

#include <csetjmp>
#include <string>
#include <vector>

#include "core/Error.h"

namespace kg::control {

namespace {
struct Sink {
    QByteArray* bytes;
};

void appendBytes(png_structp png, png_bytep data, png_size_t length)
{
    auto* sink = static_cast<Sink*>(png_get_io_ptr(png));
    bool full = false;
    try {
        sink->bytes->append(reinterpret_cast<const char*>(data), qsizetype(length));
    } catch (...) {
        full = true;  // no exception may pass through libpng's C frames
    }
    if (full) png_error(png, "out of memory");
}

void noFlush(png_structp) {}

// libpng reports failures by longjmp; everything this function owns is plain data allocated
// before the jump point, so nothing is skipped when it jumps back.
bool writeRows(png_structp png, png_infop info, const QImage& image, unsigned char* row)
{
    if (setjmp(png_jmpbuf(png))) return false;
    const int w = image.width(), h = image.height();
    png_set_IHDR(png, info, png_uint_32(w), png_uint_32(h), 8, PNG_COLOR_TYPE_RGB, PNG_INTERLACE_NONE,
                 PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
    png_set_compression_level(png, 1);
    png_set_filter(png, PNG_FILTER_TYPE_BASE, PNG_FILTER_NONE);
    // 96 dpi, as the chart's sizes are meant.
    png_set_pHYs(png, info, 3780, 3780, PNG_RESOLUTION_METER);
    png_write_info(png, info);
    for (int y = 0; y < h; ++y) {
        const auto* src = reinterpret_cast<const QRgb*>(image.constScanLine(y));
        unsigned char* out = row;
        for (int x = 0; x < w; ++x) {
            const QRgb c = src[x];
            *out++ = static_cast<unsigned char>(qRed(c));
            *out++ = static_cast<unsigned char>(qGreen(c));
            *out++ = static_cast<unsigned char>(qBlue(c));
        }
        png_write_row(png, row);
    }
    png_write_end(png, info);
    return true;
}
}  // namespace

QByteArray encodePng(const QImage& source)
{
    if (source.isNull()) throw Error::invalidCall("PNG of an empty image");
    const QImage image = source.format() == QImage::Format_RGB32 || source.format() == QImage::Format_ARGB32
                             ? source
                             : source.convertToFormat(QImage::Format_RGB32);
    QByteArray bytes;
    bytes.reserve(qsizetype(image.width()) * image.height() / 4);
    Sink sink{&bytes};
    std::vector<unsigned char> row(size_t(image.width()) * 3);
    png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
    png_infop info = png ? png_create_info_struct(png) : nullptr;
    if (!info) {
        png_destroy_write_struct(&png, nullptr);
        throw Error(errc::OutOfMemory, "Out of memory: PNG encoder");
    }
    png_set_write_fn(png, &sink, appendBytes, noFlush);
    const bool ok = writeRows(png, info, image, row.data());
    png_destroy_write_struct(&png, &info);
    if (!ok)
        throw Error::invalidCall("PNG encoding of a " + std::to_string(image.width()) + "x" +
                                 std::to_string(image.height()) + " image failed");
    return bytes;
}

}  // namespace kg::control

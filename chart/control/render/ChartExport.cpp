#include "chart/control/render/ChartExport.h"

#include <QBuffer>
#include <QFileInfo>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <QSvgGenerator>

#include "chart/control/render/ChartPainter.h"
#include "chart/control/render/Colors.h"
#include "chart/control/render/PngWriter.h"
#include "core/Error.h"
#include "files/WholeFile.h"

namespace kg::control {

namespace {
constexpr double kPointsPerPixel = 72.0 / 96.0;

void checkSize(QSize size)
{
    if (size.width() < 1 || size.height() < 1 || size.width() > kMostExportSide || size.height() > kMostExportSide) {
        throw Error::invalidCall("chart picture size " + std::to_string(size.width()) + "x" +
                                 std::to_string(size.height()) + " (each side from 1 to " +
                                 std::to_string(kMostExportSide) + " pixels)");
    }
}

QString documentTitle(const ChartControl& chart)
{
    return chart.header.text.empty() ? QStringLiteral("Chart") : QString::fromStdString(chart.header.text);
}

QByteArray svgBytes(const ChartControl& chart, QSize size)
{
    QBuffer buffer;
    buffer.open(QIODevice::WriteOnly);
    QSvgGenerator svg;
    svg.setOutputDevice(&buffer);
    svg.setSize(size);
    svg.setViewBox(QRect(QPoint(0, 0), size));
    svg.setResolution(96);
    // The generator writes title and description without escaping them.
    svg.setTitle(documentTitle(chart).toHtmlEscaped());
    svg.setDescription(QStringLiteral("KarstGraph chart"));
    QPainter painter(&svg);
    paintChart(chart, painter, QRectF(QPointF(0, 0), size));
    painter.end();
    return buffer.data();
}

QByteArray pdfBytes(const ChartControl& chart, QSize size)
{
    QBuffer buffer;
    buffer.open(QIODevice::WriteOnly);
    QPdfWriter pdf(&buffer);
    pdf.setResolution(96);
    pdf.setPageSize(QPageSize(QSizeF(size) * kPointsPerPixel, QPageSize::Point, QString(), QPageSize::ExactMatch));
    pdf.setPageMargins(QMarginsF(0, 0, 0, 0));
    pdf.setTitle(documentTitle(chart));
    pdf.setCreator(QStringLiteral("KarstGraph"));
    QPainter painter(&pdf);
    paintChart(chart, painter, QRectF(QPointF(0, 0), size));
    painter.end();
    return buffer.data();
}

}  // namespace

QImage renderImage(const ChartControl& chart, QSize size)
{
    checkSize(size);
    QImage image(size, QImage::Format_RGB32);
    if (image.isNull())
        throw Error(errc::OutOfMemory, "Out of memory: chart picture of " + std::to_string(size.width()) + "x" +
                                           std::to_string(size.height()));
    image.fill(toQColor(chart.backgroundColor));
    QPainter painter(&image);
    paintChart(chart, painter, QRectF(image.rect()));
    painter.end();
    return image;
}

namespace {
QString suffixOf(const QString& file) { return QFileInfo(file).suffix().toLower(); }
}  // namespace

bool isExportFormat(const std::string& path)
{
    const QString suffix = suffixOf(QString::fromStdString(path));
    return suffix == QLatin1String("png") || suffix == QLatin1String("svg") || suffix == QLatin1String("pdf");
}

void exportChart(const ChartControl& chart, const std::string& path, QSize size)
{
    const QString file = QString::fromStdString(path);
    const QString suffix = suffixOf(file);
    if (!isExportFormat(path)) {
        throw Error::invalidCall("chart file type \"" +
                                 (suffix.isEmpty() ? std::string() : "." + suffix.toStdString()) + "\" of " + path +
                                 " (use .png, .svg or .pdf)");
    }
    checkSize(size);
    // The folder is tried before the painting, so that a wrong path fails at once.
    if (!QFileInfo(QFileInfo(file).absolutePath()).isDir())
        throw Error(errc::PathFileAccess, "Path/File access error: cannot write " + path + ": no such folder");
    const QByteArray bytes = suffix == QLatin1String("png")   ? encodePng(renderImage(chart, size))
                             : suffix == QLatin1String("svg") ? svgBytes(chart, size)
                                                              : pdfBytes(chart, size);
    // Unsynced: see files/WholeFile.h for the time an fsync costs here.
    if (const auto failed = files::writeWholeFile(file, bytes, files::Sync::None))
        throw Error(errc::PathFileAccess,
                    "Path/File access error: cannot write " + path + ": " + failed->reason.toStdString());
}

}  // namespace kg::control

#include "chart/control/render/ChartPrinting.h"

#include <QPainter>
#include <QPrinter>
#include <QPrinterInfo>
#include <algorithm>
#include <memory>

#include "chart/control/render/ChartPainter.h"
#include "core/Error.h"

namespace kg::control {

namespace {
std::unique_ptr<QPrinter> openPrinter(const std::string& pdfFile)
{
    if (!pdfFile.empty()) {
        auto printer = std::make_unique<QPrinter>(QPrinter::HighResolution);
        printer->setOutputFormat(QPrinter::PdfFormat);
        printer->setOutputFileName(QString::fromStdString(pdfFile));
        return printer;
    }
    const QPrinterInfo info = QPrinterInfo::defaultPrinter();
    if (info.isNull()) throw Error(errc::PrinterError, "Printer error: no printer is installed");
    return std::make_unique<QPrinter>(info, QPrinter::HighResolution);
}

QString printerName(const QPrinter& printer)
{
    return printer.outputFormat() == QPrinter::PdfFormat ? QStringLiteral("the PDF file ") + printer.outputFileName()
                                                         : QStringLiteral("the printer ") + printer.printerName();
}
}  // namespace

void printChart(const ChartControl& chart, const PrintRequest& request, const std::string& pdfFile)
{
    (void)request;  // the outside control's print codes; one layout serves them all
    std::unique_ptr<QPrinter> printer = openPrinter(pdfFile);
    printer->setPageOrientation(QPageLayout::Landscape);
    printer->setDocName(QStringLiteral("KarstGraph chart"));
    printer->setCreator(QStringLiteral("KarstGraph"));

    QPainter painter;
    if (!painter.begin(printer.get()))
        throw Error(errc::PrinterError, "Printer error: cannot print to " + printerName(*printer).toStdString());
    // Painted at the size the chart is shown at, then scaled as a whole to the page.
    const double width = chart.shownWidth > 0 ? chart.shownWidth : kDefaultPrintWidth;
    const double height = chart.shownHeight > 0 ? chart.shownHeight : kDefaultPrintHeight;
    const QRectF page = printer->pageLayout().paintRectPixels(printer->resolution());
    const double scale = std::min(page.width() / width, page.height() / height);
    painter.translate((page.width() - width * scale) / 2, (page.height() - height * scale) / 2);
    painter.scale(scale, scale);
    paintChart(chart, painter, QRectF(0, 0, width, height));
    if (!painter.end())
        throw Error(errc::PrinterError,
                    "Printer error: printing to " + printerName(*printer).toStdString() + " failed");
}

void installPrinting(ChartControl& chart, PrintTarget target)
{
    chart.setPrintHandler([target = std::move(target)](const ChartControl& c, const PrintRequest& request) {
        printChart(c, request, target ? target() : std::string());
    });
}

}  // namespace kg::control

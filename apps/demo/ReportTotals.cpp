#include "apps/demo/ReportTotals.h"

#include <QLocale>
#include <cmath>

namespace kg::demo {

namespace {
constexpr int kMonths = 12;
const QString kTotalCaption = QStringLiteral("Total");
}  // namespace

double round2(double v) { return std::round(v * 100.0) / 100.0; }

QString numberCellText(double v)
{
    // 'f' with two decimals, then the zeros that say nothing are dropped: 12.50 -> 12.5, 7.00 -> 7.
    QString text = QLocale::c().toString(round2(v), 'f', 2);
    while (text.endsWith('0')) text.chop(1);
    if (text.endsWith('.')) text.chop(1);
    return text == "-0" ? QStringLiteral("0") : text;
}

bool readCellNumber(const QString& text, double& out)
{
    bool ok = false;
    const double v = QLocale::c().toDouble(text.trimmed(), &ok);
    if (ok) out = v;
    return ok;
}

bool isMonthColumn(const GridCells& grid, int col)
{
    return col >= 1 && col <= kMonths && col < grid.cols && grid.text(0, col).trimmed() != kTotalCaption;
}

int totalColumn(const GridCells& grid)
{
    for (int col = 1; col < grid.cols; ++col)
        if (grid.text(0, col).trimmed() == kTotalCaption) return col;
    return -1;
}

double rowMonthSum(const GridCells& grid, int row)
{
    double sum = 0;
    for (int col = 1; col < grid.cols; ++col) {
        double v = 0;
        if (isMonthColumn(grid, col) && readCellNumber(grid.text(row, col), v)) sum += v;
    }
    return sum;
}

double monthSum(const GridCells& grid)
{
    double sum = 0;
    for (int row = grid.fixedRows; row < grid.rows; ++row) sum += rowMonthSum(grid, row);
    return sum;
}

double average(double value, double count) { return count != 0 ? round2(value / count) : 0.0; }

ReportTotals reportTotals(const GridCells& grid1, const GridCells& grid2)
{
    ReportTotals t;
    t.quantity = round2(monthSum(grid1));
    t.value = round2(monthSum(grid2));
    t.average = average(t.value, t.quantity);
    return t;
}

}  // namespace kg::demo

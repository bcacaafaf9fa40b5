#pragma once
// The host's own arithmetic on its report grids: the totals it passes as vTotal and the derived
// figures it keeps in step when the user edits a cell. A grid is read through its cell texts:
// row 0 the captions, column 0 the row captions, columns 1 to 12 the months, and a column captioned
// "Total" holding each row's total.
#include <QString>
#include <functional>

namespace kg::demo {

struct GridCells {
    int rows = 0;
    int cols = 0;
    int fixedRows = 1;
    std::function<QString(int row, int col)> text;
};

struct ReportTotals {
    double quantity = 0;  // grid1: bookings counted
    double value = 0;     // grid2: their value
    double average = 0;   // grid3: value per booking, the overall average
};

// Columns 1 to 12 are months unless captioned "Total".
bool isMonthColumn(const GridCells& grid, int col);
// The column captioned "Total", or -1.
int totalColumn(const GridCells& grid);
// The numbers in one data row's month columns; texts that are not numbers count as nothing.
double rowMonthSum(const GridCells& grid, int row);
// The numbers in every data row's month columns.
double monthSum(const GridCells& grid);
// value / count to two decimals, or 0 when there is no count.
double average(double value, double count);
// grid1 and grid2 summed; the average is grid2's total over grid1's, not a mean of grid3's cells.
ReportTotals reportTotals(const GridCells& grid1, const GridCells& grid2);

double round2(double v);
// A number as the grids show it: no grouping, a period, at most two decimals, no trailing zeros.
QString numberCellText(double v);
// A cell text read as a number; false when it is not one.
bool readCellNumber(const QString& text, double& out);

}  // namespace kg::demo

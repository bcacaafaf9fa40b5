#pragma once
// The report screen's source form: the grids grid1, grid2, grid3 and gridsettings1 as tables, the
// date pickers dtpFromDate and dtpToDate and the field list cboFields(1) (object name
// "cboFields_1"). The component reads these widgets by name (FormObjects.h); the user edits their
// cells and dates. Editing a month of grid1 or grid2 keeps the row's Total and grid3's averages in
// step, as the host's report screen does.
#include <QWidget>

#include "apps/demo/ReportData.h"
#include "apps/demo/ReportTotals.h"

class QComboBox;
class QDateEdit;
class QLabel;
class QTableWidget;
class QTabWidget;

namespace kg::demo {

class ReportForm : public QWidget {
    Q_OBJECT
public:
    explicit ReportForm(QWidget* parent = nullptr);

    void fill(const ReportData& data);

    QTableWidget* grid(const QString& name) const;  // grid1, grid2, grid3, gridsettings1
    QDateEdit* fromDate() const { return dtpFromDate_; }
    QDateEdit* toDate() const { return dtpToDate_; }
    QComboBox* fields() const { return cboFields_; }

    // The totals the grids show now.
    ReportTotals totals() const;
    // A grid's data rows (Rows - FixedRows): the series count a grid request is given.
    int dataRows(const QString& gridName) const;

signals:
    void totalsChanged();

private:
    void fillGrid(QTableWidget* table, const GridData& data);
    void onCellChanged(QTableWidget* table, int row, int col);
    void keepDerivedFigures(int row, int col);
    void showTotals();

    QDateEdit* dtpFromDate_;
    QDateEdit* dtpToDate_;
    QComboBox* cboFields_;
    QTabWidget* tabs_;
    QLabel* lblTotals_;
    bool filling_ = false;
};

// A table as the totals read it.
GridCells cellsOf(const QTableWidget* table);

}  // namespace kg::demo

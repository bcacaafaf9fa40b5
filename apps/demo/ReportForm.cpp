#include "apps/demo/ReportForm.h"

#include <QComboBox>
#include <QDateEdit>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QTabWidget>
#include <QTableWidget>
#include <QVBoxLayout>

namespace kg::demo {

namespace {

struct GridTab {
    const char* name;
    const char* title;
};
const GridTab kGridTabs[] = {{"grid1", "Bookings (grid1)"},
                             {"grid2", "Value (grid2)"},
                             {"grid3", "Average value (grid3)"},
                             {"gridsettings1", "Quote types (gridsettings1)"}};

QDateEdit* makePicker(const char* name, QWidget* parent)
{
    auto* picker = new QDateEdit(parent);
    picker->setObjectName(name);
    picker->setCalendarPopup(true);
    picker->setDisplayFormat("dd/MM/yyyy");
    return picker;
}

int fixedRowsOf(const QTableWidget* table)
{
    const QVariant v = table->property("FixedRows");
    return v.isValid() ? v.toInt() : 1;
}

}  // namespace

GridCells cellsOf(const QTableWidget* table)
{
    GridCells cells;
    cells.rows = table->rowCount();
    cells.cols = table->columnCount();
    cells.fixedRows = fixedRowsOf(table);
    cells.text = [table](int row, int col) {
        const QTableWidgetItem* item = table->item(row, col);
        return item ? item->text() : QString();
    };
    return cells;
}

ReportForm::ReportForm(QWidget* parent) : QWidget(parent)
{
    setObjectName("frmReports");
    dtpFromDate_ = makePicker("dtpFromDate", this);
    dtpToDate_ = makePicker("dtpToDate", this);
    cboFields_ = new QComboBox(this);
    cboFields_->setObjectName("cboFields_1");

    auto* range = new QHBoxLayout;
    range->addWidget(new QLabel(tr("From"), this));
    range->addWidget(dtpFromDate_);
    range->addSpacing(12);
    range->addWidget(new QLabel(tr("To"), this));
    range->addWidget(dtpToDate_);
    range->addSpacing(12);
    range->addWidget(new QLabel(tr("Job status fields"), this));
    range->addWidget(cboFields_, 1);

    tabs_ = new QTabWidget(this);
    for (const GridTab& tab : kGridTabs) {
        auto* table = new QTableWidget(tabs_);
        table->setObjectName(tab.name);
        // Row 0 and column 0 are the grid's own captions, so Qt's headers would only repeat numbers.
        table->horizontalHeader()->hide();
        table->verticalHeader()->hide();
        table->setAlternatingRowColors(true);
        connect(table, &QTableWidget::cellChanged, this,
                [this, table](int row, int col) { onCellChanged(table, row, col); });
        tabs_->addTab(table, tr(tab.title));
    }

    lblTotals_ = new QLabel(this);
    lblTotals_->setObjectName("lblTotals");
    lblTotals_->setTextInteractionFlags(Qt::TextSelectableByMouse);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(range);
    layout->addWidget(tabs_, 1);
    layout->addWidget(lblTotals_);
}

QTableWidget* ReportForm::grid(const QString& name) const { return findChild<QTableWidget*>(name); }

void ReportForm::fill(const ReportData& data)
{
    filling_ = true;
    for (const GridTab& tab : kGridTabs) fillGrid(grid(tab.name), data.grids.value(tab.name));
    dtpFromDate_->setDate(data.fromDate);
    dtpToDate_->setDate(data.toDate);
    cboFields_->clear();
    cboFields_->addItems(data.fields);
    filling_ = false;
    showTotals();
}

void ReportForm::fillGrid(QTableWidget* table, const GridData& data)
{
    const int rows = data.cells.size(), cols = rows ? data.cells.front().size() : 0;
    table->clearContents();
    table->setRowCount(rows);
    table->setColumnCount(cols);
    table->setProperty("FixedRows", data.fixedRows);
    QFont bold = table->font();
    bold.setBold(true);
    for (int r = 0; r < rows; ++r)
        for (int c = 0; c < cols; ++c) {
            auto* item = new QTableWidgetItem(data.cells[r].value(c));
            if (r < data.fixedRows || c == 0) {
                // Captions belong to the report's layout, not to its figures.
                item->setFlags(item->flags() & ~Qt::ItemIsEditable);
                item->setFont(bold);
                item->setBackground(table->palette().button());
            } else {
                item->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
            }
            table->setItem(r, c, item);
        }
    table->resizeColumnsToContents();
}

void ReportForm::onCellChanged(QTableWidget* table, int row, int col)
{
    if (filling_) return;
    filling_ = true;
    const QString name = table->objectName();
    if ((name == "grid1" || name == "grid2") && row >= fixedRowsOf(table)) keepDerivedFigures(row, col);
    filling_ = false;
    showTotals();
}

void ReportForm::keepDerivedFigures(int row, int col)
{
    QTableWidget* counts = grid("grid1");
    QTableWidget* values = grid("grid2");
    QTableWidget* averages = grid("grid3");
    auto put = [](QTableWidget* table, int r, int c, double v) {
        if (QTableWidgetItem* item = table->item(r, c)) item->setText(numberCellText(v));
    };
    const GridCells c1 = cellsOf(counts), c2 = cellsOf(values), c3 = cellsOf(averages);
    if (!isMonthColumn(c1, col) || !isMonthColumn(c2, col)) return;
    const int total1 = totalColumn(c1), total2 = totalColumn(c2), total3 = totalColumn(c3);
    if (row < c1.rows && total1 > 0) put(counts, row, total1, rowMonthSum(c1, row));
    if (row < c2.rows && total2 > 0) put(values, row, total2, rowMonthSum(c2, row));
    // grid3 holds value per booking, cell by cell and for the row, so it follows both grids.
    if (row >= c1.rows || row >= c2.rows || row >= c3.rows) return;
    double count = 0, value = 0;
    readCellNumber(c1.text(row, col), count);
    readCellNumber(c2.text(row, col), value);
    if (col < c3.cols) put(averages, row, col, average(value, count));
    if (total3 > 0) put(averages, row, total3, average(rowMonthSum(c2, row), rowMonthSum(c1, row)));
}

ReportTotals ReportForm::totals() const { return reportTotals(cellsOf(grid("grid1")), cellsOf(grid("grid2"))); }

int ReportForm::dataRows(const QString& gridName) const
{
    const QTableWidget* table = grid(gridName);
    return table ? table->rowCount() - fixedRowsOf(table) : 0;
}

void ReportForm::showTotals()
{
    const ReportTotals t = totals();
    lblTotals_->setText(tr("Totals: %1 bookings, value %2, average value %3")
                            .arg(numberCellText(t.quantity), numberCellText(t.value), numberCellText(t.average)));
    emit totalsChanged();
}

}  // namespace kg::demo

#pragma once
// The report screen's contents as the sample's form file holds them: four grids of cell texts,
// the date range and the field list.
#include <QDate>
#include <QMap>
#include <QString>
#include <QStringList>
#include <QVector>

namespace kg::demo {

struct GridData {
    int fixedRows = 1;
    QVector<QStringList> cells;  // rows of cell texts; every row as long as the first
};

struct ReportData {
    QMap<QString, GridData> grids;  // grid1, grid2, grid3, gridsettings1
    QDate fromDate, toDate;
    QStringList fields;  // cboFields(1)
};

// Reads a form file; false and `why` (naming the file and the member) when it is not one.
bool loadReportData(const QString& path, ReportData& out, QString& why);

}  // namespace kg::demo

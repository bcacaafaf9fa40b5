#include "apps/demo/ReportData.h"

#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

#include "apps/demo/ReportTotals.h"

namespace kg::demo {

namespace {

const char* const kGridNames[] = {"grid1", "grid2", "grid3", "gridsettings1"};

QString cellText(const QJsonValue& v)
{
    if (v.isDouble()) return numberCellText(v.toDouble());
    if (v.isString()) return v.toString();
    return QString();  // null: an empty cell
}

bool readGrid(const QJsonObject& json, const QString& where, GridData& grid, QString& why)
{
    grid.fixedRows = json.value("fixedRows").toInt(1);
    const QJsonArray rows = json.value("cells").toArray();
    for (int r = 0; r < rows.size(); ++r) {
        if (!rows[r].isArray()) {
            why = where + ": row " + QString::number(r) + " is not a list of cells";
            return false;
        }
        QStringList row;
        for (const QJsonValue& cell : rows[r].toArray()) row << cellText(cell);
        if (r > 0 && row.size() != grid.cells.front().size()) {
            why = where + ": row " + QString::number(r) + " has " + QString::number(row.size()) + " cells, not " +
                  QString::number(grid.cells.front().size());
            return false;
        }
        grid.cells << row;
    }
    return true;
}

bool readDate(const QJsonObject& form, const char* name, const QString& file, QDate& out, QString& why)
{
    out = QDate::fromString(form.value(name).toString(), Qt::ISODate);
    if (!out.isValid()) why = file + ": " + name + " is not a YYYY-MM-DD date";
    return out.isValid();
}

}  // namespace

bool loadReportData(const QString& path, ReportData& out, QString& why)
{
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        why = "cannot read " + path + ": " + file.errorString();
        return false;
    }
    QJsonParseError error{};
    const QJsonDocument doc = QJsonDocument::fromJson(file.readAll(), &error);
    if (!doc.isObject()) {
        why = path + " is not a form file: " + error.errorString();
        return false;
    }
    const QJsonObject form = doc.object();
    ReportData data;
    for (const char* name : kGridNames)
        if (!readGrid(form.value(name).toObject(), path + ": " + name, data.grids[name], why)) return false;
    if (!readDate(form, "dtpFromDate", path, data.fromDate, why) || !readDate(form, "dtpToDate", path, data.toDate, why))
        return false;
    for (const QJsonValue& v : form.value("cboFields").toObject().value("1").toArray()) data.fields << v.toString();
    out = data;
    return true;
}

}  // namespace kg::demo

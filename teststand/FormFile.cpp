// Loading a form file: the whole JSON document is checked and turned into the form's objects at
// once, so a malformed file is refused before any request reads from it.
#include <cmath>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

#include "core/Convert.h"
#include "core/Date.h"
#include "core/Error.h"
#include "teststand/SourceForm.h"
#include "teststand/TestStand.h"

namespace kg::teststand {

namespace {

class FormReader {
public:
    FormReader(std::string name, QString folder) : name_(std::move(name)), folder_(std::move(folder)) {}

    FormData read(const QByteArray& json)
    {
        QJsonParseError err{};
        QJsonDocument doc = QJsonDocument::fromJson(json, &err);
        if (err.error != QJsonParseError::NoError)
            fail("is not valid JSON: " + err.errorString().toStdString() + " at " + position(json, err.offset));
        if (!doc.isObject()) fail("must hold one JSON object with the form's members");
        const QJsonObject top = doc.object();

        FormData form;
        for (const char* g : kGridMembers)
            if (top.contains(QLatin1String(g))) form.grids[g] = grid(g, top.value(QLatin1String(g)));
        for (const char* p : kPickerMembers)
            if (top.contains(QLatin1String(p))) form.pickers[p] = date(p, top.value(QLatin1String(p)));
        if (top.contains(QLatin1String(kFieldListMember))) {
            form.hasFieldLists = true;
            form.fieldLists = fieldLists(top.value(QLatin1String(kFieldListMember)));
        }
        if (top.contains(QLatin1String("jobsDatabase"))) {
            const QJsonValue db = top.value(QLatin1String("jobsDatabase"));
            if (!db.isString() || db.toString().isEmpty())
                fail("jobsDatabase", "must be the name of the database file");
            form.jobsDatabase = QDir::cleanPath(QDir(folder_).absoluteFilePath(db.toString())).toStdString();
        }
        return form;
    }

private:
    [[noreturn]] void fail(const std::string& problem) const
    {
        throw Error::host(hosterr::FormFile, "Form file \"" + name_ + "\" " + problem, "Form");
    }
    [[noreturn]] void fail(const std::string& member, const std::string& problem) const
    {
        throw Error::host(hosterr::FormFile, "Form file \"" + name_ + "\": " + member + ": " + problem, "Form");
    }

    static std::string position(const QByteArray& json, int offset)
    {
        int line = 1, column = 1;
        for (int i = 0; i < offset && i < json.size(); ++i) {
            if (json[i] == '\n') {
                ++line;
                column = 1;
            } else {
                ++column;
            }
        }
        return "line " + std::to_string(line) + ", column " + std::to_string(column);
    }

    static const char* kindOf(const QJsonValue& v)
    {
        switch (v.type()) {
        case QJsonValue::Null: return "null";
        case QJsonValue::Bool: return "true or false";
        case QJsonValue::Double: return "a number";
        case QJsonValue::String: return "a text";
        case QJsonValue::Array: return "a list";
        case QJsonValue::Object: return "an object";
        case QJsonValue::Undefined: break;
        }
        return "nothing";
    }

    GridData grid(const std::string& member, const QJsonValue& value) const
    {
        if (!value.isObject()) fail(member, std::string("must be an object with \"cells\", not ") + kindOf(value));
        const QJsonObject g = value.toObject();
        const QJsonValue cells = g.value(QLatin1String("cells"));
        if (!cells.isArray()) fail(member, std::string("must have \"cells\" as a list of rows, not ") + kindOf(cells));
        const QJsonArray rows = cells.toArray();

        GridData d;
        d.rows = static_cast<int32_t>(rows.size());
        d.cols = rows.isEmpty() || !rows.at(0).isArray() ? 0 : static_cast<int32_t>(rows.at(0).toArray().size());
        d.texts.reserve(static_cast<size_t>(d.rows) * static_cast<size_t>(d.cols));
        d.values.reserve(d.texts.capacity());
        for (int32_t r = 0; r < d.rows; ++r) {
            const std::string row = member + ", row " + std::to_string(r);
            const QJsonValue rowValue = rows.at(r);
            if (!rowValue.isArray()) fail(row, std::string("must be a list of cells, not ") + kindOf(rowValue));
            const QJsonArray rowCells = rowValue.toArray();
            if (rowCells.size() != d.cols)
                fail(row, "has " + std::to_string(rowCells.size()) + " cells, but row 0 has " + std::to_string(d.cols));
            for (int32_t c = 0; c < d.cols; ++c) {
                const QJsonValue cell = rowCells.at(c);
                if (cell.isString()) {
                    d.texts.push_back(cell.toString().toStdString());
                    d.values.emplace_back(d.texts.back());
                } else if (cell.isDouble()) {
                    d.values.emplace_back(cell.toDouble());
                    d.texts.push_back(toText(d.values.back()));
                } else if (cell.isNull()) {
                    d.texts.emplace_back();
                    d.values.push_back(Variant::null());
                } else {
                    fail(member + ", row " + std::to_string(r) + ", column " + std::to_string(c),
                         std::string("must be a text, a number or null, not ") + kindOf(cell));
                }
            }
        }

        d.fixedRows = d.rows > 0 ? 1 : 0;
        if (g.contains(QLatin1String("fixedRows"))) {
            const QJsonValue f = g.value(QLatin1String("fixedRows"));
            const double n = f.toDouble(-1);
            if (!f.isDouble() || n < 0 || n > d.rows || n != std::floor(n))
                fail(member, "fixedRows must be a whole number from 0 to the number of rows (" +
                                 std::to_string(d.rows) + ")");
            d.fixedRows = static_cast<int32_t>(n);
        }
        return d;
    }

    double date(const std::string& member, const QJsonValue& value) const
    {
        const std::optional<double> serial =
            value.isString() ? parseIsoDate(value.toString().toStdString()) : std::nullopt;
        if (!serial) {
            const std::string shown = value.isString() ? "\"" + value.toString().toStdString() + "\"" : kindOf(value);
            fail(member, "must be a date written YYYY-MM-DD, not " + shown);
        }
        return *serial;
    }

    std::map<int32_t, std::vector<std::string>> fieldLists(const QJsonValue& value) const
    {
        const std::string member = kFieldListMember;
        if (!value.isObject())
            fail(member, std::string("must be an object of lists by index, as {\"1\": [...]}, not ") + kindOf(value));
        std::map<int32_t, std::vector<std::string>> lists;
        const QJsonObject byIndex = value.toObject();
        for (auto it = byIndex.begin(); it != byIndex.end(); ++it) {
            bool ok = false;
            const int32_t index = it.key().toInt(&ok);
            const std::string at = member + "(" + it.key().toStdString() + ")";
            if (!ok || index < 0) fail(at, "must be indexed by a whole number from 0");
            if (!it.value().isArray()) fail(at, std::string("must be a list of entries, not ") + kindOf(it.value()));
            const QJsonArray entries = it.value().toArray();
            std::vector<std::string>& list = lists[index];
            for (int i = 0; i < entries.size(); ++i) {
                const QJsonValue e = entries.at(i);
                if (e.isString())
                    list.push_back(e.toString().toStdString());
                else if (e.isDouble())
                    list.push_back(toText(Variant(e.toDouble())));
                else
                    fail(at + ", entry " + std::to_string(i), std::string("must be a text, not ") + kindOf(e));
            }
        }
        return lists;
    }

    std::string name_;
    QString folder_;
};

}  // namespace

Ref<Object> loadFormJson(const std::string& jsonText, const std::string& nameForErrors)
{
    FormReader reader(nameForErrors, QDir::currentPath());
    return makeForm(reader.read(QByteArray::fromStdString(jsonText)), "SourceForm");
}

Ref<Object> loadFormFile(const std::string& path)
{
    const QString file = QString::fromStdString(path);
    const QFileInfo info(file);
    if (!info.exists())
        throw Error(errc::FileNotFound, "File not found: form file \"" + path + "\" does not exist", "Form");
    QFile f(file);
    if (info.isDir() || !f.open(QIODevice::ReadOnly))
        throw Error(errc::PathFileAccess, "Path/File access error: form file \"" + path + "\" cannot be read", "Form");
    const QByteArray json = f.readAll();
    if (f.error() != QFileDevice::NoError)
        throw Error(errc::PathFileAccess,
                    "Path/File access error: form file \"" + path + "\": " + f.errorString().toStdString(), "Form");
    FormReader reader(path, info.absolutePath());
    return makeForm(reader.read(json), "SourceForm");
}

std::string jobsDatabaseOf(const Ref<Object>& form) { return formJobsDatabase(form.get()); }

}  // namespace kg::teststand

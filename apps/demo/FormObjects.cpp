#include "apps/demo/FormObjects.h"

#include <QComboBox>
#include <QDate>
#include <QDateEdit>
#include <QLocale>
#include <QPointer>
#include <QTableWidget>

#include "apps/demo/HostObject.h"

namespace kg::demo {

namespace {

int32_t unloaded(KGErrorInfo* error, const std::string& name)
{
    return HostObject::raise(error, vberr::ObjectUnloaded, "Object was unloaded: " + name + " is no longer on the form");
}

class GridObject final : public HostObject {
public:
    GridObject(const ComponentApi& api, QTableWidget* table, std::string name)
        : HostObject(api, {"Rows", "FixedRows", "cols", "textmatrix", "GetValueFromCell"}), table_(table),
          name_(std::move(name))
    {
    }

private:
    enum { kRows = 1, kFixedRows, kCols, kTextMatrix, kGetValueFromCell };
    ~GridObject() override = default;

    int32_t call(int32_t id, KGVariant* args, uint32_t argc, KGVariant* result, KGErrorInfo* error) override
    {
        if (!table_) return unloaded(error, name_);
        const bool isCell = id == kTextMatrix || id == kGetValueFromCell;
        if (argc != (isCell ? 2u : 0u)) return KG_E_BADPARAMCOUNT;
        switch (id) {
        case kRows: return returnLong(result, table_->rowCount());
        case kFixedRows: return returnLong(result, fixedRows());
        case kCols: return returnLong(result, table_->columnCount());
        default: break;
        }
        int32_t row = 0, col = 0;
        if (!wholeNumber(args[0], row) || !wholeNumber(args[1], col)) return KG_E_TYPEMISMATCH;
        if (row < 0 || row >= table_->rowCount() || col < 0 || col >= table_->columnCount())
            return raise(error, vberr::SubscriptOutOfRange,
                         "Subscript out of range: " + name_ + (id == kTextMatrix ? ".textmatrix(" : ".GetValueFromCell(") +
                             std::to_string(row) + ", " + std::to_string(col) +
                             ") is outside its " + std::to_string(table_->rowCount()) + " rows and " +
                             std::to_string(table_->columnCount()) + " columns");
        const QTableWidgetItem* item = table_->item(row, col);
        const QString text = item ? item->text() : QString();
        if (id == kTextMatrix) return returnString(result, text.toStdString());
        if (result) cellValue(api_, text, result);
        return KG_S_OK;
    }

    int32_t fixedRows() const
    {
        const QVariant v = table_->property("FixedRows");
        return v.isValid() ? v.toInt() : 1;
    }

    QPointer<QTableWidget> table_;
    std::string name_;
};

class PickerObject final : public HostObject {
public:
    PickerObject(const ComponentApi& api, QDateEdit* picker, std::string name)
        : HostObject(api, {"Value"}), picker_(picker), name_(std::move(name))
    {
    }

private:
    ~PickerObject() override = default;

    int32_t call(int32_t, KGVariant*, uint32_t argc, KGVariant* result, KGErrorInfo* error) override
    {
        if (!picker_) return unloaded(error, name_);
        if (argc != 0) return KG_E_BADPARAMCOUNT;
        return returnDouble(result, KG_VT_DATE, dateSerial(picker_->date()));
    }

    QPointer<QDateEdit> picker_;
    std::string name_;
};

class ListObject final : public HostObject {
public:
    ListObject(const ComponentApi& api, QComboBox* list, std::string name)
        : HostObject(api, {"ListCount", "List"}), list_(list), name_(std::move(name))
    {
    }

private:
    enum { kListCount = 1, kList };
    ~ListObject() override = default;

    int32_t call(int32_t id, KGVariant* args, uint32_t argc, KGVariant* result, KGErrorInfo* error) override
    {
        if (!list_) return unloaded(error, name_);
        if (id == kListCount) return argc == 0 ? returnLong(result, list_->count()) : KG_E_BADPARAMCOUNT;
        if (argc != 1) return KG_E_BADPARAMCOUNT;
        int32_t i = 0;
        if (!wholeNumber(args[0], i)) return KG_E_TYPEMISMATCH;
        if (i < 0 || i >= list_->count())
            return raise(error, vberr::InvalidArrayIndex,
                         "Invalid property array index: " + name_ + ".List(" + std::to_string(i) + ") of " +
                             std::to_string(list_->count()) + " entries");
        return returnString(result, list_->itemText(i).toStdString());
    }

    QPointer<QComboBox> list_;
    std::string name_;
};

class FormObject final : public HostObject {
public:
    FormObject(const ComponentApi& api, QWidget* screen)
        : HostObject(api, {"grid1", "grid2", "grid3", "gridsettings1", "dtpFromDate", "dtpToDate", "cboFields"}),
          screen_(screen)
    {
    }

private:
    enum { kGrid1 = 1, kGrid2, kGrid3, kGridSettings1, kFromDate, kToDate, kFields };
    ~FormObject() override = default;

    int32_t call(int32_t id, KGVariant* args, uint32_t argc, KGVariant* result, KGErrorInfo* error) override
    {
        if (!screen_) return unloaded(error, "the report form");
        static const char* const names[] = {"", "grid1", "grid2", "grid3", "gridsettings1", "dtpFromDate",
                                            "dtpToDate", "cboFields_1"};
        const QString widgetName = names[id];
        HostObject* member = nullptr;
        if (id == kFields) {
            if (argc != 1) return KG_E_BADPARAMCOUNT;
            int32_t index = 0;
            if (!wholeNumber(args[0], index)) return KG_E_TYPEMISMATCH;
            if (index != 1)
                return raise(error, vberr::ControlArrayElement,
                             "Control array element '" + std::to_string(index) + "' doesn't exist: cboFields has only element 1");
            auto* list = screen_->findChild<QComboBox*>(widgetName);
            if (!list) return unloaded(error, "cboFields(1)");
            member = new ListObject(api_, list, "cboFields(1)");
        } else {
            if (argc != 0) return KG_E_BADPARAMCOUNT;
            if (id == kFromDate || id == kToDate) {
                auto* picker = screen_->findChild<QDateEdit*>(widgetName);
                if (!picker) return unloaded(error, names[id]);
                member = new PickerObject(api_, picker, names[id]);
            } else {
                auto* table = screen_->findChild<QTableWidget*>(widgetName);
                if (!table) return unloaded(error, names[id]);
                member = new GridObject(api_, table, names[id]);
            }
        }
        // The result takes a reference of its own; ours, from creation, is let go.
        const int32_t status = returnObject(result, member->object());
        api_.Release(member->object());
        return status;
    }

    QPointer<QWidget> screen_;
};

}  // namespace

KGObject* makeSourceForm(const ComponentApi& api, QWidget* screen) { return (new FormObject(api, screen))->object(); }

double dateSerial(const QDate& date) { return double(QDate(1899, 12, 30).daysTo(date)); }

void cellValue(const ComponentApi& api, const QString& text, KGVariant* out)
{
    api.VariantClear(out);
    const QString trimmed = text.trimmed();
    if (trimmed.isEmpty()) {
        out->vt = KG_VT_NULL;
        return;
    }
    bool isNumber = false;
    const double number = QLocale::c().toDouble(trimmed, &isNumber);
    if (isNumber) {
        out->vt = KG_VT_R8;
        out->dblVal = number;
        return;
    }
    api.VariantSetString(out, text.toStdString().c_str());
}

}  // namespace kg::demo

// The source form as the component reaches it: members by name without regard to case, the
// values of grids, pickers and the field list, and the errors a host raises for a bad call.
#include <QComboBox>
#include <QDateEdit>
#include <QTableWidget>
#include <variant>

#include "DemoSupport.h"
#include "apps/demo/FormObjects.h"
#include "apps/demo/ReportForm.h"

namespace {

using namespace demo_test;
using kg::demo::ComponentApi;
using kg::demo::ComponentLibrary;

const ComponentApi& api()
{
    static ComponentLibrary library;
    if (!library.isOpen()) {
        std::string why;
        if (!library.open(componentLibrary().toStdString(), why)) ADD_FAILURE() << why;
    }
    return library.api();
}

kg::demo::ReportData sampleReport()
{
    kg::demo::ReportData d;
    d.grids["grid1"].cells = {{"Agent", "Jan", "Feb", "Total"}, {"A", "12", "", "12"}, {"B", "n/a", "1.5", "1.5"}};
    d.grids["grid2"].cells = {{"Agent", "Jan"}, {"A", "3"}};
    d.grids["grid3"].cells = {{"Agent", "Jan"}};
    d.grids["gridsettings1"].fixedRows = 2;
    d.grids["gridsettings1"].cells = {{"Quote Type", "Qty"}, {"", ""}, {"Retail", "-4.25"}};
    d.fromDate = QDate(2026, 1, 1);
    d.toDate = QDate(1899, 12, 29);
    d.fields = {"Unconfirmed", "Unscheduled"};
    return d;
}

// One step of a late-bound path: a member and its arguments (whole numbers, or texts).
struct Step {
    const char* member;
    std::vector<std::variant<int32_t, double, const char*>> args;
};

struct Expected {
    int32_t status = KG_S_OK;
    uint16_t vt = KG_VT_EMPTY;
    std::variant<std::monostate, int32_t, double, const char*> value;
    int32_t errorNumber = 0;
};

struct PathCase {
    const char* name;
    std::vector<Step> path;
    Expected expected;
};

// Follows the path from the form, as the component does: GetIDOfName, then Invoke as method or
// property get, each object handed on to the next step.
struct Reached {
    int32_t status = KG_S_OK;
    KGVariant value;
    KGErrorInfo error{};
};

Reached follow(KGObject* form, const std::vector<Step>& path)
{
    Reached r;
    api().VariantInit(&r.value);
    KGObject* at = form;
    api().VariantSetObject(&r.value, at);
    for (const Step& step : path) {
        if (r.value.vt != KG_VT_OBJECT || !r.value.objVal) {
            r.status = KG_E_FAIL;
            return r;
        }
        KGObject* object = r.value.objVal;
        object->vtbl->AddRef(object);
        int32_t id = 0;
        r.status = object->vtbl->GetIDOfName(object, step.member, &id);
        if (KG_SUCCEEDED(r.status)) {
            std::vector<KGVariant> args(step.args.size());
            for (size_t i = 0; i < args.size(); ++i) {
                api().VariantInit(&args[i]);
                if (auto* n = std::get_if<int32_t>(&step.args[i])) {
                    args[i].vt = KG_VT_I4;
                    args[i].lVal = *n;
                } else if (auto* d = std::get_if<double>(&step.args[i])) {
                    args[i].vt = KG_VT_R8;
                    args[i].dblVal = *d;
                } else {
                    api().VariantSetString(&args[i], std::get<const char*>(step.args[i]));
                }
            }
            api().VariantClear(&r.value);
            r.status = object->vtbl->Invoke(object, id, KG_DISPATCH_METHOD | KG_DISPATCH_PROPERTYGET, args.data(),
                                            uint32_t(args.size()), &r.value, &r.error);
            for (KGVariant& a : args) api().VariantClear(&a);
        }
        object->vtbl->Release(object);
        if (KG_FAILED(r.status)) return r;
    }
    return r;
}

void PrintTo(const PathCase& c, std::ostream* os) { *os << c.name; }

class FormFixture : public ::testing::Test {
protected:
    void SetUp() override
    {
        screen.fill(sampleReport());
        form = kg::demo::makeSourceForm(api(), &screen);
    }
    void TearDown() override { api().Release(form); }

    kg::demo::ReportForm screen;
    KGObject* form = nullptr;
};

class FormObjectsTest : public FormFixture, public ::testing::WithParamInterface<PathCase> {};

TEST_P(FormObjectsTest, AnswersAsTheHostsControlsDo)
{
    const PathCase& c = GetParam();
    Reached r = follow(form, c.path);
    const Expected& e = c.expected;
    EXPECT_EQ(r.status, e.status);
    if (e.status == KG_E_EXCEPTION) {
        EXPECT_EQ(r.error.number, e.errorNumber) << r.error.description;
    }
    if (KG_SUCCEEDED(e.status)) {
        EXPECT_EQ(r.value.vt, e.vt);
        if (auto* n = std::get_if<int32_t>(&e.value)) {
            EXPECT_EQ(r.value.lVal, *n);
        } else if (auto* d = std::get_if<double>(&e.value)) {
            EXPECT_DOUBLE_EQ(r.value.dblVal, *d);
        } else if (auto* s = std::get_if<const char*>(&e.value)) {
            EXPECT_STREQ(r.value.strVal, *s);
        }
    }
    api().VariantClear(&r.value);
}

Expected longValue(int32_t n) { return {KG_S_OK, KG_VT_I4, n, 0}; }
Expected text(const char* s) { return {KG_S_OK, KG_VT_STRING, s, 0}; }
Expected number(uint16_t vt, double d) { return {KG_S_OK, vt, d, 0}; }
Expected raised(int32_t number) { return {KG_E_EXCEPTION, KG_VT_EMPTY, {}, number}; }
Expected status(int32_t s) { return {s, KG_VT_EMPTY, {}, 0}; }

const PathCase kPaths[] = {
    {"NamesIgnoreCase", {{"GRID1", {}}, {"ROWS", {}}}, longValue(3)},
    {"FixedRows", {{"grid1", {}}, {"FixedRows", {}}}, longValue(1)},
    {"FixedRowsAsTheFormFileSays", {{"gridsettings1", {}}, {"fixedrows", {}}}, longValue(2)},
    {"Cols", {{"grid1", {}}, {"cols", {}}}, longValue(4)},
    {"HalfIndexGoesToEven", {{"grid1", {}}, {"textmatrix", {0.5, 1.5}}}, text("Feb")},
    {"IndexAsText", {{"grid1", {}}, {"textmatrix", {"1", "1"}}}, text("12")},
    {"EmptyCellText", {{"grid1", {}}, {"textmatrix", {1, 2}}}, text("")},
    {"ValueIsANumber", {{"gridsettings1", {}}, {"GetValueFromCell", {2, 1}}}, number(KG_VT_R8, -4.25)},
    {"EmptyValueIsNull", {{"grid1", {}}, {"GetValueFromCell", {1, 2}}}, {KG_S_OK, KG_VT_NULL, {}, 0}},
    {"TextValueStaysText", {{"grid1", {}}, {"GetValueFromCell", {2, 1}}}, text("n/a")},
    {"RowPastTheEnd", {{"grid1", {}}, {"textmatrix", {3, 0}}}, raised(9)},
    {"NegativeColumn", {{"grid1", {}}, {"textmatrix", {0, -1}}}, raised(9)},
    {"ValuePastTheEnd", {{"grid2", {}}, {"GetValueFromCell", {1, 2}}}, raised(9)},
    {"IndexNotANumber", {{"grid1", {}}, {"textmatrix", {"first", 0}}}, status(KG_E_TYPEMISMATCH)},
    {"CellWithoutColumn", {{"grid1", {}}, {"textmatrix", {1}}}, status(KG_E_BADPARAMCOUNT)},
    {"RowsWithAnArgument", {{"grid1", {}}, {"Rows", {1}}}, status(KG_E_BADPARAMCOUNT)},
    {"UnknownGridMember", {{"grid1", {}}, {"TextArray", {0}}}, status(KG_E_UNKNOWNNAME)},
    {"UnknownFormMember", {{"grid4", {}}}, status(KG_E_UNKNOWNNAME)},
    {"FromDate", {{"dtpFromDate", {}}, {"Value", {}}}, number(KG_VT_DATE, 46023)},
    {"DateBeforeTheEpoch", {{"dtpToDate", {}}, {"value", {}}}, number(KG_VT_DATE, -1)},
    {"FieldCount", {{"cboFields", {1}}, {"ListCount", {}}}, longValue(2)},
    {"FieldText", {{"CBOFIELDS", {1}}, {"List", {1}}}, text("Unscheduled")},
    {"FieldPastTheEnd", {{"cboFields", {1}}, {"List", {2}}}, raised(381)},
    {"OtherControlArrayElement", {{"cboFields", {0}}}, raised(340)},
    {"ControlArrayWithoutIndex", {{"cboFields", {}}}, status(KG_E_BADPARAMCOUNT)},
};
INSTANTIATE_TEST_SUITE_P(Members, FormObjectsTest, ::testing::ValuesIn(kPaths),
                         [](const auto& info) { return std::string(info.param.name); });

// --- Lifetime ---------------------------------------------------------------------------------

TEST(FormObjectLifetimeTest, AGridWhoseTableIsGoneRaisesObjectUnloaded)
{
    auto* screen = new kg::demo::ReportForm;
    screen->fill(sampleReport());
    KGObject* form = kg::demo::makeSourceForm(api(), screen);
    Reached grid = follow(form, {{"grid1", {}}});
    ASSERT_EQ(grid.value.vt, KG_VT_OBJECT);
    delete screen;

    Reached rows = follow(grid.value.objVal, {{"Rows", {}}});
    EXPECT_EQ(rows.status, KG_E_EXCEPTION);
    EXPECT_EQ(rows.error.number, 364) << rows.error.description;
    Reached again = follow(form, {{"grid1", {}}});
    EXPECT_EQ(again.error.number, 364) << again.error.description;
    for (Reached* r : {&grid, &rows, &again}) api().VariantClear(&r->value);
    api().Release(form);
}

TEST_F(FormFixture, WritesAreNotMembers)
{
    int32_t id = 0;
    ASSERT_EQ(form->vtbl->GetIDOfName(form, "grid1", &id), KG_S_OK);
    KGVariant arg;
    api().VariantInit(&arg);
    EXPECT_EQ(form->vtbl->Invoke(form, id, KG_DISPATCH_PROPERTYPUT, &arg, 1, nullptr, nullptr), KG_E_MEMBERNOTFOUND);
}

}  // namespace

// cTavixGraph driven as a host drives it, through the C entry points and the dispatch ids only:
// SourceForm, GraphInitialize and the grid requests, with the test stand's form files and with a
// form the host made itself.
#include <algorithm>
#include <functional>

#include "capi/CapiSupport.h"
#include "capi/HostForm.h"

namespace {

using namespace capi_test;

constexpr int32_t kHostError = static_cast<int32_t>(0x80040000u);

// --- GraphInitialize, and a request with SourceForm Nothing -----------------------------------

TEST_F(GraphTest, GraphInitializeSucceedsAgainAndAgain)
{
    for (int i = 0; i < 3; ++i) {
        KGErrorInfo err;
        Var result;
        EXPECT_EQ(KGInvoke(graph.get(), KG_DISPID_GRAPHINITIALIZE, KG_DISPATCH_METHOD, nullptr, 0, &result.v, &err),
                  KG_S_OK) << describe(err);
        EXPECT_EQ(result.v.vt, KG_VT_EMPTY) << "an operation returns nothing but its status";
    }
}

TEST_F(GraphTest, RequestAfterSourceFormNothingFailsAtTheSourceForm)
{
    KGErrorInfo err;
    ASSERT_EQ(putSourceForm(graph.get(), nullptr, &err), KG_S_OK) << describe(err);
    Var args[2];
    setLong(args[0].v, 2);
    setDouble(args[1].v, 57);
    EXPECT_EQ(request(KG_DISPID_GENERATECHART_PROPGRAPH1, &args[0].v, 2, &err), KG_E_EXCEPTION);
    EXPECT_EQ(err.number, 91) << describe(err);
}

// --- Requests on a form file -------------------------------------------------------------------

using SetArg = std::function<void(KGVariant&)>;

SetArg longArg(int32_t n) { return [n](KGVariant& v) { setLong(v, n); }; }
SetArg doubleArg(double d) { return [d](KGVariant& v) { setDouble(v, d); }; }
SetArg textArg(const char* s) { return [s](KGVariant& v) { KGVariantSetString(&v, s); }; }
SetArg integerArg(int16_t n)
{
    return [n](KGVariant& v) {
        KGVariantClear(&v);
        v.vt = KG_VT_I2;
        v.iVal = n;
    };
}

struct FormRequest {
    const char* name;
    int32_t id;
    SetArg lNumSeries, vTotal;  // both unset: a request without arguments
    int32_t status;
    int32_t number;  // the error's, when the request fails
};

class FormRequestTest : public GraphTest, public ::testing::WithParamInterface<FormRequest> {
protected:
    void SetUp() override
    {
        GraphTest::SetUp();
        KGErrorInfo err;
        ASSERT_EQ(KGLoadFormFile(dataFile("grid1.json").c_str(), form.out(), &err), KG_S_OK) << describe(err);
        ASSERT_EQ(putSourceForm(graph.get(), form.get(), &err), KG_S_OK) << describe(err);
    }
    ObjectRef form;
};

TEST_P(FormRequestTest, EndsWithItsStatusAndLeavesTheArgumentsAsPassed)
{
    const FormRequest& c = GetParam();
    Var args[2], passed[2];
    uint32_t argc = 0;
    if (c.lNumSeries) {
        c.lNumSeries(args[0].v);
        c.vTotal(args[1].v);
        argc = 2;
        for (int i = 0; i < 2; ++i) ASSERT_EQ(KGVariantCopy(&passed[i].v, &args[i].v), KG_S_OK);
    }
    KGErrorInfo err;
    EXPECT_EQ(request(c.id, &args[0].v, argc, &err), c.status) << describe(err);
    if (KG_FAILED(c.status)) {
        EXPECT_EQ(err.number, c.number) << describe(err);
        EXPECT_NE(err.description[0], '\0');
    }
    for (uint32_t i = 0; i < argc; ++i) {
        EXPECT_EQ(args[i].v.vt, passed[i].v.vt) << "argument " << i;
        switch (passed[i].v.vt) {
        case KG_VT_I2: EXPECT_EQ(args[i].v.iVal, passed[i].v.iVal); break;
        case KG_VT_I4: EXPECT_EQ(args[i].v.lVal, passed[i].v.lVal); break;
        case KG_VT_R8: EXPECT_EQ(args[i].v.dblVal, passed[i].v.dblVal); break;
        case KG_VT_STRING: EXPECT_STREQ(args[i].v.strVal, passed[i].v.strVal); break;
        default: break;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(
    Cases, FormRequestTest,
    ::testing::Values(
        FormRequest{"HourlyGraph1", KG_DISPID_GENERATECHART_HOURLYGRAPH1, longArg(2), doubleArg(57), KG_S_OK, 0},
        FormRequest{"YearlyRpt1WithTextTotal", KG_DISPID_GENERATECHART_YEARLYRPT1, longArg(2), textArg("57"), KG_S_OK, 0},
        FormRequest{"YearlyRpt1WithIntegerSeries", KG_DISPID_GENERATECHART_YEARLYRPT1, integerArg(2), longArg(88),
                    KG_S_OK, 0},
        FormRequest{"GridTheFormLacks", KG_DISPID_GENERATECHART_HOURLYGRAPH2, longArg(2), doubleArg(57),
                    KG_E_EXCEPTION, 438},
        FormRequest{"SettingsGridTheFormLacks", KG_DISPID_GENERATECHART_BOOKINGSREPORT, nullptr, nullptr,
                    KG_E_EXCEPTION, 438},
        FormRequest{"DatePickersTheFormLacks", KG_DISPID_GENERATECHART_JOBSTATUSREPORT, nullptr, nullptr,
                    KG_E_EXCEPTION, 438}),
    byName);

// --- Requests on a form the host made ------------------------------------------------------------

// grid1 of the host's form: a caption row and two agents over twelve months and a total.
const char* const kCells[] = {
    "",        "Jan", "Feb", "Mar", "Apr", "May", "Jun", "Jul", "Aug", "Sep", "Oct", "Nov", "Dec", "Total",
    "Agent A", "3",   "5",   "2",   "7",   "4",   "6",   "8",   "1",   "0",   "5",   "9",   "7",   "57",
    "Agent B", "1",   "0",   "4",   "2",   "3",   "3",   "5",   "6",   "2",   "1",   "0",   "4",   "31",
};

struct HostRequest {
    const char* name;
    int32_t rows;         // of grid1; 1: the caption row only
    HostFailure failure;  // a failure with a number of the host's own must reach the caller as it is
    bool emptyTotal;
    int32_t number;        // else the error the request ends with
    const char* mentions;  // and a part of its description
};

class HostFormTest : public GraphTest, public ::testing::WithParamInterface<HostRequest> {
protected:
    void TearDown() override
    {
        GraphTest::TearDown();  // lets go of the form
        EXPECT_EQ(log.alive, 0) << "the component kept a host object";
    }
    HostLog log;
};

TEST_P(HostFormTest, RequestReadsTheGridOrFailsWithTheHostsErrorAsTheHostReportedIt)
{
    const HostRequest& c = GetParam();
    {
        ObjectRef form(makeHostForm(log, c.rows, 1, 14, kCells, c.failure));
        KGErrorInfo err;
        ASSERT_EQ(putSourceForm(graph.get(), form.get(), &err), KG_S_OK) << describe(err);
    }
    EXPECT_EQ(log.alive, 2) << "the component holds the form, the form its grid";
    Var args[2];
    setLong(args[0].v, 2);
    if (!c.emptyTotal) setDouble(args[1].v, 57);
    KGErrorInfo err;
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, &args[0].v, 2, &err),
              c.failure.member ? KG_E_EXCEPTION : KG_S_OK) << describe(err);
    if (!c.failure.member) {
        EXPECT_EQ(args[1].v.vt, c.emptyTotal ? KG_VT_EMPTY : KG_VT_R8);
        if (c.emptyTotal || c.rows == 1) {
            // Nothing to draw: only the number of rows was read.
            EXPECT_EQ(log.calls, (std::vector<std::string>{"grid1", "Rows", "FixedRows"}));
            return;
        }
        // Every cell of the data rows and the captions of the twelve points were read.
        for (const char* cell : {"textmatrix(1,0)", "textmatrix(0,12)", "textmatrix(1,1)", "textmatrix(2,12)"})
            EXPECT_NE(std::find(log.calls.begin(), log.calls.end(), cell), log.calls.end()) << cell;
    } else if (c.failure.number != 0) {
        EXPECT_EQ(err.number, c.failure.number) << describe(err);
        EXPECT_STREQ(err.description, c.failure.description);
        EXPECT_STREQ(err.source, "TavixHost");
    } else {
        EXPECT_EQ(err.number, c.number) << describe(err);
        EXPECT_NE(std::string(err.description).find(c.mentions), std::string::npos) << err.description;
    }
}

const HostFailure kRowsLocked{"Rows", KG_E_EXCEPTION, kHostError + 21, "Grid rows are locked"};

INSTANTIATE_TEST_SUITE_P(
    Cases, HostFormTest,
    ::testing::Values(
        HostRequest{"Succeeds", 3, {}, false, 0, ""},
        HostRequest{"EmptyTotalReadsNoCell", 3, {}, true, 0, ""},
        HostRequest{"NoDataRowsReadsNoCell", 1, {}, false, 0, ""},
        HostRequest{"FormFailsToHandOutTheGrid", 3,
                    {"grid1", KG_E_EXCEPTION, kHostError + 17, "The report grid is being refilled"}, false, 0, ""},
        HostRequest{"RowsFail", 3, kRowsLocked, false, 0, ""},
        HostRequest{"RowsFailEvenWithAnEmptyTotal", 3, kRowsLocked, true, 0, ""},
        HostRequest{"CellFails", 3, {"textmatrix", KG_E_EXCEPTION, kHostError + 30, "Cell (1, 1) cannot be read"},
                    false, 0, ""},
        HostRequest{"HostSaysMemberNotFound", 3, {"Rows", KG_E_MEMBERNOTFOUND, 0, ""}, false, 438, "grid1.Rows"},
        HostRequest{"HostSaysTypeMismatch", 3, {"cols", KG_E_TYPEMISMATCH, 0, ""}, false, 13, "grid1.cols"},
        HostRequest{"HostFailsWithAStatusOfItsOwn", 3, {"textmatrix", KG_E_FAIL, 0, ""}, false, KG_E_FAIL,
                    "Automation error"}),
    byName);

TEST_F(GraphTest, ReplacingTheSourceFormReleasesTheOldOne)
{
    HostLog first, second;
    KGErrorInfo err;
    {
        ObjectRef a(makeHostForm(first, 3, 1, 14, kCells));
        ObjectRef b(makeHostForm(second, 3, 1, 14, kCells));
        ASSERT_EQ(putSourceForm(graph.get(), a.get(), &err), KG_S_OK) << describe(err);
        ASSERT_EQ(putSourceForm(graph.get(), b.get(), &err), KG_S_OK) << describe(err);
    }
    EXPECT_EQ(first.alive, 0);
    EXPECT_EQ(second.alive, 2);
    ASSERT_EQ(putSourceForm(graph.get(), nullptr, &err), KG_S_OK) << describe(err);
    EXPECT_EQ(second.alive, 0);
}

// --- Form files and host options ---------------------------------------------------------------

TEST_F(CapiTest, LoadedFormHandsOutItsGridByNameInAnyCase)
{
    ObjectRef form;
    KGErrorInfo err;
    ASSERT_EQ(KGLoadFormFile(dataFile("grid1.json").c_str(), form.out(), &err), KG_S_OK) << describe(err);
    Var grid, rows;
    ASSERT_EQ(KGInvokeByName(form.get(), "Grid1", KG_DISPATCH_PROPERTYGET, nullptr, 0, &grid.v, &err), KG_S_OK)
        << describe(err);
    ASSERT_EQ(grid.v.vt, KG_VT_OBJECT);
    ASSERT_EQ(KGInvokeByName(grid.v.objVal, "ROWS", KG_DISPATCH_PROPERTYGET, nullptr, 0, &rows.v, &err), KG_S_OK)
        << describe(err);
    EXPECT_EQ(rows.v.vt, KG_VT_I4);
    EXPECT_EQ(rows.v.lVal, 3);
}

struct HostOptionCase {
    const char* name;
    const char* key;
    const char* value;
    int32_t status;
};

class HostOptionTest : public CapiTest, public ::testing::WithParamInterface<HostOptionCase> {};

TEST_P(HostOptionTest, KnownKeysOnly)
{
    const HostOptionCase& c = GetParam();
    EXPECT_EQ(KGSetHostOption(c.key, c.value), c.status);
    KGErrorInfo info;
    EXPECT_EQ(KGGetLastError(&info), KG_FAILED(c.status) && c.key ? KG_S_OK : KG_S_FALSE) << info.description;
    KGSetHostOption(c.key ? c.key : "settingsOwner", nullptr);  // back to the default
}

INSTANTIATE_TEST_SUITE_P(
    Cases, HostOptionTest,
    ::testing::Values(HostOptionCase{"SettingsOwner", "settingsOwner", "Tavix Test", KG_S_OK},
                      HostOptionCase{"EventLogFile", "eventLogFile", "", KG_S_OK},
                      HostOptionCase{"EventLogToStderrYes", "eventLogToStderr", "yes", KG_S_OK},
                      HostOptionCase{"EventLogToStderrZero", "eventLogToStderr", "0", KG_S_OK},
                      HostOptionCase{"EventLogToStderrMaybe", "eventLogToStderr", "maybe", KG_E_INVALIDARG},
                      HostOptionCase{"UnknownKey", "printerName", "x", KG_E_INVALIDARG},
                      HostOptionCase{"NoKey", nullptr, "x", KG_E_POINTER}),
    byName);

}  // namespace

// The source form of a form file: members by name, cells as texts and as values, and malformed
// files refused with the file, member and row named.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "core/Convert.h"
#include "core/Date.h"
#include "core/Error.h"
#include "teststand/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::teststand;

namespace {

const std::string kSample = std::string(KG_TEST_DATA) + "/host/form_sample.json";

Variant grid1() { return call(Variant(loadFormFile(kSample)), "grid1"); }

// One member of the sample form, or of the form `json`, read as text: object(objectArgs).member(args).
struct MemberCase : test::Named {
    const char* object;  // nullptr: the member is the form's own
    Args objectArgs;
    const char* member;
    Args args;
    test::Outcome<std::string> text;
    const char* json = nullptr;
};

class FormMember : public testing::TestWithParam<MemberCase> {};

TEST_P(FormMember, IsFoundWithoutRegardToCase)
{
    const MemberCase& c = GetParam();
    test::expectOutcome(c.text, [&] {
        Variant target(c.json ? loadFormJson(c.json, "inline") : loadFormFile(kSample));
        Args objectArgs = c.objectArgs, args = c.args;
        if (c.object) target = call(target, c.object, objectArgs);
        return toText(call(target, c.member, args));
    });
}

test::Raises missing(const char* member) { return {errc::MemberNotFound, member}; }
const test::Raises kSubscript{errc::SubscriptOutOfRange, ""};
const char* const kTwoGrids = R"({"grid2": {"cells": [["", "A"], ["x", 1]]}, "grid3": {"cells": []}})";

INSTANTIATE_TEST_SUITE_P(
    Sample, FormMember,
    testing::Values(MemberCase{"fixedRows", "GRID1", {}, "fixedrows", {}, "1"},
                    MemberCase{"cols", "grid1", {}, "COLS", {}, "4"},
                    MemberCase{"rowCaption", "Grid1", {}, "TextMatrix", {2, 0}, "Agent B"},
                    MemberCase{"settingsValue", "GridSettings1", {}, "getvaluefromcell", {1, 2}, "1250.5"},
                    MemberCase{"toDate", "DTPTODATE", {}, "value", {}, "31/03/2026"},
                    MemberCase{"lastEntry", "cboFields", {1}, "List", {12}, "Imported"},
                    MemberCase{"entryBeyondList", "cboFields", {1}, "List", {13}, kSubscript},
                    MemberCase{"otherFieldList", nullptr, {}, "cboFields", {2}, kSubscript},
                    MemberCase{"fieldListZero", nullptr, {}, "cboFields", {0}, kSubscript},
                    MemberCase{"fieldListWithoutIndex", nullptr, {}, "cboFields", {},
                               test::Raises{errc::WrongArgumentCount, ""}},
                    MemberCase{"gridTheFileLacks", nullptr, {}, "grid3", {}, missing("grid3")},
                    MemberCase{"formCaption", nullptr, {}, "Caption", {}, missing("Caption")},
                    MemberCase{"jobsDatabase", nullptr, {}, "jobsDatabase", {}, missing("jobsDatabase")},
                    MemberCase{"gridTextArray", "grid1", {}, "TextArray", {0, 0}, missing("TextArray")},
                    MemberCase{"emptyFormGrid", nullptr, {}, "gridsettings1", {}, missing("gridsettings1"), "{}"},
                    MemberCase{"emptyFormPicker", nullptr, {}, "dtpFromDate", {}, missing("dtpFromDate"), "{}"},
                    MemberCase{"emptyFormList", nullptr, {}, "cboFields", {1}, missing("cboFields"), "{}"},
                    // without "fixedRows", one caption row, or none in a grid without rows
                    MemberCase{"defaultFixedRows", "grid2", {}, "FixedRows", {}, "1", kTwoGrids},
                    MemberCase{"noRowsNoFixedRows", "grid3", {}, "FixedRows", {}, "0", kTwoGrids},
                    MemberCase{"noRows", "grid3", {}, "Rows", {}, "0", kTwoGrids},
                    MemberCase{"noRowsNoCols", "grid3", {}, "cols", {}, "0", kTwoGrids}),
    test::RowName{});

}  // namespace

TEST(FormFile, JobsDatabaseResolvesAgainstTheFormFolder)
{
    EXPECT_EQ(jobsDatabaseOf(loadFormFile(kSample)),
              QDir::cleanPath(QString::fromStdString(KG_TEST_DATA) + "/host/jobs.db").toStdString());
    EXPECT_EQ(jobsDatabaseOf(loadFormJson(R"({"jobsDatabase": "/srv/jobs.db"})", "inline")), "/srv/jobs.db");
    EXPECT_EQ(jobsDatabaseOf(loadFormJson("{}", "inline")), "");
}

struct OutsideCase : test::Named {
    int32_t row, col;
};

class CellOutsideTheGrid : public testing::TestWithParam<OutsideCase> {};

TEST_P(CellOutsideTheGrid, IsASubscriptError)
{
    const Variant grid = grid1();
    for (const char* member : {"textmatrix", "GetValueFromCell"}) {
        const Error e = test::errorOf([&] { call(grid, member, {GetParam().row, GetParam().col}); });
        EXPECT_EQ(e.number(), errc::SubscriptOutOfRange) << member;
        EXPECT_NE(e.description().find("grid1"), std::string::npos) << e.description();
    }
}

INSTANTIATE_TEST_SUITE_P(Cells, CellOutsideTheGrid,
                         testing::Values(OutsideCase{"rowBelowZero", -1, 0}, OutsideCase{"rowAtRows", 3, 0},
                                         OutsideCase{"colAtCols", 0, 4}, OutsideCase{"colBelowZero", 0, -1},
                                         OutsideCase{"farAway", 1000, 1000}),
                         test::RowName{});

struct CellCase : test::Named {
    const char* json;
    const char* text;     // textmatrix
    VarType valueType;    // GetValueFromCell
    const char* valueText;  // the value as text, for strings and numbers
};

class CellSemantics : public testing::TestWithParam<CellCase> {};

TEST_P(CellSemantics, TextAndValueOfOneCell)
{
    const CellCase& c = GetParam();
    const std::string json = std::string(R"({"gridsettings1": {"fixedRows": 0, "cells": [[)") + c.json + "]]}}";
    const Variant grid = call(Variant(loadFormJson(json, "cell.json")), "gridsettings1");
    const Variant text = call(grid, "textmatrix", {0, 0});
    ASSERT_EQ(text.type(), VarType::String);
    EXPECT_EQ(text.str(), c.text);
    const Variant value = call(grid, "GetValueFromCell", {0, 0});
    ASSERT_EQ(value.type(), c.valueType);
    if (c.valueType == VarType::String) EXPECT_EQ(value.str(), c.valueText);
    if (c.valueType == VarType::Double) EXPECT_EQ(toText(value), c.valueText);
}

INSTANTIATE_TEST_SUITE_P(
    Cells, CellSemantics,
    testing::Values(CellCase{"fraction", "12.5", "12.5", VarType::Double, "12.5"},
                    CellCase{"negative", "-0.25", "-0.25", VarType::Double, "-0.25"},
                    CellCase{"nullCell", "null", "", VarType::Null, ""},
                    CellCase{"emptyText", R"("")", "", VarType::String, ""},
                    CellCase{"blankText", R"(" 10")", " 10", VarType::String, " 10"},
                    CellCase{"unicodeText", R"("Grüße €")", "Grüße €", VarType::String, "Grüße €"}),
    test::RowName{});

TEST(FormFile, MembersCannotBeAssigned)
{
    EXPECT_EQ(test::errorOf([] { put(grid1(), "Rows", 5); }).number(), errc::InvalidProcedureCall);
}

struct MalformedCase : test::Named {
    const char* json;
    std::vector<const char*> named;  // what the description must name besides the file
};

class MalformedFormFile : public testing::TestWithParam<MalformedCase> {};

TEST_P(MalformedFormFile, IsRefusedNamingFileMemberAndRow)
{
    QTemporaryDir dir(test::tempTemplate("form"));
    ASSERT_TRUE(dir.isValid());
    const std::string path = dir.filePath("form.json").toStdString();
    test::writeBytes(path, GetParam().json);
    const Error e = test::errorOf([&] { loadFormFile(path); });
    EXPECT_EQ(e.number(), errc::HostBase + hosterr::FormFile);
    EXPECT_NE(e.description().find(path), std::string::npos) << e.description();
    for (const char* part : GetParam().named) EXPECT_NE(e.description().find(part), std::string::npos) << e.description();
}

INSTANTIATE_TEST_SUITE_P(
    Files, MalformedFormFile,
    testing::Values(
        MalformedCase{"badJson", "{\n  \"grid1\": {\"cells\": [[1, 2],\n", {"not valid JSON", "line 3"}},
        MalformedCase{"topLevelList", "[1, 2]", {"object"}},
        MalformedCase{"unequalRows", R"({"grid2": {"cells": [["", "A", "B"], ["x", 1, 2], ["y", 3]]}})",
                      {"grid2, row 2", "2 cells", "row 0 has 3"}},
        MalformedCase{"longerRow", R"({"grid1": {"cells": [["", "A"], ["x", 1, 2]]}})", {"grid1, row 1", "3 cells"}},
        MalformedCase{"rowNotAList", R"({"grid3": {"cells": [["", "A"], "x 1"]}})", {"grid3, row 1", "list of cells"}},
        MalformedCase{"cellIsBoolean", R"({"gridsettings1": {"cells": [["", "A", "B"], ["x", 1, true]]}})",
                      {"gridsettings1, row 1, column 2", "true or false"}},
        MalformedCase{"cellIsObject", R"({"grid1": {"cells": [[{}]]}})", {"grid1, row 0, column 0"}},
        MalformedCase{"cellsMissing", R"({"grid3": {"fixedRows": 1}})", {"grid3", "cells"}},
        MalformedCase{"gridNotObject", R"({"grid1": [[1]]})", {"grid1"}},
        MalformedCase{"fixedRowsBeyondRows", R"({"grid1": {"fixedRows": 3, "cells": [["a"], ["b"]]}})",
                      {"grid1", "fixedRows"}},
        MalformedCase{"fixedRowsNotWhole", R"({"grid1": {"fixedRows": 0.5, "cells": [["a"]]}})", {"grid1", "fixedRows"}},
        MalformedCase{"fixedRowsHuge", R"({"grid1": {"fixedRows": 1e300, "cells": [["a"]]}})", {"grid1", "fixedRows"}},
        MalformedCase{"dayThatDoesNotExist", R"({"dtpToDate": "2026-02-30"})", {"dtpToDate", "2026-02-30"}},
        MalformedCase{"dateWrittenDayFirst", R"({"dtpFromDate": "01/02/2026"})", {"dtpFromDate", "01/02/2026"}},
        MalformedCase{"dateAsNumber", R"({"dtpFromDate": 20260101})", {"dtpFromDate", "YYYY-MM-DD"}},
        MalformedCase{"fieldListNotIndexed", R"({"cboFields": ["a", "b"]})", {"cboFields"}},
        MalformedCase{"fieldListBadIndex", R"({"cboFields": {"one": ["a"]}})", {"cboFields(one)"}},
        MalformedCase{"fieldListEntryNull", R"({"cboFields": {"1": ["a", null]}})", {"cboFields(1), entry 1"}},
        MalformedCase{"jobsDatabaseNotText", R"({"jobsDatabase": 5})", {"jobsDatabase"}}),
    test::RowName{});

TEST(FormFile, MissingFileOrFolderIsRefusedNamingThePath)
{
    QTemporaryDir dir(test::tempTemplate("form"));
    const std::pair<std::string, int32_t> cases[] = {{dir.filePath("nothing.json").toStdString(), errc::FileNotFound},
                                                     {dir.path().toStdString(), errc::PathFileAccess}};
    for (const auto& [path, number] : cases) {
        const std::string& file = path;  // a structured binding cannot be captured in C++17
        const Error e = test::errorOf([&] { loadFormFile(file); });
        EXPECT_EQ(e.number(), number) << path;
        EXPECT_NE(e.description().find(path), std::string::npos) << e.description();
    }
}

TEST(FormFile, InlineJsonIsNamedAsGiven)
{
    const Error e = test::errorOf([] { loadFormJson(R"({"grid1": {"cells": [[1], [1, 2]]}})", "inline form"); });
    EXPECT_NE(e.description().find("inline form"), std::string::npos);
    EXPECT_NE(e.description().find("grid1, row 1"), std::string::npos);
}

// The source form of a form file: members by name, cells as texts and as values, and malformed
// files refused with the file, member and row named.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "core/Convert.h"
#include "core/Date.h"
#include "core/Error.h"
#include "host/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::host::teststand;

namespace {

const std::string kSample = std::string(KG_TEST_DATA) + "/host/form_sample.json";

std::string writeFile(const QTemporaryDir& dir, const char* name, const std::string& text)
{
    const QString path = dir.filePath(QString::fromLatin1(name));
    QFile f(path);
    EXPECT_TRUE(f.open(QIODevice::WriteOnly));
    f.write(text.data(), static_cast<qint64>(text.size()));
    return path.toStdString();
}

Variant grid1() { return call(Variant(loadFormFile(kSample)), "grid1"); }

}  // namespace

TEST(FormFile, SampleGridHasItsShape)
{
    const Variant grid = grid1();
    EXPECT_EQ(toLong(call(grid, "Rows")), 3);
    EXPECT_EQ(toLong(call(grid, "FixedRows")), 1);
    EXPECT_EQ(toLong(call(grid, "cols")), 4);
    EXPECT_EQ(call(grid, "textmatrix", {0, 1}).str(), "Jan");
    EXPECT_EQ(call(grid, "textmatrix", {2, 0}).str(), "Agent B");
}

TEST(FormFile, SamplePickersHoldDates)
{
    const Variant form(loadFormFile(kSample));
    const Variant from = call(call(form, "dtpFromDate"), "Value");
    const Variant to = call(call(form, "dtpToDate"), "Value");
    ASSERT_EQ(from.type(), VarType::Date);
    ASSERT_EQ(to.type(), VarType::Date);
    EXPECT_EQ(from.dateSerial(), dateSerial(2026, 1, 1));
    EXPECT_EQ(to.dateSerial(), dateSerial(2026, 3, 31));
}

TEST(FormFile, FieldListOneHoldsTheCaptions)
{
    const Variant list = call(Variant(loadFormFile(kSample)), "cboFields", {1});
    EXPECT_EQ(toLong(call(list, "ListCount")), 13);
    EXPECT_EQ(call(list, "List", {0}).str(), "Unconfirmed");
    EXPECT_EQ(call(list, "List", {12}).str(), "Imported");
    EXPECT_EQ(test::errorOf([&] { call(list, "List", {13}); }).number(), errc::SubscriptOutOfRange);
}

TEST(FormFile, OtherFieldListIndexIsASubscriptError)
{
    const Variant form(loadFormFile(kSample));
    EXPECT_EQ(test::errorOf([&] { call(form, "cboFields", {2}); }).number(), errc::SubscriptOutOfRange);
    EXPECT_EQ(test::errorOf([&] { call(form, "cboFields", {0}); }).number(), errc::SubscriptOutOfRange);
    EXPECT_EQ(test::errorOf([&] { call(form, "cboFields"); }).number(), errc::WrongArgumentCount);
}

TEST(FormFile, JobsDatabaseResolvesAgainstTheFormFolder)
{
    EXPECT_EQ(jobsDatabaseOf(loadFormFile(kSample)), QDir::cleanPath(QString::fromStdString(KG_TEST_DATA) + "/host/jobs.db").toStdString());
    EXPECT_EQ(jobsDatabaseOf(loadFormJson(R"({"jobsDatabase": "/srv/jobs.db"})", "inline")), "/srv/jobs.db");
    EXPECT_EQ(jobsDatabaseOf(loadFormJson("{}", "inline")), "");
}

TEST(FormFile, MembersTheFileLacksAreMissingMembers)
{
    const Variant form(loadFormFile(kSample));
    for (const char* member : {"grid2", "grid3", "Caption", "jobsDatabase"}) {
        const Error e = test::errorOf([&] { call(form, member); });
        EXPECT_EQ(e.number(), errc::MemberNotFound) << member;
        EXPECT_NE(e.description().find(member), std::string::npos) << e.description();
    }
    const Variant empty(loadFormJson("{}", "inline"));
    for (const char* member : {"grid1", "gridsettings1", "dtpFromDate", "cboFields"})
        EXPECT_EQ(test::errorOf([&] { call(empty, member); }).number(), errc::MemberNotFound) << member;
    EXPECT_EQ(test::errorOf([&] { call(grid1(), "TextArray", {0, 0}); }).number(), errc::MemberNotFound);
}

TEST(FormFile, NamesAreMatchedWithoutRegardToCase)
{
    const Variant form(loadFormFile(kSample));
    const Variant grid = call(form, "GRID1");
    EXPECT_EQ(call(grid, "TextMatrix", {1, 0}).str(), "Agent A");
    EXPECT_EQ(toLong(call(grid, "Cols")), 4);
    EXPECT_EQ(toLong(call(grid, "COLS")), 4);
    EXPECT_EQ(toLong(call(grid, "rows")), 3);
    EXPECT_EQ(toLong(call(grid, "fixedrows")), 1);
    EXPECT_EQ(toDouble(call(call(form, "GridSettings1"), "getvaluefromcell", {1, 2})), 1250.5);
    EXPECT_EQ(call(call(form, "DTPTODATE"), "value").type(), VarType::Date);
    EXPECT_EQ(toLong(call(call(form, "CBOFIELDS", {1}), "listcount")), 13);
}

struct OutsideCase {
    const char* name;
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
                         [](const auto& info) { return std::string(info.param.name); });

struct CellCase {
    const char* name;
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
    testing::Values(CellCase{"numericText", R"("12")", "12", VarType::String, "12"},
                    CellCase{"wholeNumber", "12", "12", VarType::Double, "12"},
                    CellCase{"fraction", "12.5", "12.5", VarType::Double, "12.5"},
                    CellCase{"negative", "-0.25", "-0.25", VarType::Double, "-0.25"},
                    CellCase{"zero", "0", "0", VarType::Double, "0"},
                    CellCase{"nullCell", "null", "", VarType::Null, ""},
                    CellCase{"emptyText", R"("")", "", VarType::String, ""},
                    CellCase{"blankText", R"(" 10")", " 10", VarType::String, " 10"},
                    CellCase{"unicodeText", R"("Grüße €")", "Grüße €", VarType::String, "Grüße €"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST(FormFile, GridWithoutFixedRowsDefaultsToOneCaptionRow)
{
    const Variant form(loadFormJson(R"({"grid2": {"cells": [["", "A"], ["x", 1]]}, "grid3": {"cells": []}})", "f"));
    EXPECT_EQ(toLong(call(call(form, "grid2"), "FixedRows")), 1);
    EXPECT_EQ(toLong(call(call(form, "grid3"), "FixedRows")), 0);
    EXPECT_EQ(toLong(call(call(form, "grid3"), "Rows")), 0);
    EXPECT_EQ(toLong(call(call(form, "grid3"), "cols")), 0);
}

TEST(FormFile, MembersCannotBeAssigned)
{
    EXPECT_EQ(test::errorOf([] { put(grid1(), "Rows", 5); }).number(), errc::InvalidProcedureCall);
}

struct MalformedCase {
    const char* name;
    const char* json;
    std::vector<const char*> named;  // what the description must name besides the file
};

class MalformedFormFile : public testing::TestWithParam<MalformedCase> {};

TEST_P(MalformedFormFile, IsRefusedNamingFileMemberAndRow)
{
    QTemporaryDir dir(test::tempTemplate("form"));
    ASSERT_TRUE(dir.isValid());
    const std::string path = writeFile(dir, "form.json", GetParam().json);
    const Error e = test::errorOf([&] { loadFormFile(path); });
    EXPECT_EQ(e.number(), errc::HostBase + hosterr::FormFile);
    EXPECT_NE(e.description().find(path), std::string::npos) << e.description();
    for (const char* part : GetParam().named) EXPECT_NE(e.description().find(part), std::string::npos) << e.description();
}

INSTANTIATE_TEST_SUITE_P(
    Files, MalformedFormFile,
    testing::Values(
        MalformedCase{"badJson", "{\n  \"grid1\": {\"cells\": [[1, 2],\n", {"not valid JSON", "line 3"}},
        MalformedCase{"trailingComma", R"({"grid1": {"cells": [[1, 2],]}})", {"not valid JSON"}},
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
    [](const auto& info) { return std::string(info.param.name); });

TEST(FormFile, MissingFileIsFileNotFound)
{
    QTemporaryDir dir(test::tempTemplate("form"));
    const std::string path = dir.filePath("nothing.json").toStdString();
    const Error e = test::errorOf([&] { loadFormFile(path); });
    EXPECT_EQ(e.number(), errc::FileNotFound);
    EXPECT_NE(e.description().find(path), std::string::npos);
}

TEST(FormFile, FolderIsNotAFormFile)
{
    QTemporaryDir dir(test::tempTemplate("form"));
    const Error e = test::errorOf([&] { loadFormFile(dir.path().toStdString()); });
    EXPECT_EQ(e.number(), errc::PathFileAccess);
    EXPECT_NE(e.description().find(dir.path().toStdString()), std::string::npos);
}

TEST(FormFile, InlineJsonIsNamedAsGiven)
{
    const Error e = test::errorOf([] { loadFormJson(R"({"grid1": {"cells": [[1], [1, 2]]}})", "inline form"); });
    EXPECT_NE(e.description().find("inline form"), std::string::npos);
    EXPECT_NE(e.description().find("grid1, row 1"), std::string::npos);
}

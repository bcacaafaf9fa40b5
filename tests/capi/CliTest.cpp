// The karstgraph tool's describe, register and unregister, checked against the C surface: what the
// tool registers, a host can create. Skipped when the tool has not been built.
#include <sys/wait.h>

#include <cstdio>

#include "capi/CapiSupport.h"

namespace {

using namespace capi_test;

struct ToolRun {
    int status = -1;
    std::string output;  // stdout and stderr
};

class CliTest : public CapiTest {
protected:
    void SetUp() override
    {
        CapiTest::SetUp();
        tool = fs::path(KG_BUILD_DIR) / "bin" / "karstgraph";
        if (!fs::exists(tool)) GTEST_SKIP() << tool << " has not been built";
    }

    ToolRun run(const std::string& arguments) const
    {
        ToolRun r;
        const std::string command = tool.string() + " " + arguments + " 2>&1";
        FILE* p = popen(command.c_str(), "r");
        if (!p) return r;
        char buf[512];
        for (size_t n; (n = std::fread(buf, 1, sizeof buf, p)) > 0;) r.output.append(buf, n);
        const int raw = pclose(p);
        r.status = WIFEXITED(raw) ? WEXITSTATUS(raw) : -1;
        return r;
    }

    fs::path tool;
};

TEST_F(CliTest, DescribeShowsTheIdsAndEveryOperationWithItsSlotAndDispatchId)
{
    const ToolRun r = run("describe");
    ASSERT_EQ(r.status, 0) << r.output;
    for (const std::string& part : {guidText(KG_CLSID_cTavixGraph), guidText(KG_IID_cTavixGraph),
                                    std::string(KG_PROGID), std::string("_cTavixGraph")})
        EXPECT_NE(r.output.find(part), std::string::npos) << part;
    const struct {
        int slot;
        const char* name;
        int32_t id;
    } ops[] = {{1, "SourceForm", KG_DISPID_SOURCEFORM},
               {8, "GraphInitialize", KG_DISPID_GRAPHINITIALIZE},
               {9, "GenerateChart_ServCatSumm", KG_DISPID_GENERATECHART_SERVCATSUMM},
               {15, "GenerateChart_HourlyGraph3", KG_DISPID_GENERATECHART_HOURLYGRAPH3}};
    for (const auto& op : ops) {
        const size_t at = r.output.find(" " + std::string(op.name) + " ");
        ASSERT_NE(at, std::string::npos) << op.name;
        const size_t from = r.output.rfind('\n', at) + 1;
        const std::string line = r.output.substr(from, r.output.find('\n', at) - from);
        char hexId[16];
        std::snprintf(hexId, sizeof hexId, "0x%08X", static_cast<unsigned>(op.id));
        EXPECT_EQ(std::stoi(line), op.slot) << line;
        EXPECT_NE(line.find(hexId), std::string::npos) << line;
    }
}

TEST_F(CliTest, WhatTheToolRegistersAHostCanCreate)
{
    const ToolRun reg = run("register");
    ASSERT_EQ(reg.status, 0) << reg.output;
    ObjectRef graph;
    ASSERT_EQ(KGCreateInstanceByProgID(KG_PROGID, graph.out()), KG_S_OK) << readText(registry);
    graph.reset();

    const ToolRun unreg = run("unregister");
    ASSERT_EQ(unreg.status, 0) << unreg.output;
    EXPECT_EQ(KGCreateInstanceByProgID(KG_PROGID, graph.out()), KG_E_CLASSNOTREG);
}

struct UsageCase {
    const char* name;
    const char* arguments;
    int status;
    const char* mentions;
};

class CliUsageTest : public CliTest, public ::testing::WithParamInterface<UsageCase> {};

TEST_P(CliUsageTest, ExitsWithItsStatus)
{
    const ToolRun r = run(GetParam().arguments);
    EXPECT_EQ(r.status, GetParam().status) << r.output;
    EXPECT_NE(r.output.find(GetParam().mentions), std::string::npos) << r.output;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, CliUsageTest,
    ::testing::Values(UsageCase{"Help", "--help", 0, "usage: karstgraph"},
                      UsageCase{"NoCommand", "", 2, "usage: karstgraph"},
                      UsageCase{"UnknownCommand", "draw", 2, "unknown command \"draw\""},
                      UsageCase{"RegisterWithAMissingLibrary", "register --library /nonexistent/libkarstgraph.so", 1,
                                "/nonexistent/libkarstgraph.so"},
                      UsageCase{"RegisterWithAStrayArgument", "register now", 2, "unexpected argument"},
                      UsageCase{"DescribeWithAnArgument", "describe all", 2, "usage: karstgraph describe"}),
    byName);

}  // namespace

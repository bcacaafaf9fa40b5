// cTavixGraph's members as the C surface offers them: names to dispatch ids, and the calls that do
// not fit a member refused before the class runs.

#include "capi/CapiSupport.h"

namespace {

using namespace capi_test;

struct Member {
    const char* name;
    int32_t id;
    uint16_t flags;   // how the member is invoked
    uint32_t argc;    // how many arguments it takes
};

const Member kMembers[] = {
    {"SourceForm", KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, 1},
    {"GenerateChart_YearlyRpt1", KG_DISPID_GENERATECHART_YEARLYRPT1, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_YearlyRpt2", KG_DISPID_GENERATECHART_YEARLYRPT2, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_YearlyRpt3", KG_DISPID_GENERATECHART_YEARLYRPT3, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_BookingsReport", KG_DISPID_GENERATECHART_BOOKINGSREPORT, KG_DISPATCH_METHOD, 0},
    {"GenerateChart_SalesDeclaration", KG_DISPID_GENERATECHART_SALESDECLARATION, KG_DISPATCH_METHOD, 0},
    {"GenerateChart_JobStatusReport", KG_DISPID_GENERATECHART_JOBSTATUSREPORT, KG_DISPATCH_METHOD, 0},
    {"GraphInitialize", KG_DISPID_GRAPHINITIALIZE, KG_DISPATCH_METHOD, 0},
    {"GenerateChart_ServCatSumm", KG_DISPID_GENERATECHART_SERVCATSUMM, KG_DISPATCH_METHOD, 0},
    {"GenerateChart_PropGraph1", KG_DISPID_GENERATECHART_PROPGRAPH1, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_PropGraph2", KG_DISPID_GENERATECHART_PROPGRAPH2, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_PropGraph3", KG_DISPID_GENERATECHART_PROPGRAPH3, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_HourlyGraph1", KG_DISPID_GENERATECHART_HOURLYGRAPH1, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_HourlyGraph2", KG_DISPID_GENERATECHART_HOURLYGRAPH2, KG_DISPATCH_METHOD, 2},
    {"GenerateChart_HourlyGraph3", KG_DISPID_GENERATECHART_HOURLYGRAPH3, KG_DISPATCH_METHOD, 2},
};

class MemberTest : public GraphTest, public ::testing::WithParamInterface<Member> {};

TEST_P(MemberTest, NameGivesItsDispatchIdInAnyCase)
{
    const Member& m = GetParam();
    for (const std::string& name : {std::string(m.name), withCase(m.name, ::toupper), withCase(m.name, ::tolower)}) {
        int32_t id = 0;
        ASSERT_EQ(KGGetIDOfName(graph.get(), name.c_str(), &id), KG_S_OK) << name;
        EXPECT_EQ(id, m.id) << name;
    }
}

TEST_P(MemberTest, CallsThatDoNotFitItAreRefusedWithADescription)
{
    const Member& m = GetParam();
    std::vector<uint32_t> wrong{m.argc + 1};
    if (m.argc > 0) wrong.push_back(m.argc - 1);
    for (uint32_t argc : wrong) {
        Var args[3];
        for (Var& a : args) setLong(a.v, 1);
        KGErrorInfo err;
        EXPECT_EQ(KGInvoke(graph.get(), m.id, m.flags, &args[0].v, argc, nullptr, &err), KG_E_BADPARAMCOUNT)
            << m.name << " with " << argc;
        EXPECT_EQ(err.number, 450);
        const std::string description = err.description;
        EXPECT_EQ(description.rfind("Wrong number of arguments or invalid property assignment", 0), 0u) << description;
        EXPECT_NE(description.find(m.name), std::string::npos) << description;
    }
    // Invoked as another kind, it is not found.
    const uint16_t other = m.flags == KG_DISPATCH_PROPERTYPUT ? KG_DISPATCH_METHOD : KG_DISPATCH_PROPERTYPUT;
    Var args[2];
    KGErrorInfo err;
    EXPECT_EQ(KGInvoke(graph.get(), m.id, other, &args[0].v, m.argc, nullptr, &err), KG_E_MEMBERNOTFOUND) << m.name;
    EXPECT_EQ(err.number, 438);
    EXPECT_NE(std::string(err.description).find(m.name), std::string::npos) << err.description;
}

INSTANTIATE_TEST_SUITE_P(AllFifteen, MemberTest, ::testing::ValuesIn(kMembers), byName);

struct RefusedCall {
    const char* name;
    int32_t id;
    uint16_t flags;
    uint16_t vt;  // of the one argument, when argc is 1
    uint32_t argc;
    int32_t status;
    int32_t number;
};

class RefusedCallTest : public GraphTest, public ::testing::WithParamInterface<RefusedCall> {};

TEST_P(RefusedCallTest, FailsWithTheDispatchStatus)
{
    const RefusedCall& c = GetParam();
    KGVariant arg;
    KGVariantInit(&arg);
    arg.vt = c.vt;
    arg.lVal = 0;
    KGErrorInfo err;
    EXPECT_EQ(KGInvoke(graph.get(), c.id, c.flags, &arg, c.argc, nullptr, &err), c.status);
    EXPECT_EQ(err.number, c.number);
    EXPECT_NE(err.description[0], '\0');
    KGVariantInit(&arg);  // a bad vt is nothing KGVariantClear could free
}

INSTANTIATE_TEST_SUITE_P(
    Cases, RefusedCallTest,
    ::testing::Values(RefusedCall{"UnknownDispatchId", KG_DISPID_GENERATECHART_HOURLYGRAPH3 + 1, KG_DISPATCH_METHOD,
                                  KG_VT_EMPTY, 0, KG_E_MEMBERNOTFOUND, 438},
                      RefusedCall{"StandardDispatchIdZero", 0, KG_DISPATCH_METHOD, KG_VT_EMPTY, 0, KG_E_MEMBERNOTFOUND,
                                  438},
                      RefusedCall{"ArgumentOfUnknownType", KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, 77, 1,
                                  KG_E_BADVARTYPE, 458},
                      RefusedCall{"SourceFormThatIsNoObject", KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT,
                                  KG_VT_I4, 1, KG_E_EXCEPTION, 13}),
    byName);

TEST_F(GraphTest, InvokeByNameFindsTheMemberInAnyCase)
{
    KGErrorInfo err;
    EXPECT_EQ(KGInvokeByName(graph.get(), "graphINITIALIZE", KG_DISPATCH_METHOD, nullptr, 0, nullptr, &err), KG_S_OK)
        << err.description;
    EXPECT_EQ(KGInvokeByName(graph.get(), "GraphInitialise", KG_DISPATCH_METHOD, nullptr, 0, nullptr, &err),
              KG_E_UNKNOWNNAME);
    EXPECT_EQ(err.number, 438);
    EXPECT_NE(std::string(err.description).find("GraphInitialise"), std::string::npos) << err.description;
    int32_t id = 0;
    EXPECT_EQ(KGGetIDOfName(graph.get(), "GenerateChart_HourlyGraph4", &id), KG_E_UNKNOWNNAME);
}

TEST_F(GraphTest, NullPointersAreRefused)
{
    EXPECT_EQ(DllGetClassObject(&KG_CLSID_cTavixGraph, nullptr, nullptr), KG_E_POINTER);
    int32_t id = 0;
    KGErrorInfo err;
    EXPECT_EQ(KGGetIDOfName(nullptr, "GraphInitialize", &id), KG_E_POINTER);
    EXPECT_EQ(KGGetIDOfName(graph.get(), nullptr, &id), KG_E_POINTER);
    EXPECT_EQ(KGGetIDOfName(graph.get(), "GraphInitialize", nullptr), KG_E_POINTER);
    EXPECT_EQ(KGInvoke(nullptr, KG_DISPID_GRAPHINITIALIZE, KG_DISPATCH_METHOD, nullptr, 0, nullptr, &err), KG_E_POINTER);
    EXPECT_EQ(KGInvoke(graph.get(), KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, nullptr, 1, nullptr, &err),
              KG_E_POINTER);
}

}  // namespace

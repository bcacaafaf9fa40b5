#pragma once
// What the C surface tests share: a scratch folder with the test stand pointed at it, a private
// registration file, a graph made through the class object, and small owners for objects and
// variants. Only the public C header is used to reach the component, as a host would.
#include <gtest/gtest.h>

#include <cstdint>
#include <cstdio>
#include <cctype>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "karstgraph/karstgraph.h"

namespace capi_test {

namespace fs = std::filesystem;

// Names each generated case after its table row.
inline constexpr auto byName = [](const auto& info) { return std::string(info.param.name); };

inline std::string dataFile(const std::string& name) { return std::string(KG_TEST_DATA) + "/capi/" + name; }

inline std::string readText(const fs::path& file)
{
    std::ifstream in(file, std::ios::binary);
    std::stringstream s;
    s << in.rdbuf();
    return s.str();
}

inline void writeText(const fs::path& file, const std::string& text)
{
    std::ofstream out(file, std::ios::binary | std::ios::trunc);
    out << text;
}

// The lines of a text that carry something (blank lines are only layout).
inline std::vector<std::string> contentLines(const std::string& text)
{
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);)
        if (line.find_first_not_of(" \t\r") != std::string::npos) lines.push_back(line);
    return lines;
}

// `s` with every letter put through `convert` (::toupper, ::tolower).
inline std::string withCase(std::string s, int (*convert)(int))
{
    for (char& c : s) c = static_cast<char>(convert(static_cast<unsigned char>(c)));
    return s;
}

inline std::string guidText(const KGGuid& g)
{
    char buf[40];
    std::snprintf(buf, sizeof buf, "{%08X-%04X-%04X-%02X%02X-%02X%02X%02X%02X%02X%02X}", unsigned(g.Data1),
                  unsigned(g.Data2), unsigned(g.Data3), g.Data4[0], g.Data4[1], g.Data4[2], g.Data4[3], g.Data4[4],
                  g.Data4[5], g.Data4[6], g.Data4[7]);
    return buf;
}

inline std::string describe(const KGErrorInfo& err)
{
    return "error " + std::to_string(err.number) + ": " + err.description;
}

inline std::string lastErrorDescription()
{
    KGErrorInfo info;
    return KGGetLastError(&info) == KG_S_OK ? std::string(info.description) : std::string("(no error kept)");
}

// One reference to an object, released at the end of the scope.
class ObjectRef {
public:
    ObjectRef() = default;
    explicit ObjectRef(KGObject* adopted) : p_(adopted) {}
    ObjectRef(const ObjectRef&) = delete;
    ObjectRef& operator=(const ObjectRef&) = delete;
    ~ObjectRef() { reset(); }
    void reset()
    {
        KGRelease(p_);
        p_ = nullptr;
    }
    KGObject* get() const { return p_; }
    KGObject** out()
    {
        reset();
        return &p_;
    }

private:
    KGObject* p_ = nullptr;
};

// A variant cleared at the end of the scope.
struct Var {
    KGVariant v;
    Var() { KGVariantInit(&v); }
    ~Var() { KGVariantClear(&v); }
    Var(const Var&) = delete;
    Var& operator=(const Var&) = delete;
};

inline void setLong(KGVariant& v, int32_t n)
{
    KGVariantClear(&v);
    v.vt = KG_VT_I4;
    v.lVal = n;
}

inline void setDouble(KGVariant& v, double d)
{
    KGVariantClear(&v);
    v.vt = KG_VT_R8;
    v.dblVal = d;
}

// SourceForm := form (Nothing when form is null).
inline int32_t putSourceForm(KGObject* graph, KGObject* form, KGErrorInfo* err)
{
    Var arg;
    KGVariantSetObject(&arg.v, form);
    return KGInvoke(graph, KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, &arg.v, 1, nullptr, err);
}

// A scratch folder per test, the test stand's settings and application folder inside it, and a
// registration file of its own through $KARSTGRAPH_REGISTRY.
class CapiTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        const char* base = std::getenv("KG_TEST_TMP");
        fs::path root = base && *base ? fs::path(base) : fs::temp_directory_path();
        fs::create_directories(root);
        std::string pattern = (root / "capi-XXXXXX").string();
        ASSERT_NE(mkdtemp(pattern.data()), nullptr);
        dir = pattern;
        registry = dir / "config" / "karstgraph" / "registry.ini";
        setenv("KARSTGRAPH_REGISTRY", registry.c_str(), 1);
        ASSERT_EQ(KGSetHostOption("settingsFile", (dir / "settings.ini").c_str()), KG_S_OK);
        ASSERT_EQ(KGSetHostOption("appFolder", dir.c_str()), KG_S_OK);
    }

    void TearDown() override
    {
        unsetenv("KARSTGRAPH_REGISTRY");
        std::error_code ec;
        fs::remove_all(dir, ec);
    }

    // A new cTavixGraph through the class object, as DllGetClassObject hands it out.
    static void createGraph(ObjectRef& graph)
    {
        void* factory = nullptr;
        ASSERT_EQ(DllGetClassObject(&KG_CLSID_cTavixGraph, &KG_IID_ClassFactory, &factory), KG_S_OK);
        auto* f = static_cast<KGClassFactory*>(factory);
        ASSERT_EQ(f->vtbl->CreateInstance(f, graph.out()), KG_S_OK);
        f->vtbl->Release(f);
        ASSERT_NE(graph.get(), nullptr);
    }

    // The registration file as a host's other classes left it.
    void writeRegistry(const std::string& text) const
    {
        fs::create_directories(registry.parent_path());
        writeText(registry, text);
    }

    fs::path dir;
    fs::path registry;
};

// A graph of its own per test; the form it was given is let go of at the end, since the state
// behind SourceForm outlives the object and no test may see another's.
class GraphTest : public CapiTest {
protected:
    void SetUp() override
    {
        CapiTest::SetUp();
        createGraph(graph);
    }
    void TearDown() override
    {
        KGErrorInfo err;
        if (graph.get()) {
            EXPECT_EQ(putSourceForm(graph.get(), nullptr, &err), KG_S_OK) << describe(err);
        }
        graph.reset();
        CapiTest::TearDown();
    }
    int32_t request(int32_t id, KGVariant* args, uint32_t argc, KGErrorInfo* err)
    {
        return KGInvoke(graph.get(), id, KG_DISPATCH_METHOD, args, argc, nullptr, err);
    }

    ObjectRef graph;
};

}  // namespace capi_test

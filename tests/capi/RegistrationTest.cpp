// Self-registration in the per-user registration file, and creation by programmatic name from it.
#include <dlfcn.h>
#include <sys/stat.h>
#include <unistd.h>

#include <functional>
#include <memory>
#include <optional>

#include "capi/CapiSupport.h"
#include "support/FileSizeLimit.h"

namespace {

using namespace capi_test;

std::string ourClassSection() { return "[CLSID\\" + guidText(KG_CLSID_cTavixGraph) + "]"; }
const std::string kOurProgIdSection = "[ProgID\\KarstGraph.cTavixGraph]";
const std::string kOtherClsid = "{11111111-2222-3333-4444-555555555555}";

// The file the code at `address` was loaded from.
std::string libraryHolding(void* address)
{
    Dl_info info{};
    return dladdr(address, &info) && info.dli_fname ? info.dli_fname : "";
}

// The file this test program loaded the component from.
std::string loadedLibrary() { return libraryHolding(reinterpret_cast<void*>(&DllRegisterServer)); }

bool sameFile(const std::string& a, const std::string& b)
{
    struct stat sa {}, sb {};
    return stat(a.c_str(), &sa) == 0 && stat(b.c_str(), &sb) == 0 && sa.st_dev == sb.st_dev && sa.st_ino == sb.st_ino;
}

size_t occurrences(const std::string& text, const std::string& what)
{
    size_t n = 0;
    for (size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + 1)) ++n;
    return n;
}

// The value of key in [section]; empty when there is none.
std::string valueIn(const std::string& text, const std::string& section, const std::string& key)
{
    bool inside = false;
    for (const std::string& line : contentLines(text)) {
        if (line.front() == '[') {
            inside = line == section;
            continue;
        }
        if (inside && line.rfind(key + "=", 0) == 0) return line.substr(key.size() + 1);
    }
    return {};
}

// Whether `lines` appear in `text` in this order (other lines may stand between them).
bool inOrder(const std::vector<std::string>& lines, const std::string& text)
{
    const std::vector<std::string> have = contentLines(text);
    size_t k = 0;
    for (const std::string& line : have)
        if (k < lines.size() && line == lines[k]) ++k;
    return k == lines.size();
}

std::string othersText()
{
    return "; classes of this user\n"
           "[CLSID\\" + kOtherClsid + "]\n"
           "ProgID=Other.Chart\n"
           "InprocServer=/opt/other/libother.so\n"
           "\n"
           "[ProgID\\Other.Chart]\n"
           "CLSID=" + kOtherClsid + "\n";
}

std::string oursText(const std::string& library)
{
    return ourClassSection() + "\nProgID=KarstGraph.cTavixGraph\nInprocServer=" + library +
           "\nInterface=_cTavixGraph " + guidText(KG_IID_cTavixGraph) + "\n\n" + kOurProgIdSection +
           "\nCLSID=" + guidText(KG_CLSID_cTavixGraph) + "\n";
}

// --- DllRegisterServer -------------------------------------------------------------------------

struct RegisterCase {
    const char* name;
    std::optional<std::string> before;   // the file before; nothing: no file
    std::vector<std::string> kept;       // lines of others that must survive, in order
    std::string gone;                    // text that must no longer be in the file
};

class RegisterTest : public CapiTest, public ::testing::WithParamInterface<RegisterCase> {};

TEST_P(RegisterTest, WritesOurEntriesOnceAndKeepsOthers)
{
    const RegisterCase& c = GetParam();
    if (c.before) writeRegistry(*c.before);
    ASSERT_EQ(DllRegisterServer(), KG_S_OK) << lastErrorDescription();
    const std::string text = readText(registry);

    EXPECT_EQ(occurrences(text, ourClassSection()), 1u) << text;
    EXPECT_EQ(occurrences(text, kOurProgIdSection), 1u) << text;
    EXPECT_EQ(valueIn(text, ourClassSection(), "ProgID"), KG_PROGID);
    EXPECT_EQ(valueIn(text, ourClassSection(), "Interface"), "_cTavixGraph " + guidText(KG_IID_cTavixGraph));
    EXPECT_EQ(valueIn(text, kOurProgIdSection, "CLSID"), guidText(KG_CLSID_cTavixGraph));
    const std::string server = valueIn(text, ourClassSection(), "InprocServer");
    EXPECT_EQ(server.front(), '/') << server;
    EXPECT_TRUE(sameFile(server, loadedLibrary())) << server << " is not " << loadedLibrary();
    EXPECT_TRUE(inOrder(c.kept, text)) << text;
    EXPECT_TRUE(c.gone.empty() || text.find(c.gone) == std::string::npos) << text;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, RegisterTest,
    ::testing::Values(
        RegisterCase{"NewFile", std::nullopt, {}, ""},
        RegisterCase{"OthersKept", othersText(), contentLines(othersText()), ""},
        RegisterCase{"StaleEntryOfOursReplaced", oursText("/old/place/libkarstgraph.so"), {}, "/old/place"},
        RegisterCase{"ProgIdOfAnotherClassTakenOver", kOurProgIdSection + "\nCLSID=" + kOtherClsid + "\n", {},
                     kOtherClsid},
        RegisterCase{"OursBetweenOthersReplacedInPlace",
                     "[Before]\nA=1\n" + oursText("/old/libkarstgraph.so") + "[After]\nB=2\n",
                     {"[Before]", "A=1", ourClassSection(), "[After]", "B=2"}, "/old/"}),
    byName);

// --- DllUnregisterServer -----------------------------------------------------------------------

struct UnregisterCase {
    const char* name;
    std::optional<std::string> before;
    std::optional<std::vector<std::string>> after;  // the lines left; nothing: still no file
};

class UnregisterTest : public CapiTest, public ::testing::WithParamInterface<UnregisterCase> {};

TEST_P(UnregisterTest, RemovesOnlyOurEntries)
{
    const UnregisterCase& c = GetParam();
    if (c.before) writeRegistry(*c.before);
    ASSERT_EQ(DllUnregisterServer(), KG_S_OK) << lastErrorDescription();
    if (!c.after) {
        EXPECT_FALSE(fs::exists(registry));
        return;
    }
    EXPECT_EQ(contentLines(readText(registry)), *c.after);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, UnregisterTest,
    ::testing::Values(
        UnregisterCase{"OursOnly", oursText("/x/libkarstgraph.so"), std::vector<std::string>{}},
        UnregisterCase{"OursAmongOthers", "[Before]\nA=1\n" + oursText("/x/libkarstgraph.so") + othersText(),
                       contentLines("[Before]\nA=1\n" + othersText())},
        UnregisterCase{"ProgIdOfAnotherClassStays",
                       kOurProgIdSection + "\nCLSID=" + kOtherClsid + "\n" + ourClassSection() + "\nProgID=X\n",
                       std::vector<std::string>{kOurProgIdSection, "CLSID=" + kOtherClsid}},
        UnregisterCase{"IdsWrittenInLowerCase", withCase(oursText("/x/libkarstgraph.so"), ::tolower), std::vector<std::string>{}},
        UnregisterCase{"NoFile", std::nullopt, std::nullopt}),
    byName);

TEST_F(CapiTest, RegisterThenUnregisterRestoresTheOthers)
{
    writeRegistry(othersText());
    ASSERT_EQ(DllRegisterServer(), KG_S_OK) << lastErrorDescription();
    ASSERT_EQ(DllUnregisterServer(), KG_S_OK) << lastErrorDescription();
    EXPECT_EQ(contentLines(readText(registry)), contentLines(othersText()));
}

// --- A write that fails ------------------------------------------------------------------------

struct FailedWriteCase {
    const char* name;
    int32_t (*entry)();
    std::string before;
    bool folderBlocked;  // a file stands where the registration folder should be; else the disk fills
};

class FailedWriteTest : public CapiTest, public ::testing::WithParamInterface<FailedWriteCase> {};

TEST_P(FailedWriteTest, FailsWithError75AndLeavesTheOldFileIntact)
{
    const FailedWriteCase& c = GetParam();
    const fs::path kept = c.folderBlocked ? dir / "blocker" : registry;  // what must stay as it was
    const fs::path file = c.folderBlocked ? kept / "registry.ini" : registry;
    fs::create_directories(kept.parent_path());
    writeText(kept, c.before);
    setenv("KARSTGRAPH_REGISTRY", file.c_str(), 1);
    int32_t status = KG_S_OK;
    {
        std::optional<kg::test::FileSizeLimit> limit;
        if (!c.folderBlocked) limit.emplace(48);
        status = c.entry();
    }
    EXPECT_EQ(status, KG_SELFREG_E_CLASS);
    EXPECT_EQ(readText(kept), c.before);
    KGErrorInfo info;
    ASSERT_EQ(KGGetLastError(&info), KG_S_OK);
    EXPECT_EQ(info.number, 75);
    EXPECT_NE(std::string(info.description).find(file.string()), std::string::npos) << info.description;
    EXPECT_EQ(KGGetLastError(&info), KG_S_FALSE) << "reading the last error forgets it";
}

INSTANTIATE_TEST_SUITE_P(
    Cases, FailedWriteTest,
    ::testing::Values(
        FailedWriteCase{"RegisterWhereTheFolderCannotBeMade", &DllRegisterServer, "a file where the folder should be\n",
                        true},
        FailedWriteCase{"UnregisterOnAFullDisk", &DllUnregisterServer, othersText() + oursText("/x/libkarstgraph.so"),
                        false}),
    byName);

// --- KGCreateInstanceByProgID ------------------------------------------------------------------

struct ProgIdCase {
    const char* name;
    // The registration file: "register" for what DllRegisterServer writes, "" for no file, else the
    // text with {LIB} standing for this library and {LIBC} for a library without the entry point.
    std::string file;
    const char* progId;
    int32_t status;
};

std::string replaced(std::string text, const std::string& from, const std::string& to)
{
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
}

class ProgIdTest : public CapiTest, public ::testing::WithParamInterface<ProgIdCase> {};

TEST_P(ProgIdTest, CreatesTheRegisteredClass)
{
    const ProgIdCase& c = GetParam();
    if (c.file == "register") {
        ASSERT_EQ(DllRegisterServer(), KG_S_OK) << lastErrorDescription();
    } else if (!c.file.empty()) {
        writeRegistry(replaced(replaced(c.file, "{LIB}", loadedLibrary()), "{LIBC}", libraryHolding(reinterpret_cast<void*>(&::getpid))));
    }
    ObjectRef graph;
    const int32_t status = KGCreateInstanceByProgID(c.progId, graph.out());
    ASSERT_EQ(status, c.status) << lastErrorDescription();
    if (KG_FAILED(status)) {
        EXPECT_EQ(graph.get(), nullptr);
        KGErrorInfo info;
        ASSERT_EQ(KGGetLastError(&info), KG_S_OK);
        EXPECT_NE(info.description[0], '\0');
        return;
    }
    int32_t id = 0;
    ASSERT_EQ(KGGetIDOfName(graph.get(), "GraphInitialize", &id), KG_S_OK);
    EXPECT_EQ(id, KG_DISPID_GRAPHINITIALIZE);
}

const std::string kOurProgIdTo = kOurProgIdSection + "\nCLSID=";

INSTANTIATE_TEST_SUITE_P(
    Cases, ProgIdTest,
    ::testing::Values(
        ProgIdCase{"Registered", "register", KG_PROGID, KG_S_OK},
        ProgIdCase{"NameInAnotherCase", "register", "KARSTGRAPH.ctavixgraph", KG_S_OK},
        ProgIdCase{"UnregisteredName", "register", "KarstGraph.cNoSuchClass", KG_E_CLASSNOTREG},
        ProgIdCase{"NoRegistrationFile", "", KG_PROGID, KG_E_CLASSNOTREG},
        ProgIdCase{"ProgIdWithoutClassEntry", kOurProgIdTo + guidText(KG_CLSID_cTavixGraph) + "\n", KG_PROGID,
                   KG_E_CLASSNOTREG},
        ProgIdCase{"RegisteredLibraryMissing",
                   oursText("/nonexistent/folder/libkarstgraph.so"), KG_PROGID, KG_E_MODNOTFOUND},
        ProgIdCase{"RegisteredLibraryWithoutEntryPoint", oursText("{LIBC}"), KG_PROGID, KG_E_CLASSNOTAVAILABLE},
        ProgIdCase{"ClassThisLibraryDoesNotServe",
                   kOurProgIdTo + kOtherClsid + "\n[CLSID\\" + kOtherClsid + "]\nInprocServer={LIB}\n", KG_PROGID,
                   KG_E_CLASSNOTAVAILABLE},
        ProgIdCase{"ClassIdThatIsNoClassId", kOurProgIdTo + "{not-a-class-id}\n", KG_PROGID, KG_E_CLASSNOTREG}),
    byName);

// --- DllGetClassObject ---------------------------------------------------------------------------

const KGGuid kOtherGuid = {0x11111111, 0x2222, 0x3333, {0x44, 0x44, 0x55, 0x55, 0x55, 0x55, 0x55, 0x55}};

struct ClassObjectCase {
    const char* name;
    const KGGuid* clsid;
    const KGGuid* iid;
    int32_t status;
};

class ClassObjectTest : public CapiTest, public ::testing::WithParamInterface<ClassObjectCase> {};

TEST_P(ClassObjectTest, HandsOutTheClassFactoryOfOurClassOnly)
{
    const ClassObjectCase& c = GetParam();
    void* out = reinterpret_cast<void*>(0x1);  // must be overwritten either way
    ASSERT_EQ(DllGetClassObject(c.clsid, c.iid, &out), c.status);
    if (KG_FAILED(c.status)) {
        EXPECT_EQ(out, nullptr);
        return;
    }
    auto* factory = static_cast<KGClassFactory*>(out);
    ObjectRef graph;
    EXPECT_EQ(factory->vtbl->CreateInstance(factory, graph.out()), KG_S_OK);
    EXPECT_NE(graph.get(), nullptr);
    factory->vtbl->Release(factory);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, ClassObjectTest,
    ::testing::Values(ClassObjectCase{"ClassFactoryInterface", &KG_CLSID_cTavixGraph, &KG_IID_ClassFactory, KG_S_OK},
                      ClassObjectCase{"NoInterfaceNamed", &KG_CLSID_cTavixGraph, nullptr, KG_S_OK},
                      ClassObjectCase{"AnotherClass", &kOtherGuid, &KG_IID_ClassFactory, KG_E_CLASSNOTAVAILABLE},
                      ClassObjectCase{"TheClassInterfaceIsNoClassObject", &KG_CLSID_cTavixGraph,
                                      &KG_IID_cTavixGraph, KG_E_NOINTERFACE},
                      ClassObjectCase{"NoClassId", nullptr, nullptr, KG_E_POINTER}),
    byName);

// --- DllCanUnloadNow -----------------------------------------------------------------------------

KGClassFactory* classObject()
{
    void* out = nullptr;
    EXPECT_EQ(DllGetClassObject(&KG_CLSID_cTavixGraph, &KG_IID_ClassFactory, &out), KG_S_OK);
    return static_cast<KGClassFactory*>(out);
}

int32_t lockServer(int32_t lock)
{
    KGClassFactory* f = classObject();
    const int32_t status = f->vtbl->LockServer(f, lock);
    f->vtbl->Release(f);
    return status;
}

KGObject* newGraph()
{
    KGClassFactory* f = classObject();
    KGObject* graph = nullptr;
    EXPECT_EQ(f->vtbl->CreateInstance(f, &graph), KG_S_OK);
    f->vtbl->Release(f);
    return graph;
}

KGObject* loadForm()
{
    KGObject* form = nullptr;
    KGErrorInfo err;
    EXPECT_EQ(KGLoadFormFile(dataFile("grid1.json").c_str(), &form, &err), KG_S_OK) << err.description;
    return form;
}

// How the host lets go of what it took; empty when it kept nothing.
using LetGo = std::function<void()>;

struct UnloadCase {
    const char* name;
    LetGo (*take)();  // takes what the host holds; what is still held keeps the library loaded
    bool keepsLoaded;
};

class UnloadTest : public CapiTest, public ::testing::WithParamInterface<UnloadCase> {};

TEST_P(UnloadTest, OnlyWhenNothingHandedOutIsAliveAndNothingIsLocked)
{
    ASSERT_EQ(DllCanUnloadNow(), KG_S_OK) << "an earlier test left an object or a lock alive";
    const LetGo letGo = GetParam().take();
    EXPECT_EQ(DllCanUnloadNow(), GetParam().keepsLoaded ? KG_S_FALSE : KG_S_OK);
    if (letGo) letGo();
    EXPECT_EQ(DllCanUnloadNow(), KG_S_OK);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, UnloadTest,
    ::testing::Values(
        UnloadCase{"ClassObject",
                   []() -> LetGo {
                       KGClassFactory* f = classObject();
                       return [f] { f->vtbl->Release(f); };
                   },
                   true},
        UnloadCase{"Instance",
                   []() -> LetGo {
                       KGObject* g = newGraph();
                       return [g] { KGRelease(g); };
                   },
                   true},
        UnloadCase{"LockWithoutObjects",
                   []() -> LetGo {
                       EXPECT_EQ(lockServer(1), KG_S_OK);
                       return [] { EXPECT_EQ(lockServer(0), KG_S_OK); };
                   },
                   true},
        UnloadCase{"UnlockWithoutALockIsRefused",
                   []() -> LetGo {
                       EXPECT_EQ(lockServer(0), KG_E_INVALIDARG);
                       return {};
                   },
                   false},
        UnloadCase{"Form",
                   []() -> LetGo {
                       KGObject* form = loadForm();
                       return [form] { KGRelease(form); };
                   },
                   true},
        UnloadCase{"ObjectAMemberReturned",
                   []() -> LetGo {
                       ObjectRef form(loadForm());  // let go of at once: the grid alone keeps the library
                       auto grid = std::make_shared<Var>();
                       KGErrorInfo err;
                       EXPECT_EQ(KGInvokeByName(form.get(), "GRID1", KG_DISPATCH_PROPERTYGET, nullptr, 0, &grid->v,
                                                &err),
                                 KG_S_OK)
                           << err.description;
                       EXPECT_EQ(grid->v.vt, KG_VT_OBJECT);
                       return [grid] { KGVariantClear(&grid->v); };
                   },
                   true},
        UnloadCase{"FormTheComponentKeepsAfterTheHostLetGo",
                   []() -> LetGo {
                       ObjectRef graph(newGraph()), form(loadForm());
                       KGErrorInfo err;
                       EXPECT_EQ(putSourceForm(graph.get(), form.get(), &err), KG_S_OK) << err.description;
                       return {};
                   },
                   false}),
    byName);

}  // namespace

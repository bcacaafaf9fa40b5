// Self-registration in the per-user registration file, and creation by programmatic name from it.
#include <dlfcn.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <csignal>
#include <functional>
#include <optional>

#include "capi/CapiSupport.h"

namespace {

using namespace capi_test;

std::string ourClassSection() { return "[CLSID\\" + guidText(KG_CLSID_cTavixGraph) + "]"; }
const std::string kOurProgIdSection = "[ProgID\\KarstGraph.cTavixGraph]";
const std::string kOtherClsid = "{11111111-2222-3333-4444-555555555555}";

// The file this test program loaded the component from.
std::string loadedLibrary()
{
    Dl_info info{};
    if (!dladdr(reinterpret_cast<void*>(&DllRegisterServer), &info) || !info.dli_fname) return {};
    return info.dli_fname;
}

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

std::string lastErrorDescription()
{
    KGErrorInfo info;
    return KGGetLastError(&info) == KG_S_OK ? std::string(info.description) : std::string("(no error kept)");
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
    if (c.before) {
        fs::create_directories(registry.parent_path());
        writeText(registry, *c.before);
    }
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
    if (!c.gone.empty()) EXPECT_EQ(text.find(c.gone), std::string::npos) << text;
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
    [](const auto& info) { return std::string(info.param.name); });

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
    if (c.before) {
        fs::create_directories(registry.parent_path());
        writeText(registry, *c.before);
    }
    ASSERT_EQ(DllUnregisterServer(), KG_S_OK) << lastErrorDescription();
    if (!c.after) {
        EXPECT_FALSE(fs::exists(registry));
        return;
    }
    EXPECT_EQ(contentLines(readText(registry)), *c.after);
}

std::string lowerCase(std::string s)
{
    for (char& ch : s) ch = static_cast<char>(std::tolower(static_cast<unsigned char>(ch)));
    return s;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, UnregisterTest,
    ::testing::Values(
        UnregisterCase{"OursOnly", oursText("/x/libkarstgraph.so"), std::vector<std::string>{}},
        UnregisterCase{"OursAmongOthers", "[Before]\nA=1\n" + oursText("/x/libkarstgraph.so") + othersText(),
                       [] {
                           std::vector<std::string> lines{"[Before]", "A=1"};
                           for (const std::string& l : contentLines(othersText())) lines.push_back(l);
                           return lines;
                       }()},
        UnregisterCase{"ProgIdOfAnotherClassStays",
                       kOurProgIdSection + "\nCLSID=" + kOtherClsid + "\n" + ourClassSection() + "\nProgID=X\n",
                       std::vector<std::string>{kOurProgIdSection, "CLSID=" + kOtherClsid}},
        UnregisterCase{"IdsWrittenInLowerCase", lowerCase(oursText("/x/libkarstgraph.so")), std::vector<std::string>{}},
        UnregisterCase{"NoFile", std::nullopt, std::nullopt}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(CapiTest, RegisterThenUnregisterRestoresTheOthers)
{
    fs::create_directories(registry.parent_path());
    writeText(registry, othersText());
    ASSERT_EQ(DllRegisterServer(), KG_S_OK) << lastErrorDescription();
    ASSERT_EQ(DllUnregisterServer(), KG_S_OK) << lastErrorDescription();
    EXPECT_EQ(contentLines(readText(registry)), contentLines(othersText()));
}

// --- A write that fails ------------------------------------------------------------------------

TEST_F(CapiTest, RegisterFailsWhenTheFolderCannotBeMade)
{
    writeText(dir / "blocker", "a file where the folder should be\n");
    const fs::path file = dir / "blocker" / "registry.ini";
    setenv("KARSTGRAPH_REGISTRY", file.c_str(), 1);

    EXPECT_EQ(DllRegisterServer(), KG_SELFREG_E_CLASS);
    KGErrorInfo info;
    ASSERT_EQ(KGGetLastError(&info), KG_S_OK);
    EXPECT_EQ(info.number, 75);
    EXPECT_NE(std::string(info.description).find(file.string()), std::string::npos) << info.description;
    EXPECT_EQ(readText(dir / "blocker"), "a file where the folder should be\n");
    EXPECT_EQ(KGGetLastError(&info), KG_S_FALSE) << "reading the last error forgets it";
}

// The file size limit makes the new file's write fail half way, as a full disk would.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes)
    {
        oldHandler_ = std::signal(SIGXFSZ, SIG_IGN);
        getrlimit(RLIMIT_FSIZE, &old_);
        rlimit small = old_;
        small.rlim_cur = bytes;
        setrlimit(RLIMIT_FSIZE, &small);
    }
    ~FileSizeLimit()
    {
        setrlimit(RLIMIT_FSIZE, &old_);
        std::signal(SIGXFSZ, oldHandler_);
    }

private:
    rlimit old_{};
    void (*oldHandler_)(int) = nullptr;
};

struct FailedWriteCase {
    const char* name;
    int32_t (*entry)();
    std::string before;
};

class FailedWriteTest : public CapiTest, public ::testing::WithParamInterface<FailedWriteCase> {};

TEST_P(FailedWriteTest, LeavesTheOldFileIntact)
{
    const FailedWriteCase& c = GetParam();
    fs::create_directories(registry.parent_path());
    writeText(registry, c.before);
    int32_t status = KG_S_OK;
    {
        FileSizeLimit limit(48);
        status = c.entry();
    }
    EXPECT_EQ(status, KG_SELFREG_E_CLASS);
    EXPECT_EQ(readText(registry), c.before);
    std::vector<std::string> files;
    for (const auto& e : fs::directory_iterator(registry.parent_path())) files.push_back(e.path().filename().string());
    EXPECT_EQ(files, std::vector<std::string>{"registry.ini"}) << "the temporary file must not be left behind";
    KGErrorInfo info;
    ASSERT_EQ(KGGetLastError(&info), KG_S_OK);
    EXPECT_EQ(info.number, 75);
    EXPECT_NE(std::string(info.description).find(registry.string()), std::string::npos) << info.description;
}

INSTANTIATE_TEST_SUITE_P(Cases, FailedWriteTest,
                         ::testing::Values(FailedWriteCase{"Register", &DllRegisterServer, othersText()},
                                           FailedWriteCase{"Unregister", &DllUnregisterServer,
                                                           othersText() + oursText("/x/libkarstgraph.so")}),
                         [](const auto& info) { return std::string(info.param.name); });

// --- KGCreateInstanceByProgID ------------------------------------------------------------------

struct ProgIdCase {
    const char* name;
    // The registration file: "register" for what DllRegisterServer writes, "" for no file, else the
    // text with {LIB} standing for this library and {LIBC} for a library without the entry point.
    std::string file;
    const char* progId;
    int32_t status;
};

std::string libcPath()
{
    Dl_info info{};
    dladdr(reinterpret_cast<void*>(&::getpid), &info);
    return info.dli_fname ? info.dli_fname : "";
}

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
        fs::create_directories(registry.parent_path());
        writeText(registry, replaced(replaced(c.file, "{LIB}", loadedLibrary()), "{LIBC}", libcPath()));
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
    [](const auto& info) { return std::string(info.param.name); });

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
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(CapiTest, ClassObjectNeedsSomewhereToPutIt)
{
    EXPECT_EQ(DllGetClassObject(&KG_CLSID_cTavixGraph, nullptr, nullptr), KG_E_POINTER);
}

// --- DllCanUnloadNow -----------------------------------------------------------------------------

// Something a host holds, and how it lets go of it.
struct Holding {
    std::vector<std::function<void()>> releases;
    void release()
    {
        for (auto it = releases.rbegin(); it != releases.rend(); ++it) (*it)();
        releases.clear();
    }
};

KGClassFactory* classObject()
{
    void* out = nullptr;
    EXPECT_EQ(DllGetClassObject(&KG_CLSID_cTavixGraph, &KG_IID_ClassFactory, &out), KG_S_OK);
    return static_cast<KGClassFactory*>(out);
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

struct UnloadCase {
    const char* name;
    // Takes what the host holds; what is still held when it returns keeps the library loaded.
    std::function<void(Holding&)> take;
    bool keepsLoaded;
};

class UnloadTest : public CapiTest, public ::testing::WithParamInterface<UnloadCase> {};

TEST_P(UnloadTest, OnlyWhenNothingHandedOutIsAliveAndNothingIsLocked)
{
    ASSERT_EQ(DllCanUnloadNow(), KG_S_OK) << "an earlier test left an object or a lock alive";
    Holding holding;
    GetParam().take(holding);
    EXPECT_EQ(DllCanUnloadNow(), GetParam().keepsLoaded ? KG_S_FALSE : KG_S_OK);
    holding.release();
    EXPECT_EQ(DllCanUnloadNow(), KG_S_OK);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, UnloadTest,
    ::testing::Values(
        UnloadCase{"ClassObject",
                   [](Holding& h) {
                       KGClassFactory* f = classObject();
                       h.releases.push_back([f] { f->vtbl->Release(f); });
                   },
                   true},
        UnloadCase{"Instance",
                   [](Holding& h) {
                       KGObject* g = newGraph();
                       h.releases.push_back([g] { KGRelease(g); });
                   },
                   true},
        UnloadCase{"LockWithoutObjects",
                   [](Holding& h) {
                       KGClassFactory* f = classObject();
                       EXPECT_EQ(f->vtbl->LockServer(f, 1), KG_S_OK);
                       f->vtbl->Release(f);
                       h.releases.push_back([] {
                           KGClassFactory* again = classObject();
                           EXPECT_EQ(again->vtbl->LockServer(again, 0), KG_S_OK);
                           again->vtbl->Release(again);
                       });
                   },
                   true},
        UnloadCase{"Form",
                   [](Holding& h) {
                       KGObject* form = loadForm();
                       h.releases.push_back([form] { KGRelease(form); });
                   },
                   true},
        UnloadCase{"ObjectAMemberReturned",
                   [](Holding& h) {
                       KGObject* form = loadForm();
                       auto* grid = new Var;
                       KGErrorInfo err;
                       EXPECT_EQ(KGInvokeByName(form, "GRID1", KG_DISPATCH_PROPERTYGET, nullptr, 0, &grid->v, &err),
                                 KG_S_OK)
                           << err.description;
                       EXPECT_EQ(grid->v.vt, KG_VT_OBJECT);
                       KGRelease(form);  // the grid alone keeps the library
                       h.releases.push_back([grid] { delete grid; });
                   },
                   true},
        UnloadCase{"FormTheComponentKeepsAfterTheHostLetGo",
                   [](Holding&) {
                       KGObject* graph = newGraph();
                       KGObject* form = loadForm();
                       KGVariant arg;
                       KGVariantInit(&arg);
                       KGVariantSetObject(&arg, form);
                       KGErrorInfo err;
                       EXPECT_EQ(KGInvoke(graph, KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, &arg, 1, nullptr, &err),
                                 KG_S_OK)
                           << err.description;
                       KGVariantClear(&arg);
                       KGRelease(form);
                       KGRelease(graph);
                   },
                   false}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(CapiTest, UnlockWithoutALockIsRefused)
{
    KGClassFactory* f = classObject();
    EXPECT_EQ(f->vtbl->LockServer(f, 0), KG_E_INVALIDARG);
    f->vtbl->Release(f);
    EXPECT_EQ(DllCanUnloadNow(), KG_S_OK);
}

}  // namespace

// The karstgraph tool: a table of commands. describe, register and unregister need no application
// object and start at once; render and gallery make their own.
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <string>

#include "apps/cli/Commands.h"
#include "capi/Registration.h"
#include "requests/cTavixGraph.h"
#include "core/Error.h"

namespace {

namespace fs = std::filesystem;

struct Command {
    const char* name;
    const char* arguments;
    const char* summary;
    int (*run)(int argc, char** argv);
};

const Command kCommands[] = {
    {"describe", "", "print the class, its ids, programmatic name and operations", runDescribe},
    {"register", "[--library PATH]", "record the component in this user's registration file", runRegister},
    {"unregister", "", "remove the component's entries from this user's registration file", runUnregister},
    {"render", "FORM.json REQUEST ... -o OUT", "run one chart request and write the chart to an image",
     runRender},
    {"gallery", "OUTDIR", "draw every chart of the sample data, with an index page", runGallery},
};

void printUsage(std::FILE* to)
{
    std::fprintf(to, "usage: karstgraph COMMAND [ARGUMENTS]\n\ncommands:\n");
    for (const Command& c : kCommands) {
        const std::string call = std::string(c.name) + (*c.arguments ? " " : "") + c.arguments;
        std::fprintf(to, "  %-40s %s\n", call.c_str(), c.summary);
    }
    std::fprintf(to, "\n'karstgraph COMMAND --help' tells more about a command.\n"
                     "The registration file is %s\n"
                     "($KARSTGRAPH_REGISTRY overrides it).\n",
                 kg::registration::registryFilePath().c_str());
}

bool isHelp(const char* arg) { return std::strcmp(arg, "--help") == 0 || std::strcmp(arg, "-h") == 0; }

// Where the build and the installation put the library: lib/ next to the bin/ of this program.
fs::path defaultLibrary()
{
    std::error_code ec;
    const fs::path exe = fs::read_symlink("/proc/self/exe", ec);
    return (ec ? fs::current_path() : exe.parent_path()) / ".." / "lib" / "libkarstgraph.so";
}

}  // namespace

int runRegister(int argc, char** argv)
{
    const char* usage = "usage: karstgraph register [--library PATH]\n"
                        "  --library  the shared library to record (default: ../lib/libkarstgraph.so from this program)\n";
    fs::path library = defaultLibrary();
    for (int i = 0; i < argc; ++i) {
        if (isHelp(argv[i])) {
            std::fputs(usage, stdout);
            return 0;
        }
        if (std::strcmp(argv[i], "--library") == 0 && i + 1 < argc && *argv[i + 1]) {
            library = argv[++i];
            continue;
        }
        std::fprintf(stderr, "karstgraph register: unexpected argument \"%s\"\n%s", argv[i], usage);
        return 2;
    }
    std::error_code ec;
    library = fs::absolute(library, ec).lexically_normal();
    if (ec || !fs::is_regular_file(library, ec)) {
        std::fprintf(stderr, "karstgraph register: there is no library at %s; name it with --library PATH\n",
                     library.c_str());
        return 1;
    }
    const std::string file = kg::registration::registryFilePath();
    try {
        kg::registration::registerServer(library.string(), file);
    } catch (const kg::Error& e) {
        std::fprintf(stderr, "karstgraph register: %s\n", e.description().c_str());
        return 1;
    }
    std::printf("Registered %s %s as %s in %s\n", kg::kProgId, kg::guidText(kg::kClsidTavixGraph).c_str(),
                library.c_str(), file.c_str());
    return 0;
}

int runUnregister(int argc, char** argv)
{
    if (argc > 0) {
        const bool help = isHelp(argv[0]);
        std::fprintf(help ? stdout : stderr, "usage: karstgraph unregister\n");
        return help ? 0 : 2;
    }
    const std::string file = kg::registration::registryFilePath();
    try {
        kg::registration::unregisterServer(file);
    } catch (const kg::Error& e) {
        std::fprintf(stderr, "karstgraph unregister: %s\n", e.description().c_str());
        return 1;
    }
    std::printf("Unregistered %s %s from %s\n", kg::kProgId, kg::guidText(kg::kClsidTavixGraph).c_str(), file.c_str());
    return 0;
}

int main(int argc, char** argv)
{
    if (argc < 2) {
        printUsage(stderr);
        return 2;
    }
    if (isHelp(argv[1]) || std::strcmp(argv[1], "help") == 0) {
        printUsage(stdout);
        return 0;
    }
    for (const Command& c : kCommands)
        if (std::strcmp(argv[1], c.name) == 0) return c.run(argc - 2, argv + 2);
    std::fprintf(stderr, "karstgraph: unknown command \"%s\"\n\n", argv[1]);
    printUsage(stderr);
    return 2;
}

// karstgraph describe: the class as a host sees it, its ids, its programmatic name and its
// operations in slot order, and whether this user has it registered.
#include <algorithm>
#include <cstdio>
#include <cstring>
#include <string>

#include "apps/cli/Commands.h"
#include "capi/Registration.h"
#include "requests/cTavixGraph.h"
#include "core/Error.h"

namespace {

const char* kindText(kg::OperationKind kind)
{
    return kind == kg::OperationKind::PropertyPut ? "property put" : "method";
}

std::string registrationText()
{
    const std::string file = kg::registration::registryFilePath();
    try {
        const auto reg = kg::registration::findProgId(kg::kProgId, file);
        if (!reg) return "no (" + file + ")";
        if (!(reg->clsid == kg::kClsidTavixGraph))
            return "as another class " + kg::guidText(reg->clsid) + " (" + file + ")";
        return reg->library + " (" + file + ")";
    } catch (const kg::Error& e) {
        return "unknown: " + e.description();
    }
}

}  // namespace

int runDescribe(int argc, char** argv)
{
    if (argc > 0) {
        const bool help = std::strcmp(argv[0], "--help") == 0 || std::strcmp(argv[0], "-h") == 0;
        std::fprintf(help ? stdout : stderr, "usage: karstgraph describe\n");
        return help ? 0 : 2;
    }
    std::printf("Class       cTavixGraph\n");
    std::printf("CLSID       %s\n", kg::guidText(kg::kClsidTavixGraph).c_str());
    std::printf("Interface   %s\n", kg::kInterfaceName);
    std::printf("IID         %s\n", kg::guidText(kg::kIidTavixGraph).c_str());
    std::printf("ProgID      %s\n", kg::kProgId);
    std::printf("Registered  %s\n\n", registrationText().c_str());

    int nameWidth = static_cast<int>(std::strlen("Operation"));
    for (const kg::Operation& op : kg::kOperations) nameWidth = std::max(nameWidth, static_cast<int>(std::strlen(op.name)));
    std::printf("Slot  %-*s  %-12s  %-11s  %s\n", nameWidth, "Operation", "Kind", "Dispatch id", "Parameters");
    for (const kg::Operation& op : kg::kOperations)
        std::printf("%4d  %-*s  %-12s  0x%08X   %s\n", op.slot, nameWidth, op.name, kindText(op.kind),
                    static_cast<unsigned>(op.id), *op.parameters ? op.parameters : "(none)");
    return 0;
}

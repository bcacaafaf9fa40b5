// Where the test stand finds its files when the configuration does not say.
#include <cstdlib>
#include <filesystem>

#include "teststand/TestStand.h"

namespace kg::teststand {

namespace {
namespace fs = std::filesystem;

std::string env(const char* name)
{
    const char* v = std::getenv(name);
    return v ? std::string(v) : std::string();
}

std::string withoutTrailingSeparator(std::string path)
{
    while (path.size() > 1 && path.back() == '/') path.pop_back();
    return path;
}

fs::path executableFolder()
{
    std::error_code ec;
    const fs::path exe = fs::read_symlink("/proc/self/exe", ec);
    return ec ? fs::current_path(ec) : exe.parent_path();
}
}  // namespace

std::string settingsFilePath(const Config& cfg)
{
    if (!cfg.settingsFile.empty()) return cfg.settingsFile;
    if (std::string file = env("KARSTGRAPH_SETTINGS"); !file.empty()) return file;
    std::string base = env("XDG_CONFIG_HOME");
    if (base.empty() || base.front() != '/') base = env("HOME") + "/.config";  // XDG: relative bases are ignored
    return withoutTrailingSeparator(base) + "/karstgraph/settings.ini";
}

std::string appFolderPath(const Config& cfg)
{
    if (!cfg.appFolder.empty()) return withoutTrailingSeparator(cfg.appFolder);
    if (std::string folder = env("KARSTGRAPH_APPFOLDER"); !folder.empty()) return withoutTrailingSeparator(folder);
    const fs::path exeDir = executableFolder();
    for (const fs::path& candidate :
         {exeDir, exeDir.parent_path(), exeDir.parent_path() / "share" / "karstgraph",
          fs::path("/usr/share/karstgraph"), fs::path("/usr/local/share/karstgraph")}) {
        std::error_code ec;
        if (fs::is_directory(candidate / "Help", ec)) return withoutTrailingSeparator(candidate.lexically_normal().string());
    }
    return withoutTrailingSeparator(exeDir.string());
}

}  // namespace kg::teststand

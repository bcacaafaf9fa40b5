#pragma once
// One settings file in IniFormat's layout (teststand/RawIni.h), keys as paths "Owner/Section/Key":
// [Owner] in the file, the key written "Section\Key".
//
// The file is read and written here rather than through a QSettings object: QSettings keeps every
// file in a process-wide cache, and after a failed sync it keeps the unwritten values there, read
// back as if stored and written by the next sync of any QSettings on that file. So every read
// reads the file, and every write is one locked, atomic replacement of the file, as QSettings
// makes it (QLockFile beside the file, then files/WholeFile.h synced to disk and renamed), with
// every byte checked as written: a write that fails raises an error and leaves the previous file
// exactly as it was.
#include <initializer_list>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace kg::teststand {

class SettingsFile {
public:
    explicit SettingsFile(std::string path);

    const std::string& path() const { return path_; }

    // The text stored under `key`, or nothing; Error when the file exists but cannot be read.
    std::optional<std::string> read(const std::string& key) const;
    // Stores all the entries in one write; Error naming the file when it cannot be written.
    void write(const std::vector<std::pair<std::string, std::string>>& entries) const;

private:
    std::string path_;
};

// Joins the parts of a key path; Error 5 naming `what` when a part is empty or holds a / or \,
// which would make it a path of its own.
std::string settingsKey(std::initializer_list<std::pair<const char*, std::string>> parts, const std::string& what);

}  // namespace kg::teststand

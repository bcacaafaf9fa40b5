#include "teststand/SettingsFile.h"

#include <QDir>
#include <QFileInfo>
#include <QLockFile>

#include "core/Error.h"
#include "files/WholeFile.h"
#include "teststand/RawIni.h"
#include "teststand/TestStand.h"

namespace kg::teststand {

namespace {

[[noreturn]] void fail(const std::string& description)
{
    throw Error::host(hosterr::Settings, description, "Settings");
}

// The file's entries; none for a file that does not exist yet.
rawini::Entries readEntries(const std::string& path)
{
    QByteArray text;
    if (const auto reason = files::readWholeFile(QString::fromStdString(path), text))
        fail("The settings file \"" + path + "\" cannot be read: " + reason->toStdString());
    return rawini::entriesOf(text);
}

}  // namespace

SettingsFile::SettingsFile(std::string path) : path_(std::move(path)) {}

std::optional<std::string> SettingsFile::read(const std::string& key) const
{
    const rawini::Entries entries = readEntries(path_);
    auto it = entries.constFind(rawini::fromUtf8Text(key));
    if (it == entries.constEnd()) return std::nullopt;
    return it.value().toStdString();
}

void SettingsFile::write(const std::vector<std::pair<std::string, std::string>>& entries) const
{
    const QString file = QString::fromStdString(path_);
    std::string names;
    for (const auto& e : entries) names += (names.empty() ? "" : ", ") + e.first;
    auto cannotWrite = [&](const QString& why) {
        fail("The settings file \"" + path_ + "\" cannot be written (" + names + "): " + why.toStdString());
    };

    if (!QDir().mkpath(QFileInfo(file).absolutePath())) cannotWrite(QStringLiteral("its folder cannot be made"));
    QLockFile lock(file + QStringLiteral(".lock"));
    if (!lock.tryLock(5000))
        cannotWrite(lock.error() == QLockFile::LockFailedError ? QStringLiteral("another program holds its lock")
                                                               : QStringLiteral("its folder is not writable"));

    // Read under the lock, so a write of another program in between is kept. A file that cannot
    // be read is not written: the write would drop what it holds.
    rawini::Entries all = readEntries(path_);
    for (const auto& [key, value] : entries) all.insert(rawini::fromUtf8Text(key), rawini::fromUtf8Text(value));

    if (const auto failed = files::writeWholeFile(file, rawini::fileTextOf(all), files::Sync::ToDisk))
        cannotWrite(failed->step == files::WriteFailure::Write
                        ? QStringLiteral("not all of it could be written; the disk may be full")
                        : failed->reason);
}

std::string settingsKey(std::initializer_list<std::pair<const char*, std::string>> parts, const std::string& what)
{
    std::string key;
    for (const auto& [name, text] : parts) {
        if (text.empty() || text.find_first_of("/\\") != std::string::npos)
            throw Error::invalidCall(what + ": the " + name + " \"" + text +
                                     "\" must be a non-empty name without / or \\");
        if (!key.empty()) key += '/';
        key += text;
    }
    return key;
}

}  // namespace kg::teststand

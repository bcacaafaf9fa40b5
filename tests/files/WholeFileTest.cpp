// The whole-file writer, synced or not: the file appears whole, as an ordinary file would, or not
// at all, and an older file stays as it was.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <optional>
#include <sys/stat.h>

#include "files/WholeFile.h"
#include "support/FileSizeLimit.h"

namespace kg::files {
namespace {

QByteArray bytesOf(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

mode_t modeOf(const QString& path)
{
    struct stat st {};
    return ::lstat(QFile::encodeName(path).constData(), &st) == 0 ? st.st_mode : 0;
}

// A scratch folder holding the folder "taken" and the file "keep" ("old").
struct Scratch : QTemporaryDir {
    explicit Scratch(mode_t keepMode)
    {
        QDir(path()).mkdir("taken");
        QFile keep(filePath("keep"));
        if (keep.open(QIODevice::WriteOnly)) keep.write("old");
        ::chmod(QFile::encodeName(keep.fileName()).constData(), keepMode);
    }
    QStringList entries() const { return QDir(path()).entryList(QDir::AllEntries | QDir::Hidden | QDir::NoDotAndDotDot); }
};

struct WriteCase {
    const char* name;
    const char* file;                           // inside the scratch folder
    mode_t keepMode;                            // of "keep"
    rlim_t sizeLimit;                           // 0: none; else as a full disk
    std::optional<WriteFailure::Step> failure;  // nothing: written
};

class WholeFileTest : public testing::TestWithParam<std::tuple<WriteCase, Sync>> {};

TEST_P(WholeFileTest, WritesTheWholeFileOrLeavesTheFolderAsItWas)
{
    const auto& [c, sync] = GetParam();
    Scratch dir(c.keepMode);
    const QString path = dir.filePath(c.file);
    QStringList expected = dir.entries();
    if (!c.failure && !expected.contains(c.file)) expected.append(c.file), expected.sort();
    std::optional<test::FileSizeLimit> limit;
    if (c.sizeLimit) limit.emplace(c.sizeLimit);
    const std::optional<WriteFailure> failed = writeWholeFile(path, QByteArray(1000, 'x'), sync);
    limit.reset();
    EXPECT_EQ(dir.entries(), expected) << "a file or a temporary one left behind";
    EXPECT_EQ(failed ? std::optional(failed->step) : std::nullopt, c.failure);
    EXPECT_EQ(bytesOf(dir.filePath("keep")), QString(c.file) == "keep" && !c.failure ? QByteArray(1000, 'x') : "old");
    // A new file is readable as the user's file mask allows (not owner-only like a temporary
    // file); a replaced file keeps the mode it had.
    const mode_t mask = ::umask(0);
    ::umask(mask);
    if (!c.failure) EXPECT_EQ(modeOf(path) & 07777, QString(c.file) == "keep" ? c.keepMode : (0666 & ~mask));
}

INSTANTIATE_TEST_SUITE_P(
    Cases, WholeFileTest,
    testing::Combine(testing::Values(WriteCase{"newFile", "new", 0644, 0, std::nullopt},
                                     WriteCase{"replacedPrivateFile", "keep", 0600, 0, std::nullopt},
                                     WriteCase{"replacedSharedFile", "keep", 0664, 0, std::nullopt},
                                     WriteCase{"fullDisk", "keep", 0644, 48, WriteFailure::Write},
                                     WriteCase{"folderInTheWay", "taken", 0644, 0, WriteFailure::Rename},
                                     WriteCase{"missingFolder", "no/such/folder/new", 0644, 0, WriteFailure::Open}),
                     testing::Values(Sync::ToDisk, Sync::None)),
    [](const auto& info) {
        return std::string(std::get<0>(info.param).name) + (std::get<1>(info.param) == Sync::ToDisk ? "Synced" : "");
    });

// The synced write goes through a link to its file, as QSaveFile did; an export replaces the link.
TEST(WholeFileLinkTest, SyncedWriteFollowsALink)
{
    for (const Sync sync : {Sync::ToDisk, Sync::None}) {
        Scratch dir(0644);
        ASSERT_TRUE(QFile::link("keep", dir.filePath("link")));
        ASSERT_FALSE(writeWholeFile(dir.filePath("link"), "new", sync));
        EXPECT_EQ(S_ISLNK(modeOf(dir.filePath("link"))), sync == Sync::ToDisk);
        EXPECT_EQ(bytesOf(dir.filePath("keep")), sync == Sync::ToDisk ? "new" : "old");
    }
}

}  // namespace
}  // namespace kg::files

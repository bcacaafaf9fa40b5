#include "files/WholeFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>
#include <cerrno>
#include <cstdio>
#include <cstring>

namespace kg::files {

namespace {

WriteFailure failure(WriteFailure::Step step, int error)
{
    return {step, QString::fromLocal8Bit(std::strerror(error))};
}

bool writeAll(int fd, const char* data, size_t size)
{
    while (size > 0) {
        const ssize_t n = ::write(fd, data, size);
        if (n < 0 && errno == EINTR) continue;
        if (n <= 0) return false;
        data += n;
        size -= size_t(n);
    }
    return true;
}

// A hidden name beside the target that no other writer uses.
QByteArray temporaryName(const QFileInfo& target)
{
    const QString name = target.absolutePath() + QStringLiteral("/.") + target.fileName() + QLatin1Char('.') +
                         QString::number(QRandomGenerator::global()->generate64(), 36);
    return QFile::encodeName(name);
}

// The file a link leads to (followed as far as it goes, not resolved to a canonical path, so a
// link to a file not there yet still names it).
QFileInfo linkedFile(QFileInfo file)
{
    for (int depth = 128; depth > 0 && file.isSymLink(); --depth) file.setFile(file.symLinkTarget());
    return file;
}

}  // namespace

std::optional<WriteFailure> writeWholeFile(const QString& path, const QByteArray& bytes, Sync sync)
{
    QFileInfo target(path);
    if (sync == Sync::ToDisk) {
        target = linkedFile(target);
        if (target.exists() && !target.isWritable())
            return WriteFailure{WriteFailure::Open, QStringLiteral("Existing file %1 is not writable").arg(path)};
    }
    const QByteArray to = QFile::encodeName(target.absoluteFilePath());
    QByteArray from;
    int fd = -1;
    for (int attempt = 0; attempt < 8 && fd < 0; ++attempt) {
        from = temporaryName(target);
        // Created as a new file would be (the user's file mask applies), never over another one.
        fd = ::open(from.constData(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (fd < 0 && errno != EEXIST) break;
    }
    if (fd < 0) return failure(WriteFailure::Open, errno);
    struct stat old {};
    if (::stat(to.constData(), &old) == 0 && S_ISREG(old.st_mode)) ::fchmod(fd, old.st_mode & 07777);  // keeps its mode
    // The temporary file goes, whatever failed; errno is taken before anything can change it.
    const auto discard = [&](WriteFailure::Step step, int error) {
        ::unlink(from.constData());
        return failure(step, error);
    };
    const auto closeAndDiscard = [&](WriteFailure::Step step, int error) {
        ::close(fd);
        return discard(step, error);
    };
    if (!writeAll(fd, bytes.constData(), size_t(bytes.size()))) return closeAndDiscard(WriteFailure::Write, errno);
    if (sync == Sync::ToDisk && ::fsync(fd) != 0) return closeAndDiscard(WriteFailure::Sync, errno);
    if (::close(fd) != 0) return discard(WriteFailure::Write, errno);
    if (std::rename(from.constData(), to.constData()) != 0) return discard(WriteFailure::Rename, errno);
    return std::nullopt;
}

std::optional<QString> readWholeFile(const QString& path, QByteArray& bytes)
{
    bytes.clear();
    QFile file(path);
    if (!file.exists()) return std::nullopt;
    if (!file.open(QIODevice::ReadOnly)) return file.errorString();
    bytes = file.readAll();
    if (file.error() != QFileDevice::NoError) return file.errorString();
    return std::nullopt;
}

}  // namespace kg::files

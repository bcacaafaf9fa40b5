#include "chart/control/render/WholeFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>
#include <cerrno>
#include <cstdio>
#include <cstring>

#include "core/Error.h"

namespace kg::control {

namespace {
Error cannotWrite(const std::string& path, int error)
{
    return Error(errc::PathFileAccess, "Path/File access error: cannot write " + path + ": " + std::strerror(error));
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
}  // namespace

void writeWholeFile(const std::string& path, const QByteArray& bytes)
{
    const QFileInfo target(QString::fromStdString(path));
    const QByteArray to = QFile::encodeName(target.absoluteFilePath());
    QByteArray from;
    int fd = -1;
    for (int attempt = 0; attempt < 8 && fd < 0; ++attempt) {
        from = temporaryName(target);
        // Created as a new file would be (the user's file mask applies), never over another one.
        fd = ::open(from.constData(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (fd < 0 && errno != EEXIST) break;
    }
    if (fd < 0) throw cannotWrite(path, errno);
    struct stat old {};
    if (::stat(to.constData(), &old) == 0 && S_ISREG(old.st_mode)) ::fchmod(fd, old.st_mode & 07777);  // keeps its mode
    const bool written = writeAll(fd, bytes.constData(), size_t(bytes.size()));
    const int writeError = errno;
    if (::close(fd) != 0 || !written) {
        const int error = written ? errno : writeError;
        ::unlink(from.constData());
        throw cannotWrite(path, error);
    }
    if (std::rename(from.constData(), to.constData()) != 0) {
        const int error = errno;
        ::unlink(from.constData());
        throw cannotWrite(path, error);
    }
}

}  // namespace kg::control

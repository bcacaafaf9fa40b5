#pragma once
// Writing a file so that it appears whole or not at all.
#include <QByteArray>
#include <QString>
#include <optional>

namespace kg::files {

// Whether the write waits for the disk to confirm the data before the file replaces the old one.
enum class Sync {
    // fsync before the rename, and a link is written through to its file and a file the user may
    // not write is not replaced, as QSaveFile did: for the settings and the registration file,
    // which a power cut must not take away.
    ToDisk,
    // No fsync: for exports. That wait took about 7 ms, as long as painting and encoding a report
    // chart together, and a chart file can always be made again.
    None,
};

// The step that failed; `reason` is the system's text for it.
struct WriteFailure {
    enum Step { Open, Write, Sync, Rename } step;
    QString reason;
};

// Writes `bytes` to a temporary file beside `path`, every byte checked, and renames it over `path`
// when complete, so a failure leaves no partial file and an older file stays as it was (with its
// permissions; a new file gets those an ordinary new file would). Nothing when it worked.
std::optional<WriteFailure> writeWholeFile(const QString& path, const QByteArray& bytes, Sync sync);

// Reads the whole file at `path` into `bytes`; a file that does not exist reads as empty. The
// system's reason when it exists but cannot be read.
std::optional<QString> readWholeFile(const QString& path, QByteArray& bytes);

}  // namespace kg::files

#pragma once
// Writing a file so that it appears whole or not at all.
#include <QByteArray>
#include <string>

namespace kg::control {

// Writes `bytes` to a temporary file beside `path` and renames it over `path` when complete, so
// a failure leaves no partial file and an older file stays as it was (with its permissions).
// Unlike QSaveFile it does not wait for the disk to confirm the data (fsync): that wait took
// about 7 ms, as long as painting and encoding a report chart together, and a chart file can
// always be made again.
// Throws kg::Error 75 naming the file when it cannot be written.
void writeWholeFile(const std::string& path, const QByteArray& bytes);

}  // namespace kg::control

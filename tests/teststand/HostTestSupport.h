#pragma once
// What the test stand's tests share: a temporary folder template under the tests' own temp folder,
// the error a call raises, whole files as bytes and environment variables set for one test.
#include <gtest/gtest.h>

#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QString>
#include <functional>
#include <string>

#include "core/Error.h"
#include "core/RowSupport.h"

namespace kg::test {

// "<KG_TEST_TMP or the system temp>/<prefix>-XXXXXX" for QTemporaryDir / QTemporaryFile.
inline QString tempTemplate(const char* prefix)
{
    const QByteArray base = qgetenv("KG_TEST_TMP");
    const QString folder = base.isEmpty() ? QDir::tempPath() : QString::fromLocal8Bit(base);
    QDir().mkpath(folder);
    return folder + "/" + prefix + "-XXXXXX";
}

// The error `f` raises; a test failure when it raises none.
inline Error errorOf(const std::function<void()>& f)
{
    try {
        f();
    } catch (const Error& e) {
        return e;
    }
    ADD_FAILURE() << "no error was raised";
    return Error(0, "");
}

inline QByteArray fileBytes(const std::string& path)
{
    QFile f(QString::fromStdString(path));
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

inline void writeBytes(const std::string& path, const QByteArray& bytes)
{
    QFile f(QString::fromStdString(path));
    ASSERT_TRUE(f.open(QIODevice::WriteOnly)) << path;
    f.write(bytes);
}

// Sets (or, for nullptr, unsets) an environment variable and puts the old state back at the end.
class ScopedEnv {
public:
    ScopedEnv(const char* name, const char* value)
        : name_(name), saved_(qgetenv(name)), wasSet_(qEnvironmentVariableIsSet(name))
    {
        set(value);
    }
    ~ScopedEnv() { set(wasSet_ ? saved_.constData() : nullptr); }
    ScopedEnv(const ScopedEnv&) = delete;
    ScopedEnv& operator=(const ScopedEnv&) = delete;
    void set(const char* value) { value ? qputenv(name_, value) : qunsetenv(name_); }

private:
    const char* name_;
    QByteArray saved_;
    bool wasSet_;
};

}  // namespace kg::test

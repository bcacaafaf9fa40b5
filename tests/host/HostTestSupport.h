#pragma once
// What the test stand's tests share: a temporary folder template under the tests' own temp folder,
// and the error a call raises.
#include <gtest/gtest.h>

#include <QDir>
#include <QString>
#include <functional>

#include "core/Error.h"

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

}  // namespace kg::test

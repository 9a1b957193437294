// SPDX-License-Identifier: MIT
// The surroundings of every test: no display, the Portuguese locale that an unset one falls back
// to, one time zone, and folders of its own, so that no test touches what belongs to the user.
#include <gtest/gtest.h>

#include <QApplication>
#include <QTemporaryDir>

using namespace Qt::StringLiterals;

namespace {

void settleSurroundings(const QTemporaryDir& folder) {
    const QByteArray path = folder.path().toUtf8();  // readable by its owner only
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    // What does not depend on it is tested in another one too.
    qputenv("LC_ALL", qEnvironmentVariable("ZELMARS_TEST_LOCALE", u"C.UTF-8"_s).toUtf8());
    qputenv("TZ", "Europe/Lisbon");
    qputenv("HOME", path);
    qputenv("CUPS_SERVER", path + "/printing/socket");
    qputenv("XDG_RUNTIME_DIR", path);
    qputenv("XDG_CONFIG_HOME", path + "/config");
    qputenv("XDG_DATA_HOME", path + "/data");
    qputenv("ZELMARS_REGISTRY", path + "/registry");
}

}  // namespace

int main(int argc, char** argv) {
    const QTemporaryDir folder;
    settleSurroundings(folder);
    testing::InitGoogleTest(&argc, argv);
    QApplication application(argc, argv);
    QApplication::setQuitOnLastWindowClosed(false);
    return RUN_ALL_TESTS();
}

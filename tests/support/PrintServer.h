// SPDX-License-Identifier: MIT
#pragma once

#include <QProcess>
#include <QString>
#include <QStringList>

namespace support {

/// A print server of this test alone, with one printer, the default one, that keeps what it is
/// given. Where no server is installed the run fails with a text that says so. Make one at a time.
/// While there is none, the machine has no printer: every test looks for the server of its run.
class PrintServer {
public:
    enum class Printer {
        Ready,
        Refusing,  ///< takes no jobs
    };
    explicit PrintServer(Printer printer = Printer::Ready);
    ~PrintServer();
    PrintServer(const PrintServer&) = delete;
    PrintServer& operator=(const PrintServer&) = delete;

    /// Titles of the jobs that were printed, in their order; waits until there are so many.
    QStringList titles(int jobs);
    /// What was printed as the `number`th job, counted from 1.
    QString file(int number) const;

private:
    QString path(const QString& name) const;
    void write(const QString& name, const QString& text) const;
    QProcess server_;
};

}  // namespace support

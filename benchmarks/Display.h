// SPDX-License-Identifier: MIT
#pragma once

#include <QProcess>
#include <stdexcept>

namespace benchmarks {

/// A display for programs that are started; its own, and gone with the object.
class Display {
public:
    Display() {
        start(server_, QStringLiteral("Xvfb"),
              {QStringLiteral("-displayfd"), QStringLiteral("1"), QStringLiteral("-screen"),
               QStringLiteral("0"), QStringLiteral("1280x800x24"), QStringLiteral("-nolisten"),
               QStringLiteral("tcp")});
        name_ = u':' + QString::fromLatin1(server_.readAll()).trimmed();
    }
    ~Display() {
        for (QProcess* each : {&manager_, &server_}) {
            each->terminate();
            each->waitForFinished();
        }
    }
    Display(const Display&) = delete;
    Display& operator=(const Display&) = delete;

    /// Without one, windows lie where they open and none is in front.
    void startWindowManager() {
        manager_.setProcessEnvironment(surroundings());
        start(manager_, QStringLiteral("openbox"),
              {QStringLiteral("--startup"), QStringLiteral("echo ready")});
    }

    /// The environment of a program that is to show itself here.
    QProcessEnvironment surroundings() const {
        QProcessEnvironment all = QProcessEnvironment::systemEnvironment();
        all.insert(QStringLiteral("DISPLAY"), name_);
        all.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("xcb"));
        all.remove(QStringLiteral("WAYLAND_DISPLAY"));
        return all;
    }

private:
    /// Until it says that it is ready.
    static void start(QProcess& process, const QString& program, const QStringList& arguments) {
        process.start(program, arguments);
        if (!process.waitForReadyRead()) throw std::runtime_error("no virtual display");
    }
    QProcess server_;
    QProcess manager_;
    QString name_;
};

}  // namespace benchmarks

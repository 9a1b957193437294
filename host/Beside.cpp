// SPDX-License-Identifier: MIT
#include "host/Beside.h"

#include <QEventLoop>
#include <QThread>
#include <exception>

#include "platform/forms/Undisturbed.h"

namespace host {

void beside(const std::function<void()>& work) {
    const forms::Undisturbed undisturbed;
    std::exception_ptr failure;
    QEventLoop loop;
    const std::unique_ptr<QThread> thread(QThread::create([&] {
        try {
            work();
        } catch (...) {
            failure = std::current_exception();
        }
    }));
    QObject::connect(thread.get(), &QThread::finished, &loop, &QEventLoop::quit);
    thread->start();
    loop.exec();
    thread->wait();
    if (failure) std::rethrow_exception(failure);
}

}  // namespace host

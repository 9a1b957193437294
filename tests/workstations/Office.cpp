// SPDX-License-Identifier: MIT
// Workstations that are started, listened to and killed.
#include "tests/workstations/Office.h"

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QEventLoop>
#include <QProcess>
#include <QTimer>
#include <climits>
#include <memory>
#include <random>
#include <vector>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace office {

namespace {

/// Silence of everybody for longer than any lock is waited for.
constexpr int StandstillMilliseconds = 45'000;
/// The time from one kill to the next is drawn below this.
constexpr int KillWithinMilliseconds = 40;

struct Desk {
    int number = 0;
    QProcess process;
    bool isReady = false;
};

}  // namespace

QString Outcome::text() const {
    QString line = u"%1 postings in %2 s (%3/s), slowest %4 ms; %5 faults"_s.arg(posted)
                       .arg(seconds, 0, 'f', 2)
                       .arg(posted / qMax(seconds, 1e-6), 0, 'f', 0)
                       .arg(slowestPosting, 0, 'f', 0)
                       .arg(faults.size());
    if (killed > 0)
        line +=
            u"; %1 killed, leaving %2 unused numbers and %3 movements that the accumulators "
            u"lack; counter held again after at most %4 ms"_s.arg(killed)
                .arg(lostNumbers)
                .arg(lagging)
                .arg(slowestRelease, 0, 'f', 0);
    return line;
}

/// A stretch of work with its processes.
class Shift {
public:
    Shift(Office& office, QString program, int workstations, int postings, int kills)
        : office_(office),
          program_(std::move(program)),
          workstations_(workstations),
          postings_(postings),
          kills_(kills),
          book_(office.connect(30)) {
        standstill_.setInterval(StandstillMilliseconds);
        QObject::connect(&standstill_, &QTimer::timeout, &loop_, [this] {
            outcome_.faults << u"nobody posted any more"_s;
            killAll();
        });
        QObject::connect(&nextKill_, &QTimer::timeout, &loop_, [this] { killOne(); });
        nextKill_.setSingleShot(true);
    }

    Outcome run() {
        for (int i = 0; i < workstations_; ++i) start();
        standstill_.start();
        loop_.exec();
        return outcome_;
    }

private:
    void start() {
        Desk& desk = *desks_.emplace_back(std::make_unique<Desk>());
        desk.number = static_cast<int>(office_.said_.size()) + 1;
        office_.said_[desk.number] = {};
        ++working_;
        QObject::connect(&desk.process, &QProcess::readyReadStandardOutput, &loop_,
                         [this, &desk] { listen(desk); });
        QObject::connect(&desk.process, &QProcess::finished, &loop_, [this, &desk] { end(desk); });
        desk.process.setProcessChannelMode(QProcess::ForwardedErrorChannel);
        desk.process.start(program_, {QString::number(desk.number), QString::number(postings_)});
    }

    void listen(Desk& desk) {
        while (desk.process.canReadLine()) {
            const QByteArray line = desk.process.readLine().trimmed();
            if (line == "ready")
                admit(desk);
            else if (line.startsWith("box "))
                outcome_.faults << QString::fromUtf8(line);
            else
                note(desk, line);
        }
    }

    /// All begin together; whoever comes later begins at once.
    void admit(Desk& desk) {
        desk.isReady = true;
        if (!clock_.isValid()) {
            if (++ready_ < workstations_) return;
            clock_.start();
            for (const auto& each : desks_) each->process.write("\n");
            if (kills_ > 0) armKill();
        } else {
            desk.process.write("\n");
        }
    }

    void note(const Desk& desk, const QByteArray& line) {
        const QList<QByteArray> words = line.split(' ');
        Said& said = office_.said_[desk.number];
        if (words.value(0).toInt() != ++said.posted)
            outcome_.faults
                << u"workstation %1 said %2"_s.arg(desk.number).arg(QString::fromUtf8(line));
        ++outcome_.posted;
        outcome_.slowestPosting = qMax(outcome_.slowestPosting, words.value(1).toDouble() / 1000);
        standstill_.start();
    }

    void end(Desk& desk) {
        listen(desk);
        const Said& said = office_.said_[desk.number];
        const bool isDone = desk.process.exitStatus() == QProcess::NormalExit &&
                            desk.process.exitCode() == 0 && said.posted == postings_;
        if (!said.isKilled && !isDone)
            outcome_.faults
                << u"workstation %1 ended after %2 postings"_s.arg(desk.number).arg(said.posted);
        outcome_.seconds = static_cast<double>(clock_.isValid() ? clock_.nsecsElapsed() : 0) / 1e9;
        if (said.isKilled && outcome_.killed < kills_) start();
        if (--working_ == 0) loop_.quit();
    }

    void armKill() { nextKill_.start(static_cast<int>(random_() % KillWithinMilliseconds)); }

    /// At least all others but one are posting meanwhile.
    void killOne() {
        std::vector<Desk*> posting;
        for (const auto& desk : desks_)
            if (desk->process.state() == QProcess::Running &&
                office_.said_[desk->number].posted > 0)
                posting.push_back(desk.get());
        if (static_cast<int>(posting.size()) >= workstations_ - 1) {
            kill(*posting[random_() % posting.size()]);
            holdCounter();
            if (outcome_.killed >= kills_) return killAll();
        }
        armKill();
    }

    void kill(Desk& desk) {
        office_.said_[desk.number].isKilled = true;
        ++outcome_.killed;
        desk.process.kill();
    }

    void killAll() {
        for (const auto& desk : desks_)
            if (desk->process.state() != QProcess::NotRunning &&
                !office_.said_[desk->number].isKilled)
                kill(*desk);
    }

    /// What the killed one held is free: the counter, which everybody needs, can be held.
    void holdCounter() {
        QElapsedTimer clock;
        clock.start();
        const ado::RecordsetPtr counter = ado::Recordset::create();
        try {
            counter->Open(u"select * from tbContadores"_s, book_, ado::adOpenDynamic,
                          ado::adLockPessimistic);
            counter->value(0);
        } catch (const core::Failure& failure) {
            outcome_.faults << failure.text();
        }
        outcome_.slowestRelease =
            qMax(outcome_.slowestRelease, static_cast<double>(clock.nsecsElapsed()) / 1e6);
    }

    Office& office_;
    QString program_;
    int workstations_;
    int postings_;
    int kills_;
    ado::ConnectionPtr book_;
    QEventLoop loop_;
    QTimer standstill_;
    QTimer nextKill_;
    std::vector<std::unique_ptr<Desk>> desks_;
    QElapsedTimer clock_;
    std::mt19937 random_{std::random_device{}()};
    int ready_ = 0;
    int working_ = 0;
    Outcome outcome_;
};

Office::Office(Engine engine, int workstations)
    : engine_(engine), registryBefore_(qgetenv("ZELMARS_REGISTRY")) {
    qputenv("ZELMARS_REGISTRY", folder_.filePath(u"registry"_s).toUtf8());
    makeBook();
    fillBook(workstations);
    nameBook();
    registerComponent();
}

Office::~Office() {
    qputenv("ZELMARS_REGISTRY", registryBefore_);
}

Outcome Office::work(int workstations, int postings, const QString& program) {
    const QString path =
        program.isEmpty() ? QCoreApplication::applicationDirPath() + u"/workstation"_s : program;
    return finish(Shift(*this, path, workstations, postings, 0).run());
}

Outcome Office::workThroughKills(int workstations, int kills) {
    return finish(Shift(*this, QCoreApplication::applicationDirPath() + u"/workstation"_s,
                        workstations, INT_MAX, kills)
                      .run());
}

Outcome Office::finish(Outcome outcome) {
    audit(connect(2), engine_, said_, wasEmpty_, outcome);
    return outcome;
}

}  // namespace office

// SPDX-License-Identifier: MIT
#include <QApplication>
#include <QTemporaryDir>
#include <cstdio>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "platform/com/Component.h"

namespace {

/// Stands for the progress window, so that the rules are measured and not the painting of a bar.
class NoProgress : public QObject {
    Q_OBJECT
public:
    Q_INVOKABLE void Iniciar(int, const QString&, const QString&) {}
    Q_INVOKABLE void setvalor(int) {}
    Q_INVOKABLE void terminar() {}
};

}  // namespace

int main(int argc, char** argv) {
    if (argc > 1 && benchmarks::UntilListStands == QLatin1StringView(argv[1])) {
        const QApplication application(argc, argv);
        return benchmarks::tellWhenListStands();
    }
    if (argc > 1 && benchmarks::TypeKeys == QLatin1StringView(argv[1])) {
        const QApplication application(argc, argv);
        return benchmarks::typeKeys();
    }
    const QTemporaryDir registry;
    qputenv("ZELMARS_REGISTRY", registry.path().toUtf8());
    const QApplication application(argc, argv);
    com::registerRunning(QStringLiteral("Vorlane.General"), [] { return new NoProgress; });

    std::printf("Books that are written much lie %s; the server waits for no disk.\n",
                benchmarks::copiesInMemory() ? "in memory" : "on the disk");
    std::fflush(stdout);
    benchmarks::Report report(application.arguments().mid(1));
    try {
        benchmarks::measureCoverage(report);
        benchmarks::measureAccounts(report);
        benchmarks::measureBankFiles(report);
        benchmarks::measureBulk(report);
        benchmarks::measureEngines(report);
        benchmarks::measureHospitals(report);
        benchmarks::measureKeys(report);
        benchmarks::measureListings(report);
        benchmarks::measureLists(report);
        benchmarks::measurePrinting(report);
        benchmarks::measureScreens(report);
        benchmarks::measureSearches(report);
        benchmarks::measureWaits(report);
        benchmarks::measureWorkstations(report);
    } catch (const std::exception& failure) {
        std::fprintf(stderr, "%s\n", failure.what());
        return 2;
    }
    if (!report.write(QStringLiteral("build/bench.json"))) return 2;
    return report.allMet() ? 0 : 1;
}

#include "main.moc"

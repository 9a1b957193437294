// SPDX-License-Identifier: MIT
// Plays the road of a document through the real screens:
// zelmars-tour FOLDER [--scale PERCENT] [--dark]
#include <QApplication>
#include <optional>

#include "host/Console.h"
#include "host/Tasks.h"
#include "platform/core/Failure.h"
#include "tour/Desktop.h"
#include "tour/Tour.h"

using namespace Qt::StringLiterals;

namespace {

constexpr QSize OfficeDisplay(1366, 900);
constexpr int LeastScale = 50;
constexpr int MostScale = 300;

struct Wanted {
    QString folder;
    int scale = 100;  // of the letters, in percent
    bool dark = false;
};

/// Nothing when the words are not understood.
std::optional<Wanted> read(int argc, char** argv) {
    Wanted wanted;
    for (int at = 1; at < argc; ++at) {
        const QString word = QString::fromLocal8Bit(argv[at]);
        if (word == "--dark"_L1)
            wanted.dark = true;
        else if (word == "--scale"_L1 && at + 1 < argc)
            wanted.scale = QString::fromLocal8Bit(argv[++at]).toInt();
        else if (wanted.folder.isEmpty() && !word.startsWith(u'-'))
            wanted.folder = word;
        else
            return {};
    }
    const bool isUsual = wanted.scale >= LeastScale && wanted.scale <= MostScale;
    if (wanted.folder.isEmpty() || !isUsual) return {};
    return wanted;
}

}  // namespace

int main(int argc, char** argv) {
    const std::optional<Wanted> wanted = read(argc, argv);
    if (!wanted) {
        host::complain(
            u"zelmars-tour PASTA [--scale PERCENTAGEM] [--dark]: percorre o lançamento de um "
            "documento num livro de exemplo e deixa as imagens na pasta; com as letras de 50 % a "
            "300 % do tamanho habitual, e com cores escuras."_s);
        return host::WrongUse;
    }
    const tour::Display display(OfficeDisplay);
    QApplication application(argc, argv);
    QApplication::setApplicationName(u"zelmars"_s);
    QApplication::setApplicationVersion(QStringLiteral(ZELMARS_VERSION));
    tour::setDesktop(wanted->scale, wanted->dark);
    try {
        return tour::play(wanted->folder) ? host::Done : host::Failed;
    } catch (const core::Failure& failure) {
        host::complain(failure.text());
        return host::Failed;
    }
}

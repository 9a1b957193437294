// SPDX-License-Identifier: MIT
#include "host/BookAge.h"

#include <QDir>
#include <QMessageBox>
#include <QPushButton>

#include "database/Schema.h"
#include "database/Upgrade.h"
#include "database/Version.h"
#include "host/Beside.h"
#include "host/BookSettings.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

bool wantsToUpgrade(QWidget* window, const database::BookPlace& place, int version,
                    const QString& backup) {
    QMessageBox question(
        QMessageBox::Question, u"Livro de uma versão anterior"_s,
        u"O livro «%1» foi feito por um programa anterior e tem de ser atualizado antes de se "
        "trabalhar nele (da versão %2 para a %3)."_s.arg(QDir::toNativeSeparators(place.shown()))
            .arg(version)
            .arg(database::SchemaVersion),
        QMessageBox::Yes | QMessageBox::No, window);
    question.setObjectName(u"AtualizarLivro"_s);
    question.setTextFormat(Qt::PlainText);
    question.setInformativeText(
        u"Primeiro guarda-se uma cópia de segurança em\n%1\n\nDepois o livro passa à versão nova, "
        "de uma só vez: se alguma coisa falhar, fica como estava. Nada do que nele está escrito "
        "muda. O livro tem de estar fechado nos outros postos, que precisam também do programa "
        "novo.\n\nQuer atualizá-lo agora?"_s.arg(backup));
    question.button(QMessageBox::Yes)->setText(u"&Atualizar agora"_s);
    question.button(QMessageBox::No)->setText(u"&Mais tarde"_s);
    question.setDefaultButton(QMessageBox::No);
    question.setEscapeButton(QMessageBox::No);
    return question.exec() == QMessageBox::Yes;
}

}  // namespace

std::optional<QString> reasonAgainst(const BookSettings& settings) {
    try {
        const database::BookPlace place = settings.place();
        return database::whyUnfit(database::schemaVersion(*database::openedAnyway(place)), place);
    } catch (const core::Failure&) {
        return {};
    }
}

bool offerToUpgrade(QWidget* window, const BookSettings& settings) {
    const database::BookPlace place = settings.place();
    if (place.isOnServer()) return false;
    const int version = database::schemaVersion(*database::openedAnyway(place));
    if (version >= database::SchemaVersion) return version == database::SchemaVersion;
    const QString backup = database::upgradeBackupFile(place, version);
    if (!wantsToUpgrade(window, place, version, backup)) return false;
    beside([&] { database::bringUpToDate(place, backup, [](const QString&) {}); });
    QMessageBox done(QMessageBox::Information, u"Livro atualizado"_s,
                     u"O livro está atualizado. A cópia de segurança ficou em\n%1"_s.arg(backup),
                     QMessageBox::Ok, window);
    done.setTextFormat(Qt::PlainText);
    done.exec();
    return true;
}

}  // namespace host

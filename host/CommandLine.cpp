// SPDX-License-Identifier: MIT
#include "host/CommandLine.h"

#include <QFile>

#include "host/bankfile/PayingAccount.h"
#include "host/import/Kinds.h"

using namespace Qt::StringLiterals;

// A static library's resource is linked in only when it is asked for, and that from outside any
// namespace.
static void loadHelp() {
    Q_INIT_RESOURCE(help);
}

namespace host {

namespace {

const QString Administrator = u"postgres"_s;

CommandLine wrong(const QString& why) {
    return {.task = CommandLine::Task::Wrong, .wrong = why};
}

bool isSwitch(const QString& word) {
    return word.startsWith(u'-');
}

/// The words behind a command, which are taken out one after the other.
class Words {
public:
    explicit Words(const QStringList& line) : command_(line.first()), rest_(line.mid(1)) {}

    /// Takes a switch out; false when it is not there.
    bool flag(const QString& name) { return rest_.removeAll(name) > 0; }
    /// Takes a switch out and the word behind it; without the switch the text stays as it is.
    void value(const QString& name, QString& text) {
        const qsizetype at = rest_.indexOf(name);
        if (at < 0) return;
        const QString word = rest_.value(at + 1);
        if (word.isEmpty() || isSwitch(word))
            note(u"a «%1» falta o que vem a seguir."_s.arg(name));
        else
            text = word;
        rest_.remove(at, qMin(qsizetype{2}, rest_.size() - at));
    }
    /// Takes the next word, which has to be there.
    QString next(const QString& meaning) {
        for (qsizetype at = 0; at < rest_.size(); ++at)
            if (!isSwitch(rest_[at]) && !rest_[at].isEmpty()) return rest_.takeAt(at);
        note(u"falta %1."_s.arg(meaning));
        return {};
    }
    /// Takes the next word, which has to be a day.
    QDate nextDay(const QString& meaning) {
        const QString word = next(meaning);
        const QDate day = QDate::fromString(word, u"yyyy-MM-dd"_s);
        if (!word.isEmpty() && !day.isValid())
            note(u"«%1» não é um dia; a forma é aaaa-mm-dd."_s.arg(word));
        return day;
    }
    /// Notes what is wrong when it is.
    void require(bool isRight, const QString& why) {
        if (!isRight) note(why);
    }
    /// The line as it was read, or a refusal when something is missing in it or left over.
    CommandLine ended(const CommandLine& line) {
        // An unknown switch is told first: it may be a misspelt one, for want of which something
        // else seems to be missing.
        for (const QString& word : rest_)
            if (isSwitch(word)) return refused(u"não há a opção «%1»."_s.arg(word));
        if (!wrong_.isEmpty()) return refused(wrong_);
        if (!rest_.isEmpty()) return refused(u"«%1» está a mais."_s.arg(rest_.first()));
        return line;
    }

private:
    /// Of several things that are missing the first is told.
    void note(const QString& why) {
        if (wrong_.isEmpty()) wrong_ = why;
    }
    CommandLine refused(const QString& why) const { return wrong(command_ + u": "_s + why); }

    QString command_;
    QStringList rest_;
    QString wrong_;
};

CommandLine serverLine(Words words) {
    CommandLine line{
        .task = CommandLine::Task::InitServer, .user = u"zelmars"_s, .admin = Administrator};
    line.sample = words.flag(u"--sample"_s);
    words.value(u"--server"_s, line.server);
    words.value(u"--catalog"_s, line.catalogue);
    words.value(u"--user"_s, line.user);
    words.value(u"--admin"_s, line.admin);
    const CommandLine read = words.ended(line);
    if (read.task != CommandLine::Task::Wrong && line.catalogue.isEmpty())
        return wrong(u"init: falta «--catalog NOME»."_s);
    return read;
}

CommandLine initLine(const QStringList& all) {
    Words words(all);
    if (all.contains(u"--server"_s)) return serverLine(words);
    CommandLine line{.task = CommandLine::Task::Init};
    line.sample = words.flag(u"--sample"_s);
    line.ifNeeded = words.flag(u"--if-needed"_s);
    words.value(u"--group"_s, line.group);
    line.folder = words.next(u"a pasta do livro"_s);
    return words.ended(line);
}

CommandLine copyLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::Copy, .admin = Administrator};
    words.value(u"--admin"_s, line.admin);
    line.from = words.next(u"o livro de onde se copia"_s);
    line.into = words.next(u"o livro para onde se copia"_s);
    return words.ended(line);
}

CommandLine checkLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::Check};
    line.quick = words.flag(u"--quick"_s);
    words.value(u"--book"_s, line.book);
    words.value(u"--admin"_s, line.admin);
    return words.ended(line);
}

CommandLine backupLine(const QStringList& all, CommandLine::Task task) {
    Words words(all);
    CommandLine line{.task = task};
    words.value(u"--book"_s, line.book);
    words.value(u"--admin"_s, line.admin);
    if (task == CommandLine::Task::Restore) line.replace = words.flag(u"--replace"_s);
    line.file = words.next(u"o ficheiro da cópia de segurança"_s);
    return words.ended(line);
}

CommandLine upgradeLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::Upgrade};
    words.value(u"--book"_s, line.book);
    words.value(u"--admin"_s, line.admin);
    words.value(u"--backup"_s, line.file);
    return words.ended(line);
}

CommandLine bankFileLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::BankFile};
    line.withoutRefused = words.flag(u"--without-refused"_s);
    line.withoutSent = words.flag(u"--without-sent"_s);
    line.again = words.flag(u"--again"_s);
    words.require(!line.again || !line.withoutSent,
                  u"«--again» e «--without-sent» não vão juntos."_s);
    words.value(u"--version"_s, line.version);
    bankfile::Version version{};
    words.require(line.version.isEmpty() || bankfile::readVersion(line.version, version),
                  u"não há a versão «%1»; há 03 e 09."_s.arg(line.version));
    line.first = words.nextDay(u"o primeiro dia"_s);
    line.last = words.nextDay(u"o último dia"_s);
    line.file = words.next(u"o ficheiro a fazer"_s);
    words.require(line.first <= line.last, u"o último dia é anterior ao primeiro."_s);
    return words.ended(line);
}

CommandLine documentsLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::Documents};
    line.together = words.flag(u"--together"_s);
    line.wish.detailed = words.flag(u"--detailed"_s);
    const QString kind = words.next(u"o que se faz: letters, declarations ou extracts"_s);
    if (kind == "letters"_L1) {
        line.wish.kind = documents::Kind::Letters;
    } else if (kind == "declarations"_L1) {
        line.wish.kind = documents::Kind::Declarations;
        const QString year = words.next(u"o ano"_s);
        line.wish.year = year.toInt();
        words.require(line.wish.year > 0, u"«%1» não é um ano."_s.arg(year));
    } else if (kind == "extracts"_L1) {
        line.wish.first = words.nextDay(u"o primeiro dia"_s);
        line.wish.last = words.nextDay(u"o último dia"_s);
        words.require(line.wish.first <= line.wish.last, u"o último dia é anterior ao primeiro."_s);
    } else {
        words.require(false,
                      u"não há documentos «%1»; há letters, declarations e extracts."_s.arg(kind));
    }
    words.require(!line.wish.detailed || line.wish.kind == documents::Kind::Extracts,
                  u"«--detailed» é só dos extratos."_s);
    line.file = words.next(line.together ? u"o ficheiro a fazer"_s : u"a pasta"_s);
    return words.ended(line);
}

CommandLine importLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::Import};
    line.dryRun = words.flag(u"--dry-run"_s);
    line.withoutRefused = words.flag(u"--without-refused"_s);
    words.value(u"--book"_s, line.book);
    words.value(u"--admin"_s, line.admin);
    QStringList kinds;
    for (const importing::Description& each : importing::descriptions()) kinds << each.word;
    line.kind = words.next(u"o que se importa: "_s + kinds.join(u", "_s));
    words.require(line.kind.isEmpty() || kinds.contains(line.kind),
                  u"não se importa «%1»; há %2."_s.arg(line.kind, kinds.join(u", "_s)));
    line.file = words.next(u"o ficheiro a importar"_s);
    return words.ended(line);
}

CommandLine registerLine(const QStringList& all) {
    Words words(all);
    CommandLine line{.task = CommandLine::Task::Register};
    line.undo = words.flag(u"--undo"_s);
    return words.ended(line);
}

CommandLine operationLine(const QStringList& words) {
    if (const auto call = Operations::parsed(words))
        return {.task = CommandLine::Task::Operation, .call = *call};
    if (!Operations::names().contains(words.first(), Qt::CaseInsensitive))
        return wrong(u"«%1» não é um comando nem uma operação."_s.arg(words.first()));
    if (words.size() == 1) return wrong(u"a «%1» falta um argumento."_s.arg(words.first()));
    return wrong(u"«%1» não se chama com «%2»."_s.arg(words.first(), words.mid(1).join(u' ')));
}

}  // namespace

CommandLine CommandLine::parsed(const QStringList& words) {
    if (words.isEmpty()) return {};
    const QString& first = words.first();
    if (first == "init"_L1) return initLine(words);
    if (first == "copy"_L1) return copyLine(words);
    if (first == "check"_L1) return checkLine(words);
    if (first == "backup"_L1) return backupLine(words, Task::Backup);
    if (first == "restore"_L1) return backupLine(words, Task::Restore);
    if (first == "upgrade"_L1) return upgradeLine(words);
    if (first == "bankfile"_L1) return bankFileLine(words);
    if (first == "documents"_L1) return documentsLine(words);
    if (first == "import"_L1) return importLine(words);
    if (first == "register"_L1) return registerLine(words);
    if (first == "--help"_L1 || first == "-h"_L1) return Words(words).ended({.task = Task::Help});
    if (first == "--version"_L1) return Words(words).ended({.task = Task::Version});
    return operationLine(words);
}

bool CommandLine::needsScreen() const {
    const bool onlyLogsIn = task == Task::Operation && call.operation == "Login"_L1;
    return task == Task::Window || (task == Task::Operation && !onlyLogsIn);
}

QString helpText() {
    loadHelp();
    QFile file(u":/zelmars/help.txt"_s);
    return file.open(QIODevice::ReadOnly) ? QString::fromUtf8(file.readAll()) : QString();
}

}  // namespace host

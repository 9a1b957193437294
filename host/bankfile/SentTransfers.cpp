// SPDX-License-Identifier: MIT
#include "host/bankfile/SentTransfers.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QSaveFile>
#include <QStandardPaths>
#include <algorithm>

#include "platform/core/Failure.h"
#include "platform/core/NewFile.h"
#include "platform/core/PrivateFiles.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

constexpr int Patience = 5'000;  // milliseconds
const QString Ending = u".json"_s;
const QString Begun = u".iniciado.json"_s;  // of a record whose file is not known to be there

// The two tables of movements, as a record names them.
const QString Active = u"tbZelmar_Movimentos"_s;
const QString Left = u"tbZelmar_Movimentos_Inactivos"_s;

QString sentFolder() {
    return QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) +
           u"/zelmars/transferencias"_s;
}

QJsonArray written(const std::vector<MovementKey>& movements, bool left) {
    QJsonArray keys;
    for (const MovementKey& key : movements)
        if (key.left == left) keys.append(key.movimento_id);
    return keys;
}

QJsonObject written(const SentTransfer& transfer) {
    return {{u"no_kor"_s, transfer.staffNumber},
            {u"montante"_s, transfer.amount.toPlainText()},
            {u"referencia"_s, transfer.reference},
            {Active, written(transfer.movements, false)},
            {Left, written(transfer.movements, true)}};
}

QJsonObject written(const SentFile& sent) {
    QJsonArray transfers;
    for (const SentTransfer& transfer : sent.transfers) transfers.append(written(transfer));
    return {{u"quando"_s, sent.when.toString(Qt::ISODateWithMs)},
            {u"quem"_s, sent.who},
            {u"ficheiro"_s, sent.file},
            {u"livro"_s, sent.book},
            {u"transferencias"_s, transfers}};
}

/// Reads one record. Everything that it needs has to be there and of its kind: of a record that is
/// not understood nobody knows which movements were sent.
class RecordReader {
public:
    explicit RecordReader(const QString& path) : path_(path) {}

    SentFile read() const {
        QFile source(path_);
        if (!source.open(QIODevice::ReadOnly)) throw refusal(source.errorString());
        QJsonParseError error;
        const QJsonObject record = QJsonDocument::fromJson(source.readAll(), &error).object();
        if (error.error != QJsonParseError::NoError) throw refusal(error.errorString());
        SentFile sent{.when = QDateTime::fromString(text(record, u"quando"_s), Qt::ISODateWithMs),
                      .who = text(record, u"quem"_s),
                      .file = text(record, u"ficheiro"_s),
                      .book = text(record, u"livro"_s),
                      .isDone = !path_.endsWith(Begun)};
        for (const QJsonValue& each : array(record, u"transferencias"_s))
            sent.transfers.push_back(transfer(each.toObject()));
        return sent;
    }

private:
    core::Failure refusal(const QString& why) const {
        return {core::InvalidCall,
                u"O registo de transferências enviadas «%1» não se entende: %2"_s.arg(path_, why)};
    }
    QJsonValue value(const QJsonObject& object, const QString& name, QJsonValue::Type type) const {
        const QJsonValue found = object.value(name);
        if (found.type() != type) throw refusal(u"falta «%1»"_s.arg(name));
        return found;
    }
    QString text(const QJsonObject& object, const QString& name) const {
        return value(object, name, QJsonValue::String).toString();
    }
    QJsonArray array(const QJsonObject& object, const QString& name) const {
        return value(object, name, QJsonValue::Array).toArray();
    }
    SentTransfer transfer(const QJsonObject& object) const {
        const auto amount = core::Money::fromPlainText(text(object, u"montante"_s));
        if (!amount) throw refusal(u"«montante» não é um número"_s);
        SentTransfer read{text(object, u"no_kor"_s), *amount, text(object, u"referencia"_s), {}};
        for (const bool left : {false, true})
            for (const QJsonValue& key : array(object, left ? Left : Active))
                read.movements.push_back({left, key.toInteger()});
        return read;
    }

    QString path_;
};

}  // namespace

core::Money SentFile::sum() const {
    core::Money sum;
    for (const SentTransfer& transfer : transfers) sum = sum + transfer.amount;
    return sum;
}

SentTransfers::SentTransfers() : folder_(sentFolder()), lock_(folder_ + u"/ocupado"_s) {
    lock_.setStaleLockTime(0);  // never by its age; that of a program that is gone does not count
    if (!core::makePrivateFolder(folder_))
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível fazer a pasta «%1»."_s.arg(folder_));
}

void SentTransfers::lock() {
    if (lock_.tryLock(Patience)) return;
    throw core::Failure(core::InvalidCall,
                        lock_.error() == QLockFile::LockFailedError
                            ? u"Está outro ficheiro para o banco a ser feito. Tente outra vez "
                              "quando esse estiver pronto."_s
                            : u"Não foi possível escrever na pasta «%1»."_s.arg(folder_));
}

std::vector<SentFile> SentTransfers::files() const {
    std::vector<SentFile> files;
    const QDir folder(folder_);
    for (const QString& name : folder.entryList({u'*' + Ending}, QDir::Files, QDir::Name))
        files.push_back(RecordReader(folder.filePath(name)).read());
    std::stable_sort(files.begin(), files.end(), [](const SentFile& one, const SentFile& other) {
        return one.when > other.when;
    });
    return files;
}

SentMovements SentTransfers::movementsOf(const QString& book) const {
    SentMovements movements;
    for (const SentFile& sent : files()) {
        if (sent.book != book) continue;
        for (const SentTransfer& transfer : sent.transfers)
            for (const MovementKey& key : transfer.movements)
                movements.try_emplace(key, EarlierFile{sent.file, sent.when, sent.isDone});
    }
    return movements;
}

void SentTransfers::begin(const QString& name, const SentFile& sent) const {
    QSaveFile target(begunPath(name));
    const QByteArray record = QJsonDocument(written(sent)).toJson(QJsonDocument::Compact);
    if (!target.open(QIODevice::WriteOnly) || !target.setPermissions(core::OwnerOnly) ||
        target.write(record) != record.size() || !target.commit())
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível registar o que se envia em «%1»: %2"_s.arg(
                                target.fileName(), target.errorString()));
    core::toDisk(folder_);
}

void SentTransfers::finish(const QString& name) const {
    if (!QFile::rename(begunPath(name), folder_ + u'/' + name + Ending))
        throw core::Failure(
            core::InvalidCall,
            u"O ficheiro está feito, mas o registo «%1» ficou por acabar."_s.arg(begunPath(name)));
    core::toDisk(folder_);
}

void SentTransfers::giveUp(const QString& name) const {
    QFile::remove(begunPath(name));
}

QString SentTransfers::begunPath(const QString& name) const {
    return folder_ + u'/' + name + Begun;
}

}  // namespace bankfile

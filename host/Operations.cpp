// SPDX-License-Identifier: MIT
#include "host/Operations.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// An operation and how many texts it takes on the command line.
struct Signature {
    const char* name;
    int least;
    int most;
};

constexpr Signature Signatures[] = {
    {"CallPlafonds", 0, 2}, {"CallHospitais", 0, 2},  {"CallManutencaoDados", 0, 0},
    {"CallIRS", 0, 0},      {"CallFechoAno", 0, 0},   {"Login", 0, 5},
    {"Registo", 1, 1},      {"NewMovimento", 0, 3},   {"Correcao", 0, 2},
    {"Recebimento", 0, 2},  {"Extratos", 0, 2},       {"LPagamentos", 0, 0},
    {"Ldividas", 0, 0},     {"Lcartasdividas", 0, 0}, {"Lhospitais", 0, 0},
};

/// "true" and "false", also in Portuguese.
std::optional<bool> truth(const QString& text) {
    const QString lower = text.toLower();
    if (lower == "true"_L1 || lower == "verdadeiro"_L1 || lower == "sim"_L1) return true;
    if (lower == "false"_L1 || lower == "falso"_L1 || lower == u"não"_s) return false;
    return {};
}

std::optional<OperationCall> withTypes(const QString& name, const QStringList& texts) {
    QVariantList arguments(texts.begin(), texts.end());
    if (name == "CallPlafonds"_L1 && texts.isEmpty()) return Operations::rubrics();
    if (name == "CallHospitais"_L1 && texts.isEmpty()) return Operations::hospitals();
    if (name == "Registo"_L1) {
        bool isKey = false;
        const qint32 key = texts.first().toInt(&isKey);
        if (!isKey) return {};
        return Operations::movement(key, nullptr);
    }
    if (name == "NewMovimento"_L1) {
        if (arguments.isEmpty()) return Operations::newDocument(false);
        const auto hospital = truth(texts.first());
        if (!hospital) return {};
        arguments.first() = *hospital;
    }
    return OperationCall{name, arguments};
}

}  // namespace

QStringList Operations::names() {
    QStringList names;
    for (const Signature& signature : Signatures) names.append(QString::fromLatin1(signature.name));
    return names;
}

std::optional<OperationCall> Operations::parsed(const QStringList& words) {
    if (words.isEmpty()) return {};
    const QStringList texts = words.mid(1);
    for (const Signature& signature : Signatures) {
        const QString name = QString::fromLatin1(signature.name);
        if (words.first().compare(name, Qt::CaseInsensitive) != 0) continue;
        if (texts.size() < signature.least || texts.size() > signature.most) return {};
        return withTypes(name, texts);
    }
    return {};
}

OperationCall Operations::rubrics() {
    return {u"CallPlafonds"_s,
            {u"MSAccess"_s,
             u"select * from tbZelmar_Plafonds where rubrica_id_main is null order by code"_s}};
}

OperationCall Operations::hospitals() {
    // The screen shows the postal code under another name than the table has for it.
    return {
        u"CallHospitais"_s,
        {u"MSAccess"_s,
         u"select tbHospitais.*, code_postal as Codigo_Postal from tbHospitais order by nome"_s}};
}

OperationCall Operations::movement(qint32 movimento_id, QObject* caller) {
    return {u"Registo"_s,
            {QVariant(), movimento_id, QVariant(), QVariant(), QVariant::fromValue(caller)}};
}

OperationCall Operations::newDocument(bool hospital) {
    return {u"NewMovimento"_s, {hospital}};
}

QVariant Operations::call(const OperationCall& call) {
    if (!general_) general_ = com::createObject(u"Zelmars.General"_s);
    QVariantList arguments = call.arguments;
    return general_.call(call.operation, arguments);
}

}  // namespace host

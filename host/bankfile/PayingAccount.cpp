// SPDX-License-Identifier: MIT
#include "host/bankfile/PayingAccount.h"

#include <QFileInfo>
#include <QStandardPaths>

#include "host/bankfile/BankText.h"
#include "host/bankfile/Iban.h"
#include "platform/core/Failure.h"
#include "platform/core/PrivateFiles.h"
#include "platform/registry/SettingsFile.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

const QString Number = u"conta/numero"_s;
const QString Name = u"conta/nome"_s;
const QString Identifier = u"conta/identificacao"_s;
const QString Bic = u"conta/bic"_s;
const QString FileVersion = u"ficheiro/versao"_s;

constexpr qsizetype MostOfName = 70;
constexpr qsizetype MostOfIdentifier = 35;

}  // namespace

QString PayingAccount::settingsFile() {
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
           u"/zelmars/banco.ini"_s;
}

PayingAccount PayingAccount::read() {
    const registry::SettingsFile file(settingsFile());
    const auto text = [&](const QString& setting) { return file.value(setting).value_or(u""_s); };
    PayingAccount account{.number = text(Number),
                          .name = text(Name),
                          .identifier = text(Identifier),
                          .bic = text(Bic)};
    const QString version = text(FileVersion);
    if (!version.isEmpty() && !readVersion(version, account.version))
        throw core::Failure(
            core::InvalidCall,
            u"%1: não há a versão «%2» do ficheiro; há 03 e 09."_s.arg(settingsFile(), version));
    return account;
}

void PayingAccount::write() const {
    core::makePrivateFolder(QFileInfo(settingsFile()).absolutePath());
    registry::SettingsFile file(settingsFile());
    file.set(Number, number);
    file.set(Name, name);
    file.set(Identifier, identifier);
    file.set(Bic, bic);
    file.set(FileVersion, nameOf(version));
    file.write();
}

QStringList PayingAccount::faults() const {
    QStringList faults;
    if (number.isEmpty())
        faults << u"Falta a conta que paga (NIB ou IBAN)."_s;
    else if (iban().isEmpty())
        faults << u"A conta que paga não é um NIB nem um IBAN certo: os algarismos de controlo não "
                  "condizem."_s;
    if (bankText(name, MostOfName).isEmpty()) faults << u"Falta o nome da organização."_s;
    if (bankText(identifier, MostOfIdentifier).isEmpty())
        faults << u"Falta a identificação da organização."_s;
    else if (identifier.size() > MostOfIdentifier)
        faults << u"A identificação da organização tem mais de 35 carateres."_s;
    if (!bic.isEmpty() && !isBic(bic))
        faults << u"O BIC não é certo: tem 8 ou 11 letras e algarismos."_s;
    return faults;
}

QString PayingAccount::iban() const {
    return ibanTyped(number);
}

QString nameOf(Version version) {
    return version == Version::V03 ? u"03"_s : u"09"_s;
}

bool readVersion(const QString& name, Version& version) {
    if (name != "03"_L1 && name != "09"_L1) return false;
    version = name == "03"_L1 ? Version::V03 : Version::V09;
    return true;
}

}  // namespace bankfile

// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>

namespace bankfile {

/// The form of the file, by the year in which it was given out: banks are changing over from the
/// older to the newer.
enum class Version { V03, V09 };

/// Who pays, from which account. Kept in this user's settings, `zelmars/banco.ini`; the texts stand
/// as they were typed.
struct PayingAccount {
    QString number = {};      ///< national or international
    QString name = {};        ///< of the organisation
    QString identifier = {};  ///< by which the bank knows it
    QString bic = {};         ///< the bank's code; may be empty
    Version version = Version::V09;

    /// Fails when the settings cannot be read; what is not there is empty.
    static PayingAccount read();
    void write() const;
    /// Where they stand, for people.
    static QString settingsFile();

    /// What is missing or wrong, each in a sentence; none when a file can be made.
    QStringList faults() const;
    QString iban() const;

    friend bool operator==(const PayingAccount&, const PayingAccount&) = default;
};

/// "03" and "09", as people say it.
QString nameOf(Version version);
/// False, with the version as it was, for anything else.
bool readVersion(const QString& name, Version& version);

}  // namespace bankfile

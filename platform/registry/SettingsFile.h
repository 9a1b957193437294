// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QStringList>
#include <optional>
#include <vector>

namespace registry {

/// A settings file: lines `name=value` under headings `[group]`, comments behind ";" or "#" at the
/// beginning of a line, UTF-8. A value means what stands there, whatever signs it holds; blanks
/// around it do not count. Between quotes they do, and `\"`, `\\`, `\n`, `\r`, `\t` and `\xHHHH`
/// stand for signs. A setting is named by its group and its name, parted by "/", without regard to
/// case; the group "General" is no part of it. Comments and the order of the lines are kept.
class SettingsFile {
public:
    /// Who may read a file that holds a password.
    enum class Readers {
        Owner,
        Group,  ///< of a file that the administrator keeps for several users
    };

    /// Reads the file; a missing one is empty. Fails with the file's name and the number of the
    /// line when a line has no meaning, when the file cannot be read, or when it holds a password
    /// and somebody else has access to it.
    explicit SettingsFile(const QString& file, Readers readers = Readers::Owner);

    /// The names of all settings, in the order of the lines.
    QStringList settings() const;
    /// Nothing for a missing setting. Of several with the same name the last one counts.
    std::optional<QString> value(const QString& setting) const;

    /// Changes the setting's line; a new one goes behind the last line of its group.
    void set(const QString& setting, const QString& value);
    /// Removes the setting and all that lies under it; with an empty name everything.
    void remove(const QString& setting);
    /// Replaces the file in one go; only its owner can read it. Fails with a core::Failure.
    void write() const;

private:
    struct Line {
        QString text;     ///< as it stands in the file
        QString group;    ///< that it belongs to
        QString setting;  ///< empty for comments and headings
        QString value;
    };
    Line understood(const QString& text, qsizetype number, QString& group) const;
    const Line* find(const QString& setting) const;
    void refusePassword(Readers readers) const;

    QString file_;
    std::vector<Line> lines_;
};

/// True for the setting itself and for all that lies under it; for an empty name for everything.
bool liesUnder(const QString& setting, const QString& name);

}  // namespace registry

// SPDX-License-Identifier: MIT
#include "platform/registry/SettingsFile.h"

#include <QFile>
#include <QSaveFile>
#include <QStringDecoder>
#include <algorithm>

#include "platform/core/Failure.h"
#include "platform/core/PrivateFiles.h"

using namespace Qt::StringLiterals;

namespace registry {

namespace {

/// The heading under which settings without a group stand.
const QString NoGroup = u"General"_s;
/// The heading of a group that has that name.
const QString NamedGeneral = u"%General"_s;

/// Signs behind a backslash and what they stand for.
constexpr std::pair<char16_t, char16_t> Escapes[] = {
    {u'"', u'"'}, {u'\\', u'\\'}, {u'n', u'\n'}, {u'r', u'\r'}, {u't', u'\t'}};

/// The text without the blanks around it, which are blanks, tabs and the end of a foreign line.
QString trimmed(const QString& text) {
    const auto isBlank = [](QChar c) { return c == u' ' || c == u'\t' || c == u'\r'; };
    qsizetype from = 0;
    qsizetype to = text.size();
    while (from < to && isBlank(text[from])) ++from;
    while (to > from && isBlank(text[to - 1])) --to;
    return text.mid(from, to - from);
}

/// Hexadecimal digits from a place on, at most so many; none gives no number.
std::optional<char16_t> hexadecimal(const QString& text, qsizetype at, qsizetype most,
                                    qsizetype& length) {
    length = 0;
    const auto isDigit = [](QChar c) { return u"0123456789abcdefABCDEF"_s.contains(c); };
    while (length < most && at + length < text.size() && isDigit(text[at + length])) ++length;
    if (length == 0) return std::nullopt;
    return static_cast<char16_t>(text.mid(at, length).toUShort(nullptr, 16));
}

/// What stands between quotes; nothing when the quotes do not close at the end, or a backslash
/// stands before a sign that has no meaning.
std::optional<QString> unquoted(const QString& text) {
    QString value;
    for (qsizetype at = 1; at < text.size(); ++at) {
        if (text[at] == u'"') {
            if (at + 1 != text.size()) return std::nullopt;
            return value.isNull() ? u""_s : value;
        }
        if (text[at] != u'\\') {
            value += text[at];
            continue;
        }
        const QChar sign = ++at < text.size() ? text[at] : QChar();
        const auto* known = std::find_if(std::begin(Escapes), std::end(Escapes),
                                         [&](const auto& each) { return each.first == sign; });
        qsizetype digits = 0;
        if (known != std::end(Escapes)) {
            value += QChar(known->second);
        } else if (const auto code = hexadecimal(text, at + 1, 4, digits); sign == u'x' && code) {
            value += QChar(*code);
            at += digits;
        } else {
            return std::nullopt;
        }
    }
    return std::nullopt;
}

/// A value as it is written. Signs that would end the line or the quotes are written as escapes.
QString quotedWhereNeeded(const QString& value) {
    const bool isPlain = value == trimmed(value) && !value.startsWith(u'"') &&
                         std::none_of(value.begin(), value.end(),
                                      [](QChar c) { return c == u'\\' || c.unicode() < u' '; });
    if (isPlain) return value;
    QString text;
    for (const QChar c : value) {
        const auto* known = std::find_if(std::begin(Escapes), std::end(Escapes),
                                         [&](const auto& each) { return each.second == c; });
        if (known != std::end(Escapes))
            text += u"\\"_s + QChar(known->first);
        else if (c.unicode() < u' ')
            text += u"\\x%1"_s.arg(c.unicode(), 4, 16, QChar(u'0'));
        else
            text += c;
    }
    return u'"' + text + u'"';
}

/// A name as it is written: what is neither a letter, a digit nor one of "_-." as its code.
QString encodedName(const QString& name) {
    QString text;
    for (const QChar c : name) {
        const bool isPlain = c.unicode() < 0x80 && (c.isLetterOrNumber() || u"_-."_s.contains(c));
        if (c == u'/')
            text += u'\\';
        else if (isPlain)
            text += c;
        else
            text += c.unicode() <= 0xFF ? u"%%1"_s.arg(c.unicode(), 2, 16, QChar(u'0')).toUpper()
                                        : u"%U%1"_s.arg(c.unicode(), 4, 16, QChar(u'0')).toUpper();
    }
    return text;
}

QString decodedName(const QString& text) {
    QString name;
    for (qsizetype at = 0; at < text.size(); ++at) {
        const bool isLong = text[at] == u'%' && text.mid(at + 1, 1) == "U"_L1;
        const qsizetype wanted = isLong ? 4 : 2;
        const qsizetype from = at + (isLong ? 2 : 1);
        qsizetype digits = 0;
        const auto code = hexadecimal(text, from, wanted, digits);
        if (text[at] == u'%' && code && digits == wanted) {
            name += QChar(*code);
            at = from + digits - 1;
        } else {
            name += text[at] == u'\\' ? QChar(u'/') : text[at];
        }
    }
    return name;
}

QString groupOf(const QString& heading) {
    const QString text = trimmed(heading.mid(1, heading.size() - 2));
    if (text == NamedGeneral) return NoGroup;
    return text.compare(NoGroup, Qt::CaseInsensitive) == 0 ? QString() : decodedName(text);
}

QString headingOf(const QString& group) {
    if (group.isEmpty()) return u'[' + NoGroup + u']';
    const bool isTaken = group.compare(NoGroup, Qt::CaseInsensitive) == 0;
    return u'[' + (isTaken ? NamedGeneral : encodedName(group)) + u']';
}

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

}  // namespace

bool liesUnder(const QString& setting, const QString& name) {
    return name.isEmpty() || setting.compare(name, Qt::CaseInsensitive) == 0 ||
           setting.startsWith(name + u'/', Qt::CaseInsensitive);
}

SettingsFile::SettingsFile(const QString& file, Readers readers) : file_(file) {
    QFile source(file);
    if (!source.exists()) return;
    if (!source.open(QFile::ReadOnly))
        throw refusal(u"Não foi possível ler o ficheiro %1: %2"_s.arg(file, source.errorString()));
    QByteArray bytes = source.readAll();
    if (bytes.startsWith("\xEF\xBB\xBF")) bytes.remove(0, 3);
    if (bytes.endsWith('\n')) bytes.chop(1);
    if (bytes.isEmpty()) return;
    QString group;
    for (const QByteArray& each : bytes.split('\n')) {
        QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
        const QString text = decoder(each);
        const auto number = static_cast<qsizetype>(lines_.size()) + 1;
        if (decoder.hasError() || text.contains(QChar(u'\0')))
            throw refusal(u"%1, linha %2: não é texto em UTF-8."_s.arg(file).arg(number));
        lines_.push_back(understood(text, number, group));
    }
    refusePassword(readers);
}

SettingsFile::Line SettingsFile::understood(const QString& text, qsizetype number,
                                            QString& group) const {
    const auto refuse = [&](const QString& why) {
        return refusal(u"%1, linha %2: %3"_s.arg(file_).arg(number).arg(why));
    };
    const QString bare = trimmed(text);
    if (bare.startsWith(u'[') && bare.endsWith(u']')) group = groupOf(bare);
    if (bare.isEmpty() || u";#["_s.contains(bare[0])) {
        if (bare.startsWith(u'[') && !bare.endsWith(u']')) throw refuse(u"falta o «]»."_s);
        return {text, group, {}, {}};
    }
    const qsizetype sign = bare.indexOf(u'=');
    const QString name = decodedName(trimmed(bare.left(qMax(sign, qsizetype{0}))));
    if (name.isEmpty()) throw refuse(u"falta o nome ou o «=»; a forma é nome=valor."_s);
    const QString setting = group.isEmpty() ? name : group + u'/' + name;
    const QString written = trimmed(bare.mid(sign + 1));
    if (written.startsWith(u'"')) {
        const auto value = unquoted(written);
        if (!value)
            throw refuse(
                u"as aspas não fecham no fim, ou uma «\\» está antes de um sinal sem "
                "significado (escreva «\\\\» por «\\» e «\\\"» por aspas)."_s);
        return {text, group, setting, *value};
    }
    // Programs read such a value in two ways, so that neither can be taken for what was meant.
    if (written.contains(u'\\'))
        throw refuse(u"um valor com «\\» tem de estar entre aspas, com «\\\\» por cada «\\»."_s);
    return {text, group, setting, written.isNull() ? u""_s : written};
}

void SettingsFile::refusePassword(Readers readers) const {
    const bool holdsPassword = std::any_of(lines_.begin(), lines_.end(), [](const Line& line) {
        return line.setting.endsWith("password"_L1, Qt::CaseInsensitive) && !line.value.isEmpty();
    });
    const bool isShared = readers == Readers::Group;
    const QFile::Permissions theirs = isShared ? QFile::ReadGroup : QFile::Permissions();
    if (holdsPassword && !core::isPrivate(file_, theirs))
        throw refusal(
            u"O ficheiro %1 contém uma palavra-passe e outros utilizadores têm acesso a ele. "
            "Corrija-o com o comando: chmod %2 '%1'"_s.arg(file_, isShared ? u"640"_s : u"600"_s));
}

const SettingsFile::Line* SettingsFile::find(const QString& setting) const {
    const auto found = std::find_if(lines_.rbegin(), lines_.rend(), [&](const Line& line) {
        return !line.setting.isEmpty() && line.setting.compare(setting, Qt::CaseInsensitive) == 0;
    });
    return found == lines_.rend() ? nullptr : &*found;
}

QStringList SettingsFile::settings() const {
    QStringList settings;
    for (const Line& line : lines_)
        if (!line.setting.isEmpty()) settings << line.setting;
    return settings;
}

std::optional<QString> SettingsFile::value(const QString& setting) const {
    const Line* const line = find(setting);
    return line ? std::optional(line->value) : std::nullopt;
}

void SettingsFile::set(const QString& setting, const QString& value) {
    if (const Line* const known = find(setting)) {
        Line& line = lines_[static_cast<std::size_t>(known - lines_.data())];
        line.text = line.text.left(line.text.indexOf(u'=') + 1) + quotedWhereNeeded(value);
        line.value = value;
        return;
    }
    const qsizetype slash = setting.indexOf(u'/');
    const QString group = slash < 0 ? QString() : setting.left(slash);
    const QString text = encodedName(setting.mid(slash + 1)) + u'=' + quotedWhereNeeded(value);
    // Behind the last line of its group, before the blank lines that part it from the next one.
    auto last = std::find_if(lines_.rbegin(), lines_.rend(), [&](const Line& line) {
        return line.group.compare(group, Qt::CaseInsensitive) == 0 && !trimmed(line.text).isEmpty();
    });
    if (last == lines_.rend()) {
        lines_.push_back({headingOf(group), group, {}, {}});
        last = lines_.rbegin();
    }
    lines_.insert(last.base(), {text, group, setting, value});
}

void SettingsFile::remove(const QString& setting) {
    std::erase_if(lines_, [&](const Line& line) {
        return !line.setting.isEmpty() && liesUnder(line.setting, setting);
    });
}

void SettingsFile::write() const {
    QSaveFile target(file_);
    bool isWritten = target.open(QFile::WriteOnly) && target.setPermissions(core::OwnerOnly);
    for (const Line& line : lines_)
        isWritten = isWritten && target.write(line.text.toUtf8() + '\n') >= 0;
    if (!isWritten || !target.commit())
        throw refusal(u"Não foi possível guardar o valor no ficheiro %1: %2"_s.arg(
            file_, target.errorString()));
}

}  // namespace registry

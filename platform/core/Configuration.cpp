// SPDX-License-Identifier: MIT
#include "platform/core/Configuration.h"

#include <QFile>
#include <QStandardPaths>

using namespace Qt::StringLiterals;

namespace core {

QStringList configurationFiles(const QString& name) {
    return {QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
                u"/zelmars/"_s + name,
            u"/etc/zelmars/"_s + name};
}

std::optional<QString> lineFor(const QString& key, const QString& file) {
    QFile lines(file);
    if (!lines.open(QIODevice::ReadOnly)) return std::nullopt;
    while (!lines.atEnd()) {
        const QString line = QString::fromUtf8(lines.readLine()).trimmed();
        if (line.startsWith(u'#') || line.startsWith(u';')) continue;
        const qsizetype mark = line.indexOf(u'=');
        if (mark > 0 && line.first(mark).trimmed().compare(key, Qt::CaseInsensitive) == 0)
            return line.mid(mark + 1).trimmed();
    }
    return std::nullopt;
}

}  // namespace core

// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <algorithm>
#include <vector>

namespace ado {

/// Changes to a text, collected by position and made in one go.
class Edits {
public:
    void replace(qsizetype at, qsizetype length, const QString& text) {
        edits_.push_back({at, length, text});
    }
    void insert(qsizetype at, const QString& text) { replace(at, 0, text); }

    /// The text with all changes; of several at one place the earlier made stands first.
    QString applied(const QString& text) {
        if (edits_.empty()) return text;
        std::stable_sort(edits_.begin(), edits_.end(),
                         [](const Edit& a, const Edit& b) { return a.at < b.at; });
        QString result;
        result.reserve(text.size() + 64);
        qsizetype from = 0;
        for (const Edit& edit : edits_) {
            result += QStringView(text).mid(from, edit.at - from);
            result += edit.text;
            from = edit.at + edit.length;
        }
        return result += QStringView(text).mid(from);
    }

private:
    struct Edit {
        qsizetype at;
        qsizetype length;
        QString text;
    };
    std::vector<Edit> edits_;
};

}  // namespace ado

// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include <QObject>
#include <QStringList>
#include <functional>
#include <string>

#include "coverage/Posting.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "tests/support/Book.h"

inline void PrintTo(const QString& text, std::ostream* out) {
    *out << text.toStdString();
}

/// Stands for the progress window. It notes what it is asked, one line a call: "setvalor(1)";
/// "made" and "gone" tell of the object itself.
class FakeVorlane : public QObject {
    Q_OBJECT
public:
    FakeVorlane() { calls() << QStringLiteral("made"); }
    ~FakeVorlane() override { calls() << QStringLiteral("gone"); }
    static QStringList& calls() {
        static QStringList calls;
        return calls;
    }
    /// How many times the bar went one step on.
    static qsizetype steps() { return calls().count(QStringLiteral("setvalor(1)")); }

    Q_INVOKABLE void Iniciar(qint16 steps, const QString& text, const QString& title) {
        calls() << QStringLiteral("Iniciar(%1, %2, %3)").arg(QString::number(steps), text, title);
    }
    Q_INVOKABLE void setvalor(qint16 steps) {
        calls() << QStringLiteral("setvalor(%1)").arg(steps);
    }
    Q_INVOKABLE void terminar() { calls() << QStringLiteral("terminar()"); }
};

/// What an operator has keyed in; the amounts in euros, null for an empty field.
struct Document {
    QVariant rubrica_id;
    QString codABC = QStringLiteral("A");
    QVariant doc_valor = 100;
    QVariant recebido = 0;      ///< of a document
    bool hospital = false;      ///< a hospital bill
    QVariant incidencia = 100;  ///< of a hospital bill
};

/// A place where documents are entered: a book with one member in order, both connections open on
/// it, a progress window that only notes, a fixed day (15 May 2026) and operator ("operador").
class Desk : public ::testing::Test {
protected:
    Desk();
    ~Desk() override;

    /// The next message box. One that nobody expects, or one with another text, icon, title or
    /// choice, fails the test; so does one that never comes. Answers other than Ok are to a choice.
    static void expectBox(const QString& text, core::Icon icon = core::Icon::None,
                          const QString& title = core::DefaultTitle.toString(),
                          core::Answer answer = core::Answer::Ok);

    /// Opens the pending row of a new movement, as the entry screen does, and keys the document in.
    coverage::Entry enter(const Document& document) const;
    /// Tries out; the outcome is in `run`.
    void tryOut(const coverage::Entry& entry) { coverage::tryOut(entry, run); }
    /// A posting with nothing missing, by bank transfer.
    static coverage::PostingEntry posting(const coverage::Entry& entry);
    /// Posts, the operator saying yes.
    bool post(const coverage::PostingEntry& posting);
    bool post(const coverage::Entry& entry) { return post(posting(entry)); }

    /// Adds an accumulator row of the member.
    void accumulated(const QString& codABC, qint64 rubrica_id, double credit, int documents = 1);
    /// Adds an earlier movement of the member.
    void moved(qint64 rubrica_id, const QVariant& liquido, const QVariant& credito,
               const QString& tipo = QStringLiteral("DOC"));
    void setRubric(qint64 rubrica_id, const char* column, const QVariant& value);

    /// A column of the pending row as plain text, all decimals kept; "null" for null.
    static std::string kept(const coverage::Entry& entry, const char* column);
    /// A query's rows as text.
    std::string stored(const char* query) {
        return book.text(QString::fromUtf8(query)).toStdString();
    }

    static const QString caption;  ///< of the entry screen
    support::Book book;
    qint32 socio;
    coverage::TryOut run;
};

/// The number of the failure that `statement` raises; 0 when it passes.
int failureOf(const std::function<void()>& statement);

// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include <QObject>
#include <string>

#include "coverage/Posting.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

/// Stands for the progress window.
class FakeVorlane : public QObject {
    Q_OBJECT
public:
    Q_INVOKABLE void Iniciar(qint16, const QString&, const QString&) {}
    Q_INVOKABLE void setvalor(qint16) {}
    Q_INVOKABLE void terminar() {}
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
/// it, a progress window that shows nothing, a fixed day (15 May 2026) and operator ("operador").
class Desk : public ::testing::Test {
protected:
    Desk();
    ~Desk() override;

    /// The next message box.
    void expectBox(const QString& text, core::Icon icon = core::Icon::None,
                   const QString& title = core::DefaultTitle.toString()) {
        person.expectBox({.text = text, .icon = icon, .title = title});
    }

    /// Opens the pending row of a new movement, as the entry screen does, and keys the document in.
    coverage::Document enter(const Document& document) const;
    /// Tries out; the outcome is in `run`.
    void tryOut(const coverage::Document& entry) { coverage::tryOut(entry, run); }
    /// A posting with nothing missing, by bank transfer.
    static coverage::Posting posting(const coverage::Document& entry);
    /// Posts, the operator saying yes; then the boxes come.
    bool post(const coverage::Posting& posting, const QList<support::Operator::Box>& boxes = {});
    bool post(const coverage::Document& entry) { return post(posting(entry)); }

    /// Adds an accumulator row of the member.
    void accumulated(const QString& codABC, qint64 rubrica_id, double credit, int documents = 1);
    /// Adds an earlier movement of the member.
    void moved(qint64 rubrica_id, const QVariant& liquido, const QVariant& credito,
               const QString& tipo = QStringLiteral("DOC"));
    void setRubric(qint64 rubrica_id, const char* column, const QVariant& value);

    /// A column of the pending row as plain text, all decimals kept; "null" for null.
    static std::string kept(const coverage::Document& entry, const char* column);
    /// A query's rows as text.
    std::string stored(const char* query) {
        return book.text(QString::fromUtf8(query)).toStdString();
    }

    static const QString caption;  ///< of the entry screen
    support::Book book;
    support::Operator person;
    qint32 socio;
    coverage::TryOut run;
    data::Operation begun;  ///< of the last posting
};

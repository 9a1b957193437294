// SPDX-License-Identifier: MIT
#pragma once

#include "boundary/General.h"
#include "platform/core/Failure.h"
#include "platform/forms/DataCombo.h"
#include "platform/forms/TextBox.h"
#include "tests/coverage/Desk.h"

/// Stands for the two components that find members and persons.
class FakeSearch : public QObject {
    Q_OBJECT
public:
    static inline QVariant member = 0;  ///< what the next search finds
    static inline QVariant person = 0;
    static inline QString failure;

    Q_INVOKABLE void Login(const QVariant& = {}, const QVariant& = {}) {
        if (!failure.isEmpty()) throw core::Failure(core::CannotCreateObject, failure);
    }
    Q_INVOKABLE QVariant appShow(const QString&, const QVariant&) { return member; }
    Q_INVOKABLE QVariant FindSocios() { return member; }
    Q_INVOKABLE QVariant EscolherFamiliar(const QVariant&) { return person; }
};

/// The desk with the screens of receipts and repositions, and a rubric and a relative of the member
/// in order, who has the number 100015. Today is 15 May 2026.
class AccountTest : public Desk {
protected:
    AccountTest();
    ~AccountTest() override;

    /// Opens a new receipt or reposition as a host does, and waits for its defaults.
    void open(void (General::*operation)(QString*, QString*), const QString& screen);
    /// Opens a movement read-only and turns to its screen.
    void openView(qint64 key, const QString& screen);
    /// A movement of the member; the suffix of the tables of those who have left, or none.
    qint64 insert(const QString& tipo, const QString& suffix = {});

    /// Alt and the letter of a button that asks; yes.
    void press(QChar letter, const QString& question, const QString& title,
               const QList<support::Operator::Box>& boxes = {});
    /// "&OK" and yes; then the boxes come.
    void postAnd(const QList<support::Operator::Box>& boxes = {}) {
        press(u'O', QStringLiteral("Deseja finalizar o registo?"), title, boxes);
    }
    /// Types into a field and expects a box, the field keeping the focus.
    void expectHeld(const QString& field, const QString& text, const QString& box);
    QString shown(const QString& field) { return person.peek(field)->property("text").toString(); }
    bool isGrey(const QString& field) {
        return person.peek<forms::TextBox>(field)->backColor() == forms::BackColor::Menu;
    }
    /// The next number, and the accumulators in the order in which they came.
    std::string totals(const QString& suffix = {});

    const QString title = QStringLiteral("Lançamento de Zelmar");
    const qint64 rubric = book.childRubric({.code = QStringLiteral("0101")});
    const qint64 relative = book.person({.socio_id = socio});
    General general;
};

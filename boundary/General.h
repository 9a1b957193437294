// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QString>
#include <QVariant>

/// The component's one public class. Each operation logs in by itself, from the values of the
/// registry, and opens one screen or one report; a host creates the object and calls what it wants.
/// The operations stand in the order of their interface slots. Texts are by reference; null is an
/// argument left out. It holds no data: all objects share one login state and one data environment.
///
/// A failure goes up to the caller as a core::Failure, except where an operation says otherwise. A
/// call in another thread than the application's always fails so. Without a valid login an
/// operation shows the refusal "Bad Login" and returns, except where it says otherwise.
class General : public QObject {
    Q_OBJECT
public:
    General();

    /// The rubrics, modal, on the row set of `strSQL` through the connection of that name.
    Q_INVOKABLE void CallPlafonds(QString* strConMember, QString* strSQL);
    /// The hospitals, in the same way.
    Q_INVOKABLE void CallHospitais(QString* strConMember, QString* strSQL);
    /// Data maintenance, tax declarations, year close; modal.
    Q_INVOKABLE void CallManutencaoDados();
    Q_INVOKABLE void CallIRS();
    Q_INVOKABLE void CallFechoAno();
    /// Whether the five values are there and both connections opened. The arguments are ignored.
    Q_INVOKABLE bool Login(QString* Temp1 = nullptr, QString* Temp2 = nullptr,
                           QString* Temp3 = nullptr, QString* Temp4 = nullptr,
                           QString* Temp5 = nullptr);
    /// One existing movement, read-only and modeless. `rs`, `Tabela` and `strWhere` are ignored.
    /// Goes on without a valid login; shows its failures in a box.
    Q_INVOKABLE void Registo(const QVariant& rs, const QVariant& Pkey = {},
                             QString* Tabela = nullptr, QString* strWhere = nullptr,
                             QObject* Caller = nullptr);
    /// The entry screen on a new row, modeless. Empty texts receive the defaults that were used.
    Q_INVOKABLE void NewMovimento(bool bHospital, QString* strConMember = nullptr,
                                  QString* strSQL = nullptr);
    /// A reposition, and a receipt, on a new row in the same way.
    Q_INVOKABLE void Correcao(QString* strConMember = nullptr, QString* strSQL = nullptr);
    Q_INVOKABLE void Recebimento(QString* strConMember = nullptr, QString* strSQL = nullptr);
    /// A member's extract, modal. Both arguments are ignored.
    Q_INVOKABLE void Extratos(QString* strConMember = nullptr, QString* strSQL = nullptr);
    /// The payment listings, modal.
    Q_INVOKABLE void LPagamentos();
    /// Debt listing, debt letters, hospital listing: true on success. Intentional: they go on
    /// without a valid login and give false for any failure, without a word.
    Q_INVOKABLE bool Ldividas();
    Q_INVOKABLE bool Lcartasdividas();
    Q_INVOKABLE bool Lhospitais();
};

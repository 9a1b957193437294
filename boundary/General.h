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
/// call in another thread than the application's always fails so.
/// Without a valid login all but the marked operations show the refusal "Bad Login" and return.
class General : public QObject {
    Q_OBJECT
public:
    General();

    /// The rubrics, modal, on the row set of `strSQL` through the connection of that name.
    Q_INVOKABLE void CallPlafonds(QString* strConMember, QString* strSQL);
    /// The hospitals, likewise.
    Q_INVOKABLE void CallHospitais(QString* strConMember, QString* strSQL);
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
    /// A correction of an account, and a receipt, likewise.
    Q_INVOKABLE void Correcao(QString* strConMember = nullptr, QString* strSQL = nullptr);
    Q_INVOKABLE void Recebimento(QString* strConMember = nullptr, QString* strSQL = nullptr);
    /// Both arguments are ignored.
    Q_INVOKABLE void Extratos(QString* strConMember = nullptr, QString* strSQL = nullptr);
    Q_INVOKABLE void LPagamentos();
    // These three go on without a valid login and give false for any failure, without a word.
    Q_INVOKABLE bool Ldividas();
    Q_INVOKABLE bool Lcartasdividas();
    Q_INVOKABLE bool Lhospitais();
};

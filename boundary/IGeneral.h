// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>

#include "platform/com/Unknown.h"

/// The interface `_General`: the operations of General in the order of their slots, for hosts that
/// do not call by name. Each gives a status: Ok, or Fail with the text in lastErrorText(). Results
/// come back through the last argument, which may be null; null texts are arguments left out.
class IGeneral : public com::Dispatch {
public:
    virtual com::Status CallPlafonds(QString* strConMember, QString* strSQL) = 0;
    virtual com::Status CallHospitais(QString* strConMember, QString* strSQL) = 0;
    virtual com::Status CallManutencaoDados() = 0;
    virtual com::Status CallIRS() = 0;
    virtual com::Status CallFechoAno() = 0;
    virtual com::Status Login(QString* Temp1, QString* Temp2, QString* Temp3, QString* Temp4,
                              QString* Temp5, bool* result) = 0;
    /// A null `rs` or `Pkey` is one left out.
    virtual com::Status Registo(const QVariant* rs, const QVariant* Pkey, QString* Tabela,
                                QString* strWhere, QObject* Caller) = 0;
    virtual com::Status NewMovimento(bool bHospital, QString* strConMember, QString* strSQL) = 0;
    virtual com::Status Correcao(QString* strConMember, QString* strSQL) = 0;
    virtual com::Status Recebimento(QString* strConMember, QString* strSQL) = 0;
    virtual com::Status Extratos(QString* strConMember, QString* strSQL) = 0;
    virtual com::Status LPagamentos() = 0;
    virtual com::Status Ldividas(bool* result) = 0;
    virtual com::Status Lcartasdividas(bool* result) = 0;
    virtual com::Status Lhospitais(bool* result) = 0;

protected:
    ~IGeneral() = default;
};

/// {7862b93e-d483-4374-9451-1136597e36c0}
inline constexpr com::Guid IidGeneral{
    0x7862b93e, 0xd483, 0x4374, {0x94, 0x51, 0x11, 0x36, 0x59, 0x7e, 0x36, 0xc0}};
/// {ca01cffc-cfd5-45ba-8a33-b5db8fd32e63}, programmatic name "Zelmars.General"
inline constexpr com::Guid ClsidGeneral{
    0xca01cffc, 0xcfd5, 0x45ba, {0x8a, 0x33, 0xb5, 0xdb, 0x8f, 0xd3, 0x2e, 0x63}};

// SPDX-License-Identifier: MIT
#include "host/bankfile/CreditTransferFile.h"

#include <QIODevice>
#include <QXmlStreamWriter>

#include "host/bankfile/BankText.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

constexpr qsizetype MostOfName = 70;
constexpr qsizetype MostOfIdentifier = 35;

/// Writes the parts of one file, in the order that its form demands.
class Writer {
public:
    Writer(const CreditTransferFile& file, QString& text) : file_(file), xml_(&text) {
        core::Money sum;
        for (const Payment& payment : file.payments) sum = sum + payment.amount;
        sum_ = amountText(sum);
        count_ = QString::number(file.payments.size());
    }

    void write() {
        xml_.setAutoFormatting(true);
        xml_.setAutoFormattingIndent(0);  // a line an element
        xml_.writeStartElement(u"Document"_s);
        xml_.writeDefaultNamespace(u"urn:iso:std:iso:20022:tech:xsd:pain.001.001."_s +
                                   nameOf(file_.payer.version));
        xml_.writeStartElement(u"CstmrCdtTrfInitn"_s);
        writeHeader();
        writePayments();
        xml_.writeEndDocument();
        if (xml_.hasError()) throw core::Failure(core::InvalidCall, xml_.device()->errorString());
    }

private:
    /// An element and, inside, what the function writes.
    template <class Inside>
    void within(const QString& name, const Inside& inside) {
        xml_.writeStartElement(name);
        inside();
        xml_.writeEndElement();
    }
    void text(const QString& name, const QString& value) { xml_.writeTextElement(name, value); }
    bool isOld() const { return file_.payer.version == Version::V03; }

    void writeHeader() {
        within(u"GrpHdr"_s, [&] {
            text(u"MsgId"_s, file_.message);
            text(u"CreDtTm"_s, file_.made.toString(u"yyyy-MM-ddTHH:mm:ss"_s));
            text(u"NbOfTxs"_s, count_);
            text(u"CtrlSum"_s, sum_);
            writeOrganisation(u"InitgPty"_s);
        });
    }
    void writeOrganisation(const QString& role) {
        within(role, [&] {
            text(u"Nm"_s, bankText(file_.payer.name, MostOfName));
            within(u"Id"_s, [&] {
                within(u"OrgId"_s, [&] {
                    within(u"Othr"_s, [&] {
                        text(u"Id"_s, bankText(file_.payer.identifier, MostOfIdentifier));
                    });
                });
            });
        });
    }
    void writeAccount(const QString& role, const QString& iban) {
        within(role, [&] { within(u"Id"_s, [&] { text(u"IBAN"_s, iban); }); });
    }
    void writePayments() {
        within(u"PmtInf"_s, [&] {
            text(u"PmtInfId"_s, file_.message);
            text(u"PmtMtd"_s, u"TRF"_s);
            text(u"BtchBookg"_s, u"true"_s);
            text(u"NbOfTxs"_s, count_);
            text(u"CtrlSum"_s, sum_);
            within(u"PmtTpInf"_s, [&] { within(u"SvcLvl"_s, [&] { text(u"Cd"_s, u"SEPA"_s); }); });
            writeDay();
            writeOrganisation(u"Dbtr"_s);
            writeAccount(u"DbtrAcct"_s, file_.payer.iban());
            within(u"DbtrAgt"_s, [&] { within(u"FinInstnId"_s, [&] { writeBank(); }); });
            text(u"ChrgBr"_s, u"SLEV"_s);
            for (const Payment& payment : file_.payments) writePayment(payment);
        });
    }
    void writeDay() {
        const QString day = file_.execution.toString(Qt::ISODate);
        if (isOld())
            text(u"ReqdExctnDt"_s, day);
        else
            within(u"ReqdExctnDt"_s, [&] { text(u"Dt"_s, day); });
    }
    void writeBank() {
        if (file_.payer.bic.isEmpty())
            within(u"Othr"_s, [&] { text(u"Id"_s, u"NOTPROVIDED"_s); });
        else
            text(isOld() ? u"BIC"_s : u"BICFI"_s, file_.payer.bic);
    }
    void writePayment(const Payment& payment) {
        within(u"CdtTrfTxInf"_s, [&] {
            within(u"PmtId"_s, [&] { text(u"EndToEndId"_s, payment.reference); });
            within(u"Amt"_s, [&] {
                within(u"InstdAmt"_s, [&] {
                    xml_.writeAttribute(u"Ccy"_s, u"EUR"_s);
                    xml_.writeCharacters(amountText(payment.amount));
                });
            });
            within(u"Cdtr"_s, [&] { text(u"Nm"_s, payment.name); });
            writeAccount(u"CdtrAcct"_s, payment.iban);
            within(u"RmtInf"_s, [&] { text(u"Ustrd"_s, payment.explanation); });
        });
    }

    const CreditTransferFile& file_;
    QXmlStreamWriter xml_;
    QString sum_;
    QString count_;
};

}  // namespace

void CreditTransferFile::write(QIODevice& device) const {
    // In one piece: a device takes a million pieces of some letters very slowly.
    QString text = u"<?xml version=\"1.0\" encoding=\"UTF-8\"?>"_s;
    Writer(*this, text).write();
    const QByteArray bytes = text.toUtf8();
    if (device.write(bytes) != bytes.size())
        throw core::Failure(core::InvalidCall, device.errorString());
}

QString amountText(core::Money amount) {
    const QString four = amount.toPlainText();
    return four.left(four.size() - 2);
}

}  // namespace bankfile

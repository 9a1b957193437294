// SPDX-License-Identifier: MIT
// The component's way out: its object for hosts, its class, and the four entry points.
#include <QApplication>
#include <QThread>
#include <algorithm>

#include "boundary/General.h"
#include "boundary/IGeneral.h"
#include "platform/com/Counted.h"
#include "platform/com/Server.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace {

/// Turns the exceptions of General into failing statuses.
class GeneralComponent final : public com::Counted<IGeneral> {
public:
    GeneralComponent() : Counted({com::IidUnknown, com::IidDispatch, IidGeneral}) {}

    QObject* automation() override { return &general_; }
    const char* lastErrorText() override { return lastError_.constData(); }

    com::Status CallPlafonds(QString* strConMember, QString* strSQL) override {
        return run([&] { general_.CallPlafonds(strConMember, strSQL); });
    }
    com::Status CallHospitais(QString* strConMember, QString* strSQL) override {
        return run([&] { general_.CallHospitais(strConMember, strSQL); });
    }
    com::Status CallManutencaoDados() override {
        return run([&] { general_.CallManutencaoDados(); });
    }
    com::Status CallIRS() override {
        return run([&] { general_.CallIRS(); });
    }
    com::Status CallFechoAno() override {
        return run([&] { general_.CallFechoAno(); });
    }
    com::Status Login(QString* Temp1, QString* Temp2, QString* Temp3, QString* Temp4,
                      QString* Temp5, bool* result) override {
        return run(result, [&] { return general_.Login(Temp1, Temp2, Temp3, Temp4, Temp5); });
    }
    com::Status Registo(const QVariant* rs, const QVariant* Pkey, QString* Tabela,
                        QString* strWhere, QObject* Caller) override {
        const QVariant leftOut;
        return run([&] {
            general_.Registo(rs ? *rs : leftOut, Pkey ? *Pkey : leftOut, Tabela, strWhere, Caller);
        });
    }
    com::Status NewMovimento(bool bHospital, QString* strConMember, QString* strSQL) override {
        return run([&] { general_.NewMovimento(bHospital, strConMember, strSQL); });
    }
    com::Status Correcao(QString* strConMember, QString* strSQL) override {
        return run([&] { general_.Correcao(strConMember, strSQL); });
    }
    com::Status Recebimento(QString* strConMember, QString* strSQL) override {
        return run([&] { general_.Recebimento(strConMember, strSQL); });
    }
    com::Status Extratos(QString* strConMember, QString* strSQL) override {
        return run([&] { general_.Extratos(strConMember, strSQL); });
    }
    com::Status LPagamentos() override {
        return run([&] { general_.LPagamentos(); });
    }
    com::Status Ldividas(bool* result) override {
        return run(result, [&] { return general_.Ldividas(); });
    }
    com::Status Lcartasdividas(bool* result) override {
        return run(result, [&] { return general_.Lcartasdividas(); });
    }
    com::Status Lhospitais(bool* result) override {
        return run(result, [&] { return general_.Lhospitais(); });
    }

private:
    template <class Operation>
    com::Status run(const Operation& operation) {
        lastError_.clear();
        try {
            operation();
            return com::Ok;
        } catch (const std::exception& failure) {
            lastError_ = failure.what();
        } catch (...) {
            lastError_ = "Falha desconhecida.";
        }
        return com::Fail;
    }

    template <class Operation>
    com::Status run(bool* result, const Operation& operation) {
        bool value = false;
        const com::Status status = run([&] { value = operation(); });
        if (result) *result = value;
        return status;
    }

    General general_;
    QByteArray lastError_;
};

com::Dispatch* makeGeneral() {
    return new GeneralComponent;
}

/// True when a screen is still open: screens outlive the object whose operation opened them. Only
/// their own thread can look for them; in any other one there may be some.
bool isScreenShown() {
    if (!qobject_cast<QApplication*>(QCoreApplication::instance())) return false;
    if (QThread::currentThread() != qApp->thread()) return true;
    const QWidgetList windows = QApplication::topLevelWidgets();
    return std::any_of(windows.begin(), windows.end(), [](const QWidget* window) {
        return window->isVisible() && qobject_cast<const forms::Form*>(window);
    });
}

const com::ServedClass& servedGeneral() {
    static const com::ServedClass served{ClsidGeneral,   u"Zelmars.General"_s, u"Plano de saúde"_s,
                                         u"1.00.0002"_s, u"_General"_s,        makeGeneral,
                                         isScreenShown};
    return served;
}

}  // namespace

ZELMARS_SERVER(servedGeneral)

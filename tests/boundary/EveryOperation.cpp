// SPDX-License-Identifier: MIT
// A host of its own, which knows the component's table of functions and nothing else of it: calls
// every operation and tells, a line each, its status, its result and the windows that came, which
// are closed at once. usage: every_operation LIBRARY KEY_OF_A_MOVEMENT
#include <QApplication>
#include <QLibrary>
#include <QMessageBox>
#include <QTextStream>
#include <QTimer>

#include "boundary/IGeneral.h"

using namespace Qt::StringLiterals;

namespace {

/// Notes and closes every window that is shown.
class Person : public QObject {
public:
    Person() { qApp->installEventFilter(this); }
    QStringList takeWindows() {
        // What stays open beyond its operation is closed by now.
        for (int turn = 0; turn < 20; ++turn) QApplication::processEvents();
        return std::exchange(windows_, {});
    }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        auto* window = qobject_cast<QDialog*>(watched);
        if (window && event->type() == QEvent::Show) {
            const auto* box = qobject_cast<QMessageBox*>(window);
            windows_ << (box ? u"box:"_s + box->text() : window->objectName());
            QTimer::singleShot(0, window, [window] { window->reject(); });
        }
        return false;
    }

private:
    QStringList windows_;
};

IGeneral* createGeneral(const QString& library) {
    const auto entry =
        reinterpret_cast<com::Status (*)(const com::Guid*, const com::Guid*, void**)>(
            QLibrary::resolve(library, "DllGetClassObject"));
    void* made = nullptr;
    if (!entry || entry(&ClsidGeneral, &com::IidClassFactory, &made) != com::Ok) return nullptr;
    auto* const factory = static_cast<com::ClassFactory*>(made);
    made = nullptr;
    factory->CreateInstance(nullptr, IidGeneral, &made);
    factory->Release();
    return static_cast<IGeneral*>(made);
}

}  // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    const QStringList words = QApplication::arguments();
    IGeneral* const general = createGeneral(words.value(1));
    if (!general) return 2;
    Person person;
    QTextStream out(stdout);
    const auto tell = [&](const char* name, com::Status status, const char* result = "") {
        out << name << ' ' << (status == com::Ok ? "ok" : "failed") << result;
        if (status != com::Ok && qstrlen(general->lastErrorText()) == 0) out << " without a text";
        for (QString window : person.takeWindows())
            out << " [" << window.replace(u'\n', u' ') << ']';
        out << Qt::endl;
    };
    bool result = false;
    const auto shown = [&result] { return result ? " true" : " false"; };
    QString connection = u"MSAccess"_s;
    QString rubrics = u"select * from tbZelmar_Plafonds order by code"_s;
    QString hospitals =
        u"select tbHospitais.*, code_postal as Codigo_Postal from tbHospitais order by nome"_s;
    const QVariant key = words.value(2).toInt();
    QString none;

    com::Status status = general->Login(nullptr, nullptr, nullptr, nullptr, nullptr, &result);
    tell("Login", status, shown());
    tell("CallPlafonds", general->CallPlafonds(&connection, &rubrics));
    tell("CallHospitais", general->CallHospitais(&connection, &hospitals));
    tell("CallManutencaoDados", general->CallManutencaoDados());
    tell("CallIRS", general->CallIRS());
    tell("CallFechoAno", general->CallFechoAno());
    tell("Registo", general->Registo(nullptr, &key, nullptr, nullptr, nullptr));
    tell("NewMovimento", general->NewMovimento(false, nullptr, nullptr));
    tell("Correcao", general->Correcao(nullptr, nullptr));
    tell("Recebimento", general->Recebimento(nullptr, nullptr));
    tell("Extratos", general->Extratos(nullptr, nullptr));
    tell("LPagamentos", general->LPagamentos());
    status = general->Ldividas(&result);
    tell("Ldividas", status, shown());
    status = general->Lcartasdividas(&result);
    tell("Lcartasdividas", status, shown());
    status = general->Lhospitais(&result);
    tell("Lhospitais", status, shown());
    return general->Release() == 0 ? 0 : 1;
}

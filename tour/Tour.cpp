// SPDX-License-Identifier: MIT
#include "tour/Tour.h"

#include <QAbstractButton>
#include <QAction>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QScreen>
#include <QTableView>
#include <QTemporaryDir>

#include "host/Console.h"
#include "host/Operations.h"
#include "host/Registration.h"
#include "host/frmAjuda.h"
#include "host/frmPrincipal.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/forms/MsgBoxes.h"
#include "tour/Player.h"

using namespace Qt::StringLiterals;

namespace tour {

namespace {

using host::Operations;
using host::say;
using Keys = QStringList;

// Members of the sample book: one with everything in order, one without a bank number.
const QString GoodMember = u"100015"_s;
const QString MemberWithoutNib = u"100023"_s;

std::function<void(QWidget*)> typing(const Keys& keys) {
    return [keys](QWidget* screen) { Player::type(screen, keys); };
}

/// A condition: a field of the screen shows something.
std::function<bool(QWidget*)> shows(const QString& field) {
    return [field](QWidget* screen) {
        const auto* box = screen->findChild<QLineEdit*>(field);
        return box && !box->text().isEmpty();
    };
}

/// A condition: a label of the screen begins with that text.
std::function<bool(QWidget*)> says(const QString& label, const QString& text) {
    return [label, text](QWidget* screen) {
        const auto* found = screen->findChild<QLabel*>(label);
        return found && found->text().startsWith(text);
    };
}

std::function<bool(QWidget*)> canPress(const QString& button) {
    return [button](QWidget* screen) {
        const auto* found = screen->findChild<QAbstractButton*>(button);
        return found && found->isEnabled();
    };
}

std::function<bool(QWidget*)> unticked(const QString& check) {
    return [check](QWidget* screen) {
        const auto* found = screen->findChild<QAbstractButton*>(check);
        return found && !found->isChecked();
    };
}

/// A condition: the first row of the screen's list has that text in one of its columns.
std::function<bool(QWidget*)> listBeginsWith(const QString& text) {
    return [text](QWidget* screen) {
        const auto* list = screen->findChild<QTableView*>();
        if (!list || !list->model()) return false;
        const QAbstractItemModel& rows = *list->model();
        for (int column = 0; column < rows.columnCount(); ++column)
            if (rows.index(0, column).data().toString() == text) return true;
        return false;
    };
}

/// A condition: the screen's list has rows.
std::function<bool(QWidget*)> hasRows() {
    return [](QWidget* screen) {
        const auto* list = screen->findChild<QTableView*>();
        return list && list->model() && list->model()->rowCount() > 0;
    };
}

/// The script of the tour, road by road.
class Script {
public:
    explicit Script(Player& player) : player_(player) {}

    /// The page that meets somebody without a book, and the way from there to the examples.
    void firstStart() {
        player_.step(u"frmPrincipal"_s, u"00-primeiro-arranque"_s, typing({u"<Alt+S>"_s}));
        player_.step(u"frmServidor"_s, u"00a-servidor"_s, typing({u"<Escape>"_s}));
        player_.step(u"frmPrincipal"_s, {}, typing({u"<Alt+X>"_s}));
        player_.step(u"frmPrincipal"_s, {}, {}, hasRows());
    }

    void document() {
        open(u"01-janela-principal"_s, Operations::newDocument(false));
        player_.step(u"frmMovimentos"_s, u"02-novo-documento"_s, {}, shows(u"Text8"_s));
        chooseMember(u"03-pergunta-quotizacoes"_s);
        choosePerson(u"04-escolher-familiar"_s, {u"<Return>"_s});
        fillIn({u"4711"_s, u"87,35"_s, u"0"_s, u"23"_s, {}, u"Lentes"_s, u"5.02"_s, {}});
        player_.step(u"frmMovimentos"_s, u"05-ensaio"_s, typing({u"<F2>"_s}), shows(u"Debito"_s));
        player_.step(u"frmExplicacao"_s, u"39-porque"_s, typing({u"<Escape>"_s}));
        player_.step(u"frmMovimentos"_s, {}, typing({u"<Alt+O>"_s}));
        player_.step(u"box:Deseja finalizar o registo?"_s, u"06-confirmar"_s,
                     typing({u"<Alt+S>"_s}));
        player_.step(u"frmMovimentosF"_s, u"07-sair-de-lancamentos"_s, typing({u"<Return>"_s}));
        player_.step(u"frmMovimentos"_s, u"08-mesmo-associado"_s, typing({u"<Escape>"_s}),
                     shows(u"Text2"_s));
        leave();
    }

    void hospitalBill() {
        open({}, Operations::newDocument(true));
        chooseMember({});
        choosePerson({}, {u"<Down>"_s, u"<Return>"_s});
        fillIn({u"H-2001"_s,
                u"1250"_s,
                u"1000"_s,
                u"6"_s,
                {},
                u"Internamento"_s,
                u"7.01"_s,
                u"<Down>"_s,
                {}});
        player_.step(u"frmMovimentos"_s, u"09-hospital"_s, typing({u"<Alt+O>"_s}),
                     shows(u"Debito"_s));
        player_.step(u"box:Deseja finalizar o registo?"_s, {}, typing({u"<Alt+S>"_s}));
        player_.step(u"frmPagamentoCheque"_s, u"10-cheque"_s,
                     typing({u"<Ctrl+A>"_s, u"500"_s, u"<Return>"_s}));
        leave();
    }

    void view() {
        player_.step(u"frmPrincipal"_s, {}, typing({u"<F5>"_s}));
        player_.step(u"frmPrincipal"_s, u"11-lista"_s, typing({u"<Return>"_s}),
                     listBeginsWith(u"H-2001"_s));
        player_.step(u"frmMovimentos"_s, u"12-movimento"_s, typing({u"<Alt+S>"_s}));
    }

    /// The manual, at the page of the screen.
    void manual() {
        open({}, Operations::newDocument(false));
        player_.step(u"frmMovimentos"_s, {}, typing({u"<F1>"_s}), shows(u"Text8"_s));
        player_.step(u"frmAjuda"_s, u"43-manual"_s, typing({u"<Escape>"_s}));
        player_.step(u"frmMovimentos"_s, {}, typing({u"<Escape>"_s}));
        leave();
        player_.step(u"frmPrincipal"_s, {}, {});
    }

    /// What a filter leaves of the list, printed.
    void filteredList() {
        player_.step(u"frmPrincipal"_s, {}, typing({u"<Ctrl+F>"_s, u"silva doc"_s}));
        player_.step(u"frmPrincipal"_s, u"11a-filtro"_s, {}, hasRows());
        choose(u"ImprimirLista"_s);
        player_.step(u"prtMovimentos"_s, u"11b-lista-impressa"_s, typing({u"<Escape>"_s}),
                     says(u"Estado"_s, u"Página 1"_s));
        player_.step(u"frmPrincipal"_s, {}, typing({u"<Escape>"_s}));
    }

    /// The member of the newest movement, and what the ceilings leave his family, printed.
    void accountPage() {
        choose(u"Conta"_s);
        player_.step(u"frmConta"_s, u"40-conta"_s, typing({u"<Alt+I>"_s}));
        player_.step(u"prtResta"_s, u"41-o-que-resta"_s, typing({u"<Escape>"_s}),
                     says(u"Estado"_s, u"Página 1"_s));
        player_.step(u"frmConta"_s, {}, {});
        player_.step(u"frmConta"_s, {}, typing({u"<Escape>"_s}));
    }

    /// Money that a member brings, and a correction of what he owes; neither is posted.
    void account() {
        for (const auto& [operation, screen, picture] :
             {std::tuple(u"Recebimento"_s, u"frmRecebimento"_s, u"12a-recebimento"_s),
              std::tuple(u"Correcao"_s, u"frmReposicao"_s, u"12b-correcao"_s)}) {
            open({}, {operation, {}});
            player_.step(screen, {}, typing({GoodMember, u"<Tab>"_s}), shows(u"Text8"_s));
            player_.step(screen, picture, typing({u"<Escape>"_s}), shows(u"Text2"_s));
            player_.step(u"box:Há dados por lançar"_s, {}, typing({u"<Alt+S>"_s}));
        }
        player_.step(u"frmPrincipal"_s, {}, {});
    }

    void otherWindows() {
        open({}, Operations::newDocument(false));
        player_.step(u"frmMovimentos"_s, {}, typing({u"<Alt+P>"_s}), shows(u"Text8"_s));
        player_.step(u"frmProcurar"_s, {}, typing({u"silva ant"_s}));
        player_.step(u"frmProcurar"_s, u"13-procurar"_s, typing({u"<Escape>"_s}),
                     listBeginsWith(GoodMember));
        player_.step(u"frmMovimentos"_s, {},
                     typing({u"<Shift+Tab>"_s, MemberWithoutNib, u"<Tab>"_s}));
        player_.step(u"box:Quer ver o extrato"_s, {}, typing({u"<Alt+S>"_s}));
        player_.step(u"box:Este Associado não tem NIB!"_s, u"14-sem-nib"_s,
                     typing({u"<Return>"_s}));
        player_.step(u"box:Quer abrir a ficha"_s, {}, typing({u"<Alt+S>"_s}));
        player_.step(u"frmFichaSocio"_s, u"15-ficha-de-associado"_s, typing({u"<Escape>"_s}));
        player_.step(u"frmQuotas"_s, u"16-quotizacoes"_s, [](QWidget* screen) { screen->close(); });
        player_.step(u"frmMovimentos"_s, {}, typing({u"<Escape>"_s}));
        player_.step(u"box:Há dados por lançar"_s, {}, typing({u"<Alt+S>"_s}));
        leave();
        player_.step(u"frmPrincipal"_s, {}, {});
    }

    /// The member's documents of the year, looked at and kept as PDF.
    void extract(const QString& file) {
        open({}, {u"Extratos"_s, {}});
        const QString newYear = core::today().toString(u"01-01-yyyy"_s);
        player_.step(u"frmExtratos"_s, {},
                     typing({GoodMember, u"<Tab>"_s, u"<Tab>"_s, u"<Tab>"_s, newYear, u"<Tab>"_s,
                             u"<Tab>"_s, u"<Space>"_s}));
        player_.step(u"frmExtratos"_s, u"17-extratos"_s, typing({u"<Alt+I>"_s}),
                     unticked(u"Check1"_s));
        player_.step(u"prtExtrato1"_s, u"18-pre-visualizacao"_s,
                     typing({u"<Ctrl+F>"_s, u"consulta"_s}), says(u"Estado"_s, u"Página 1"_s));
        player_.step(u"prtExtrato1"_s, u"18a-localizar"_s, typing({u"<Escape>"_s, u"<Ctrl+S>"_s}));
        player_.step(u"FicheiroPdf"_s, u"18b-guardar"_s,
                     typing({u"<Ctrl+A>"_s, file, u"<Return>"_s}));
        player_.step(u"prtExtrato1"_s, {}, typing({u"<Escape>"_s}),
                     says(u"Mensagem"_s, u"Guardado: "_s));
        player_.step(u"frmPrincipal"_s, {}, {});
    }

    /// A group of rubrics, one of its rubrics, a hospital.
    void masterData() {
        open({}, Operations::rubrics());
        player_.step(u"frmPlafonds"_s, u"19-rubricas"_s, typing({u"<Down>"_s, u"<Alt+T>"_s}));
        player_.step(u"frmPlafonds_Main"_s, u"20-grupo-de-rubricas"_s, typing({u"<Alt+E>"_s}),
                     hasRows());
        player_.step(u"frmPlafonds_record"_s, u"21-rubrica"_s, typing({u"<Escape>"_s}));
        leaveList(u"frmPlafonds_Main"_s);
        leaveList(u"frmPlafonds"_s);
        open({}, Operations::hospitals());
        player_.step(u"frmHospitais"_s, u"22-hospitais"_s, typing({u"<Alt+T>"_s}), hasRows());
        player_.step(u"frmHospitais_record"_s, u"23-hospital"_s, typing({u"<Escape>"_s}));
        leaveList(u"frmHospitais"_s);
    }

    /// A file with a hospital that is new, one that changes, and one without a name.
    void importedFile(const QString& name) {
        QFile file(name);
        const QByteArray rows =
            "Código;Nome;Localidade\nH90;Clínica de São Gonçalo;Lisboa\nH91;;Faro\n"
            "H92;Hospital do Mar;Faro\n";
        if (!file.open(QFile::WriteOnly) || file.write(rows) != rows.size())
            throw core::Failure(core::InvalidCall, file.errorString());
        file.close();
        choose(u"Importar"_s);
        player_.step(u"frmImportar"_s, {}, typing({u"h"_s, u"<Tab>"_s, name, u"<Alt+V>"_s}));
        player_.step(u"frmImportar"_s, u"42-importar"_s, typing({u"<Escape>"_s}), hasRows());
        player_.step(u"frmPrincipal"_s, {}, {});
    }

    /// What is paid by transfer since the beginning of the year, and the screen that types it into
    /// the bank's program.
    void payments() {
        const QString newYear = core::today().toString(u"01-01-yyyy"_s);
        open({}, {u"LPagamentos"_s, {}});
        player_.step(u"frmTRFs"_s, {},
                     typing({newYear, u"<Tab>"_s, u"<Tab>"_s, u"<Tab>"_s, u"<Space>"_s}));
        player_.step(u"frmTRFs"_s, u"24-pagamentos"_s, typing({u"<Alt+O>"_s}),
                     unticked(u"Check1"_s));
        player_.step(u"Print_frmTRF_TRF"_s, u"25-transferencias"_s, typing({u"<Escape>"_s}),
                     says(u"Estado"_s, u"Página 1"_s));
        open({}, {u"LPagamentos"_s, {}});
        player_.step(u"frmTRFs"_s, {}, typing({u"<Alt+B>"_s}));
        player_.step(u"frmBanca"_s, u"26-banca"_s, typing({u"<Alt+A>"_s}));
        player_.step(u"box:Deseja abortar"_s, {}, typing({u"<Alt+S>"_s}));
        choose(u"FicheiroBanco"_s);
        player_.step(u"frmFicheiroBanco"_s, {}, typing({newYear, u"<Tab>"_s, u"<Alt+M>"_s}));
        player_.step(u"frmFicheiroBanco"_s, u"26a-ficheiro-para-o-banco"_s,
                     typing({u"<Escape>"_s}));
    }

    /// Who owes, and what was borne in a closed year.
    void debtsAndTaxes() {
        open({}, {u"Ldividas"_s, {}});
        player_.step(u"Print_frmListagemDividas"_s, u"27-dividas"_s, typing({u"<Escape>"_s}),
                     says(u"Estado"_s, u"Página 1"_s));
        open({}, {u"Lcartasdividas"_s, {}});
        player_.step(u"Print_frmCartasDividas"_s, u"28-cartas"_s, typing({u"<Escape>"_s}),
                     says(u"Estado"_s, u"Página 1"_s));
        open({}, {u"CallIRS"_s, {}});
        player_.step(u"frmIRS"_s, {},
                     typing({u"<Tab>"_s, u"<Space>"_s, u"<Tab>"_s, u"<Ctrl+A>"_s}));
        player_.step(u"frmIRS"_s, u"29-irs"_s, typing({u"<Alt+I>"_s}));
        player_.step(u"prtIRS"_s, u"30-declaracao"_s, typing({u"<Escape>"_s}),
                     says(u"Estado"_s, u"Página 1"_s));
        leaveList(u"frmIRS"_s);
        choose(u"Documentos"_s);
        player_.step(u"frmDocumentos"_s, u"31-documentos"_s, typing({u"<Escape>"_s}));
    }

    /// What each hospital's bills came to since the beginning of the year.
    void hospitalList() {
        const QString newYear = core::today().toString(u"01-01-yyyy"_s);
        open({}, {u"Lhospitais"_s, {}});
        player_.step(u"frmListagemHospitais"_s, {}, typing({newYear, u"<Tab>"_s}));
        player_.step(u"frmListagemHospitais"_s, u"32-hospitais-listagem"_s, typing({u"<Alt+O>"_s}));
        player_.step(u"Print_frmListagemHospitais"_s, u"33-hospitais-mapa"_s,
                     typing({u"<Escape>"_s}), says(u"Estado"_s, u"Página 1"_s));
    }

    /// The repair of the book and the close of the year.
    void yearEnd(const QString& backup) {
        open({}, {u"CallManutencaoDados"_s, {}});
        player_.step(u"frmManutencaoDados"_s, {}, typing({u"<Alt+I>"_s}));
        player_.step(u"box:Manutenção de Dados Concluída."_s, {}, typing({u"<Return>"_s}));
        player_.step(u"frmManutencaoDados"_s, u"34-manutencao"_s, typing({u"<Alt+F>"_s}));
        choose(u"Verificar"_s);
        player_.step(u"frmVerificacao"_s, u"35-verificacao"_s, typing({u"<Alt+S>"_s}));
        choose(u"CallFechoAno"_s);
        player_.step(u"frmPrepararFecho"_s, u"36-preparar-o-fecho"_s,
                     typing({u"<Ctrl+A>"_s, backup, u"<Alt+F>"_s}));
        player_.step(u"frmFechoAno"_s, {}, typing({u"<Alt+F>"_s}));
        player_.step(u"box:Tem a certeza"_s, u"37-pergunta-do-fecho"_s, typing({u"<Alt+S>"_s}));
        player_.step(u"box:Procedimentos de Fim de Ano"_s, {}, typing({u"<Return>"_s}));
        player_.step(u"frmFechoAno"_s, u"38-fecho-do-ano"_s, typing({u"<Alt+S>"_s}));
        player_.step(u"frmPrincipal"_s, {}, {});
    }

private:
    void open(const QString& picture, const host::OperationCall& call) {
        player_.step(u"frmPrincipal"_s, picture,
                     [this, call](QWidget*) { operations_.call(call); });
    }

    /// Leaves a screen whose record or preview has just been left; its button takes a press once it
    /// has returned.
    void leaveList(const QString& list) {
        player_.step(list, {}, {});
        player_.step(list, {}, typing({u"<Alt+S>"_s}));
    }

    /// Chooses an entry of the main window's menu.
    void choose(const QString& entry) {
        player_.step(u"frmPrincipal"_s, {},
                     [entry](QWidget* screen) { screen->findChild<QAction*>(entry)->trigger(); });
    }

    /// Types the member's number and answers the question about his premiums, which always comes.
    void chooseMember(const QString& picture) {
        player_.step(u"frmMovimentos"_s, {}, typing({GoodMember, u"<Tab>"_s}), shows(u"Text8"_s));
        player_.step(u"box:Quer ver o extrato"_s, picture, typing({u"<Alt+N>"_s}));
    }

    void choosePerson(const QString& picture, const Keys& way) {
        player_.step(u"frmMovimentos"_s, {}, typing({u"<Alt+I>"_s}), canPress(u"Command2"_s));
        player_.step(u"frmEscolherFamiliar"_s, picture, typing(way));
    }

    /// Types today and then one field after the other (an empty text leaves one as it is), and
    /// tries the document out.
    void fillIn(const Keys& texts) {
        Keys keys{core::today().toString(u"dd-MM-yyyy"_s)};
        for (const QString& text : texts) {
            keys << u"<Tab>"_s;
            if (!text.isEmpty()) keys << text;
        }
        keys << u"<Alt+E>"_s;
        player_.step(u"frmMovimentos"_s, {}, typing(keys), shows(u"Text3"_s));
    }

    void leave() { player_.step(u"frmMovimentosF"_s, {}, typing({u"<Alt+S>"_s, u"<Return>"_s})); }

    Player& player_;
    Operations operations_;
};

}  // namespace

bool play(const QString& folder, const std::function<void(QWidget*)>& look) {
    forms::install();
    const QTemporaryDir own;
    if (!own.isValid() || !QDir().mkpath(folder))
        throw core::Failure(core::InvalidCall, u"A pasta %1 não pode ser feita."_s.arg(folder));
    // Nothing of the person's own is read or left behind: neither books nor what windows remember.
    for (const char* const name : {"ZELMARS_REGISTRY", "XDG_CONFIG_HOME", "XDG_DATA_HOME"})
        qputenv(name, own.filePath(QString::fromLatin1(name)).toUtf8());
    host::registerComponents(false);
    say(u"Um documento médico, uma conta de hospital e as janelas do caminho, num livro de exemplo "
        "que não fica:"_s);

    const host::HelpKey help;
    host::frmPrincipal principal;
    principal.resize(QSize(1280, 800).boundedTo(principal.screen()->availableSize()));
    principal.show();
    Player player(folder, look);
    Script script(player);
    script.firstStart();
    script.document();
    script.hospitalBill();
    script.view();
    script.manual();
    script.filteredList();
    script.accountPage();
    script.account();
    script.otherWindows();
    const QString extract = QDir(folder).absoluteFilePath(u"extrato.pdf"_s);
    QFile::remove(extract);
    script.extract(extract);
    script.masterData();
    script.importedFile(own.filePath(u"hospitais.csv"_s));
    script.payments();
    script.debtsAndTaxes();
    script.hospitalList();
    script.yearEnd(own.filePath(u"antes-do-fecho.copia"_s));
    const bool played = player.play();
    say(played ? u"Visita completa."_s : u"A visita parou a meio."_s);
    return played;
}

}  // namespace tour

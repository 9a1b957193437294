// SPDX-License-Identifier: MIT
#include "host/CommandLine.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// Takes a switch out of the words; false when it is not among them.
bool take(QStringList& words, const QString& name) {
    return words.removeAll(name) > 0;
}

/// Takes a switch and its value out of the words; false when it stands there without one.
bool take(QStringList& words, const QString& name, QString& value) {
    const qsizetype at = words.indexOf(name);
    if (at < 0) return true;
    if (at + 1 == words.size() || words[at + 1].isEmpty() || words[at + 1].startsWith('-'_L1))
        return false;
    value = words[at + 1];
    words.remove(at, 2);
    return true;
}

const QString Administrator = u"postgres"_s;

CommandLine serverLine(QStringList words) {
    CommandLine line{
        .task = CommandLine::Task::InitServer, .user = u"zelmars"_s, .admin = Administrator};
    line.sample = take(words, u"--sample"_s);
    const bool isRight =
        take(words, u"--server"_s, line.server) && take(words, u"--catalog"_s, line.catalogue) &&
        take(words, u"--user"_s, line.user) && take(words, u"--admin"_s, line.admin);
    if (!isRight || line.catalogue.isEmpty() || !words.isEmpty())
        return {.task = CommandLine::Task::Wrong};
    return line;
}

CommandLine initLine(QStringList words) {
    if (words.contains(u"--server"_s)) return serverLine(words);
    CommandLine line{.task = CommandLine::Task::Init};
    line.sample = take(words, u"--sample"_s);
    line.ifNeeded = take(words, u"--if-needed"_s);
    if (words.size() != 1 || words.first().isEmpty() || words.first().startsWith('-'_L1))
        return {.task = CommandLine::Task::Wrong};
    line.folder = words.first();
    return line;
}

CommandLine copyLine(QStringList words) {
    CommandLine line{.task = CommandLine::Task::Copy, .admin = Administrator};
    if (!take(words, u"--admin"_s, line.admin) || words.size() != 2 ||
        words[0].startsWith('-'_L1) || words[1].startsWith('-'_L1))
        return {.task = CommandLine::Task::Wrong};
    line.from = words[0];
    line.into = words[1];
    return line;
}

CommandLine registerLine(QStringList words) {
    CommandLine line{.task = CommandLine::Task::Register};
    line.undo = take(words, u"--undo"_s);
    if (!words.isEmpty()) return {.task = CommandLine::Task::Wrong};
    return line;
}

CommandLine tourLine(const QStringList& words) {
    if (words.size() != 1 || words.first().startsWith('-'_L1))
        return {.task = CommandLine::Task::Wrong};
    return {.task = CommandLine::Task::Tour, .folder = words.first()};
}

}  // namespace

CommandLine CommandLine::parsed(const QStringList& words) {
    if (words.isEmpty()) return {};
    const QString& first = words.first();
    if (first == "init"_L1) return initLine(words.mid(1));
    if (first == "copy"_L1) return copyLine(words.mid(1));
    if (first == "register"_L1) return registerLine(words.mid(1));
    if (first == "tour"_L1) return tourLine(words.mid(1));
    if (words.size() == 1 && (first == "--help"_L1 || first == "-h"_L1))
        return {.task = Task::Help};
    if (words == QStringList{u"--version"_s}) return {.task = Task::Version};
    if (const auto call = Operations::parsed(words))
        return {.task = Task::Operation, .call = *call};
    return {.task = Task::Wrong};
}

bool CommandLine::needsScreen() const {
    const bool onlyLogsIn = task == Task::Operation && call.operation == "Login"_L1;
    return task == Task::Window || task == Task::Tour || (task == Task::Operation && !onlyLogsIn);
}

QString helpText() {
    return u"Utilização:\n"
           "  zelmars                            abre a janela com os movimentos em vigor\n"
           "  zelmars OPERAÇÃO [ARGUMENTO…]      abre uma operação directamente\n"
           "  zelmars init [--sample] PASTA      faz um livro novo (com dados de exemplo) e passa\n"
           "                                     a usá-lo; --if-needed: só se não houver outro\n"
           "  zelmars init --server postgresql:SERVIDOR[:PORTA] --catalog NOME [--sample]\n"
           "               [--user OPERADOR] [--admin ADMINISTRADOR]\n"
           "                                     o mesmo num servidor; o operador (zelmars, se "
           "não\n"
           "                                     se disser outro) é criado, se ainda não existir\n"
           "  zelmars copy [--admin ADMINISTRADOR] DE PARA\n"
           "                                     copia um livro inteiro; DE e PARA são\n"
           "                                     sqlite:PASTA/NOME ou\n"
           "                                     postgresql:SERVIDOR[:PORTA]/NOME\n"
           "  zelmars register [--undo]          regista (ou retira) os componentes\n"
           "  zelmars tour PASTA                 percorre o lançamento de um documento num livro\n"
           "                                     de exemplo e deixa as imagens na pasta\n"
           "  zelmars --help | --version\n"
           "\n"
           "As palavras-passe pedem-se no terminal, ou lêem-se das variáveis de ambiente\n"
           "ZELMARS_ADMIN_PASSWORD (do administrador do servidor, que é postgres se não se disser\n"
           "outro) e ZELMARS_USER_PASSWORD (do operador). Nunca se escrevem na linha de comando.\n"
           "\n"
           "Operações (maiúsculas e minúsculas não contam):\n"
           "  NewMovimento [false|true]          novo documento; true: documento de hospital\n"
           "  Registo CHAVE                      abre o movimento com essa chave\n"
           "  Recebimento, Correcao              recebimento, correcção\n"
           "  Extratos, LPagamentos              extratos, listagens de pagamentos\n"
           "  Ldividas, Lcartasdividas           listagem e cartas de dívidas\n"
           "  Lhospitais                         listagem de hospitais\n"
           "  CallPlafonds, CallHospitais        tabelas de rúbricas e de hospitais\n"
           "  CallIRS, CallManutencaoDados       declarações para IRS, manutenção de dados\n"
           "  CallFechoAno                       fecho do ano\n"
           "  Login                              diz se a ligação ao livro se faz\n"_s;
}

}  // namespace host

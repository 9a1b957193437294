// SPDX-License-Identifier: MIT
#include "host/CommandLine.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// Takes a switch out of the words; false when it is not among them.
bool take(QStringList& words, const QString& name) {
    return words.removeAll(name) > 0;
}

CommandLine initLine(QStringList words) {
    CommandLine line{.task = CommandLine::Task::Init};
    line.sample = take(words, u"--sample"_s);
    line.ifNeeded = take(words, u"--if-needed"_s);
    if (words.size() != 1 || words.first().isEmpty() || words.first().startsWith('-'_L1))
        return {.task = CommandLine::Task::Wrong};
    line.folder = words.first();
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
    return task == Task::Window || task == Task::Operation || task == Task::Tour;
}

QString helpText() {
    return u"Utilização:\n"
           "  zelmars                            abre a janela com os movimentos em vigor\n"
           "  zelmars OPERAÇÃO [ARGUMENTO…]      abre uma operação directamente\n"
           "  zelmars init [--sample] PASTA      faz um livro novo (com dados de exemplo) e passa\n"
           "                                     a usá-lo; --if-needed: só se não houver outro\n"
           "  zelmars register [--undo]          regista (ou retira) os componentes\n"
           "  zelmars tour PASTA                 percorre o lançamento de um documento num livro\n"
           "                                     de exemplo e deixa as imagens na pasta\n"
           "  zelmars --help | --version\n"
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

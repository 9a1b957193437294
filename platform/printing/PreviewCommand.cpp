// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewCommand.h"

#include <algorithm>

namespace printing {

namespace {

using enum PreviewCommand;

// Home, End, Esc and the arrows belong to the pages and to the window.
constexpr PreviewAction Actions[] = {
    {Print, u"Imprimir", u"&Imprimir", u"Imprimir o relatório (Ctrl+P)", u"Ctrl+P"},
    {SavePdf, u"GuardarPdf", u"&Guardar PDF", u"Guardar as páginas num ficheiro PDF (Ctrl+S)",
     u"Ctrl+S"},
    {ExportCsv, u"ExportarCsv", u"&Exportar CSV",
     u"Exportar as linhas para a folha de cálculo (Ctrl+E)", u"Ctrl+E"},
    {FirstPage, u"Primeira", u"«", u"Primeira página (Home)", {}},
    {PreviousPage, u"Anterior", u"‹", u"Página anterior (Ctrl+PgUp)", u"Ctrl+PgUp"},
    {AskPage, {}, {}, {}, u"Ctrl+G"},
    {NextPage, u"Seguinte", u"›", u"Página seguinte (Ctrl+PgDn)", u"Ctrl+PgDown"},
    {LastPage, u"Ultima", u"»", u"Última página (End)", {}},
    {AskZoom, {}, {}, {}, u"Alt+Z"},
    {ZoomOut, u"Reduzir", u"−", u"Reduzir (Ctrl+-)", u"Ctrl+-"},
    {ZoomIn, u"Aumentar", u"+", u"Aumentar (Ctrl++)", u"Ctrl++"},
    {ZoomIn, {}, {}, {}, u"Ctrl+="},
    {ActualSize, {}, {}, {}, u"Ctrl+0"},
    {FitWidth, {}, {}, {}, u"Ctrl+1"},
    {FitPage, {}, {}, {}, u"Ctrl+2"},
    {Continuous,
     u"Continuo",
     u"&Contínuo",
     u"Páginas umas por baixo das outras, ou uma de cada vez",
     {}},
    {Find, u"Procurar", u"&Procurar", u"Procurar um texto nas páginas (Ctrl+F)", u"Ctrl+F"},
    {FindPrevious, u"OcorrenciaAnterior", u"‹", u"Ocorrência anterior (Shift+F3)", u"Shift+F3"},
    {FindNext, u"OcorrenciaSeguinte", u"›", u"Ocorrência seguinte (F3)", u"F3"},
    {EndFind, u"FecharProcura", u"×", u"Terminar a procura (Esc)", {}},
    {Close, u"Fechar", u"&Fechar", u"Fechar a pré-visualização (Esc)", {}},
};

}  // namespace

std::span<const PreviewAction> previewActions() {
    return Actions;
}

const PreviewAction& previewAction(PreviewCommand command) {
    return *std::find_if(std::begin(Actions), std::end(Actions),
                         [=](const PreviewAction& action) { return action.command == command; });
}

}  // namespace printing

// SPDX-License-Identifier: MIT
#pragma once

#include <QStringView>
#include <span>

namespace printing {

/// What a person can ask of a preview, by button or by key.
enum class PreviewCommand {
    Print,
    SavePdf,
    ExportCsv,
    FirstPage,
    PreviousPage,
    AskPage,  ///< the cursor into the page's field
    NextPage,
    LastPage,
    AskZoom,  ///< the cursor into the size's field
    ZoomOut,
    ZoomIn,
    ActualSize,
    FitWidth,
    FitPage,
    Continuous,
    Find,
    FindPrevious,
    FindNext,
    EndFind,
    Close,
};

/// How a command looks and which key it answers to.
struct PreviewAction {
    PreviewCommand command;
    QStringView name;     ///< of its button; empty where it has none
    QStringView caption;  ///< with the accelerator
    QStringView toolTip;
    QStringView keys;  ///< none where it is empty
};

/// The actions of all commands, in the order of the commands.
std::span<const PreviewAction> previewActions();
/// The action of one command.
const PreviewAction& previewAction(PreviewCommand command);

}  // namespace printing

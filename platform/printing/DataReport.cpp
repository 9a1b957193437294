// SPDX-License-Identifier: MIT
#include "platform/printing/DataReport.h"

#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/printing/Layout.h"
#include "platform/printing/Output.h"
#include "platform/printing/Preview.h"
#include "platform/printing/Progress.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

Label& labelOf(Report& report, const QString& section, const QString& label) {
    for (Section* each :
         {&report.reportHeader, &report.pageHeader, &report.groupHeader, &report.detail,
          &report.groupFooter, &report.pageFooter, &report.reportFooter}) {
        if (each->name.compare(section, Qt::CaseInsensitive) != 0) continue;
        for (Item& item : each->items)
            if (auto* found = std::get_if<Label>(&item);
                found && found->name.compare(label, Qt::CaseInsensitive) == 0)
                return *found;
    }
    throw core::Failure(core::NoSuchItem, u"O mapa «%1» não tem «%2» na secção «%3»."_s.arg(
                                              report.name, label, section));
}

}  // namespace

DataReport::DataReport(const Report& design) : report_(design) {}

void DataReport::setCaption(const QString& section, const QString& label, const QString& caption) {
    labelOf(report_, section, label).caption = letterForLetter(caption);
}

void DataReport::PrintReport(const ado::RecordsetPtr& rows) const {
    if (!isPrinted(rows))
        core::MsgBox(u"A impressão foi cancelada. Nada foi enviado para a impressora."_s,
                     core::Icon::Information, report_.caption);
}

bool DataReport::isPrinted(const ado::RecordsetPtr& rows) const {
    constexpr int Slice = 50;      // milliseconds until the next look at the person's clicks
    constexpr int Half = 500'000;  // the pages' preparation, and again the making of the job
    Progress progress(nullptr, report_.caption, u"A preparar a impressão…"_s, 2 * Half);
    Layout layout(report_, rows);
    while (!layout.go(Slice))
        if (!progress.show(static_cast<int>(layout.share() * Half))) return false;
    const Pages& pages = *layout.pages();
    return printUnasked(pages, [&](int done) {
        return progress.show(Half + static_cast<int>(qint64(Half) * done / pages.count()));
    });
}

void DataReport::Show(const ado::RecordsetPtr& rows, Wait wait) const {
    auto* preview = new Preview(report_, rows);
    if (wait == Wait::Modal)
        preview->ShowModal();
    else
        preview->Show();
}

}  // namespace printing

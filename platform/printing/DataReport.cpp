// SPDX-License-Identifier: MIT
#include "platform/printing/DataReport.h"

#include "platform/core/Failure.h"
#include "platform/printing/Layout.h"
#include "platform/printing/Output.h"
#include "platform/printing/Preview.h"

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
    Layout layout(report_, rows);
    layout.go(-1);
    printUnasked(*layout.pages());
}

void DataReport::Show(const ado::RecordsetPtr& rows, Wait wait) const {
    auto* preview = new Preview(report_, rows);
    if (wait == Wait::Modal)
        preview->ShowModal();
    else
        preview->Show();
}

}  // namespace printing

// SPDX-License-Identifier: MIT
#include "host/BookMenu.h"

#include <QAction>
#include <QMenu>

#include "host/BookChoice.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

QString shown(const registry::LoginValues& book) {
    return u"%1 (%2)"_s.arg(book.dtInitialCatalog, book.dtDataSource).replace(u'&', u"&&"_s);
}

/// A book that cannot be opened any more can be taken from the list.
bool openOrForget(const registry::LoginValues& book) {
    try {
        return choice::remembered(book);
    } catch (const core::Failure& failure) {
        const auto answer =
            core::MsgBox(failure.text() + u"\n\nQuer retirar este livro da lista dos usados?"_s,
                         core::Icon::Question, {}, core::Buttons::NoYes);
        if (answer == core::Answer::Yes) RememberedBooks::forget(book);
        return false;
    }
}

}  // namespace

BookMenu::BookMenu(QMenu* menu, const std::function<void(const std::function<bool()>& way)>& choose)
    : QObject(menu), menu_(menu), choose_(choose) {
    connect(menu, &QMenu::aboutToShow, this, &BookMenu::fill);
}

void BookMenu::fill() {
    for (QAction* action : menu_->actions())
        if (action->property("usado").toBool()) delete action;
    const BookSettings present = BookSettings::readOrTell();
    int number = 0;
    for (const registry::LoginValues& book : RememberedBooks::all()) {
        QAction* action = menu_->addAction(u"&%1  %2"_s.arg(++number % 10).arg(shown(book)));
        action->setProperty("usado", true);
        action->setCheckable(true);
        action->setChecked(RememberedBooks::areSame(book, present));
        connect(action, &QAction::triggered, this, [this, book] {
            forms::handle([&] { choose_([book] { return openOrForget(book); }); });
        });
    }
}

}  // namespace host

// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Controls.h"
#include "platform/forms/DataCombo.h"
#include "platform/forms/DatePicker.h"
#include "platform/forms/Form.h"
#include "platform/forms/TextBox.h"

/// A record screen as the rooms of the work have them, small: a field for each type of column, a
/// free box, lists, a default button and one to give up.
class SampleScreen : public forms::Form {
public:
    explicit SampleScreen(const QString& name = QStringLiteral("frmRecibo"));
    void take(const ado::RecordsetPtr& rows) { Adodc1.setRecordset(rows); }

    forms::DataControl Adodc1{QStringLiteral("Adodc1"), this};
    forms::TextBox Livre{QStringLiteral("Livre")};
    forms::TextBox Numero{QStringLiteral("Numero")};
    forms::TextBox Valor{QStringLiteral("Valor")};
    forms::TextBox Ordem{QStringLiteral("Ordem")};
    forms::TextBox Dia{QStringLiteral("Dia")};
    forms::TextBox Notas{QStringLiteral("Notas")};
    forms::TextBox Mostra{QStringLiteral("Mostra")};  ///< only shows
    forms::DataCombo Rubrica{QStringLiteral("Rubrica")};
    forms::DatePicker Desde{QStringLiteral("Desde")};
    forms::OptionButton Option2{QStringLiteral("Option2"), QStringLiteral("&Inactivos")};
    forms::Button Command1{QStringLiteral("Command1"), QStringLiteral("&Procurar Sócio")};
    forms::Button Command3{QStringLiteral("Command3"), QStringLiteral("&OK")};
    forms::Button Command4{QStringLiteral("Command4"), QStringLiteral("&Desistir")};
    int pressed = 0;    ///< times that Command1 was pressed
    int finished = 0;   ///< times that the default button was pressed
    int cancelled = 0;  ///< times that Command4 was pressed
};

/// A screen of a test: on the heap, as a screen that unloads itself has to be, and unloaded with
/// the test at the latest.
template <class Screen>
class Held {
public:
    template <class... Arguments>
    explicit Held(Arguments... arguments) : screen_(new Screen(arguments...)) {}
    ~Held() {
        if (!isGone()) screen_->Unload();
    }
    Held(const Held&) = delete;
    Held& operator=(const Held&) = delete;
    Screen* operator->() const { return screen_; }
    Screen& operator*() const { return *screen_; }
    bool isGone() const { return !screen_ || screen_->isUnloaded(); }

private:
    QPointer<Screen> screen_;
};

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

    forms::DataControl Adodc1;
    forms::TextBox Livre, Numero, Valor, Taxa, Ordem, Dia, Notas, Mostra;
    forms::DataCombo Rubrica, Modo;
    forms::DatePicker Desde;
    forms::CheckBox Check1;
    forms::OptionButton Option1, Option2;
    forms::Button Command1, Command3, Command4;
    int pressed = 0;    ///< times that Command1 was pressed
    int finished = 0;   ///< times that the default button was pressed
    int cancelled = 0;  ///< times that "&Cancelar" was pressed

private:
    void layOut();
    void bindControls();
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

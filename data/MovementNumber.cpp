// SPDX-License-Identifier: MIT
#include "data/MovementNumber.h"

#include "boundary/environment/dtZelmars.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

qint32 drawMovementNumber() {
    qint32 number = 1;
    const ado::RecordsetPtr counter = ado::Recordset::create();
    counter->Open(CounterQuery.toString(), environment::dtZelmars::instance().MSAccess(),
                  ado::adOpenDynamic, ado::adLockPessimistic, ado::adCmdUnknown);
    if (counter->atEnd()) {
        counter->AddNew();
        counter->setCollect(u"zelmars"_s, 1);
    } else {
        number = core::toLong(counter->Collect(u"zelmars"_s));
        counter->setCollect(u"zelmars"_s, static_cast<qint64>(number) + 1);
    }
    counter->Update();
    counter->Close();
    return number;
}

}  // namespace data

// SPDX-License-Identifier: MIT
#include "coverage/Calculation.h"

#include "data/Procedures.h"

namespace coverage {

using data::MaxSingle;
using data::MinSingle;

double share(double incidence, Single percent) {
    return incidence * percent.toDouble();
}

Single remainder(double ceiling, Single usedUp) {
    return MaxSingle(Single(), Single(ceiling - usedUp.toDouble()));
}

bool isUsedUp(double maximum, int documents) {
    return maximum - static_cast<double>(documents) <= 0;
}

Single grossAmount(Single share, double incidence, double received) {
    return MinSingle(share, Single(incidence - received));
}

Single netAmount(Single gross, Single left) {
    return MinSingle(gross, left);
}

Single spentFranchise(double net, double credit) {
    return Single(net - credit);
}

Single franchiseLeft(Single franchise, Single spent) {
    return spent < franchise ? franchise - spent : Single();
}

Single creditAmount(Single net, Single franchise, Single spent) {
    if (!(spent < franchise)) return net;
    const Single left = franchiseLeft(franchise, spent);
    return left < net ? net - left : Single();
}

Single debitAmount(Single credit) {
    return MaxSingle(Single(), credit);
}

}  // namespace coverage

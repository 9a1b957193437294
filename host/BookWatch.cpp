// SPDX-License-Identifier: MIT
#include "host/BookWatch.h"

#include "database/QuickCheck.h"
#include "database/Version.h"
#include "host/BookAge.h"
#include "host/LeftForLater.h"
#include "host/SystemJournal.h"
#include "platform/core/Failure.h"

namespace host {

void BookWatch::look(const BookSettings& settings) {
    settings_ = settings;
    unfit_.reset();
    ++turn_;
    std::erase_if(looks_, [](const auto& look) { return look->isDone.load(); });
    for (const auto& look : looks_) look->thread.request_stop();
    if (!settings.isComplete || !settings.unreadable.isEmpty()) return;
    const auto& look = looks_.emplace_back(std::make_unique<Look>());
    look->thread = std::jthread(
        [this, &isDone = look->isDone, settings, turn = turn_](const std::stop_token& stop) {
            try {
                read(settings.place(), turn, stop);
            } catch (const core::Failure&) {
                // The list fails in the same way, and tells it.
            }
            isDone = true;
        });
}

void BookWatch::read(const database::BookPlace& place, int turn, const std::stop_token& stop) {
    const std::unique_ptr<ado::BulkAccess> book = database::openedAnyway(place);
    const QString why = database::whyUnfit(database::schemaVersion(*book), place);
    tell(turn, [this, why] {
        unfit_ = why;
        if (!why.isEmpty()) emit unfit(why);
    });
    if (!why.isEmpty()) return;
    QStringList findings;
    try {
        findings = database::quickFindings(*book, [&] { return !stop.stop_requested(); });
    } catch (const core::Failure& failure) {
        findings << failure.text();
        tell(turn, [failure] { journal::note(failure, QStringLiteral("frmPrincipal")); });
    }
    if (!findings.isEmpty()) tell(turn, [this, findings] { emit found(findings); });
}

/// Has something told in the window's thread, once the book is not being waited for there.
void BookWatch::tell(int turn, const std::function<void()>& result) {
    QMetaObject::invokeMethod(this, [this, turn, result] {
        if (turn != turn_ || leftForLater(this, [this, turn, result] { tell(turn, result); }))
            return;
        result();
    });
}

QString BookWatch::whyUnfit() {
    if (!unfit_) unfit_ = reasonAgainst(settings_);
    return unfit_.value_or(QString());
}

}  // namespace host

// SPDX-License-Identifier: MIT
#include "platform/core/Failure.h"

namespace core {

namespace {
thread_local Err pending;
thread_local int depth = 0;
}  // namespace

Failure::Failure(int number, const QString& text, const QString& code)
    : number_(number), text_(text), code_(code), utf8_(text.toUtf8()) {}

void Err::set(int number, const QString& description) {
    number_ = number;
    description_ = description;
}

Err& err() {
    return pending;
}

HandlerScope::HandlerScope() {
    ++depth;
}

HandlerScope::~HandlerScope() {
    if (--depth == 0) pending.clear();
}

}  // namespace core

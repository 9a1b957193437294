// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include "boundary/environment/LoginState.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/registry/Registry.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"

/// A book with the five values that name it. After each case the component's state is that of a
/// fresh one.
class Configured : public testing::Test {
protected:
    void TearDown() override {
        using environment::dtZelmars;
        for (const auto& connection :
             {dtZelmars::instance().MSAccess(), dtZelmars::instance().SqlServer()})
            if (connection->State() != ado::adStateClosed) connection->Close();
        environment::loginState() = {};
    }

    static QString keyPath() { return QStringLiteral("SOFTWARE\\Norvanta\\Corvenda"); }
    static void set(const QString& name, const QString& value) {
        registry::writeValue(registry::Hive::LocalMachine, keyPath(), name, value);
    }
    static void remove(const QString& name) {
        registry::removeKey(registry::Hive::LocalMachine, keyPath() + u'\\' + name);
    }

    /// The text with which an operation fails; empty when it passes.
    template <class Operation>
    static QString failureOf(const Operation& operation) {
        return support::failureOf(operation).text();
    }

    support::Book book;
};

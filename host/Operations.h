// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QVariant>
#include <optional>

#include "platform/com/Component.h"

namespace host {

/// One call of the component.
struct OperationCall {
    QString operation;
    QVariantList arguments;
};

/// Calls the component by name; it is made when the first operation is called.
class Operations {
public:
    /// Names of the component's operations, as the command line knows them.
    static QStringList names();
    /// What a command line asks for: a name without regard to case, then its arguments as texts.
    /// Nothing when there is no such operation or the arguments do not fit it.
    static std::optional<OperationCall> parsed(const QStringList& words);

    /// The lists of master data that this program opens.
    static OperationCall rubrics();
    static OperationCall hospitals();
    /// @param caller  told of an annulment through its member RemoteKey; null for nobody
    static OperationCall movement(qint32 movimento_id, QObject* caller);
    static OperationCall newDocument(bool hospital);

    /// Fails with a core::Failure when the component cannot be made or the operation fails.
    QVariant call(const OperationCall& call);

private:
    com::Object general_;
};

}  // namespace host

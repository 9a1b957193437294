// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <exception>

namespace core {

/// Numbers of the failures that this system raises itself. A database engine's failure has the
/// number `DatabaseFailure` and the engine's own code as text in Failure::code().
enum FailureNumber : int {
    InvalidCall = 5,
    Overflow = 6,
    TypeMismatch = 13,
    InvalidUseOfNull = 94,
    CannotCreateObject = 429,
    NoSuchMember = 438,
    NoSuchItem = 3265,
    NoCurrentRow = 3021,
    ObjectClosed = 3704,
    ObjectOpen = 3705,
    NotUpdatable = 3251,
    RowInUse = 3260,
    NotAccompanied = 3261,
    DatabaseFailure = -2147217900,
};

/// A query or write that failed: what the operator reads when nobody traps it.
class Failure : public std::exception {
public:
    /// @param number  never 0
    /// @param text    in Portuguese, or as the database engine worded it
    /// @param code    the engine's own code (SQLSTATE or result code); empty where there is none
    Failure(int number, const QString& text, const QString& code = {});

    int number() const { return number_; }
    const QString& text() const { return text_; }
    const QString& code() const { return code_; }
    /// The text in UTF-8.
    const char* what() const noexcept override { return utf8_.constData(); }

private:
    int number_;
    QString text_;
    QString code_;
    QByteArray utf8_;
};

/// The pending error of the thread: what the last failure that was passed over left behind.
class Err {
public:
    /// 0 when no failure is pending.
    int number() const { return number_; }
    const QString& description() const { return description_; }
    void set(int number, const QString& description);
    void clear() { set(0, {}); }

private:
    int number_ = 0;
    QString description_;
};

/// The one pending error of the calling thread.
Err& err();

/// Runs one statement; when it fails, the failure becomes the pending error and the next statement
/// runs. Returns whether the statement passed.
template <class Statement>
bool passingOver(Statement&& statement) {
    try {
        statement();
        return true;
    } catch (const Failure& failure) {
        err().set(failure.number(), failure.text());
    } catch (const std::exception& failure) {
        err().set(InvalidCall, QString::fromUtf8(failure.what()));
    }
    return false;
}

/// Marks the run of an event handler or of a public operation. When the outermost one of the
/// thread ends, the pending error is cleared.
class HandlerScope {
public:
    HandlerScope();
    ~HandlerScope();
    HandlerScope(const HandlerScope&) = delete;
    HandlerScope& operator=(const HandlerScope&) = delete;
};

}  // namespace core

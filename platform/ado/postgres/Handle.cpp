// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Handle.h"

#include <poll.h>
#include <sys/socket.h>

#include <QRegularExpression>
#include <QtEndian>
#include <mutex>
#include <utility>

#include "platform/ado/engine/RowHolders.h"
#include "platform/ado/postgres/Failures.h"
#include "platform/core/Failure.h"
#include "platform/core/Wait.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

/// A server that is silent for the whole time-out counts as gone, but not before these seconds.
constexpr int LeastPatience = 4;
constexpr int OldestServer = 140000;
/// Milliseconds after which the windows get a turn while an answer is waited for.
constexpr qint64 WaitSlice = 50;
/// Statements that stay prepared; more than these and all are prepared anew.
constexpr int PreparedStatements = 128;

constexpr auto NoAnswer = "57014";
constexpr auto CannotConnect = "08001";
/// The server ends the connection by itself: it is shut down, or its administrator wants it so.
constexpr auto Ending = "57P0"_L1;

/// The server's text as it stands, on one line.
QString oneLine(const char* text) {
    return QString::fromUtf8(text).simplified();
}

struct Said {
    QString text;
    QString code;  ///< SQLSTATE; empty when the server never spoke
};

/// Takes the code and the place in the server's sources out of its verbose text.
Said withoutCode(const QString& verbose) {
    static const QRegularExpression form(
        u": ((?=[A-Z]*[0-9])[0-9A-Z]{5}): (.*?)(?: LOCATION: .*)?$"_s);
    const QRegularExpressionMatch match = form.match(verbose);
    if (!match.hasMatch()) return {verbose, {}};
    return {verbose.left(match.capturedStart()) + u": "_s + match.captured(2), match.captured(1)};
}

/// Connections of this process, in all its threads. Those that were closed stay among them: the
/// server takes a moment to let go of one.
struct Backends {
    std::mutex guard;
    QSet<int> numbers;
};
Backends& backends() {
    static Backends all;
    return all;
}

bool isFailure(const PGresult* result) {
    const ExecStatusType status = PQresultStatus(result);
    return status == PGRES_FATAL_ERROR || status == PGRES_BAD_RESPONSE;
}

std::vector<const char*> pointers(const Values& values) {
    std::vector<const char*> texts;
    for (const auto& value : values) texts.push_back(value ? value->constData() : nullptr);
    return texts;
}

/// Waits until the socket is ready; false when the time is over.
bool isReady(PGconn* connection, short events, qint64 milliseconds) {
    pollfd socket{PQsocket(connection), events, 0};
    return poll(&socket, 1, static_cast<int>(milliseconds)) != 0;
}

/// The same; false also when the operator gives up.
bool await(PGconn* connection, short events, const QDeadlineTimer& deadline, core::Wait& waiting) {
    while (waiting.goesOn()) {
        const qint64 left = deadline.remainingTime();
        if (isReady(connection, events, qMin(left, WaitSlice))) return true;
        if (left <= WaitSlice && deadline.hasExpired()) return false;
    }
    return false;
}

}  // namespace

Handle::Handle(const Address& address, Role role)
    : place_(address.shown()),
      awaited_(u"À espera da resposta do servidor de «%1»."_s.arg(place_)) {
    try {
        connect(address);
        settle(role);
    } catch (...) {
        PQfinish(connection_);
        throw;
    }
}

Handle::~Handle() {
    PQfinish(connection_);
}

QSet<int> Handle::ownBackends() {
    const std::lock_guard guard(backends().guard);
    return backends().numbers;
}

PGconn* Handle::connected(const Address& address) {
    Handle handle;
    handle.place_ = address.shown();
    handle.connect(address);
    return std::exchange(handle.connection_, nullptr);
}

void Handle::connect(const Address& address) {
    const auto fail = [&](const QString& why,
                          const QString& code = QLatin1StringView(CannotConnect)) {
        return core::Failure(
            core::DatabaseFailure,
            u"Não foi possível abrir o livro «%1» como «%2». %3"_s.arg(place_, address.user, why),
            code);
    };
    const QDeadlineTimer deadline(address.connectSeconds * 1000);
    const Address::Found found = address.lookUp(deadline);
    const QString silent =
        u"O servidor não respondeu em %1 segundos."_s.arg(address.connectSeconds);
    if (!found.error.isEmpty()) throw fail(found.error);
    if (found.isLate) throw fail(silent);
    start(address, found);
    core::Wait waiting(u"À espera da ligação a «%1»."_s.arg(place_));
    for (PostgresPollingStatusType next = PGRES_POLLING_WRITING; next != PGRES_POLLING_OK;
         next = PQconnectPoll(connection_)) {
        if (next == PGRES_POLLING_FAILED || PQstatus(connection_) == CONNECTION_BAD) {
            const Said said = withoutCode(oneLine(PQerrorMessage(connection_)));
            const QString code =
                said.code.isEmpty() ? QString::fromLatin1(CannotConnect) : said.code;
            throw fail(failure(code, said.text).text(), code);
        }
        if (!await(connection_, next == PGRES_POLLING_READING ? POLLIN : POLLOUT, deadline,
                   waiting))
            throw waiting.isGivenUp() ? givenUp() : fail(silent);
        if (address.isReadable(found) && wantsBarePassword())
            throw fail(
                u"O servidor pediu a palavra-passe sem a proteger (é preciso scram-sha-256); não "
                "lhe foi dada."_s);
    }
    if (PQserverVersion(connection_) < OldestServer)
        throw fail(u"O servidor tem a versão %1; é precisa a 14 ou mais recente."_s.arg(
            PQserverVersion(connection_) / 10000));
    const std::lock_guard guard(backends().guard);
    backends().numbers.insert(PQbackendPID(connection_));
}

void Handle::start(const Address& address, const Address::Found& found) {
    const std::vector<Option> options = address.options(found);
    std::vector<const char*> names;
    std::vector<const char*> texts;
    for (const Option& option : options) {
        names.push_back(option.name);
        texts.push_back(option.value.constData());
    }
    names.push_back(nullptr);
    texts.push_back(nullptr);
    connection_ = PQconnectStartParams(names.data(), texts.data(), 0);
    // Of a refused connection the code is told nowhere else.
    PQsetErrorVerbosity(connection_, PQERRORS_VERBOSE);
}

/// True when the server, on an unencrypted line, wants the password as it is or scrambled in the
/// old way that gives it away. The library would answer by itself, so what came is looked at before
/// the library reads it. Until the server has let the client in, only whole requests pass: the
/// library keeps a part that it has read, and nobody would see how it ends.
bool Handle::wantsBarePassword() const {
    constexpr ssize_t Head = 9;  // 'R', the length behind it, the kind: four bytes each
    constexpr quint32 LetIn = 0;
    constexpr quint32 ClearText = 3;
    constexpr quint32 Md5 = 5;
    if (PQstatus(connection_) != CONNECTION_AWAITING_RESPONSE) return false;
    char came[4096];
    const ssize_t size = recv(PQsocket(connection_), came, sizeof came, MSG_PEEK | MSG_DONTWAIT);
    for (ssize_t at = 0; at < size;) {
        if (came[at] == 'E') return false;  // the server refuses the connection, and says why
        if (came[at] != 'R' || size - at < Head) return true;
        const auto kind = qFromBigEndian<quint32>(came + at + 5);
        if (kind == LetIn) return false;
        if (kind == ClearText || kind == Md5) return true;
        at += 1 + qMax(Head - 1, static_cast<ssize_t>(qFromBigEndian<quint32>(came + at + 1)));
        if (at > size) return true;
    }
    return false;
}

void Handle::settle(Role role) {
    PQsetnonblocking(connection_, 1);
    PQenterPipelineMode(connection_);
    PQsetNoticeProcessor(
        connection_, [](void*, const char*) {}, nullptr);
    send("SET datestyle = ISO, MDY");
    send("SET standard_conforming_strings = on");
    // A name means the book's own table, whatever somebody has set for the role.
    send("SET search_path = public, pg_temp");
    // What a book's administrator may have set otherwise: the read behind a lock must see what the
    // row's last holder stored, and a number must come with all its digits.
    send("SET default_transaction_isolation = 'read committed'");
    send("SET extra_float_digits = 1");
    // Compiling pays for statements of seconds; those of the daily work take milliseconds.
    send("SET jit = off");
    // A set may stay open over lunch.
    send("SET idle_in_transaction_session_timeout = 0");
    // Whoever is killed while the server works for him lets go of his rows all the same.
    send("SET client_connection_check_interval = 500");
    if (role == Role::Reader) send("SET default_transaction_read_only = on");
}

void Handle::setTimeout(int seconds) {
    if (seconds == timeout_) return;
    timeout_ = seconds;
    // The server's own limits, in milliseconds, end a little before anybody takes it for gone. 0
    // would be no limit at all.
    send("SET lock_timeout = " + QByteArray::number(qMax(1, seconds * 950)));
    send("SET statement_timeout = " + QByteArray::number(qMax(1000, seconds * 975)));
}

bool Handle::isLost() {
    while (!lost_ && isReady(connection_, POLLIN, 0))
        if (!PQconsumeInput(connection_)) lost_ = true;
    lost_ = lost_ || PQstatus(connection_) == CONNECTION_BAD;
    return lost_;
}

Result Handle::run(const std::vector<Call>& calls) {
    requireConnection();
    int count = 0;
    for (const Call& call : calls) count += dispatch(call);
    try {
        return committed(count);
    } catch (const core::Failure&) {
        // Which of them the server knows by now nobody can tell; a table may have been altered.
        for (const Call& call : calls) forget(call.text);
        throw;
    }
}

Result Handle::runThenCommit(const Call& call, const More& more) {
    requireConnection();
    const int count = dispatch(call);
    flush();
    drain(0);
    Result result = answers(count);
    const bool isDone = !isFailure(result.get());
    const std::optional<Call> further = isDone ? more(result.get()) : std::nullopt;
    if (further) dispatch(*further);
    synchronise();
    try {
        const Result refusal = drain(0);
        if (isDone && refusal) refuse(refusal.get());
    } catch (const core::Failure& failure) {
        if (further) forget(further->text);
        if (!isDone || !lost_) throw;
        throw perhapsStored(failure);
    }
    if (isDone) return result;
    forget(call.text);
    refuse(result.get());
}

Result Handle::runOnce(const QByteArray& text) {
    requireConnection();
    return committed(dispatch(text));
}

Result Handle::committed(int count) {
    synchronise();
    drain(1);
    Result result = answers(count);
    drain(0);
    if (isFailure(result.get())) refuse(result.get());
    return result;
}

void Handle::send(const Call& call) {
    dispatch(call);
    synchronise();
}

void Handle::send(const QByteArray& text) {
    dispatch(text);
    synchronise();
}

void Handle::ask(const std::vector<QByteArray>& texts) {
    if (asked_ > 0) answer();
    requireConnection();
    for (const QByteArray& text : texts) asked_ += dispatch(text);
    flush();
}

Result Handle::answer() {
    drain(0);
    Result result = answers(asked_);
    asked_ = 0;
    if (!isFailure(result.get())) return result;
    synchronise();
    send("ROLLBACK");
    refuse(result.get());
}

void Handle::finish() {
    // A statement that nobody waited for may fail and would take the next one with it.
    if (asked_ > 0) synchronise();
    send("COMMIT");
}

int Handle::dispatch(const QByteArray& text) {
    PQsendQueryParams(connection_, text, 0, nullptr, nullptr, nullptr, nullptr, 0);
    return 1;
}

int Handle::dispatch(const Call& call) {
    int count = 1;
    if (prepared_.size() >= PreparedStatements) {
        prepared_.clear();
        count += dispatch("DEALLOCATE ALL");
    }
    QByteArray& name = prepared_[call.text];
    if (name.isEmpty()) {
        name = 's' + QByteArray::number(++lastPrepared_);
        PQsendPrepare(connection_, name, call.text, 0, nullptr);
        ++count;
    }
    PQsendQueryPrepared(connection_, name, static_cast<int>(call.values.size()),
                        pointers(call.values).data(), nullptr, nullptr, 0);
    return count;
}

void Handle::forget(const QByteArray& text) {
    const QByteArray name = prepared_.take(text);
    if (!name.isEmpty()) send("DEALLOCATE " + name);
}

void Handle::flush() {
    PQsendFlushRequest(connection_);
    PQflush(connection_);
}

void Handle::synchronise() {
    PQpipelineSync(connection_);
    PQflush(connection_);
    ++unread_;
    asked_ = 0;
}

void Handle::requireConnection() {
    if (lost_)
        throw core::Failure(core::DatabaseFailure, u"A ligação a «%1» foi fechada."_s.arg(place_),
                            u"08006"_s);
}

/// Reads what earlier statements still answer, up to the last so many synchronisations. Gives the
/// first failure among the answers, if any.
Result Handle::drain(int but) {
    requireConnection();
    deadline_.setRemainingTime(patience() * 1000);
    Result failure;
    while (unread_ > but) {
        Result result(take());
        if (PQresultStatus(result.get()) == PGRES_PIPELINE_SYNC) --unread_;
        if (!failure && result && isFailure(result.get())) failure = std::move(result);
    }
    return failure;
}

/// Seconds after which a silent server counts as gone.
int Handle::patience() const {
    return qMax(timeout_, LeastPatience);
}

/// The answer of the last of so many statements, or of the first one that failed.
Result Handle::answers(int count) {
    Result result;
    for (; count > 0; --count) {
        Result next(take());
        Result(take()).reset();  // the end of the statement's answers
        if (!isFailure(result.get()) || !result) result = std::move(next);
    }
    return result;
}

PGresult* Handle::take() {
    if (PQisBusy(connection_)) {
        core::Wait waiting(awaited_);
        while (PQisBusy(connection_)) wait(waiting);
    }
    PGresult* result = PQgetResult(connection_);
    if (PQstatus(connection_) != CONNECTION_BAD) return result;
    const Result last(result);
    lose(oneLine(result ? PQresultErrorMessage(result) : PQerrorMessage(connection_)));
}

void Handle::wait(core::Wait& waiting) {
    const int sending = PQflush(connection_);
    if (sending < 0) lose(oneLine(PQerrorMessage(connection_)));
    if (!await(connection_, static_cast<short>(sending > 0 ? POLLIN | POLLOUT : POLLIN), deadline_,
               waiting)) {
        // Nobody knows what a silent server still does: the connection is given up, at once, so
        // that it lets go of everything when it wakes up.
        lost_ = true;
        PQfinish(std::exchange(connection_, nullptr));
        if (waiting.isGivenUp()) throw givenUp();
        throw core::Failure(
            core::DatabaseFailure,
            u"O servidor de «%1» não respondeu em %2 segundos; a ligação foi fechada."_s.arg(place_)
                .arg(patience()),
            QString::fromLatin1(NoAnswer));
    }
    if (!PQconsumeInput(connection_)) lose(oneLine(PQerrorMessage(connection_)));
}

void Handle::refuse(const PGresult* result) {
    const auto code = QString::fromLatin1(PQresultErrorField(result, PG_DIAG_SQLSTATE));
    QString text = oneLine(PQresultErrorField(result, PG_DIAG_MESSAGE_PRIMARY));
    if (const char* detail = PQresultErrorField(result, PG_DIAG_MESSAGE_DETAIL))
        text += u'\n' + oneLine(detail);
    if (text.isEmpty()) text = oneLine(PQresultErrorMessage(result));
    if (code.startsWith(Ending)) lose(text, code);
    throw failure(code, text);
}

void Handle::lose(const QString& text, const QString& code) {
    lost_ = true;
    throw core::Failure(core::DatabaseFailure,
                        withDetails(u"A ligação a «%1» perdeu-se."_s.arg(place_), text), code);
}

}  // namespace ado::postgres

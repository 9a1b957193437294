// SPDX-License-Identifier: MIT
#pragma once

#include <QDateTime>
#include <optional>
#include <vector>

#include "platform/ado/Recordset.h"

/// Postings and annulments are several writes, one commit each. The journal `tbOperacoes` tells
/// what is missing of those that were cut short: each of its rows is written in the same commit as
/// the write that it tells of, so that a missing step is done exactly once, whoever does it.
namespace data {

/// What is missing of an operation, from where on.
enum class Step {
    Nothing,
    CorrectingRow,  ///< the correcting row of an annulment, and then the accumulator
    Accumulator,
};

/// What differs between movements by their type.
struct MovementRules {
    /// Adds a registered movement to the accumulators.
    void (*accumulate)(const ado::Recordset& movement, const ado::Accompaniment& with);
    /// Sets the columns of a correcting row beyond day, type, member and number; null where the
    /// type is not annulled.
    void (*setCorrectingRow)(const ado::Recordset& shown, ado::Recordset& correcting) = nullptr;
    /// Takes an annulled movement back from the accumulators.
    void (*takeBack)(const ado::Recordset& shown, const ado::Accompaniment& with) = nullptr;
};

/// One posting or annulment of a movement.
struct Operation {
    enum class Kind { Posting, Annulment };

    QString id;  ///< key in the journal, chosen before the first write; empty until then
    Kind kind = Kind::Posting;
    Step missing = Step::Nothing;
    bool isRegistered = false;  ///< its first write stands in the book
    QString ficheiro;           ///< where the movement lives, as the view of movements names it
    qint32 movimento_id = 0;
    qint32 movimento_no = 0;
    qint32 socio_id = 0;
    QString tipo;            ///< of the movement, before its annulment
    qint32 correcao_no = 0;  ///< number of the correcting row; 0 when there is none yet
    QString quem;            ///< user@machine
    QDateTime quando;
    QStringList confirmed;  ///< unusual values that the operator said yes to
};

/// Chooses the key, and says who and when. Does nothing to an operation that was begun before: a
/// second press of a button goes on with the same one, so that the book takes it once only.
void begin(Operation& operation, Operation::Kind kind);

/// True when the operation's first write stands in the book, also where its answer was lost: the
/// journal is asked for it.
bool isRegistered(Operation& operation);

/// Asks the journal how far somebody else brought a registered operation; where it does not answer
/// the operation stays as it is.
void catchUp(Operation& operation);

/// The movement of an operation as the view of movements has it, with `ficheiro`; null when it is
/// not there any more. `ficheiro` of the operation follows the movement.
ado::RecordsetPtr openMovement(Operation& operation);

/// Adds the posting's movement to the accumulators, or takes the annulment's back from them, which
/// is the last step of either. Does nothing when somebody else did it meanwhile. A failure is told,
/// with what is registered and what is missing; the screen then has to stay. True when nothing is
/// missing any more.
bool accumulatedOrTold(Operation& operation, const ado::Recordset& movement,
                       const MovementRules& rules, const QString& caption);

/// Tells what is registered and what is missing, and why.
void tellUnfinished(const Operation& operation, const QString& why, const QString& caption);

/// What was begun: "Lançamento nº 4001".
QString named(const Operation& operation);
/// In words for a person, without a full stop: "Lançamento nº 4001 de 100015, 52,41: falta somar
/// aos acumulados".
QString described(Operation operation);
/// What is missing, in words: "falta somar aos acumulados".
QString missingText(const Operation& operation);

/// The journal. A book made by an older program has none: nothing is then written beside the other
/// writes, and nothing is found.
namespace journal {

/// The row of an operation that begins, beside its first write.
/// @param keyColumn  the journal's column that takes the key of the row written; empty for none
ado::Accompaniment begun(const Operation& operation, const QString& keyColumn = {});
/// The correcting row stands: beside that row.
ado::Accompaniment corrected(const Operation& operation);
/// The last step is done: beside it. An annulment stays in the journal as history, a posting that
/// was never cut short leaves no trace.
ado::Accompaniment finished(const Operation& operation);
/// The same for a step that was cut short and is done by another hand. Such a row stays, so that a
/// screen that is still open on it finds that nothing is missing.
ado::Accompaniment finishedLater(const Operation& operation);
/// Notes that there is nothing left to do.
void close(const Operation& operation);
/// The same for every operation that has yet to be added to the accumulators, of the members or of
/// those who have left: they have been emptied, and whatever fills them counts all movements.
void closeAccumulations(bool ofMembers);

std::optional<Operation> find(const QString& id);
/// The last annulment of a movement that was begun.
std::optional<Operation> annulmentOf(const QString& ficheiro, qint32 movimento_id);
/// What is unfinished and nobody is about to finish: what this user began at this machine, and of
/// others what is older than five minutes. The oldest first.
std::vector<Operation> unfinished();

}  // namespace journal

}  // namespace data

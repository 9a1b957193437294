// SPDX-License-Identifier: MIT
// A row set against a model of it that is as plain as can be: random steps on rows in memory and on
// longer passes, held or not, beside another program that writes to the table.
#include <algorithm>
#include <map>
#include <optional>
#include <random>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

struct Kind {
    const char* name;
    ado::CursorType cursor;
    ado::LockType lock;
    int rows;  ///< 5 are held in memory, 100 are not
};

/// What a set of tbMov, by its key, must look like; `nome` stands for all columns.
struct Model {
    struct Row {
        qint64 id;
        QString seen;  ///< when the query ran, or stored by the set
        bool isDeleted = false;
        bool isStored = false;
    };
    enum class At { Nothing, Queried, Inserted };

    Kind kind;
    std::map<qint64, QString> table;  ///< nome by id
    std::vector<Row> queried;
    std::vector<qint64> inserted;
    At at = At::Nothing;
    std::size_t place = 0;
    /// Of more rows than a few the set keeps none, nor what it stored there.
    bool isLong = false;
    bool isNew = false, isDeleted = false, isHeld = false, isLetGo = false;
    std::optional<QString> change;

    bool exists() const { return isNew || (at != At::Nothing && !isDeleted); }
    qint64 id() const { return at == At::Inserted ? inserted[place] : queried[place].id; }
    QString shown() {
        if (change || isNew) return change.value_or(QString());
        look();
        const bool isFresh = at == At::Inserted || kind.lock == ado::adLockPessimistic ||
                             kind.cursor == ado::adOpenDynamic ||
                             (queried[place].isStored && isLong);
        return isFresh ? table[id()] : queried[place].seen;
    }
    void look() {
        if (kind.lock == ado::adLockPessimistic && !isNew && !isLetGo) isHeld = true;
    }
    void leave() {
        isNew = isDeleted = isHeld = isLetGo = false;
        change.reset();
    }
    void standOn(At where, std::size_t which) {
        leave();
        at = where;
        place = which;
    }
    void goOn(std::size_t from) {
        while (from < queried.size() && queried[from].isDeleted) ++from;
        if (from < queried.size()) return standOn(At::Queried, from);
        inserted.empty() ? standOn(At::Nothing, 0) : standOn(At::Inserted, 0);
    }
    void toNext() {
        leave();
        if (at == At::Queried) return goOn(place + 1);
        if (at == At::Inserted)
            place + 1 < inserted.size() ? standOn(At::Inserted, place + 1)
                                        : standOn(At::Nothing, 0);
    }
    void toLast() {
        if (!inserted.empty()) return standOn(At::Inserted, inserted.size() - 1);
        std::size_t count = queried.size();
        while (count > 0 && queried[count - 1].isDeleted) --count;
        count > 0 ? standOn(At::Queried, count - 1) : standOn(At::Nothing, 0);
    }
    void requery() {
        queried.clear();
        inserted.clear();
        for (const auto& [id, nome] : table) queried.push_back({id, nome});
        isLong = queried.size() > 32;
        goOn(0);
    }
    void startNew() {
        const bool wasDeleted = isDeleted;
        leave();
        isDeleted = wasDeleted;
        isNew = true;
    }
    void takeNew(qint64 id) {
        inserted.push_back(id);
        table[id] = change.value_or(QString());
        standOn(At::Inserted, inserted.size() - 1);
    }
    void stored() {
        if (change && at == At::Queried) {
            queried[place].seen = *change;
            queried[place].isStored = true;
        }
        if (change) table[id()] = *change;
        change.reset();
        isHeld = false;
        isLetGo = true;
    }
    void remove() {
        table.erase(id());
        if (at == At::Queried) queried[place].isDeleted = true;
        if (at == At::Inserted) inserted.erase(inserted.begin() + std::ptrdiff_t(place--));
        leave();
        isDeleted = true;
    }
    qint64 count() const {
        return std::count_if(queried.begin(), queried.end(),
                             [](const Row& row) { return !row.isDeleted; }) +
               qint64(inserted.size());
    }
};

class RandomSteps : public SmallBook, public testing::WithParamInterface<Kind> {
protected:
    int below(int limit) { return int(random_() % unsigned(limit)); }
    QString word() { return u"w%1"_s.arg(below(1000)); }

    void start() {
        model_.kind = GetParam();
        fill(model_.kind.rows);
        const auto all = open(u"select id, nome from tbMov"_s, connection);
        for (; !all->atEnd(); all->MoveNext())
            model_.table[all->value(0).toLongLong()] = all->value(1).toString();
        rows_ = open(u"select * from tbMov order by id"_s, connection, model_.kind.lock,
                     model_.kind.cursor);
        model_.requery();
    }

    void move() {
        // What others write is seen where the set next looks at a row.
        if (below(3) == 0 && !model_.table.empty()) {
            auto row = std::next(model_.table.begin(), below(int(model_.table.size())));
            row->second = word();
            book.exec(
                u"UPDATE tbMov SET nome = '%1' WHERE id = %2"_s.arg(row->second).arg(row->first));
        }
        switch (below(4)) {
            case 0:
                rows_->MoveFirst();
                return model_.goOn(0);
            case 1:
                rows_->MoveLast();
                return model_.toLast();
            default:
                rows_->MoveNext();
                model_.toNext();
        }
    }

    void write() {
        const QString text = word();
        if (!model_.exists()) {
            EXPECT_EQ(failureOf([&] { rows_->setCollect(u"nome"_s, text); }).number(),
                      core::NoCurrentRow);
            return;
        }
        rows_->setCollect(u"nome"_s, text);
        if (!model_.isNew) model_.isLetGo = false;
        model_.look();
        model_.change = text;
    }

    void store() {
        if (!model_.exists()) return;
        const bool wasNew = model_.isNew;
        // Update lets go of the row, also where nobody looked at it before.
        ASSERT_EQ(rows_->Collect(u"nome"_s).toString(), model_.shown());
        rows_->Update();
        if (wasNew) model_.takeNew(rows_->Collect(u"id"_s).toLongLong());
        model_.stored();
    }

    void remove() {
        if (!model_.exists()) return;
        rows_->Delete();
        if (!model_.isNew) return model_.remove();
        model_.isNew = false;
        model_.change.reset();
    }

    void step() {
        switch (below(12)) {
            case 0:
                rows_->AddNew();
                return model_.startNew();
            case 1:
                rows_->CancelUpdate();
                model_.isNew = false;
                return model_.change.reset();
            case 2:
                return remove();
            case 3:
            case 4:
                return store();
            case 5:
            case 6:
            case 7:
                return write();
            case 8:
                if (below(10) != 0) return;
                rows_->Requery();
                return model_.requery();
            default:
                return move();
        }
    }

    void compare() {
        ASSERT_EQ(rows_->isNewRow(), model_.isNew);
        ASSERT_EQ(rows_->atEnd(), model_.at == Model::At::Nothing && !model_.isNew);
        if (rows_->RecordCount() >= 0 || !model_.isLong) {
            ASSERT_EQ(rows_->RecordCount(), model_.count());
        }
        if (!model_.exists()) {
            ASSERT_EQ(failureOf([&] { rows_->Collect(u"nome"_s); }).number(), core::NoCurrentRow);
        } else if (below(2) == 0) {  // a row that nobody looks at is not held
            ASSERT_EQ(rows_->Collect(u"nome"_s).toString(), model_.shown());
        }
    }

    /// Whether others can hold the row stood on.
    void compareHold() {
        if (model_.at == Model::At::Nothing || model_.isDeleted || model_.isNew) return;
        const auto other = open(u"select * from tbMov where id = %1"_s.arg(model_.id()), others_);
        bool isRefused = false;
        try {
            other->Collect(u"nome"_s);
        } catch (const core::Failure& failure) {
            isRefused = failure.number() == core::RowInUse;
        }
        ASSERT_EQ(isRefused, model_.isHeld);
    }

    void compareTable() {
        const auto all = open(u"select id, nome from tbMov order by id"_s, others_);
        for (const auto& [id, nome] : model_.table) {
            ASSERT_FALSE(all->atEnd());
            ASSERT_EQ(all->value(0).toLongLong(), id);
            ASSERT_EQ(all->value(1).toString(), nome);
            all->MoveNext();
        }
        ASSERT_TRUE(all->atEnd());
    }

    ado::RecordsetPtr rows_;
    ado::ConnectionPtr others_ = connect();
    Model model_;
    std::mt19937 random_{7};
};

TEST_P(RandomSteps, LeaveTheSetAndTheTableAsTheModelHasThem) {
    const int steps = qEnvironmentVariableIntValue("ZELMARS_STEPS");
    start();
    for (int each = 0; each < std::max(steps, 2000); ++each) {
        SCOPED_TRACE(each);
        step();
        compare();
        if (each % 10 == 0) compareHold();
        if (each % 50 == 0) compareTable();
        if (HasFailure()) return;
    }
}

INSTANTIATE_TEST_SUITE_P(
    , RandomSteps,
    testing::Values(Kind{"held", ado::adOpenStatic, ado::adLockPessimistic, 5},
                    Kind{"heldLong", ado::adOpenStatic, ado::adLockPessimistic, 100},
                    Kind{"heldDynamic", ado::adOpenDynamic, ado::adLockPessimistic, 5},
                    Kind{"optimistic", ado::adOpenStatic, ado::adLockOptimistic, 5},
                    Kind{"optimisticLong", ado::adOpenStatic, ado::adLockOptimistic, 100},
                    Kind{"optimisticDynamic", ado::adOpenDynamic, ado::adLockOptimistic, 100}),
    [](const auto& kind) { return std::string(kind.param.name); });

}  // namespace

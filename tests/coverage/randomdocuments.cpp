// SPDX-License-Identifier: MIT
// What holds for every document, tried on thousands of them.
#include <algorithm>
#include <random>

#include "coverage/Calculation.h"
#include "coverage/Remainders.h"
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

const int Documents = support::onServer() ? 500 : 2000;
constexpr int Members = 4;
constexpr int Groups = 6;
constexpr int RubricsPerGroup = 3;

/// A plan year of random documents: rubrics with any mixture of ceilings, maxima and franchises.
class RandomDocuments : public Desk {
protected:
    RandomDocuments() {
        core::setMsgBoxPresenter([](const QString& text, auto...) {
            EXPECT_EQ(text.toStdString(), "Deseja finalizar o registo?");
            return core::Answer::Yes;
        });
        for (int i = 0; i < Members; ++i) members.push_back(static_cast<qint32>(book.member({})));
        for (int group = 0; group < Groups; ++group) {
            const qint64 main =
                book.insert(u"tbZelmar_Plafonds"_s, {{"agregado", maybe(1500)},
                                                     {"socio", maybe(800)},
                                                     {"familiar", maybe(600)},
                                                     {"total_familia", maybe(700)}});
            for (int i = 0; i < RubricsPerGroup; ++i)
                rubrics.push_back(
                    book.insert(u"tbZelmar_Plafonds"_s, {{"rubrica_id_main", main},
                                                         {"percent", 0.05 * (1 + below(20))},
                                                         {"agregado", maybe(2000)},
                                                         {"socio", amount(2000)},
                                                         {"familiar", amount(2000)},
                                                         {"total_familia", maybe(1200)},
                                                         {"socio_max_lan", maybe(200)},
                                                         {"familiar_max_lan", maybe(200)},
                                                         {"nomax_recibos_socio", maybeCount()},
                                                         {"franquia", maybe(60)}}));
        }
    }

    int below(int limit) { return static_cast<int>(generator() % static_cast<unsigned>(limit)); }
    /// 0,01 up to `highest`, in cents.
    QVariant amount(int highest) { return (1 + below(highest * 100)) / 100.0; }
    /// The same, or none.
    QVariant maybe(int highest) { return below(2) ? amount(highest) : QVariant(); }

    /// So many documents that none is refused.
    QVariant maybeCount() { return below(2) ? QVariant(Documents + below(9)) : QVariant(); }

    Document anyDocument() {
        const double value = amount(400).toDouble();
        const char* const codes[] = {"A", "B", "C1"};
        return {.rubrica_id = rubrics[static_cast<std::size_t>(below(Groups * RubricsPerGroup))],
                .codABC = QString::fromLatin1(codes[below(3)]),
                .doc_valor = value,
                .recebido = below(3) ? 0 : value * below(10) / 10,
                .hospital = below(4) == 0,
                .incidencia = value * (1 + below(10)) / 10};
    }

    static double number(const coverage::Document& entry, const QString& column) {
        return core::toDouble(entry.record->Collect(column));
    }

    void expectSoundAmounts(const coverage::Document& entry) {
        const double credit = number(entry, u"credito"_s);
        EXPECT_GE(number(entry, u"saldo_plafond"_s), 0);
        EXPECT_LE(number(entry, u"liquido"_s), number(entry, u"saldo_plafond"_s));
        EXPECT_LE(number(entry, u"liquido"_s), number(entry, u"iliquido"_s));
        EXPECT_LE(number(entry, u"iliquido"_s), number(entry, u"comparticipacao"_s) + 0.0001);
        EXPECT_LE(credit, std::max(0.0, number(entry, u"liquido"_s)));
        EXPECT_NEAR(number(entry, u"debito"_s),
                    entry.isHospital ? number(entry, u"doc_valor"_s) : std::max(0.0, credit),
                    0.0001);
    }

    /// What the run tells of itself adds up to what the row keeps, and agrees with what was left to
    /// that person beforehand.
    void expectExplained(const coverage::Document& entry, const coverage::Remainders& before) {
        const coverage::Explanation& told = run.explanation;
        ASSERT_EQ(told.end, coverage::Explanation::End::Reached);
        const coverage::Ceiling* bound = coverage::binding(told.ceilings);
        ASSERT_NE(bound, nullptr);
        // The column keeps four decimals.
        EXPECT_NEAR(bound->left.toDouble(), number(entry, u"saldo_plafond"_s), 0.00005);
        for (const coverage::Ceiling& each : told.ceilings) {
            EXPECT_GE(each.left, bound->left);
        }
        EXPECT_EQ(told.net, entry.record->Collect(u"liquido"_s));
        EXPECT_EQ(told.credit, entry.record->Collect(u"credito"_s));
        expectLeftBefore(entry, before);
    }
    void expectLeftBefore(const coverage::Document& entry, const coverage::Remainders& before) {
        const coverage::Explanation& told = run.explanation;
        const std::vector<coverage::Remainder> all = before.of(entry.personCode);
        EXPECT_EQ(all.size(), rubrics.size());
        const auto found = std::find_if(all.begin(), all.end(), [&](const auto& each) {
            return each.rubrica_id == core::toLong(entry.rubrica_id);
        });
        ASSERT_NE(found, all.end());
        ASSERT_EQ(found->ceilings.size(), told.ceilings.size());
        for (std::size_t at = 0; at < told.ceilings.size(); ++at) {
            EXPECT_EQ(found->ceilings[at].of, told.ceilings[at].of);
            EXPECT_EQ(found->ceilings[at].amount, told.ceilings[at].amount);
            EXPECT_EQ(found->ceilings[at].used, told.ceilings[at].used);
            EXPECT_EQ(found->ceilings[at].left, told.ceilings[at].left);
        }
        EXPECT_EQ(found->used.documents, told.used.documents);
        EXPECT_EQ(found->franchiseLeft,
                  coverage::franchiseLeft(told.franchise, told.franchiseSpent));
    }

    std::string everything(const coverage::Document& entry) {
        std::string all = stored("select * from tbSocios_Acumulados order by 1, 2, 3");
        for (int column = 0; column < entry.record->columnCount(); ++column)
            all += '|' + core::toText(entry.record->value(column)).toStdString();
        return all;
    }
    /// Two runs in a row leave the same row and the same book.
    void expectSecondRunToChangeNothing(const coverage::Document& entry) {
        tryOut(entry);
        const std::string first = everything(entry);
        tryOut(entry);
        EXPECT_EQ(everything(entry), first);
    }

    std::mt19937 generator{20260515};
    std::vector<qint32> members;
    std::vector<qint64> rubrics;
};

TEST_F(RandomDocuments, NeverCreditMoreThanTheCeilingsLeaveAndAddUp) {
    for (int i = 0; i < Documents; ++i) {
        SCOPED_TRACE(i);
        const Document document = anyDocument();
        socio = members[static_cast<std::size_t>(below(Members))];
        const coverage::Document entry = enter(document);
        const coverage::Remainders before(socio);
        if (i % 3 == 0) expectSecondRunToChangeNothing(entry);
        begun = {};
        ASSERT_TRUE(coverage::post(posting(entry), run, begun));
        expectSoundAmounts(entry);
        expectExplained(entry, before);
        EXPECT_EQ(entry.record->Collect(u"movimento_no"_s).toInt(), i + 1);
        if (HasFailure()) return;
    }
    // The accumulators add in 32-bit floats.
    EXPECT_EQ(stored("select count(*), sum(no_docs), max(abs(credito_ac - credit)) < 0.01, "
                     "max(abs(debito_ac - debit)) < 0.01 from tbSocios_Acumulados a join "
                     "(select socio_id s, codABC c, rubrica_id r, count(*) n, sum(credito) credit, "
                     "sum(debito) debit from tbZelmar_Movimentos group by 1, 2, 3) "
                     "m on s = socio_id and c = codABC and r = rubrica_id and n = no_docs"),
              std::to_string(book.count(u"tbSocios_Acumulados"_s)) + "|" +
                  std::to_string(Documents) + "|1|1");
}

}  // namespace

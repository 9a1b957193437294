// SPDX-License-Identifier: MIT
#include "platform/ado/dialect/ShapeQuery.h"

#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// Reads the tokens of the form one behind the other.
class Reader {
public:
    explicit Reader(const Query& query) : s(query) {}

    void expect(QLatin1StringView word) {
        if (!s.is(at_, word)) fail();
        ++at_;
    }
    QString braced() {
        const int behind = s.behindBracket(at_);
        if (!s.is(at_, "{"_L1) || !s.is(behind - 1, "}"_L1)) fail();
        const qsizetype from = s.token(at_).at + 1;
        at_ = behind;
        return s.text().mid(from, s.token(behind - 1).at - from);
    }
    QString name() {
        if (at_ >= s.count() || s.kind(at_) == TokenKind::Symbol) fail();
        return s.name(at_++);
    }
    void skipName() {
        if (!s.is(at_, "as"_L1)) return;
        ++at_;
        name();
    }
    void end() {
        if (at_ != s.count()) fail();
    }

private:
    [[noreturn]] void fail() const {
        throw core::Failure(core::InvalidCall,
                            u"A consulta SHAPE não tem a forma esperada junto de: %1"_s.arg(
                                at_ < s.count() ? s.text().mid(s.token(at_).at, 60) : u"(fim)"_s));
    }

    const Query& s;
    int at_ = 0;
};

}  // namespace

bool ShapeQuery::isShape(const Query& query) {
    return query.is(0, "shape"_L1);
}

ShapeQuery ShapeQuery::parse(const Query& query) {
    Reader reader(query);
    ShapeQuery shape;
    reader.expect("shape"_L1);
    shape.parent = reader.braced();
    reader.skipName();
    reader.expect("append"_L1);
    reader.expect("("_L1);
    shape.child = reader.braced();
    reader.skipName();
    reader.expect("relate"_L1);
    shape.parentColumn = reader.name();
    reader.expect("to"_L1);
    shape.childColumn = reader.name();
    reader.expect(")"_L1);
    reader.expect("as"_L1);
    shape.chapter = reader.name();
    reader.end();
    return shape;
}

}  // namespace ado

#include "data/sql_parts.h"

#include <QStringList>

namespace zv {
namespace {

// Blanks only, as the statement text is split on blanks.
QString TrimBlanks(const QString& s) {
    qsizetype b = 0;
    qsizetype e = s.size();
    while (b < e && s.at(b) == QLatin1Char(' ')) {
        ++b;
    }
    while (e > b && s.at(e - 1) == QLatin1Char(' ')) {
        --e;
    }
    return s.mid(b, e - b);
}

// Wraps the word that follows FROM (the table) in brackets unless it has them.
QString BracketTable(const QString& select) {
    QString rebuilt;
    bool afterFrom = false;
    for (const QString& raw : select.split(QLatin1Char(' '), Qt::SkipEmptyParts)) {
        const QString word = TrimBlanks(raw);
        const bool bracketed = word.startsWith(QLatin1Char('[')) && word.endsWith(QLatin1Char(']'));
        if (afterFrom && !bracketed) {
            rebuilt += QStringLiteral(" [") + word + QLatin1Char(']');
        } else {
            rebuilt += QLatin1Char(' ') + word;
        }
        afterFrom = word.compare(QLatin1String("FROM"), Qt::CaseInsensitive) == 0;
    }
    return TrimBlanks(rebuilt) + QLatin1Char(' ');
}

}  // namespace

std::array<QString, 3> GetSqlParts(const QString& sql, bool keepCase) {
    const QString s = keepCase ? sql : sql.toUpper();
    const QLatin1String whereWord("WHERE ");
    const QLatin1String orderWord(" ORDER ");
    QString select, where, order;
    const qsizetype w = s.indexOf(whereWord);
    const qsizetype o = s.indexOf(orderWord);
    if (w < 0) {
        if (o < 0) {
            select = s;
        } else {
            order = s.mid(o + 1);
            select = s.left(o + 1);
        }
    } else {
        select = s.left(w);
        where = s.mid(w);
        const qsizetype q = where.indexOf(orderWord);
        if (q >= 0) {
            where = TrimBlanks(where.left(q + 1)) + QLatin1Char(' ');
        }
        if (o >= 0) {
            order = s.mid(o + 1);
        }
    }
    return {BracketTable(select), where, order};
}

}  // namespace zv

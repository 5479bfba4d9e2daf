#include "data/pg_dialect.h"

#include <QRegularExpression>

namespace zv {
namespace {

bool IsWordChar(QChar c) {
    return c.isLetterOrNumber() || c == QLatin1Char('_');
}

bool IsPlainIdentifier(const QString& name) {
    static const QRegularExpression plain(QStringLiteral("^[A-Za-z_][A-Za-z0-9_]*$"));
    return plain.match(name).hasMatch();
}

QString Literal(const QString& text) {
    QString t = text;
    return QLatin1Char('\'') + t.replace(QLatin1Char('\''), QStringLiteral("''")) +
           QLatin1Char('\'');
}

// "USE name": the connection already names its database; fail unless it is that one.
QString UseCheck(const QString& name) {
    const QString message = QStringLiteral("Database '%1' is not the database of this connection.");
    QString body = QStringLiteral("BEGIN IF current_database() <> ") + Literal(name) +
                   QStringLiteral(" THEN RAISE EXCEPTION '%', ") + Literal(message.arg(name)) +
                   QStringLiteral("; END IF; END");
    return QStringLiteral("DO $zv$") + body + QStringLiteral("$zv$");
}

// The column before a LIKE (skipping NOT) gets "::text", as SQL Server converts numbers
// to text for LIKE and PostgreSQL does not.
void CastOperandBeforeLike(QString& out) {
    qsizetype end = out.size();
    while (end > 0 && out.at(end - 1).isSpace()) {
        --end;
    }
    qsizetype start = end;
    while (start > 0 && IsWordChar(out.at(start - 1))) {
        --start;
    }
    if (out.mid(start, end - start).compare(QLatin1String("NOT"), Qt::CaseInsensitive) == 0) {
        end = start;
        while (end > 0 && out.at(end - 1).isSpace()) {
            --end;
        }
        start = end;
        while (start > 0 && IsWordChar(out.at(start - 1))) {
            --start;
        }
    }
    if (start < end && !out.at(start).isDigit()) {
        out.insert(end, QStringLiteral("::text"));
    }
}

}  // namespace

QString AdaptForPostgres(const QString& tsql) {
    static const QRegularExpression use(
        QStringLiteral("^\\s*USE\\s+\\[?([^\\]\\s;]+)\\]?\\s*;?\\s*$"),
        QRegularExpression::CaseInsensitiveOption);
    const QRegularExpressionMatch u = use.match(tsql);
    if (u.hasMatch()) {
        return UseCheck(u.captured(1));
    }

    QString sql = tsql;
    QString limit;
    static const QRegularExpression top(QStringLiteral("^(\\s*SELECT\\s+)TOP\\s+(\\d+)\\s+"),
                                        QRegularExpression::CaseInsensitiveOption);
    const QRegularExpressionMatch t = top.match(sql);
    if (t.hasMatch()) {
        limit = t.captured(2);
        sql = t.captured(1) + sql.mid(t.capturedEnd(0));
    }

    QString out;
    out.reserve(sql.size() + 16);
    const qsizetype n = sql.size();
    for (qsizetype i = 0; i < n;) {
        const QChar c = sql.at(i);
        if (c == QLatin1Char('\'')) {
            // A string literal, '' inside standing for one apostrophe.
            qsizetype j = i + 1;
            while (j < n) {
                if (sql.at(j) == QLatin1Char('\'')) {
                    if (j + 1 < n && sql.at(j + 1) == QLatin1Char('\'')) {
                        j += 2;
                        continue;
                    }
                    break;
                }
                ++j;
            }
            out += sql.mid(i, j + 1 - i);
            i = j + 1;
        } else if (c == QLatin1Char('[')) {
            const qsizetype close = sql.indexOf(QLatin1Char(']'), i + 1);
            if (close < 0) {
                out += sql.mid(i);
                break;
            }
            const QString name = sql.mid(i + 1, close - i - 1);
            out += IsPlainIdentifier(name) ? name
                                           : QLatin1Char('"') + name.toLower() + QLatin1Char('"');
            i = close + 1;
        } else if (IsWordChar(c) && (i == 0 || !IsWordChar(sql.at(i - 1)))) {
            qsizetype j = i;
            while (j < n && IsWordChar(sql.at(j))) {
                ++j;
            }
            const QString word = sql.mid(i, j - i);
            if (word.compare(QLatin1String("LIKE"), Qt::CaseInsensitive) == 0) {
                CastOperandBeforeLike(out);
                out += QStringLiteral("ILIKE");
            } else {
                out += word;
            }
            i = j;
        } else {
            out += c;
            ++i;
        }
    }

    if (!limit.isEmpty()) {
        qsizetype end = out.size();
        while (end > 0 && (out.at(end - 1).isSpace() || out.at(end - 1) == QLatin1Char(';'))) {
            --end;
        }
        out = out.left(end) + QStringLiteral(" LIMIT ") + limit + out.mid(end);
    }
    return out;
}

}  // namespace zv

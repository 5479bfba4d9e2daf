#include "selection/list_query.h"

#include <QStringList>

#include "data/values.h"

namespace zv {
namespace {

// "[F] LIKE '*q*' OR [G] LIKE '*q*' ..." with the back-end's wildcard.
QString ContainsAny(bool server, const QStringList& fields, const QString& text) {
    const QString wild = server ? QStringLiteral("%") : QStringLiteral("*");
    const QString q = FixQuote(text);
    QStringList parts;
    for (const auto& f : fields) {
        parts << QStringLiteral("[%1] LIKE '%2%3%2'").arg(f, wild, q);
    }
    return parts.join(QStringLiteral(" OR "));
}

const QString kCaseKinds = QStringLiteral("[OptKey] IN (1,2,3,4,5,6,10,11)");
const QString kAllKinds = QStringLiteral("[OptKey] IN (0,1,2,3,4,5,6,10,11)");

QString OfClient(const QString& clientNum) {
    // The number is quoted like any other value, so an apostrophe in it cannot break the query.
    return QStringLiteral("[LakNum]='") + FixQuote(clientNum) + QStringLiteral("' AND ") +
           kCaseKinds;
}

}  // namespace

QString ListQuery::Text() const {
    QString sql = QStringLiteral("SELECT * FROM ") + table;
    if (!where.isEmpty()) {
        sql += QStringLiteral(" WHERE ") + where;
    }
    if (!order.isEmpty()) {
        sql += QStringLiteral(" ORDER BY ") + order;
    }
    return sql;
}

QString ListQuery::CountText() const {
    QString sql = QStringLiteral("SELECT COUNT(*) FROM ") + table;
    if (!where.isEmpty()) {
        sql += QStringLiteral(" WHERE ") + where;
    }
    return sql;
}

ListQuery ClientListQuery(bool server, const QString& text) {
    ListQuery q{QStringLiteral("[CLIENT]"), {}, QStringLiteral("NUM")};
    if (!text.isEmpty()) {
        q.where = server ? ContainsAny(true, {"NUM", "F_NAME", "L_NAME", "TELEFON"}, text)
                         : ContainsAny(false, {"F_NAME", "L_NAME", "TELEFON", "NUM"}, text);
    }
    return q;
}

ListQuery NamesOpenQuery(bool server, const QString& clientNum) {
    if (clientNum.isEmpty()) {
        return {QStringLiteral("[LOOKFOR]"),
                server ? QStringLiteral("1=0") : QStringLiteral("FALSE"),
                {}};
    }
    return {QStringLiteral("[LOOKFOR]"), OfClient(clientNum), QStringLiteral("OptKey, Tik")};
}

ListQuery NamesSearchQuery(bool server, const QString& clientNum, const QString& text) {
    if (text.isEmpty()) {
        if (clientNum.isEmpty()) {
            return {QStringLiteral("[LOOKFOR]"), kAllKinds, QStringLiteral("OptKey, LakNum")};
        }
        return NamesOpenQuery(server, clientNum);
    }
    const QString condition = ContainsAny(server, {"F_NAME", "L_NAME", "TELEFON", "TIK"}, text);
    if (clientNum.isEmpty()) {
        // Without parentheses: the kind restriction binds to the first-name match alone.
        return {QStringLiteral("[LOOKFOR]"), kAllKinds + QStringLiteral(" AND ") + condition,
                QStringLiteral("OptKey, Tik")};
    }
    return {QStringLiteral("[LOOKFOR]"),
            OfClient(clientNum) + QStringLiteral(" AND (") + condition + QStringLiteral(")"),
            QStringLiteral("OptKey, Tik")};
}

}  // namespace zv

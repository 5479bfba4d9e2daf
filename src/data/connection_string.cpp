#include "data/connection_string.h"

#include <QHash>
#include <QRegularExpression>

#include "data/data_errors.h"
#include "util/state.h"

namespace zv {

QString QuoteConnectionValue(const QString& value) {
    // Unquoted values lose the blanks around them when read back.
    const bool needs = value.contains(QLatin1Char(';')) || value.startsWith(QLatin1Char('"')) ||
                       value.startsWith(QLatin1Char('\'')) || value != value.trimmed();
    if (!needs) {
        return value;
    }
    const QChar dq('"');
    const QChar sq('\'');
    if (!value.contains(dq)) {
        return dq + value + dq;
    }
    if (!value.contains(sq)) {
        return sq + value + sq;
    }
    QString doubled = value;
    doubled.replace(dq, QStringLiteral("\"\""));
    return dq + doubled + dq;
}

QString GetConnectionByDbName(const QString& dbName) {
    QString s = QStringLiteral("Provider=") + QuoteConnectionValue(Provider()) + QLatin1Char(';');
    s += QStringLiteral("Data Source=") + QuoteConnectionValue(DataSource()) + QLatin1Char(';');
    s += QStringLiteral("Initial Catalog=") + QuoteConnectionValue(dbName + VolnaGlobNum()) +
         QLatin1Char(';');
    s += QStringLiteral("MARS Connection=True;");
    s += QStringLiteral("Connect Timeout=30;");
    s += QStringLiteral("DataTypeCompatibility=80;");
    s += QStringLiteral("User ID=") + QuoteConnectionValue(UserID()) + QLatin1Char(';');
    if (!PassWord().isEmpty()) {
        s += QStringLiteral("Password=") + QuoteConnectionValue(PassWord()) + QLatin1Char(';');
    }
    return s;
}

QString SqlServerOdbcDriver() {
    const QString configured = qEnvironmentVariable("ZORVANE_ODBC_DRIVER").trimmed();
    if (!configured.isEmpty()) {
        return configured;
    }
#ifdef Q_OS_WIN
    return QStringLiteral("SQL Server");
#else
    return QStringLiteral("FreeTDS");
#endif
}

namespace {

// Keys (lower case) to values; a quoted value loses its quotes, doubled quotes inside
// stand for one. Later duplicates of a key are ignored, as OLE DB does.
QHash<QString, QString> SplitPairs(const QString& s) {
    QHash<QString, QString> pairs;
    qsizetype i = 0;
    const qsizetype n = s.size();
    while (i < n) {
        const qsizetype eq = s.indexOf(QLatin1Char('='), i);
        if (eq < 0) {
            break;
        }
        const QString key = s.mid(i, eq - i).trimmed().toLower();
        i = eq + 1;
        while (i < n && s.at(i) == QLatin1Char(' ')) {
            ++i;
        }
        QString value;
        if (i < n && (s.at(i) == QLatin1Char('"') || s.at(i) == QLatin1Char('\''))) {
            const QChar quote = s.at(i++);
            while (i < n) {
                if (s.at(i) == quote) {
                    if (i + 1 < n && s.at(i + 1) == quote) {
                        value += quote;
                        i += 2;
                        continue;
                    }
                    ++i;
                    break;
                }
                value += s.at(i++);
            }
            const qsizetype semi = s.indexOf(QLatin1Char(';'), i);
            i = semi < 0 ? n : semi + 1;
        } else {
            const qsizetype semi = s.indexOf(QLatin1Char(';'), i);
            const qsizetype end = semi < 0 ? n : semi;
            value = s.mid(i, end - i).trimmed();
            i = end + 1;
        }
        if (!key.isEmpty() && !pairs.contains(key)) {
            pairs.insert(key, value);
        }
    }
    return pairs;
}

// ODBC values holding separators or braces go in braces, with "}" doubled.
QString OdbcValue(const QString& v) {
    if (!v.contains(QRegularExpression(QStringLiteral("[;{}=]"))) && v.trimmed() == v) {
        return v;
    }
    QString escaped = v;
    escaped.replace(QLatin1Char('}'), QStringLiteral("}}"));
    return QLatin1Char('{') + escaped + QLatin1Char('}');
}

// "host", "host,port" or a socket folder, optionally followed by ",port".
void SplitDataSource(const QString& dataSource, ServerConnectionParams& p) {
    static const QRegularExpression withPort(QStringLiteral("^(.*),\\s*(\\d+)\\s*$"));
    const QRegularExpressionMatch m = withPort.match(dataSource);
    if (m.hasMatch()) {
        p.host = m.captured(1).trimmed();
        p.port = m.captured(2).toInt();
    } else {
        p.host = dataSource.trimmed();
    }
}

bool IsSqlServerProvider(const QString& provider) {
    const QString p = provider.trimmed().toUpper();
    return p == QLatin1String("SQLOLEDB") || p.startsWith(QLatin1String("SQLOLEDB.")) ||
           p.startsWith(QLatin1String("SQLNCLI")) || p.startsWith(QLatin1String("MSOLEDBSQL"));
}

}  // namespace

ServerConnectionParams ParseConnectionString(const QString& connectionString) {
    const QHash<QString, QString> pairs = SplitPairs(connectionString);
    ServerConnectionParams p;
    const QString provider = pairs.value(QStringLiteral("provider"));
    SplitDataSource(pairs.value(QStringLiteral("data source")), p);
    p.database = pairs.value(QStringLiteral("initial catalog"));
    p.user = pairs.value(QStringLiteral("user id"));
    p.password = pairs.value(QStringLiteral("password"));
    bool ok = false;
    const int timeout = pairs.value(QStringLiteral("connect timeout")).toInt(&ok);
    if (ok && timeout >= 0) {
        p.connectTimeout = timeout;
    }
    if (provider.trimmed().compare(QLatin1String("PostgreSQL"), Qt::CaseInsensitive) == 0) {
        p.driver = QStringLiteral("QPSQL");
        return p;
    }
    if (!IsSqlServerProvider(provider)) {
        throw VbError(err::AdoProviderNotFound,
                      QStringLiteral("Provider cannot be found. It may not be properly "
                                     "installed. (%1)")
                          .arg(provider));
    }
    p.driver = QStringLiteral("QODBC");
    const QString driver = SqlServerOdbcDriver();
    QString odbc = QStringLiteral("DRIVER={") + driver + QStringLiteral("};");
    // FreeTDS takes the port as a key of its own; Microsoft's drivers take "host,port".
    if (driver.compare(QLatin1String("FreeTDS"), Qt::CaseInsensitive) == 0) {
        odbc += QStringLiteral("SERVER=") + OdbcValue(p.host) + QLatin1Char(';');
        if (p.port > 0) {
            odbc += QStringLiteral("PORT=") + QString::number(p.port) + QLatin1Char(';');
        }
    } else {
        const QString server =
            p.port > 0 ? p.host + QLatin1Char(',') + QString::number(p.port) : p.host;
        odbc += QStringLiteral("SERVER=") + OdbcValue(server) + QLatin1Char(';');
        if (pairs.value(QStringLiteral("mars connection"))
                .compare(QLatin1String("True"), Qt::CaseInsensitive) == 0) {
            odbc += QStringLiteral("MARS_Connection=yes;");
        }
    }
    odbc += QStringLiteral("DATABASE=") + OdbcValue(p.database) + QLatin1Char(';');
    odbc += QStringLiteral("UID=") + OdbcValue(p.user) + QLatin1Char(';');
    odbc += QStringLiteral("PWD=") + OdbcValue(p.password) + QLatin1Char(';');
    p.odbcConnectionString = odbc;
    return p;
}

}  // namespace zv

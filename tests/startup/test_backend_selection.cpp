// Back-end selection: the server login of MSSQLSetting.INI and the MSql row of MAIN.MDB,
// on a sample installation.

#include <QDir>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QTest>
#include <QUuid>
#include <optional>

#include "sample_install/sample_install.h"
#include "scripted_ui.h"
#include "startup/backend_selection.h"
#include "test_env.h"
#include "test_files.h"
#include "util/state.h"

using namespace zv;

namespace {

// The installation's client number; quoted in the query that looks up its MSql row.
const QString kOwn = QStringLiteral("2'3");
const QString kComplete = QStringLiteral(
    "[MSSQL]\nProvider=SQLOLEDB\nDataSource=srv\\office\n[1]\nUserID=dana\nPassWord=p;w\n");

// A connection of the test's own to a file of the installation.
class File {
  public:
    explicit File(const QString& path) : name_(QUuid::createUuid().toString()) {
        db_ = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name_);
        db_.setDatabaseName(path);
        db_.open();
    }
    ~File() {
        db_.close();
        db_ = QSqlDatabase();
        QSqlDatabase::removeDatabase(name_);
    }
    bool Exec(const QString& sql, const QVariantList& values = {}) {
        QSqlQuery q(db_);
        q.prepare(sql);
        for (const QVariant& v : values)
            q.addBindValue(v);
        return q.exec();
    }

  private:
    QString name_;
    QSqlDatabase db_;
};

class Installation {
  public:
    Installation() {
        SampleOptions options;
        options.writeSettings = false;
        CreateSampleInstallation(env_.DataDir(), options);
        SetMainPath(env_.DataDir());
        SetMyUser(QStringLiteral("1"));
        SetVolnaGlobNum(kOwn);
    }
    QString Path(const QString& relative) const { return QDir(env_.DataDir()).filePath(relative); }
    bool WriteIni(const QString& text) const {
        return test::WriteFile(Path(QStringLiteral("Def/MSSQLSetting.INI")), text.toUtf8());
    }
    // The MSql row of a client number with the four flags (IsDocs, IsBM, IsOffice, IsZorva).
    bool SetRow(const QString& client, const QVariantList& flags) const {
        File main(Path(QStringLiteral("MAIN.MDB")));
        return main.Exec(QStringLiteral("DELETE FROM MSql WHERE ClientID=?"), {client}) &&
               main.Exec(QStringLiteral("INSERT INTO MSql (ClientID, IsDocs, IsBM, IsOffice, "
                                        "IsZorva) VALUES (?, ?, ?, ?, ?)"),
                         QVariantList{client} + flags);
    }

  private:
    test::TestEnv env_;
};

QString Flags() {
    return QStringLiteral("%1%2%3%4")
        .arg(IsDocs() ? "D" : "-", IsBM() ? "B" : "-", IsOffice() ? "O" : "-",
             IsZorva() ? "Z" : "-");
}

}  // namespace

class TestBackendSelection : public QObject {
    Q_OBJECT

  private slots:
    void selection_data();
    void selection();
    void flagStaysSet();
    void mainUnreadable_data();
    void mainUnreadable();
};

// Expected: provider|data source|user|password|flags, the flags as D, B, O, Z or -; the MSql
// row holds IsDocs, IsBM, IsOffice, IsZorva.
void TestBackendSelection::selection_data() {
    QTest::addColumn<QString>("ini");  // null: no file
    QTest::addColumn<QString>("rowOf");
    QTest::addColumn<QVariantList>("row");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const QString& ini, const QVariantList& flags,
                        const char* expected, const QString& rowOf = kOwn) {
        QTest::newRow(name) << ini << rowOf << flags << QString::fromUtf8(expected);
    };
    const QVariantList all{1, 1, 1, 1};
    row("complete, own login", kComplete, all, "SQLOLEDB|srv\\office|dana|p;w|DBOZ");
    row("shared login 000, own password ignored",
        "[MSSQL]\nProvider=P\nDataSource=S\n[1]\nPassWord=own\n[000]\nUserID=office\n"
        "PassWord=shared\n",
        all, "P|S|office|shared|DBOZ");
    row("no provider", "[MSSQL]\nDataSource=S\n[1]\nUserID=dana\nPassWord=p\n", all,
        "|S|dana|p|----");
    row("no login in either section",
        "[MSSQL]\nProvider=P\nDataSource=S\n[2]\nUserID=other\n[000]\nPassWord=y\n", all,
        "P|S||y|----");
    row("no settings file", QString(), all, "||||----");
    const QVariant null{QMetaType(QMetaType::Int)};
    row("clients on the server only", kComplete, {0, 0, 1, 0},
        "SQLOLEDB|srv\\office|dana|p;w|--O-");
    row("true written as -1", kComplete, {-1, 0, 0, -1}, "SQLOLEDB|srv\\office|dana|p;w|D--Z");
    row("null reads as false", kComplete, {null, 1, null, null},
        "SQLOLEDB|srv\\office|dana|p;w|-B--");
    row("no row for this installation", kComplete, all, "SQLOLEDB|srv\\office|dana|p;w|----",
        QStringLiteral("23"));
}

void TestBackendSelection::selection() {
    QFETCH(QString, ini);
    QFETCH(QString, rowOf);
    QFETCH(QVariantList, row);
    QFETCH(QString, expected);
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.SetRow(rowOf, row));
    if (!ini.isNull())
        QVERIFY(inst.WriteIni(ini));
    GetMSSQLParam();
    QCOMPARE(QStringList({Provider(), DataSource(), UserID(), PassWord(), Flags()})
                 .join(QLatin1Char('|')),
             expected);
    QCOMPARE(ui->Texts(), QStringList());
}

// The dialog reads the settings again when it loads; a flag once set is not taken back.
void TestBackendSelection::flagStaysSet() {
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.WriteIni(kComplete));
    QVERIFY(inst.SetRow(kOwn, {0, 1, 1, 0}));
    GetMSSQLParam();
    QCOMPARE(Flags(), QStringLiteral("-BO-"));
    QVERIFY(inst.SetRow(kOwn, {1, 0, 0, 0}));
    GetMSSQLParam();
    QCOMPARE(Flags(), QStringLiteral("DBO-"));
}

// The damage is a statement run on MAIN.MDB over a connection held to the end ("" removes
// the file).
void TestBackendSelection::mainUnreadable_data() {
    QTest::addColumn<QString>("damage");
    QTest::addColumn<QString>("start");
    const auto row = [](const char* name, const char* damage, const char* start) {
        QTest::newRow(name) << QString::fromLatin1(damage) << QString::fromLatin1(start);
    };
    row("missing", "", "3024-0-GetMSSQLParam-");
    row("locked by another writer", "BEGIN EXCLUSIVE", "3260-0-GetMSSQLParam-");
    row("without the MSql table", "DROP TABLE MSql", "-0-GetMSSQLParam-");
    row("row without a flag column", "ALTER TABLE MSql DROP COLUMN IsZorva",
        "3265-0-GetMSSQLParam-");
}

void TestBackendSelection::mainUnreadable() {
    QFETCH(QString, damage);
    QFETCH(QString, start);
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.WriteIni(kComplete));
    QVERIFY(inst.SetRow(kOwn, {1, 1, 1, 1}));
    const QString mainMdb = inst.Path(QStringLiteral("MAIN.MDB"));
    std::optional<File> held;
    if (damage.isEmpty()) {
        QVERIFY(QFile::remove(mainMdb));
    } else {
        QVERIFY(held.emplace(mainMdb).Exec(damage));
    }
    GetMSSQLParam();
    QCOMPARE(ui->Messages().size(), std::size_t{1});
    const test::ShownMessage& m = ui->Messages().front();
    QVERIFY2(m.text.contains(start) && !m.text.startsWith(QLatin1Char('-')), qPrintable(m.text));
    QCOMPARE(m.style, int{vbOKOnly});
    // Nothing is set from a row that was not read; the login read before stays.
    QCOMPARE(Flags(), QStringLiteral("----"));
    QCOMPARE(UserID(), QStringLiteral("dana"));
    QCOMPARE(DataSource(), QStringLiteral("srv\\office"));
}

QTEST_MAIN(TestBackendSelection)
#include "test_backend_selection.moc"

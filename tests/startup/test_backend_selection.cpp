// Back-end selection: the server login of MSSQLSetting.INI and the MSql row of MAIN.MDB,
// on a sample installation.

#include <QDir>
#include <QFile>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QTest>
#include <QUuid>

#include "sample_install/sample_install.h"
#include "scripted_ui.h"
#include "startup/backend_selection.h"
#include "test_env.h"
#include "util/state.h"

using namespace zv;

namespace {

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
        SetVolnaGlobNum(QStringLiteral("23"));
    }
    QString Path(const QString& relative) const { return QDir(env_.DataDir()).filePath(relative); }
    bool WriteIni(const QString& text) const {
        QFile f(Path(QStringLiteral("Def/MSSQLSetting.INI")));
        return f.open(QIODevice::WriteOnly) && f.write(text.toUtf8()) >= 0;
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
    void login_data();
    void login();
    void flagsFromRow_data();
    void flagsFromRow();
    void flagStaysSet();
    void mainUnreadable_data();
    void mainUnreadable();
};

void TestBackendSelection::login_data() {
    QTest::addColumn<QString>("ini");  // null: no file
    QTest::addColumn<QString>("provider");
    QTest::addColumn<QString>("dataSource");
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("flags");

    QTest::newRow("complete, own login") << kComplete << "SQLOLEDB"
                                         << "srv\\office"
                                         << "dana"
                                         << "p;w"
                                         << "DBOZ";
    QTest::newRow("own login without password")
        << "[MSSQL]\nProvider=P\nDataSource=S\n[1]\nUserID=dana\n[000]\nUserID=x\nPassWord=y\n"
        << "P"
        << "S"
        << "dana"
        << ""
        << "DBOZ";
    QTest::newRow("shared login 000, own password ignored")
        << "[MSSQL]\nProvider=P\nDataSource=S\n[1]\nPassWord=own\n[000]\nUserID=office\n"
           "PassWord=shared\n"
        << "P"
        << "S"
        << "office"
        << "shared"
        << "DBOZ";
    QTest::newRow("no provider") << "[MSSQL]\nDataSource=S\n[1]\nUserID=dana\nPassWord=p\n"
                                 << ""
                                 << "S"
                                 << "dana"
                                 << "p"
                                 << "----";
    QTest::newRow("no data source") << "[MSSQL]\nProvider=P\n[1]\nUserID=dana\n"
                                    << "P"
                                    << ""
                                    << "dana"
                                    << ""
                                    << "----";
    QTest::newRow("no login in either section")
        << "[MSSQL]\nProvider=P\nDataSource=S\n[2]\nUserID=other\n[000]\nPassWord=y\n"
        << "P"
        << "S"
        << ""
        << "y"
        << "----";
    QTest::newRow("no settings file") << QString() << ""
                                      << ""
                                      << ""
                                      << ""
                                      << "----";
}

void TestBackendSelection::login() {
    QFETCH(QString, ini);
    QFETCH(QString, provider);
    QFETCH(QString, dataSource);
    QFETCH(QString, user);
    QFETCH(QString, password);
    QFETCH(QString, flags);
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.SetRow(QStringLiteral("23"), {1, 1, 1, 1}));
    if (!ini.isNull())
        QVERIFY(inst.WriteIni(ini));

    GetMSSQLParam();
    QCOMPARE(Provider(), provider);
    QCOMPARE(DataSource(), dataSource);
    QCOMPARE(UserID(), user);
    QCOMPARE(PassWord(), password);
    QCOMPARE(Flags(), flags);
    QCOMPARE(ui->Texts(), QStringList());
}

void TestBackendSelection::flagsFromRow_data() {
    QTest::addColumn<QString>("clientNumber");
    QTest::addColumn<QString>("rowOf");
    QTest::addColumn<QVariantList>("row");
    QTest::addColumn<QString>("flags");
    const QVariant null{QMetaType(QMetaType::Int)};
    QTest::newRow("clients on the server only") << "23"
                                                << "23" << QVariantList{0, 0, 1, 0} << "--O-";
    QTest::newRow("documents and reminders") << "23"
                                             << "23" << QVariantList{1, 1, 0, 0} << "DB--";
    QTest::newRow("true written as -1") << "23"
                                        << "23" << QVariantList{-1, 0, 0, -1} << "D--Z";
    QTest::newRow("null reads as false") << "23"
                                         << "23" << QVariantList{null, 1, null, null} << "-B--";
    QTest::newRow("no row for this installation") << "42"
                                                  << "23" << QVariantList{1, 1, 1, 1} << "----";
    QTest::newRow("client number with an apostrophe")
        << "2'3"
        << "2'3" << QVariantList{0, 0, 1, 1} << "--OZ";
}

void TestBackendSelection::flagsFromRow() {
    QFETCH(QString, clientNumber);
    QFETCH(QString, rowOf);
    QFETCH(QVariantList, row);
    QFETCH(QString, flags);
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.WriteIni(kComplete));
    QVERIFY(inst.SetRow(rowOf, row));
    SetVolnaGlobNum(clientNumber);

    GetMSSQLParam();
    QCOMPARE(Flags(), flags);
    QCOMPARE(ui->Texts(), QStringList());
}

// The dialog reads the settings again when it loads; a flag once set is not taken back.
void TestBackendSelection::flagStaysSet() {
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.WriteIni(kComplete));
    QVERIFY(inst.SetRow(QStringLiteral("23"), {0, 1, 1, 0}));
    GetMSSQLParam();
    QCOMPARE(Flags(), QStringLiteral("-BO-"));
    QVERIFY(inst.SetRow(QStringLiteral("23"), {1, 0, 0, 0}));
    GetMSSQLParam();
    QCOMPARE(Flags(), QStringLiteral("DBO-"));
}

void TestBackendSelection::mainUnreadable_data() {
    QTest::addColumn<QString>("damage");
    QTest::addColumn<QString>("start");
    QTest::newRow("missing") << "missing"
                             << "3024-0-GetMSSQLParam-";
    QTest::newRow("locked by another writer") << "locked"
                                              << "3260-0-GetMSSQLParam-";
    QTest::newRow("without the MSql table") << "no table"
                                            << "-0-GetMSSQLParam-";
    QTest::newRow("row without a flag column") << "no column"
                                               << "3265-0-GetMSSQLParam-";
}

void TestBackendSelection::mainUnreadable() {
    QFETCH(QString, damage);
    QFETCH(QString, start);
    Installation inst;
    test::ScopedScriptedUi ui;
    QVERIFY(inst.WriteIni(kComplete));
    QVERIFY(inst.SetRow(QStringLiteral("23"), {1, 1, 1, 1}));
    const QString mainMdb = inst.Path(QStringLiteral("MAIN.MDB"));
    std::unique_ptr<File> lock;
    if (damage == QLatin1String("missing")) {
        QVERIFY(QFile::remove(mainMdb));
    } else if (damage == QLatin1String("locked")) {
        lock = std::make_unique<File>(mainMdb);
        QVERIFY(lock->Exec(QStringLiteral("BEGIN EXCLUSIVE")));
    } else if (damage == QLatin1String("no table")) {
        QVERIFY(File(mainMdb).Exec(QStringLiteral("DROP TABLE MSql")));
    } else {
        File main(mainMdb);
        QVERIFY(
            main.Exec(QStringLiteral("CREATE TABLE M2 (ClientID TEXT, IsDocs, IsBM, IsOffice)")));
        QVERIFY(main.Exec(QStringLiteral("INSERT INTO M2 VALUES ('23', 1, 1, 1)")));
        QVERIFY(main.Exec(QStringLiteral("DROP TABLE MSql")));
        QVERIFY(main.Exec(QStringLiteral("ALTER TABLE M2 RENAME TO MSql")));
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

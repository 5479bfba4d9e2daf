// The filing dialog's load on an installation whose modules live on the server: each list
// comes from the back-end its flag names, the origins always from the file.

#include <QComboBox>
#include <QSqlError>

#include "dialog_fixture.h"
#include "sample_install/sample_server.h"
#include "sample_install/test_server.h"
#include "startup/backend_selection.h"
#include "startup/settings.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;
using zv::test::DialogFixture;

namespace {

void OnServer(const SampleOptions& options, const QString& database, const QString& sql) {
    const QString name = QUuid::createUuid().toString();
    {
        QSqlDatabase db = ConnectSampleServer(options, database + options.volnaGlobNum, name);
        QSqlQuery q(db);
        QVERIFY2(q.exec(sql), qPrintable(q.lastError().text()));
    }
    QSqlDatabase::removeDatabase(name);
}

}  // namespace

class TestDialogServer : public QObject {
    Q_OBJECT

  private slots:
    void listsFromTheirBackEnd_data() {
        QTest::addColumn<bool>("office");
        QTest::addColumn<bool>("docs");
        QTest::newRow("all on the server") << true << true;
        QTest::newRow("documents in the file") << true << false;
        QTest::newRow("office in the file") << false << true;
    }
    void listsFromTheirBackEnd() {
        QFETCH(bool, office);
        QFETCH(bool, docs);
        SampleOptions options = TestServerOptions();
        ZV_REQUIRE_TEST_SERVER(options);
        options.onServerOffice = office;
        options.onServerDocs = docs;
        DialogFixture f(options);

        // The same rows differ between server and file, so each list tells where it came from.
        for (const bool server : {true, false}) {
            const QString where = server ? u"שרת"_s : u"קובץ"_s;
            auto run = [&](const QString& db, const QString& sql) {
                if (server) {
                    OnServer(options, db, sql);
                } else {
                    f.Exec(db, sql);
                }
            };
            run(u"OFFICE"_s, u"DELETE FROM OFF_CODE WHERE CODE=20"_s);
            run(u"OFFICE"_s,
                u"INSERT INTO OFF_CODE (CODE, NUM, Teur) VALUES (20, 1, '%1')"_s.arg(where));
            run(u"OFFICE"_s, u"DELETE FROM MTIK"_s);
            run(u"OFFICE"_s,
                u"INSERT INTO MTIK (ID, TEUR, SHOW) VALUES (%1, '%2', 1)"_s.arg(server ? 40 : 50)
                    .arg(where));
            run(u"MDOCS"_s, u"UPDATE DOCSTATUS SET Caption='%1' WHERE ID=2"_s.arg(where));
        }
        f.Exec(u"MADAD"_s,
               QStringLiteral("UPDATE TRANS_CODE SET Teur='קובץ' WHERE TABLE_NUM='1080' AND "
                              "KOD_NUM_1='1'"));

        // As at start-up: the back-ends are known before the dialog opens.
        SetBasicParam();
        GetMSSQLParam();
        f.Load();
        QCOMPARE(f.Ui().Texts(), QStringList());
        QCOMPARE(IsOffice(), office);
        QCOMPARE(IsDocs(), docs);
        const QString officeText = office ? u"שרת"_s : u"קובץ"_s;
        const QString docsText = docs ? u"שרת"_s : u"קובץ"_s;
        QCOMPARE(f.Child<QComboBox>("CboTeur").itemText(0), officeText);
        QCOMPARE(f.Child<QComboBox>("CboTeur").count(), 1);
        QCOMPARE(OptKeyNames().value(office ? u"1040"_s : u"1050"_s), officeText);
        QCOMPARE(OptKeyNames().size(), 19);
        QCOMPARE(f.Child<QComboBox>("CboStatus").currentText(), u"2 - "_s + docsText);
        QCOMPARE(f.Child<QComboBox>("CboPartOf").itemText(0), u"1 - קובץ"_s);
        QVERIFY(f.Child<QComboBox>("CboSecTeur").count() > 0);
    }
};

QTEST_MAIN(TestDialogServer)
#include "test_dialog_server.moc"

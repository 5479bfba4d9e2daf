// The filing dialog's load on an installation whose modules live on the server: each list
// comes from the back-end its flag names, the origins always from the file.

#include <QComboBox>

#include "data/database.h"
#include "dialog_fixture.h"
#include "sample_install/test_server.h"
#include "startup/backend_selection.h"
#include "startup/settings.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;
using zv::test::DialogFixture;

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

        // As at start-up: the back-ends are known before the dialog opens.
        SetBasicParam();
        GetMSSQLParam();
        // The same rows differ between server and file, so each list tells where it came from.
        for (const bool server : {true, false}) {
            const QString where = server ? u"שרת"_s : u"קובץ"_s;
            const auto db = Database::Open(u"OFFICE"_s, server);
            db->Execute(u"UPDATE OFF_CODE SET Teur='%1' WHERE CODE=20"_s.arg(where));
            db->Execute(u"UPDATE MTIK SET TEUR='%1'"_s.arg(where));
            Database::Open(u"MDOCS"_s, server)
                ->Execute(u"UPDATE DOCSTATUS SET Caption='%1' WHERE ID=2"_s.arg(where));
        }
        f.Exec(u"MADAD"_s,
               u"UPDATE TRANS_CODE SET Teur='קובץ' WHERE TABLE_NUM='1080' AND KOD_NUM_1='1'"_s);
        f.Load();
        QCOMPARE(f.Ui().Texts(), QStringList());
        const QString officeText = office ? u"שרת"_s : u"קובץ"_s;
        const QString docsText = docs ? u"שרת"_s : u"קובץ"_s;
        QCOMPARE(f.Child<QComboBox>("CboTeur").itemText(0), officeText);
        QCOMPARE(OptKeyNames().value(u"1026"_s), officeText);
        QCOMPARE(f.Child<QComboBox>("CboStatus").currentText(), u"2 - "_s + docsText);
        QCOMPARE(f.Child<QComboBox>("CboPartOf").itemText(0), u"1 - קובץ"_s);
    }
};

QTEST_MAIN(TestDialogServer)
#include "test_dialog_server.moc"

// The filing dialog as it opens on a sample installation: lists, defaults, folder view,
// catalogue, and how it ends.

#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QSet>

#include "controls/gdate.h"
#include "dialog_fixture.h"
#include "filing_dialog/folder_view.h"
#include "util/settings_store.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;
using zv::test::DialogFixture;

namespace {

QStringList Texts(const QComboBox& box) {
    QStringList out;
    for (int i = 0; i < box.count(); ++i) {
        out << box.itemText(i);
    }
    return out;
}

QList<int> Data(const QComboBox& box) {
    QList<int> out;
    for (int i = 0; i < box.count(); ++i) {
        out << box.itemData(i).toInt();
    }
    return out;
}

// Code tables of known content, written out of order and with blanks around the texts.
void SetCodeRows(DialogFixture& f) {
    f.Exec(u"OFFICE"_s, u"DELETE FROM OFF_CODE"_s);
    f.Exec(u"OFFICE"_s,
           QStringLiteral("INSERT INTO OFF_CODE (CODE, NUM, Teur) VALUES (20, 2, ' חוזה '), "
                          "(20, 1, 'מכתב'), (20, 10, 'פסק דין'), (21, 1, 'מקור'), "
                          "(21, 2, 'העתק'), (5, 1, 'סניף')"));
    f.Exec(u"OFFICE"_s, u"DELETE FROM MTIK"_s);
    f.Exec(
        u"OFFICE"_s,
        QStringLiteral("INSERT INTO MTIK (ID, TEUR, SHOW) VALUES (28, '  תיקי הוצאה לפועל  ', 1), "
                       "(26, 'תיקי ירושה', 1), (29, 'תיקי ארכיון', 0)"));
    f.Exec(u"MDOCS"_s, u"DELETE FROM DOCSTATUS"_s);
    f.Exec(u"MDOCS"_s,
           QStringLiteral("INSERT INTO DOCSTATUS (ID, Caption, ORD) VALUES (3, 'סגור', 4), "
                          "(1, 'חדש', 1), (4, ' ממתין לתגובה ', 3), (2, 'בטיפול', 2)"));
    f.Exec(u"MADAD"_s, u"DELETE FROM TRANS_CODE"_s);
    f.Exec(u"MADAD"_s, QStringLiteral("INSERT INTO TRANS_CODE (TABLE_NUM, KOD_NUM_1, Teur) VALUES "
                                      "('1080', '10', 'אחר'), ('1080', '9', 'הוצאה לפועל'), "
                                      "('1080', '5', ' סריקה '), ('1080', '1', 'דואר'), "
                                      "('1070', '2', 'טבלה אחרת')"));
}

}  // namespace

class TestDialogLoad : public QObject {
    Q_OBJECT

  private slots:
    void listsAndDefaults() {
        DialogFixture f;
        SetCodeRows(f);
        FrmGetDocDet& d = f.Load();
        QCOMPARE(f.Ui().Texts(), QStringList());

        QCOMPARE(Texts(f.Child<QComboBox>("CboTeur")), QStringList({"מכתב", "חוזה", "פסק דין"}));
        QCOMPARE(Texts(f.Child<QComboBox>("CboSecTeur")), QStringList({"מקור", "העתק"}));
        QCOMPARE(f.Child<QComboBox>("CboTeur").currentText(), QString());

        auto& status = f.Child<QComboBox>("CboStatus");
        QCOMPARE(Texts(status),
                 QStringList({"1 - חדש", "2 - בטיפול", "4 - ממתין לתגובה", "3 - סגור"}));
        QCOMPARE(Data(status), QList<int>({1, 2, 4, 3}));
        QCOMPARE(d.Status(), int16_t(2));
        QCOMPARE(status.currentText(), u"2 - בטיפול"_s);

        auto& origin = f.Child<QComboBox>("CboPartOf");
        QCOMPARE(Texts(origin),
                 QStringList({"1 - דואר", "5 - סריקה", "9 - הוצאה לפועל", "10 - אחר"}));
        QCOMPARE(Data(origin), QList<int>({1, 5, 9, 10}));
        QCOMPARE(origin.currentIndex(), 0);
        QVERIFY(origin.isEnabled());

        const QStringList inner = Texts(f.Child<QComboBox>("CboDocBasic"));
        QCOMPARE(QSet<QString>(inner.begin(), inner.end()),
                 QSet<QString>(SampleDocBasicFolders().begin(), SampleDocBasicFolders().end()));
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").currentIndex(), -1);
        QVERIFY(f.Child<QRadioButton>("Option1_0").isChecked());

        QCOMPARE(f.Child<GDate>("TDate").date(), QDate(2026, 3, 17));
        QCOMPARE(f.Child<GDate>("TDateRecieved").date(), QDate(2026, 3, 17));
        QVERIFY(!f.Child<GDate>("TDate").Enabled());
        QCOMPARE(f.Child<QLineEdit>("TDBTime1").text(), u"08:00"_s);
        QCOMPARE(f.Child<QLabel>("LPersonal").text(), u"דנה כהן"_s);
        QCOMPARE(f.Child<QLabel>("LGlobalNum").text(), u"23/100/1"_s);

        auto& name = f.Child<QLineEdit>("TxtTeur");
        QCOMPARE(name.text(), u"מכתב ללקוח"_s);
        QCOMPARE(name.selectedText(), name.text());

        const QString mailIn = f.Docs() + u"/MAILIN"_s;
        auto& tree = f.Child<FolderView>("FolderView1");
        QVERIFY(tree.isHidden());
        QCOMPARE(tree.SelectedPath(), mailIn);
        QCOMPARE(f.Child<QLabel>("LDir").text(), mailIn);
        QCOMPARE(d.FileNameToSave(), mailIn + u"/מכתב ללקוח"_s);
        QCOMPARE(f.Child<QLabel>("LFileName").text(), d.FileNameToSave());
        QVERIFY(!d.IsCancel());

        QCOMPARE(OptKeyNames().size(), 20);
        QCOMPARE(OptKeyNames().value(u"1026"_s), u"תיקי ירושה"_s);
        QCOMPARE(OptKeyNames().value(u"1028"_s), u"תיקי הוצאה לפועל"_s);
        QVERIFY(!OptKeyNames().contains(u"1029"_s));
        QVERIFY(!f.Child<QLabel>("LblSug").isVisibleTo(&d));
    }

    void presets_data() {
        QTest::addColumn<int>("status");
        QTest::addColumn<int>("partOf");
        QTest::addColumn<QString>("statusText");
        QTest::addColumn<QString>("originText");
        QTest::addColumn<bool>("originLocked");
        QTest::newRow("status 3, origin 5") << 3 << 5 << u"3 - סגור"_s << u"5 - סריקה"_s << true;
        QTest::newRow("origin 10") << 0 << 10 << u"2 - בטיפול"_s << u"10 - אחר"_s << true;
        QTest::newRow("unknown status") << 9 << 0 << u""_s << u"1 - דואר"_s << false;
        QTest::newRow("unknown origin") << 1 << 99 << u"1 - חדש"_s << u""_s << false;
    }
    void presets() {
        QFETCH(int, status);
        QFETCH(int, partOf);
        QFETCH(QString, statusText);
        QFETCH(QString, originText);
        QFETCH(bool, originLocked);
        DialogFixture f;
        SetCodeRows(f);
        FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) {
            d.SetStatus(int16_t(status));
            d.SetPartOf(int16_t(partOf));
        });
        QCOMPARE(d.Status(), int16_t(status == 0 ? 2 : status));
        QCOMPARE(f.Child<QComboBox>("CboStatus").currentText(), statusText);
        QCOMPARE(f.Child<QComboBox>("CboPartOf").currentText(), originText);
        QCOMPARE(!f.Child<QComboBox>("CboPartOf").isEnabled(), originLocked);
        // The list after the origins fills whatever the origin did.
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").count(), SampleDocBasicFolders().size());
        QCOMPARE(d.Details().origin.has_value(), !originText.isEmpty());
        QCOMPARE(d.Details().status.has_value(), !statusText.isEmpty());
        QCOMPARE(f.Ui().Texts(), QStringList());
    }

    void catalogue_data() {
        QTest::addColumn<QString>("change");
        QTest::addColumn<int>("messages");
        QTest::newRow("no user kinds") << u"DELETE FROM MTIK"_s << 0;
        QTest::newRow("none shown") << u"UPDATE MTIK SET SHOW=0"_s << 0;
        QTest::newRow("no table") << u"DROP TABLE MTIK"_s << 1;
    }
    void catalogue() {
        QFETCH(QString, change);
        QFETCH(int, messages);
        DialogFixture f;
        f.Exec(u"OFFICE"_s, change);
        f.Load();
        QStringList keys = OptKeyNames().keys();
        std::sort(keys.begin(), keys.end(),
                  [](const QString& a, const QString& b) { return a.toInt() < b.toInt(); });
        QCOMPARE(keys, QStringList({"0", "1", "2", "3", "4", "5", "7", "8", "9", "10", "11", "12",
                                    "13", "14", "15", "16", "17", "18"}));
        QCOMPARE(OptKeyNames().value("13"), OptKeyNames().value("5"));
        QCOMPARE(OptKeyNames().value("18"), u"מומחים"_s);
        QCOMPARE(f.Ui().Messages().size(), size_t(messages));
        if (messages) {
            QVERIFY(f.Ui().Texts().front().contains(u"-0-SetOptKeyLakTik-"_s));
        }
    }

    void userKindAddedUnderItsKey() {
        DialogFixture f;
        f.Exec(u"OFFICE"_s, "INSERT INTO MTIK (ID, TEUR, SHOW) VALUES (3, NULL, 1)");
        f.Load();
        QVERIFY(OptKeyNames().contains(u"1003"_s));
        QCOMPARE(OptKeyNames().value(u"1003"_s), QString());
    }

    void failingListStopsTheRest() {
        DialogFixture f;
        SetCodeRows(f);
        f.Exec(u"MDOCS"_s, "DROP TABLE DOCSTATUS");
        f.Load();
        QCOMPARE(f.Ui().Messages().size(), size_t(1));
        QVERIFY(f.Ui().Texts().front().contains(u"-0-InitCbo10-"_s));
        QCOMPARE(f.Child<QComboBox>("CboSecTeur").count(), 2);
        QCOMPARE(f.Child<QComboBox>("CboStatus").count(), 0);
        QCOMPARE(f.Child<QComboBox>("CboPartOf").count(), 0);
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").count(), 0);
        // The rest of the load still runs.
        QCOMPARE(f.Child<QLineEdit>("TDBTime1").text(), u"08:00"_s);
    }

    void startFolder_data() {
        QTest::addColumn<QString>("start");     // below the data folder; "-" outside it
        QTest::addColumn<QString>("selected");  // below the data folder
        QTest::newRow("empty") << u""_s << u"DOCS/MAILIN"_s;
        QTest::newRow("inside the archive") << u"DOCS/DOC1001"_s << u"DOCS/DOC1001"_s;
        QTest::newRow("the archive itself") << u"DOCS"_s << u"DOCS"_s;
        QTest::newRow("outside the archive") << u"-"_s << u"DOCS/MAILIN"_s;
        QTest::newRow("data folder") << u"Def"_s << u"DOCS/MAILIN"_s;
    }
    void startFolder() {
        QFETCH(QString, start);
        QFETCH(QString, selected);
        DialogFixture f;
        QDir(f.Docs() + u"/MAILIN"_s).removeRecursively();
        QVERIFY(QDir().mkpath(f.Docs() + u"/DOC1001"_s));
        QVERIFY(QDir().mkpath(f.Root() + u"/elsewhere"_s));
        const QString startDir = start.isEmpty() ? QString()
                                 : start == QLatin1String("-")
                                     ? f.Root() + u"/elsewhere"_s
                                     : f.DataDir() + QLatin1Char('/') + start;
        FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) { d.SetStartDir(startDir); });
        QVERIFY(QFileInfo(f.Docs() + u"/MAILIN"_s).isDir());
        const QString want = f.DataDir() + QLatin1Char('/') + selected;
        QCOMPARE(f.Child<FolderView>("FolderView1").SelectedPath(), want);
        QCOMPARE(d.FileNameToSave(), want + u"/מכתב ללקוח"_s);
    }

    void unidentifiedInstallation() {
        SampleOptions options;
        options.writeSettings = false;
        DialogFixture f(options);
        FrmGetDocDet& d = f.Load();
        const auto& m = f.Ui().Messages();
        QVERIFY(!m.empty());
        QCOMPARE(m.back().text, u"אין זיהוי של עבודה בזורבן במחשב זה"_s);
        QCOMPARE(m.back().style, int(vbCritical));
        QCOMPARE(f.Child<QComboBox>("CboStatus").count(), 0);
        QCOMPARE(f.Child<QLineEdit>("TxtTeur").text(), QString());
        d.show();
        d.close();
        QVERIFY(d.IsCancel());
    }

    void fileNameCreatesItsFolders_data() {
        QTest::addColumn<QString>("name");    // below the data folder
        QTest::addColumn<QString>("folder");  // what must exist afterwards; empty: nothing new
        QTest::newRow("new folders") << u"DOCS/A/ב/name"_s << u"DOCS/A/ב"_s;
        QTest::newRow("backslashes") << u"DOCS\\C\\D\\name"_s << u"DOCS/C/D"_s;
        QTest::newRow("no separator") << u""_s << u""_s;
    }
    void fileNameCreatesItsFolders() {
        QFETCH(QString, name);
        QFETCH(QString, folder);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        const QString value = name.isEmpty() ? u"name"_s : f.DataDir() + QLatin1Char('/') + name;
        d.SetFileNameToSave(value);
        const QStringList before = QDir(f.DataDir()).entryList();
        QCOMPARE(d.FileNameToSave(), value);
        if (folder.isEmpty()) {
            QCOMPARE(QDir(f.DataDir()).entryList(), before);
        } else {
            QVERIFY(QFileInfo(f.DataDir() + QLatin1Char('/') + folder).isDir());
            QVERIFY(!QFileInfo::exists(f.DataDir() + QLatin1Char('/') + folder + "/name"));
        }
    }

    void mediumFontMarker_data() {
        QTest::addColumn<bool>("marker");
        QTest::newRow("with the user's marker") << true;
        QTest::newRow("without") << false;
    }
    void mediumFontMarker() {
        QFETCH(bool, marker);
        DialogFixture f;
        SaveSetting(u"Kavex32"_s, u"General"_s, u"MedFontName"_s, u"DejaVu Serif"_s);
        SaveSetting(u"Kavex32"_s, u"General"_s, u"MedFontSize"_s, u"13"_s);
        QVERIFY(QDir().mkpath(f.DataDir() + u"/GDetDef"_s));
        if (marker) {
            QFile file(f.DataDir() + u"/GDetDef/LB81.1"_s);
            QVERIFY(file.open(QIODevice::WriteOnly));
        }
        f.Load();
        QCOMPARE(f.Child<QLabel>("Label4").font().pointSize() == 13, marker);
        QCOMPARE(f.Child<QPushButton>("CmdOK").font().pointSize() == 13, marker);
        QVERIFY(f.Child<QLineEdit>("TxtTeur").font().pointSize() != 13);
        QCOMPARE(f.Ui().Texts(), QStringList());
    }

    void closing_data() {
        QTest::addColumn<bool>("escape");
        QTest::newRow("close box") << false;
        QTest::newRow("escape") << true;
    }
    void closing() {
        QFETCH(bool, escape);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        QVERIFY(!d.IsCancel());
        if (escape) {
            QTest::keyClick(&d, Qt::Key_Escape);
        } else {
            d.close();
        }
        QVERIFY(d.IsCancel());
        QVERIFY(d.isHidden());
    }
};

QTEST_MAIN(TestDialogLoad)
#include "test_dialog_load.moc"

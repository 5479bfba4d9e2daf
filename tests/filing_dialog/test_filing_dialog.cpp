// The filing dialog on a sample installation: the lists and defaults it opens with, the
// target folder and name, confirming, the creation-date unlock, the filters and the keyboard.

#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMimeData>
#include <QPushButton>
#include <QRadioButton>
#include <QSet>

#include "controls/date_box.h"
#include "controls/gdate.h"
#include "dialog_fixture.h"
#include "dialogs/frm_get_password.h"
#include "dialogs/frm_get_users.h"
#include "filing_dialog/file_naming.h"
#include "filing_dialog/folder_view.h"
#include "filing_dialog/name_guard.h"
#include "recording_keyboard.h"
#include "util/keyboard_layout.h"
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

void Touch(const QString& path) {
    QFile f(path);
    QVERIFY2(f.open(QIODevice::WriteOnly), qPrintable(path));
}

void SetLabels(DialogFixture& f, const QString& client, const QString& kind, const QString& subKind,
               const QString& caseNum, const QString& caseCode) {
    f.Child<QLabel>("LakNum").setText(client);
    f.Child<QLabel>("LblSug").setText(kind);
    f.Child<QLabel>("LSugTik").setText(subKind);
    f.Child<QLabel>("LTik").setText(caseNum);
    f.Child<QLabel>("LTikNum").setText(caseCode);
}

void Type(QWidget& w, QChar c) {
    QTest::sendKeyEvent(QTest::Click, &w, Qt::Key_unknown, QString(c), Qt::NoModifier);
}

}  // namespace

class TestFilingDialog : public QObject {
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

    void escapeCancels() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        QVERIFY(!d.IsCancel());
        QTest::keyClick(&d, Qt::Key_Escape);
        QVERIFY(d.IsCancel());
        QVERIFY(d.isHidden());
    }

    void nameBox_data() {
        QTest::addColumn<bool>("captureMail");
        QTest::addColumn<bool>("fromScan");
        QTest::addColumn<bool>("asked");
        QTest::newRow("document") << false << false << true;
        QTest::newRow("mail") << true << false << false;
        QTest::newRow("scan") << false << true << false;
    }
    void nameBox() {
        QFETCH(bool, captureMail);
        QFETCH(bool, fromScan);
        QFETCH(bool, asked);
        DialogFixture f;
        FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) {
            d.SetIsCaptureMail(captureMail);
            d.SetIsFromScan(fromScan);
        });
        const QString mailIn = f.Docs() + u"/MAILIN/"_s;
        auto& name = f.Child<QLineEdit>("TxtTeur");
        name.setText(u"חוזה שכירות"_s);
        QCOMPARE(d.FileNameToSave(), mailIn + u"חוזה שכירות"_s);
        name.clear();
        QCOMPARE(d.FileNameToSave(), mailIn + u"חוזה שכירות"_s);
        QCOMPARE(f.Child<QLabel>("LFileName").text(), d.FileNameToSave());
        const QStringList want =
            asked ? QStringList{u"חובה לקבוע שם למסמך שישמר"_s} : QStringList{};
        QCOMPARE(f.Ui().Texts(), want);
        if (asked) {
            QCOMPARE(f.Ui().Messages().front().style, int(vbOKOnly));
        }
    }

    void folderFollowsTheChoice_data() {
        QTest::addColumn<QString>("client");
        QTest::addColumn<QString>("kind");
        QTest::addColumn<QString>("subKind");
        QTest::addColumn<QString>("caseNum");
        QTest::addColumn<QString>("caseCode");
        QTest::addColumn<QString>("folder");  // below DOCS; empty: DOCS itself
        QTest::newRow("client") << u"1001"_s << u"F"_s << u""_s << u""_s << u""_s << u"DOC1001"_s;
        QTest::newRow("bureau, no client")
            << u""_s << u"L"_s << u""_s << u"3"_s << u"12-34"_s << u"DOC00000/L/1234"_s;
        QTest::newRow("no rule") << u"5"_s << u"FS"_s << u""_s << u""_s << u""_s << u""_s;
    }
    void folderFollowsTheChoice() {
        QFETCH(QString, client);
        QFETCH(QString, kind);
        QFETCH(QString, subKind);
        QFETCH(QString, caseNum);
        QFETCH(QString, caseCode);
        QFETCH(QString, folder);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        SetLabels(f, client, kind, subKind, caseNum, caseCode);
        d.RefreshDocsFolder();
        const QString want = folder.isEmpty() ? f.Docs() : f.Docs() + QLatin1Char('/') + folder;
        QVERIFY(QFileInfo(want).isDir());
        QCOMPARE(f.Child<FolderView>("FolderView1").SelectedPath(), want);
        QCOMPARE(f.Child<QLabel>("LDir").text(), want);
        QCOMPARE(d.FileNameToSave(), want + u"/מכתב ללקוח"_s);
        QCOMPARE(f.Ui().Texts(), QStringList());
    }

    void clientButton_data() {
        QTest::addColumn<bool>("choose");
        QTest::newRow("chosen") << true;
        QTest::newRow("closed") << false;
    }
    void clientButton() {
        QFETCH(bool, choose);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        SetLabels(f, u"5"_s, u"W"_s, {}, u"9"_s, {});
        d.show();
        f.Ui().QueueModal([&](QWidget& list) {
            if (!choose) {
                list.close();
                return;
            }
            for (auto* b : list.findChildren<QPushButton*>()) {
                if (b->text() == u"בחר וסגור"_s) {
                    b->click();
                }
            }
        });
        f.Child<QPushButton>("CmdLak").click();
        QCOMPARE(f.Ui().UnexpectedModals(), 0);
        auto& tree = f.Child<FolderView>("FolderView1");
        if (choose) {
            QCOMPARE(f.Child<QLabel>("LakNum").text(), u"1001"_s);
            QCOMPARE(f.Child<QLabel>("LblSug").text(), u"F"_s);
            QCOMPARE(f.Child<QLabel>("LTik").text(), QString());
            QVERIFY(tree.isVisible());
            QCOMPARE(tree.SelectedPath(), f.Docs() + u"/DOC1001"_s);
            QCOMPARE(d.FileNameToSave(), f.Docs() + u"/DOC1001/מכתב ללקוח"_s);
        } else {
            QCOMPARE(f.Child<QLabel>("LakNum").text(), u"5"_s);
            QCOMPARE(f.Child<QLabel>("LTik").text(), u"9"_s);
            QVERIFY(!tree.isVisible());
            QCOMPARE(tree.SelectedPath(), f.Docs() + u"/MAILIN"_s);
        }
    }

    void folderViewStaysInTheArchive() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        auto& tree = f.Child<FolderView>("FolderView1");
        tree.show();
        d.resize(1000, 800);
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        const QString mailIn = f.Docs() + u"/MAILIN"_s;
        // The folder chosen while the tree was hidden is the one it shows.
        QCOMPARE(tree.currentIndex().data().toString(), u"MAILIN"_s);

        // Nothing outside the archive can be selected.
        QVERIFY(!tree.SelectPath(f.DataDir() + u"/Def"_s));
        QVERIFY(!tree.SelectPath(f.Root()));
        QVERIFY(!tree.SelectPath(f.Docs() + u"/../Def"_s));
        QCOMPARE(tree.SelectedPath(), mailIn);

        // The archive is the only entry at the top of the tree.
        auto* model = tree.model();
        const QModelIndex top = tree.rootIndex();
        QTRY_VERIFY(model->rowCount(top) > 1);
        int shown = 0;
        for (int row = 0; row < model->rowCount(top); ++row) {
            if (!tree.isRowHidden(row, top)) {
                ++shown;
                QCOMPARE(model->index(row, 0, top).data().toString(), u"DOCS"_s);
            }
        }
        QCOMPARE(shown, 1);

        // A folder made a moment ago is selected and shown at once.
        const QString fresh = f.Docs() + u"/DOC77/N/3"_s;
        QVERIFY(QDir().mkpath(fresh));
        QVERIFY(tree.SelectPath(fresh));
        QCOMPARE(tree.SelectedPath(), fresh);
        QCOMPARE(tree.currentIndex().data().toString(), u"3"_s);

        // A click reports the folder into LDir and the target follows.
        const QModelIndex docs = tree.currentIndex().parent().parent().parent();
        QCOMPARE(docs.data().toString(), u"DOCS"_s);
        tree.scrollTo(docs);
        QTest::mouseClick(tree.viewport(), Qt::LeftButton, {}, tree.visualRect(docs).center());
        QCOMPARE(f.Child<QLabel>("LDir").text(), f.Docs());
        QCOMPARE(d.FileNameToSave(), f.Docs() + u"/מכתב ללקוח"_s);
    }

    void innerFolder() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        const QString mailIn = f.Docs() + u"/MAILIN"_s;
        auto& inner = f.Child<QComboBox>("CboDocBasic");
        auto& direct = f.Child<QRadioButton>("Option1_0");
        auto& nested = f.Child<QRadioButton>("Option1_1");
        QVERIFY(inner.count() >= 2);

        nested.click();
        QCOMPARE(inner.currentIndex(), 0);
        const QString first = inner.itemText(0);
        QCOMPARE(d.DirToSave(), mailIn + QLatin1Char('/') + first + QLatin1Char('/'));
        QCOMPARE(d.FileNameToSave(), mailIn + QLatin1Char('/') + first + u"/מכתב ללקוח"_s);
        QVERIFY(QFileInfo(mailIn + QLatin1Char('/') + first).isDir());

        direct.click();
        QCOMPARE(inner.currentIndex(), -1);
        QCOMPARE(d.FileNameToSave(), mailIn + u"/מכתב ללקוח"_s);

        inner.setCurrentIndex(1);
        QVERIFY(nested.isChecked());
        QCOMPARE(d.FileNameToSave(),
                 mailIn + QLatin1Char('/') + inner.itemText(1) + u"/מכתב ללקוח"_s);
    }

    void innerFolderWithoutEntries() {
        DialogFixture f;
        QDir(f.Docs() + u"/DOCBASIC"_s).removeRecursively();
        FrmGetDocDet& d = f.Load();
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").count(), 0);
        f.Child<QRadioButton>("Option1_1").click();
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").currentIndex(), -1);
        QCOMPARE(d.DirToSave(), f.Docs() + u"/MAILIN/"_s);
    }

    void numbering_data() {
        QTest::addColumn<QString>("ext");
        QTest::addColumn<bool>("useInner");
        QTest::addColumn<QString>("name");
        QTest::newRow("doc") << u"doc"_s << false << u"T13"_s;
        QTest::newRow("doc, inner folder") << u"doc"_s << true << u"T13"_s;
        QTest::newRow("pdf") << u"pdf"_s << false << u"S8"_s;
        QTest::newRow("mail") << u"eml"_s << false << u"E1"_s;
        QTest::newRow("unknown extension") << u"xlsx"_s << false << u"מכתב ללקוח"_s;
    }
    void numbering() {
        QFETCH(QString, ext);
        QFETCH(bool, useInner);
        QFETCH(QString, name);
        DialogFixture f;
        SetSourceExt(ext);
        FrmGetDocDet& d = f.Load();
        SetLabels(f, u"5"_s, u"F"_s, {}, {}, {});
        d.RefreshDocsFolder();
        const QString folder = f.Docs() + u"/DOC5"_s;
        for (const char* file : {"T1.doc", "S7.pdf", "t12.docx", "Tax.doc"}) {
            Touch(folder + QLatin1Char('/') + QLatin1String(file));
        }
        auto& inner = f.Child<QComboBox>("CboDocBasic");
        if (useInner) {
            inner.setCurrentIndex(0);
            // Files of the inner folder do not count.
            QVERIFY(QDir().mkpath(folder + QLatin1Char('/') + inner.currentText()));
            Touch(folder + QLatin1Char('/') + inner.currentText() + u"/T50.doc"_s);
        }
        auto& box = f.Child<QLineEdit>("TxtTeur");
        box.setText(u"שם אחר"_s);
        f.Child<QPushButton>("CmdMPlus").click();
        QCOMPARE(box.text(), name);
        const QString dir = useInner ? folder + QLatin1Char('/') + inner.currentText() : folder;
        QCOMPARE(d.FileNameToSave(), dir + QLatin1Char('/') + name);
        QCOMPARE(f.Ui().Texts(), QStringList());
    }

    void refusals_data() {
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("client");
        QTest::addColumn<QString>("message");
        const QString noClient = u"חובה לבחור לקוח / תיק רלוונטים לתיוק המסמך"_s;
        QTest::newRow("no client, with a name") << u"מכתב"_s << QString() << noClient;
        QTest::newRow("no client, no name") << QString() << QString() << noClient;
        QTest::newRow("no name") << QString() << u"1001"_s << u"יש לקבוע שם לקובץ הנשמר"_s;
        // Enter in a text box confirms like the button.
        QTest::newRow("no client, Enter") << u"מכתב"_s << u"enter"_s << noClient;
    }
    void refusals() {
        QFETCH(QString, name);
        QFETCH(QString, client);
        QFETCH(QString, message);
        DialogFixture f;
        FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) {
            d.SetDefultName(name);
            d.SetIsCaptureMail(true);
        });
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        if (client == u"enter"_s) {
            // The first step has the focus.
            QCOMPARE(QApplication::focusWidget(), &f.Child<QWidget>("CmdLak"));
            f.Child<QLineEdit>("TxtRemark").setFocus();
            QTest::keyClick(&f.Child<QLineEdit>("TxtRemark"), Qt::Key_Return);
        } else {
            f.Child<QLabel>("LakNum").setText(client);
            f.Child<QPushButton>("CmdOK").click();
        }
        QCOMPARE(f.Ui().Texts(), QStringList{message});
        QCOMPARE(f.Ui().Messages().front().style, int(vbCritical));
        QVERIFY(d.isVisible());
    }

    void existingFile_data() {
        QTest::addColumn<QString>("existing");  // name of a file in the target folder
        QTest::addColumn<int>("answer");
        QTest::addColumn<bool>("asked");
        QTest::addColumn<bool>("confirmed");
        QTest::newRow("no") << u"מכתב ללקוח"_s << int(vbNo) << true << false;
        QTest::newRow("yes") << u"מכתב ללקוח"_s << int(vbYes) << true << true;
        QTest::newRow("same name with extension")
            << u"מכתב ללקוח.doc"_s << int(vbNo) << false << true;
        QTest::newRow("no file") << u""_s << int(vbNo) << false << true;
    }
    void existingFile() {
        QFETCH(QString, existing);
        QFETCH(int, answer);
        QFETCH(bool, asked);
        QFETCH(bool, confirmed);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        f.Child<QLabel>("LakNum").setText(u"1001"_s);
        f.Child<QComboBox>("CboTeur").setEditText(u"תיאור חופשי"_s);
        const QString target = d.FileNameToSave();
        if (!existing.isEmpty()) {
            QFile file(f.Docs() + u"/MAILIN/"_s + existing);
            QVERIFY(file.open(QIODevice::WriteOnly));
        }
        d.show();
        f.Ui().QueueAnswer(answer);
        f.Child<QPushButton>("CmdOK").click();
        if (asked) {
            QCOMPARE(f.Ui().Texts(),
                     QStringList{u"קיים קובץ בשם זה האם לשכתבו : "_s + u"\r\n"_s + target});
            QCOMPARE(f.Ui().Messages().front().style, int(vbQuestion | vbYesNo | vbDefaultButton2));
        } else {
            QCOMPARE(f.Ui().Texts(), QStringList());
        }
        QCOMPARE(d.isVisible(), !confirmed);
        QVERIFY(!d.IsCancel());
        QCOMPARE(d.FileNameToSave(), target);
        QCOMPARE(d.Details().description, u"תיאור חופשי"_s);
    }

    void details() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load([](FrmGetDocDet& d) { d.SetPartOf(5); });
        f.Child<QLabel>("LakNum").setText(u"5"_s);
        f.Child<QLabel>("LblSug").setText(u"H"_s);
        f.Child<QLabel>("LSugTik").setText(u"4"_s);
        f.Child<QLabel>("LTik").setText(u"9"_s);
        f.Child<QLabel>("LTikNum").setText(u"9-1"_s);
        f.Child<QComboBox>("CboSecTeur").setCurrentIndex(1);
        f.Child<QLineEdit>("TxtRemark").setText(u"הערה"_s);
        f.Child<QCheckBox>("ChkIsMemo").click();
        f.Child<QCheckBox>("ChkIsJumpMemo").click();
        f.Child<GDate>("TDateMemo").SetValue(QDate(2026, 4, 1));
        d.show();
        f.Child<QPushButton>("CmdOK").click();
        QVERIFY(!d.isVisible());
        const DocDetails v = d.Details();
        QCOMPARE(v.handlers, u"דנה כהן"_s);
        QCOMPARE(v.moreDescription, u"העתק"_s);
        QCOMPARE(v.remark, u"הערה"_s);
        QVERIFY(v.reminder);
        QVERIFY(v.popup);
        QCOMPARE(v.reminderDate, QDate(2026, 4, 1));
        QCOMPARE(v.reminderTime, u"08:00"_s);
        QCOMPARE(v.receivedDate, QDate(2026, 3, 17));
        QCOMPARE(v.createdDate, QDate(2026, 3, 17));
        QVERIFY(!v.createdUnlocked);
        QCOMPARE(v.origin, std::optional<int>(5));
        QCOMPARE(v.status, std::optional<int>(2));
        QCOMPARE(v.clientNumber, u"5"_s);
        QCOMPARE(v.kindLetter, u"H"_s);
        QCOMPARE(v.subKind, u"4"_s);
        QCOMPARE(v.caseNumber, u"9"_s);
        QCOMPARE(v.caseCode, u"9-1"_s);
    }

    void unlockCreationDate_data() {
        QTest::addColumn<QString>("code");  // "-": the prompt is closed
        QTest::addColumn<bool>("unlocked");
        QTest::newRow("right code") << u"5382"_s << true;
        QTest::newRow("wrong code") << u"1234"_s << false;
        QTest::newRow("code with more") << u"53820"_s << false;
        QTest::newRow("cancelled") << u"-"_s << false;
    }
    void unlockCreationDate() {
        QFETCH(QString, code);
        QFETCH(bool, unlocked);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QString prompt;
        f.Ui().QueueModal([&](QWidget& w) {
            auto& p = dynamic_cast<FrmGetPassword&>(w);
            prompt = p.Label1().text();
            QCOMPARE(p.Text1().echoMode(), QLineEdit::Password);
            if (code == QLatin1String("-")) {
                p.Text1().setText(u"5382"_s);
                p.close();
            } else {
                p.Text1().setText(code);
                p.Command1().click();
            }
        });
        f.Child<QPushButton>("Command3").click();
        QCOMPARE(prompt, u"קלוט סיסמא לשינוי תאריך היצירה"_s);
        QCOMPARE(f.Child<GDate>("TDate").Enabled(), unlocked);
        QCOMPARE(d.Details().createdUnlocked, unlocked);
        if (unlocked) {
            QCOMPARE(f.Ui().Texts(), QStringList{u"ניתן כעת לערוך את תאריך יצירה ולשמור"_s});
            QCOMPARE(f.Ui().Messages().front().style, int(vbExclamation));
        } else {
            QCOMPARE(f.Ui().Texts(), QStringList());
        }
        QCOMPARE(f.Ui().UnexpectedModals(), 0);
    }

    void handlerPicker_data() {
        QTest::addColumn<QStringList>("pick");  // "-": the picker is closed
        QTest::addColumn<QString>("shown");
        QTest::newRow("two users") << QStringList{"יוסי לוי", "מיכל ברק"} << u"יוסי לוי;מיכל ברק"_s;
        QTest::newRow("nobody") << QStringList{} << u"דנה כהן"_s;
        QTest::newRow("closed") << QStringList{"-"} << u"משה לוי"_s;
    }
    void handlerPicker() {
        QFETCH(QStringList, pick);
        QFETCH(QString, shown);
        DialogFixture f;
        FrmGetDocDet& d = f.Load([](FrmGetDocDet& d) { d.SetDefaultMetapel("משה לוי"); });
        d.show();
        QString start;
        bool all = false;
        f.Ui().QueueModal([&](QWidget& w) {
            auto& picker = dynamic_cast<FrmGetUsers&>(w);
            start = picker.StartUsers();
            all = picker.WithAllUsers();
            if (pick == QStringList{u"-"_s}) {
                picker.close();
                return;
            }
            picker.List1().clearSelection();
            for (int i = 0; i < picker.List1().count(); ++i) {
                picker.List1().item(i)->setSelected(pick.contains(picker.List1().item(i)->text()));
            }
            picker.Command1().click();
        });
        f.Child<QPushButton>("CmdListOpen").click();
        QCOMPARE(start, u"משה לוי"_s);
        QVERIFY(all);
        QCOMPARE(f.Child<QLabel>("LPersonal").text(), shown);
        QCOMPARE(d.Details().handlers, shown);
    }

    void currentTimeAndReminder() {
        DialogFixture f;
        f.Load();
        auto& now = f.Child<QPushButton>("CmdNow");
        now.click();
        QCOMPARE(f.Child<QLineEdit>("TDBTime1").text(), u"14:05"_s);
        QVERIFY(!now.isChecked());

        auto& memo = f.Child<QCheckBox>("ChkIsMemo");
        auto& popup = f.Child<QCheckBox>("ChkIsJumpMemo");
        QVERIFY(!popup.isEnabled());
        memo.click();
        QVERIFY(popup.isEnabled());
        popup.click();
        memo.click();
        QVERIFY(!popup.isEnabled());
        QVERIFY(popup.isChecked());
    }

    void inputFilters_data() {
        QTest::addColumn<QString>("control");
        QTest::addColumn<QString>("typed");
        QTest::addColumn<bool>("changes");
        QTest::newRow("date: letter") << u"TDate"_s << u"a"_s << false;
        QTest::newRow("date: digit") << u"TDateMemo"_s << u"3"_s << true;
        QTest::newRow("time: letter") << u"TDBTime1"_s << u"a"_s << false;
        QTest::newRow("time: backspace") << u"TDBTime1"_s << u"\b"_s << false;
        QTest::newRow("time: slash") << u"TDBTime1"_s << u"/"_s << false;
        QTest::newRow("time: digit") << u"TDBTime1"_s << u"9"_s << true;
        QTest::newRow("time: colon") << u"TDBTime1"_s << u":"_s << true;
    }
    void inputFilters() {
        QFETCH(QString, control);
        QFETCH(QString, typed);
        QFETCH(bool, changes);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        f.Child<GDate>("TDate").SetEnabled(true);
        QLineEdit* edit = control == QLatin1String("TDBTime1")
                              ? &f.Child<QLineEdit>("TDBTime1")
                              : &f.Child<GDate>(qPrintable(control)).TDBDate1().Edit();
        edit->setFocus();
        edit->setCursorPosition(edit->text().size());
        const QString before = edit->text();
        // A refused character never reaches the date box, so it does not count as invalid
        // input there either.
        int invalid = 0;
        if (control != QLatin1String("TDBTime1")) {
            connect(&f.Child<GDate>(qPrintable(control)), &GDate::InvalidInput, this,
                    [&] { ++invalid; });
        }
        if (typed == QLatin1String("\b")) {
            QTest::sendKeyEvent(QTest::Click, edit, Qt::Key_Backspace, typed, Qt::NoModifier);
        } else {
            edit->selectAll();
            Type(*edit, typed.front());
        }
        QCOMPARE(edit->text() != before, changes);
        QCOMPARE(invalid, 0);
        // Keys without a character pass the filters.
        edit->setCursorPosition(0);
        QTest::keyClick(edit, Qt::Key_Right);
        QCOMPARE(edit->cursorPosition(), 1);
    }

    void forbiddenNameChars_data() {
        QTest::addColumn<QString>("how");
        QTest::addColumn<QString>("input");
        QTest::newRow("typed colon") << u"type"_s << u":"_s;
        QTest::newRow("typed backslash") << u"type"_s << u"\\"_s;
        QTest::newRow("pasted path") << u"paste"_s << u"..\\..\\x"_s;
        QTest::newRow("dropped quote") << u"drop"_s << u"a\"b"_s;
    }
    void forbiddenNameChars() {
        QFETCH(QString, how);
        QFETCH(QString, input);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        auto& name = f.Child<QLineEdit>("TxtTeur");
        name.setFocus();
        name.setCursorPosition(2);
        const QString before = name.text();
        const QString target = d.FileNameToSave();
        if (how == QLatin1String("type")) {
            Type(name, input.front());
        } else if (how == QLatin1String("paste")) {
            QApplication::clipboard()->setText(input);
            QTest::keyClick(&name, Qt::Key_V, Qt::ControlModifier);
        } else {
            auto* mime = new QMimeData;
            mime->setText(input);
            const QPoint at = name.rect().center();
            QDragEnterEvent enter(at, Qt::CopyAction, mime, Qt::LeftButton, Qt::NoModifier);
            QApplication::sendEvent(&name, &enter);
            QDropEvent drop(at, Qt::CopyAction, mime, Qt::LeftButton, Qt::NoModifier);
            QApplication::sendEvent(&name, &drop);
            delete mime;
        }
        QCOMPARE(name.text(), before);
        QCOMPARE(f.Ui().Texts(), QStringList{ForbiddenNameMessage()});
        QCOMPARE(ForbiddenNameMessage(),
                 u"אסור לקלוט כחלק משם קובץ את התווים הבאים : /\\:*?\"<>|"_s);
        QCOMPARE(f.Ui().Messages().front().style, int(vbCritical));
        QCOMPARE(d.FileNameToSave(), target);
        // Allowed text still goes in the same way.
        f.Ui().Clear();
        if (how == QLatin1String("paste")) {
            QApplication::clipboard()->setText(u"-2"_s);
            QTest::keyClick(&name, Qt::Key_V, Qt::ControlModifier);
        } else {
            name.end(false);
            Type(name, QLatin1Char('7'));
        }
        QVERIFY(name.text() != before);
        QCOMPARE(f.Ui().Texts(), QStringList());
        QCOMPARE(d.FileNameToSave(), d.DirToSave() + name.text());
    }

    void hebrewKeyboardOnFocus_data() {
        QTest::addColumn<QString>("control");
        QTest::addColumn<QString>("layout");
        QTest::newRow("name") << u"TxtTeur"_s << u"0000040D"_s;
        QTest::newRow("remark") << u"TxtRemark"_s << u"0000040D"_s;
        QTest::newRow("time") << u"TDBTime1"_s << u"00000409"_s;
    }
    void hebrewKeyboardOnFocus() {
        QFETCH(QString, control);
        QFETCH(QString, layout);
        DialogFixture f;
        test::ScopedRecordingKeyboard keyboard;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        d.activateWindow();
        f.Child<QPushButton>("CmdLak").setFocus();
        f.Child<QLineEdit>(qPrintable(control)).setFocus();
        QTRY_VERIFY(f.Child<QLineEdit>(qPrintable(control)).hasFocus());
        QCOMPARE(CurrentKeyboardPlatform().ActiveLayoutName(), layout);
    }
};

QTEST_MAIN(TestFilingDialog)
#include "test_filing_dialog.moc"

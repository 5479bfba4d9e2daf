// The filing dialog's target folder and name: the name box, the folder view, the inner
// folder and the numbering button.

#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>

#include "dialog_fixture.h"
#include "filing_dialog/folder_view.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;
using zv::test::DialogFixture;

namespace {

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

}  // namespace

class TestDialogNaming : public QObject {
    Q_OBJECT

  private slots:
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
};

QTEST_MAIN(TestDialogNaming)
#include "test_dialog_naming.moc"

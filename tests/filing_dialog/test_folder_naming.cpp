// Client and case folders, numbered names and the small path helpers, without a window.

#include <QDir>
#include <QTest>

#include "filing_dialog/docs_folder.h"
#include "filing_dialog/file_naming.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "test_files.h"
#include "util/state.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;

class TestFolderNaming : public QObject {
    Q_OBJECT

  private slots:
    void init() {
        env_ = std::make_unique<test::TestEnv>();
        ui_ = std::make_unique<test::ScopedScriptedUi>();
        QVERIFY(QDir().mkpath(env_->DataDir()));
        SetMainPath(env_->DataDir());
        SetVolnaGlobNum(u"23"_s);
        docs_ = env_->DataDir() + u"/DOCS"_s;
    }
    void cleanup() {
        ui_.reset();
        env_.reset();
    }

    void clientCaseFolder_data() {
        QTest::addColumn<QStringList>("choice");  // kind, client, sub-kind, case number, code
        QTest::addColumn<QString>("volna");
        QTest::addColumn<bool>("lcn7");         // the wide-number marker file is there
        QTest::addColumn<QString>("expected");  // below DOCS; empty: DOCS itself
        const auto row = [](const char* name, const char* choice, const char* expected,
                            const char* volna = "23", bool lcn7 = false) {
            QTest::newRow(name) << QString::fromUtf8(choice).split(u'|') << QString(volna) << lcn7
                                << QString(expected);
        };
        // The kind is looked up in fixed texts with exact case: an empty kind fits the first.
        row("client", "F|123|||", "DOC123");
        row("no kind", "|123|||", "DOC123");
        row("M and R", "MR|8|||", "DOC8");
        row("supplier", "S|77|||", "SPK77");
        row("bureau, placeholder", "L||||12-34", "DOC00000/L/1234");
        row("bureau, marker without 81005", "L||||12-34", "DOC00000/L/1234", "23", true);
        row("bureau, 81005 without marker", "L||||12-34", "DOC00000/L/1234", "81005");
        row("bureau, wide placeholder", "L||||1-2-3", "DOC0000000/L/123", "81005", true);
        row("bureau, client", "L|5|||7", "DOC5/L/7", "81005", true);
        row("general, kind 26", "T|5|26|9|", "DOC5/26/9");
        row("general, kind 25", "T|5|25|9|", "");
        row("general, blank kind", "T|5|abc|9|", "");
        row("tort", "N|5||9|", "DOC5/N/9");
        row("debtor", "H|5||9|4", "DOC5/H/4");
        row("A", "A|5||9|4", "DOC5/A/4");
        row("two kinds", "FS|5|||", "");
        row("lower case", "f|5|||", "");
    }
    void clientCaseFolder() {
        QFETCH(QStringList, choice);
        QFETCH(QString, volna);
        QFETCH(bool, lcn7);
        QFETCH(QString, expected);
        SetVolnaGlobNum(volna);
        if (lcn7) {
            QVERIFY(test::WriteFile(env_->DataDir() + u"/LCN7.txt"_s, {}));
        }
        const QString want = expected.isEmpty() ? docs_ : docs_ + u'/' + expected;
        QCOMPARE(GetDocsDirByClientTik(choice[1], choice[0], choice[2], choice[3], choice[4]),
                 want);
        QVERIFY(QFileInfo(want).isDir());
        QVERIFY((*ui_)->Messages().empty());
    }

    // A file where the folder should be: no folder, and a word on it only in a development run.
    void folderThatCannotBeMade() {
        QVERIFY(test::WriteFile(docs_ + u"/DOC9"_s, {}));
        for (const bool development : {false, true}) {
            SetIsDevelopmentRun(development);
            (*ui_)->Clear();
            QCOMPARE(GetDocsDirByClientTik(u"9"_s, u"N"_s, QString(), u"1"_s, QString()),
                     QString());
            const QString told = u"בעיה בבניית ספריית לקוח/תיק\r\nDOC9/N/1"_s;
            QCOMPARE((*ui_)->Texts().contains(told), development);
        }
    }

    void nextNumber_data() {
        QTest::addColumn<QStringList>("files");
        QTest::addColumn<QString>("ext");
        QTest::addColumn<QString>("letter");
        QTest::addColumn<QString>("expected");  // name after the upper-cased folder

        const QStringList mixed{"T1.doc", "T7.pdf", "t12.docx", "Tax.doc", "E40.msg", "X3"};
        QTest::newRow("mixed names") << mixed << u"DOC"_s << u"T"_s << u"T13.DOC"_s;
        QTest::newRow("no extension text") << mixed << u""_s << u"X"_s << u"X4"_s;
        QTest::newRow("halves to even")
            << QStringList{"T12.5.doc", "S2.5.pdf", "S1.pdf"} << u"DOC"_s << u"T"_s << u"T13.DOC"_s;
        QTest::newRow("halves to even, up")
            << QStringList{"T13.5.doc"} << u"DOC"_s << u"T"_s << u"T15.DOC"_s;
        QTest::newRow("dot first") << QStringList{"T.5"} << u"DOC"_s << u"T"_s << u"T1.DOC"_s;
        // Plain digits are read directly; anything else as a number is read in general.
        QTest::newRow("zeros, blanks, exponent, sixteen digits")
            << QStringList{"T0099.doc", "T 150.doc", "T1e2.doc", "T1000000000000000.doc", "Ω7.doc"}
            << u"DOC"_s << u"T"_s << u"T1000000000000001.DOC"_s;
        QTest::newRow("zeros, blanks, exponent")
            << QStringList{"T0099.doc", "T 150 .doc", "T1e2.doc", "ת500.doc"} << u"DOC"_s << u"T"_s
            << u"T151.DOC"_s;
    }
    void nextNumber() {
        QFETCH(QStringList, files);
        QFETCH(QString, ext);
        QFETCH(QString, letter);
        QFETCH(QString, expected);
        const QString folder = docs_ + u"/DOC5/תיק"_s;
        QVERIFY(QDir().mkpath(folder + u"/T99"_s));  // folders do not count
        for (const QString& f : files) {
            QVERIFY(test::WriteFile(folder + u'/' + f, {}));
        }
        QCOMPARE(GetNextFileName(folder, ext, letter), (folder + u'/').toUpper() + expected);
    }

    void pathHelpers() {
        const QString folder = docs_ + u"/NEW/"_s;
        QCOMPARE(GetNextFileName(folder, u"PDF"_s, u"S"_s), folder.toUpper() + u"S1.PDF"_s);
        QVERIFY(QFileInfo(folder).isDir());
        QCOMPARE(GetNextFileName(QString(), u"PDF"_s, u"S"_s), QString());

        QCOMPARE(CCpath(u"a"_s), u"a"_s + QDir::separator());
        QCOMPARE(CCpath(u"a/"_s), u"a/"_s);
        QCOMPARE(CCpath(u"a\\"_s), u"a\\"_s);
        QVERIFY((*ui_)->Messages().empty());
        QCOMPARE(CCpath(QString()), QString());
        QCOMPARE((*ui_)->Texts(), QStringList{u"אין הגדרת ספריה לעבודה"_s});
        QCOMPARE((*ui_)->Messages().front().style, int(vbCritical));

        QCOMPARE(TruncateFileName(u"\\DOCS\\DOC5\\a.doc"_s), u"a.doc"_s);
        QCOMPARE(TruncateFileName(u"c.doc"_s), u"c.doc"_s);
        QCOMPARE(TruncateFileName(u"dir/"_s), QString());
    }

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    QString docs_;
};

QTEST_MAIN(TestFolderNaming)
#include "test_folder_naming.moc"

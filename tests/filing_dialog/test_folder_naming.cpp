// Client and case folders, numbered names and the small path helpers, without a window.

#include <QDir>
#include <QFile>
#include <QTest>

#include "filing_dialog/docs_folder.h"
#include "filing_dialog/file_naming.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/state.h"

using namespace zv;

namespace {

void Touch(const QString& path) {
    QFile f(path);
    QVERIFY2(f.open(QIODevice::WriteOnly), qPrintable(path));
}

}  // namespace

class TestFolderNaming : public QObject {
    Q_OBJECT

  private slots:
    void init() {
        env_ = std::make_unique<test::TestEnv>();
        ui_ = std::make_unique<test::ScopedScriptedUi>();
        QVERIFY(QDir().mkpath(env_->DataDir()));
        SetMainPath(env_->DataDir());
        SetVolnaGlobNum(QStringLiteral("23"));
        docs_ = env_->DataDir() + QStringLiteral("/DOCS");
    }
    void cleanup() {
        ui_.reset();
        env_.reset();
    }

    void clientCaseFolder_data() {
        QTest::addColumn<QString>("kind");
        QTest::addColumn<QString>("client");
        QTest::addColumn<QString>("subKind");
        QTest::addColumn<QString>("caseNum");
        QTest::addColumn<QString>("caseCode");
        QTest::addColumn<QString>("volna");
        QTest::addColumn<bool>("lcn7");
        QTest::addColumn<QString>("expected");  // below DOCS; empty: DOCS itself

        QTest::newRow("client") << "F"
                                << "123"
                                << ""
                                << ""
                                << ""
                                << "23" << false << "DOC123";
        QTest::newRow("no kind") << ""
                                 << "123"
                                 << ""
                                 << ""
                                 << ""
                                 << "23" << false << "DOC123";
        QTest::newRow("M and R") << "MR"
                                 << "8"
                                 << ""
                                 << ""
                                 << ""
                                 << "23" << false << "DOC8";
        QTest::newRow("supplier") << "S"
                                  << "77"
                                  << ""
                                  << ""
                                  << ""
                                  << "23" << false << "SPK77";
        QTest::newRow("bureau, placeholder") << "L"
                                             << ""
                                             << ""
                                             << ""
                                             << "12-34"
                                             << "23" << false << "DOC00000/L/1234";
        QTest::newRow("bureau, marker without 81005") << "L"
                                                      << ""
                                                      << ""
                                                      << ""
                                                      << "12-34"
                                                      << "23" << true << "DOC00000/L/1234";
        QTest::newRow("bureau, wide placeholder") << "L"
                                                  << ""
                                                  << ""
                                                  << ""
                                                  << "1-2-3"
                                                  << "81005" << true << "DOC0000000/L/123";
        QTest::newRow("bureau, client") << "L"
                                        << "5"
                                        << ""
                                        << ""
                                        << "7"
                                        << "81005" << true << "DOC5/L/7";
        QTest::newRow("general, own kind") << "T"
                                           << "5"
                                           << "30"
                                           << "9"
                                           << ""
                                           << "23" << false << "DOC5/30/9";
        QTest::newRow("general, kind 26") << "T"
                                          << "5"
                                          << "26"
                                          << "9"
                                          << ""
                                          << "23" << false << "DOC5/26/9";
        QTest::newRow("general, kind 25") << "T"
                                          << "5"
                                          << "25"
                                          << "9"
                                          << ""
                                          << "23" << false << "";
        QTest::newRow("general, blank kind") << "T"
                                             << "5"
                                             << "abc"
                                             << "9"
                                             << ""
                                             << "23" << false << "";
        QTest::newRow("tort") << "N"
                              << "5"
                              << ""
                              << "9"
                              << ""
                              << "23" << false << "DOC5/N/9";
        QTest::newRow("real estate") << "W"
                                     << "5"
                                     << ""
                                     << "9"
                                     << ""
                                     << "23" << false << "DOC5/W/9";
        QTest::newRow("labour") << "G"
                                << "5"
                                << ""
                                << "9"
                                << ""
                                << "23" << false << "DOC5/G/9";
        QTest::newRow("debtor") << "H"
                                << "5"
                                << ""
                                << "9"
                                << "4"
                                << "23" << false << "DOC5/H/4";
        QTest::newRow("A") << "A"
                           << "5"
                           << ""
                           << "9"
                           << "4"
                           << "23" << false << "DOC5/A/4";
        QTest::newRow("two kinds") << "FS"
                                   << "5"
                                   << ""
                                   << ""
                                   << ""
                                   << "23" << false << "";
        QTest::newRow("lower case") << "f"
                                    << "5"
                                    << ""
                                    << ""
                                    << ""
                                    << "23" << false << "";
        QTest::newRow("unknown") << "X"
                                 << "5"
                                 << ""
                                 << "9"
                                 << "4"
                                 << "23" << false << "";
    }
    void clientCaseFolder() {
        QFETCH(QString, kind);
        QFETCH(QString, client);
        QFETCH(QString, subKind);
        QFETCH(QString, caseNum);
        QFETCH(QString, caseCode);
        QFETCH(QString, volna);
        QFETCH(bool, lcn7);
        QFETCH(QString, expected);
        SetVolnaGlobNum(volna);
        if (lcn7) {
            Touch(env_->DataDir() + QStringLiteral("/LCN7.txt"));
        }
        const QString want = expected.isEmpty() ? docs_ : docs_ + QLatin1Char('/') + expected;
        QCOMPARE(GetDocsDirByClientTik(client, kind, subKind, caseNum, caseCode), want);
        QVERIFY(QFileInfo(want).isDir());
        QVERIFY((*ui_)->Messages().empty());
    }

    void clientNumWidth() {
        QCOMPARE(GetClientNumWidth(), int16_t(5));
        Touch(env_->DataDir() + QStringLiteral("/LCN7.txt"));
        QCOMPARE(GetClientNumWidth(), int16_t(5));
        SetVolnaGlobNum(QStringLiteral("81005"));
        QCOMPARE(GetClientNumWidth(), int16_t(7));
    }

    void folderThatCannotBeMade_data() {
        QTest::addColumn<bool>("development");
        QTest::newRow("installed") << false;
        QTest::newRow("development") << true;
    }
    void folderThatCannotBeMade() {
        QFETCH(bool, development);
        SetIsDevelopmentRun(development);
        QVERIFY(QDir().mkpath(docs_));
        Touch(docs_ + QStringLiteral("/DOC9"));  // a file where the folder should be
        QCOMPARE(GetDocsDirByClientTik(QStringLiteral("9"), QStringLiteral("N"), QString(),
                                       QStringLiteral("1"), QString()),
                 QString());
        const bool told = (*ui_)->Texts().contains(QStringLiteral("בעיה בבניית ספריית לקוח/תיק") +
                                                   QStringLiteral("\r\nDOC9/N/1"));
        QCOMPARE(told, development);
    }

    void nextNumber_data() {
        QTest::addColumn<QStringList>("files");
        QTest::addColumn<QString>("ext");
        QTest::addColumn<QString>("letter");
        QTest::addColumn<QString>("expected");  // name after the upper-cased folder

        const QStringList mixed{"T1.doc", "T7.pdf", "t12.docx", "Tax.doc", "E40.msg", "X3"};
        QTest::newRow("mixed names") << mixed << "DOC"
                                     << "T"
                                     << "T13.DOC";
        QTest::newRow("other letter") << mixed << "MSG"
                                      << "E"
                                      << "E41.MSG";
        QTest::newRow("no extension text") << mixed << ""
                                           << "X"
                                           << "X4";
        QTest::newRow("empty folder") << QStringList() << "DOC"
                                      << "T"
                                      << "T1.DOC";
        QTest::newRow("halves to even") << QStringList{"T12.5.doc", "S2.5.pdf", "S1.pdf"} << "DOC"
                                        << "T"
                                        << "T13.DOC";
        QTest::newRow("halves to even, up") << QStringList{"T13.5.doc"} << "DOC"
                                            << "T"
                                            << "T15.DOC";
        QTest::newRow("dot first") << QStringList{"T.5"} << "DOC"
                                   << "T"
                                   << "T1.DOC";
        // Plain digits are read directly; anything else as a number is read in general.
        QTest::newRow("zeros, blanks, exponent, sixteen digits")
            << QStringList{"T0099.doc", "T 150.doc", "T1e2.doc", "T1000000000000000.doc", "Ω7.doc"}
            << "DOC"
            << "T"
            << "T1000000000000001.DOC";
        QTest::newRow("zeros, blanks, exponent")
            << QStringList{"T0099.doc", "T 150 .doc", "T1e2.doc", "ת500.doc"} << "DOC"
            << "T"
            << "T151.DOC";
    }
    void nextNumber() {
        QFETCH(QStringList, files);
        QFETCH(QString, ext);
        QFETCH(QString, letter);
        QFETCH(QString, expected);
        const QString folder = docs_ + QStringLiteral("/DOC5/תיק");
        QVERIFY(QDir().mkpath(folder));
        QVERIFY(QDir().mkpath(folder + QStringLiteral("/T99")));  // folders do not count
        for (const QString& f : files) {
            Touch(folder + QLatin1Char('/') + f);
        }
        QCOMPARE(GetNextFileName(folder, ext, letter),
                 (folder + QLatin1Char('/')).toUpper() + expected);
    }

    void nextNumberCreatesFolder() {
        const QString folder = docs_ + QStringLiteral("/NEW/");
        QCOMPARE(GetNextFileName(folder, QStringLiteral("PDF"), QStringLiteral("S")),
                 folder.toUpper() + QStringLiteral("S1.PDF"));
        QVERIFY(QFileInfo(folder).isDir());
        QCOMPARE(GetNextFileName(QString(), QStringLiteral("PDF"), QStringLiteral("S")), QString());
        QVERIFY((*ui_)->Messages().empty());
    }

    void numberedName_data() {
        QTest::addColumn<QString>("ext");
        QTest::addColumn<QString>("expected");
        QTest::newRow("doc") << "doc"
                             << "T13";
        QTest::newRow("DOC") << "DOC"
                             << "T13";
        QTest::newRow("docx") << "docx"
                              << "T13";
        QTest::newRow("msg") << "msg"
                             << "E1";
        QTest::newRow("pdf") << "pdf"
                             << "S1";
        QTest::newRow("xlsx: the proposed name") << "xlsx"
                                                 << "מכתב ללקוח";
        QTest::newRow("html: the proposed name") << "html"
                                                 << "מכתב ללקוח";
        QTest::newRow("no extension") << ""
                                      << "מכתב ללקוח";
    }
    void numberedName() {
        QFETCH(QString, ext);
        QFETCH(QString, expected);
        const QString folder = docs_ + QStringLiteral("/DOC5");
        QVERIFY(QDir().mkpath(folder));
        for (const char* f : {"T1.doc", "T7.pdf", "t12.docx", "Tax.doc"}) {
            Touch(folder + QLatin1Char('/') + QLatin1String(f));
        }
        QCOMPARE(NumberedName(QStringLiteral("מכתב ללקוח"), ext, folder), expected);
        QCOMPARE(NumberedName(QStringLiteral("x"), ext, QString()), std::nullopt);
    }

    void pathHelpers() {
        QCOMPARE(CCpath(QStringLiteral("a")), QStringLiteral("a") + QDir::separator());
        QCOMPARE(CCpath(QStringLiteral("a/")), QStringLiteral("a/"));
        QCOMPARE(CCpath(QStringLiteral("a\\")), QStringLiteral("a\\"));
        QVERIFY((*ui_)->Messages().empty());
        QCOMPARE(CCpath(QString()), QString());
        QCOMPARE((*ui_)->Texts(), QStringList{QStringLiteral("אין הגדרת ספריה לעבודה")});
        QCOMPARE((*ui_)->Messages().front().style, int(vbCritical));

        QCOMPARE(TruncateFileName(QStringLiteral("\\DOCS\\DOC5\\a.doc")), QStringLiteral("a.doc"));
        QCOMPARE(TruncateFileName(QStringLiteral("/x/y/b")), QStringLiteral("b"));
        QCOMPARE(TruncateFileName(QStringLiteral("c.doc")), QStringLiteral("c.doc"));
        QCOMPARE(TruncateFileName(QString()), QString());
        QCOMPARE(TruncateFileName(QStringLiteral("dir/")), QString());
    }

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    QString docs_;
};

QTEST_MAIN(TestFolderNaming)
#include "test_folder_naming.moc"

// Filing without a window: the built program run with --batch as a script runs it, on a
// fresh sample installation per case; the file, the rows, standard output and exit status.
#include <QFile>
#include <QtTest>

#include "filing_fixture.h"

using namespace zv::test;

namespace {

const QString kDoc = QStringLiteral("מכתב א");  // the suggested name "מכתב: א", cleaned

QString DateOf(const QVariant& v) {
    return v.toDateTime().date().toString(Qt::ISODate);
}

}  // namespace

class TestFilingBatch : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void filed_data();
    void filed();
    void everyDetail();
    void notFiled_data();
    void notFiled();
    void usageError();
};

void TestFilingBatch::filed_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("sourceName");
    QTest::addColumn<QStringList>("options");
    QTest::addColumn<QString>("sug");
    QTest::addColumn<QStringList>("existing");  // files already in the archive
    QTest::addColumn<QString>("expected");
    const QStringList client{"--client", "1001"};
    QTest::newRow("client") << 1 << "a.docx" << client << "F" << QStringList()
                            << "DOC1001/" + kDoc + ".docx";
    QTest::newRow("case") << 1 << "a.docx" << client + QStringList{"--case", "2"} << "W"
                          << QStringList() << "DOC1001/W/2/" + kDoc + ".docx";
    QTest::newRow("general case") << 1 << "a.pdf" << client + QStringList{"--case", "8"} << "T"
                                  << QStringList() << "DOC1001/26/8/" + kDoc + ".pdf";
    QTest::newRow("inner folder") << 1 << "a.pdf"
                                  << QStringList{"--client", "1002", "--inner-folder", "חוזים"}
                                  << "F" << QStringList() << "DOC1002/חוזים/" + kDoc + ".pdf";
    QTest::newRow("numbering") << 1 << "a.doc" << client + QStringList{"--number"} << "F"
                               << QStringList{"DOC1001/T4.pdf"} << "DOC1001/T5.doc";
    QTest::newRow("own name") << 1 << "a.doc" << client + QStringList{"--name", "דוח שנתי"} << "F"
                              << QStringList() << "DOC1001/דוח שנתי.doc";
    QTest::newRow("clash overwritten")
        << 1 << "a.docx" << client + QStringList{"--on-clash", "overwrite"} << "F"
        << QStringList{"DOC1001/" + kDoc + ".docx"} << "DOC1001/" + kDoc + ".docx";
    QTest::newRow("mail") << 2 << "m.eml" << client << "F" << QStringList()
                          << "DOC1001/" + kDoc + ".msg.eml";
}

void TestFilingBatch::filed() {
    QFETCH(int, mode);
    QFETCH(QString, sourceName);
    QFETCH(QStringList, options);
    QFETCH(QString, sug);
    QFETCH(QStringList, existing);
    QFETCH(QString, expected);
    FilingFixture f;
    const QString source = f.Source(sourceName, "new");
    for (const QString& name : existing) {
        f.ArchiveFile(name, "old, longer");
    }

    const ProcessResult r = f.RunProgram(QStringList{"--batch"} + options +
                                         QStringList{f.Request(mode, source, "מכתב: א")});

    QCOMPARE(r.status, 0);
    const QString archived = f.Docs() + QLatin1Char('/') + expected;
    QCOMPARE(r.out, archived + QLatin1Char('\n'));
    QVERIFY2(r.err.contains(QStringLiteral("הקובץ נשמר לכתובת המבוקשת")), qPrintable(r.err));
    QCOMPARE(Content(archived), QByteArray("new"));
    QVERIFY(!QFile::exists(source));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    QCOMPARE(rows.first()["FULLNAME"].toString(), FullName(expected));
    QCOMPARE(rows.first()["SUG"].toString(), sug);
    QCOMPARE(rows.first()["PARTOF"].toInt(), mode == 1 ? 2 : 1);
}

// Every option reaches the row and the reminders as the dialog's fields would.
void TestFilingBatch::everyDetail() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("r.pdf"));
    const QStringList options =
        QStringLiteral(
            "--batch|--client|1001|--case|4|--description|חוזה|--more-description|נספח|"
            "--remark|נחתם היום|--origin|3|--status|1|--handlers|יוסי לוי;מיכל ברק|"
            "--received|01-02-2026|--created|15-01-2026|"
            "--reminder|20-03-2026 10:30|--popup")
            .split(QLatin1Char('|'));
    const ProcessResult r = f.RunProgram(options + QStringList{f.Request(1, source, "דוח")});
    QCOMPARE(r.status, 0);
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    const QVariantMap& row = rows.first();
    const QMap<QString, QString> expected{{"FULLNAME", FullName("DOC1001/H/1001-4/דוח.pdf")},
                                          {"SUG", "H"},
                                          {"IDTIK", "2"},
                                          {"TIK", "4"},
                                          {"NUM", "1001-4"},
                                          {"TEUR", "חוזה"},
                                          {"SECTEUR", "נספח"},
                                          {"PARTOF", "3"},
                                          {"STATUS", "1"},
                                          {"METAPEL", "יוסי לוי;מיכל ברק"},
                                          {"MEMOHOUR", "10:30"}};
    for (auto it = expected.cbegin(); it != expected.cend(); ++it) {
        QCOMPARE(row[it.key()].toString(), it.value());
    }
    QVERIFY(row["BODY"].toString().endsWith(QStringLiteral(" -- נחתם היום")));
    QCOMPARE(DateOf(row["RECIEVEDATE"]), QStringLiteral("2026-02-01"));
    QCOMPARE(DateOf(row["DATECREATED"]), QStringLiteral("2026-01-15"));
    QCOMPARE(DateOf(row["MEMODATE"]), QStringLiteral("2026-03-20"));
    QVERIFY(!row["ISMEMO"].toBool());
    QVERIFY(row["ISJUMPMEMO"].toBool());
    const auto memos = Rows(QStringLiteral("BM"),
                            QStringLiteral("SELECT * FROM UMEMO WHERE ID=") + row["ID"].toString());
    QStringList handlers;
    for (const QVariantMap& memo : memos) {
        handlers << memo["METAPEL"].toString();
    }
    handlers.sort();
    // A pop-up and a regular reminder for each handler.
    QCOMPARE(handlers, (QStringList{"יוסי לוי", "יוסי לוי", "מיכל ברק", "מיכל ברק"}));
}

void TestFilingBatch::notFiled_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("sourceName");
    QTest::addColumn<QStringList>("options");
    QTest::addColumn<QString>("message");   // %D: the DOCS folder
    QTest::addColumn<QString>("existing");  // relative path; ending in "/": a folder
    const QStringList client{"--client", "1001"};
    const QString none;
    QTest::newRow("unknown client")
        << 1 << "a.pdf" << QStringList{"--client", "9999"} << "לא נמצא לקוח מספר 9999" << none;
    QTest::newRow("unknown case") << 1 << "a.pdf" << client + QStringList{"--case", "77"}
                                  << "לא נמצא תיק מספר 77 בתיקי לקוח מספר 1001" << none;
    QTest::newRow("a kind outside the client's case list")
        << 1 << "a.pdf" << QStringList{"--client", "1003", "--case", "3"}
        << "לא נמצא תיק מספר 3 בתיקי לקוח מספר 1003" << none;
    QTest::newRow("another client's case")
        << 1 << "a.pdf" << QStringList{"--client", "1006", "--case", "2"}
        << "לא נמצא תיק מספר 2 בתיקי לקוח מספר 1006" << none;
    QTest::newRow("unknown inner folder")
        << 1 << "a.pdf" << client + QStringList{"--inner-folder", "אין"}
        << "לא נמצאה ספריה פנימית בשם אין" << none;
    QTest::newRow("unknown origin") << 1 << "a.pdf" << client + QStringList{"--origin", "99"}
                                    << "לא נמצא מקור מסמך בקוד 99" << none;
    QTest::newRow("unknown status")
        << 1 << "a.pdf" << client + QStringList{"--status", "9"} << "לא נמצא סטטוס בקוד 9" << none;
    QTest::newRow("forbidden name") << 1 << "a.pdf" << client + QStringList{"--name", "../x"}
                                    << "אסור לקלוט כחלק משם קובץ את התווים הבאים : " << none;
    QTest::newRow("empty name") << 2 << "m.msg" << client + QStringList{"--name", ""}
                                << "יש לקבוע שם לקובץ הנשמר" << none;
    QTest::newRow("clash left alone")
        << 1 << "a.pdf" << client
        << "קיים קובץ בשם זה, המסמך לא תויק :\n%D/DOC1001/" + kDoc + ".pdf"
        << "DOC1001/" + kDoc + ".pdf";
    QTest::newRow("mail clash under its final name")
        << 2 << "m.eml" << client
        << "קיים קובץ בשם זה, המסמך לא תויק :\n%D/DOC1001/" + kDoc + ".msg.eml"
        << "DOC1001/" + kDoc + ".msg.eml";
    QTest::newRow("copy that cannot be written") << 1 << "a.pdf" << client << "75-0-WorkWithStr-"
                                                 << "DOC1001/" + kDoc + ".pdf/";
}

void TestFilingBatch::notFiled() {
    QFETCH(int, mode);
    QFETCH(QString, sourceName);
    QFETCH(QStringList, options);
    QFETCH(QString, message);
    QFETCH(QString, existing);
    FilingFixture f;
    const QString source = f.Source(sourceName, "new");
    if (existing.endsWith(QLatin1Char('/'))) {
        QVERIFY(QDir().mkpath(f.Docs() + QLatin1Char('/') + existing));
    } else if (!existing.isEmpty()) {
        f.ArchiveFile(existing, "old");
    }
    const QStringList before = FolderEntries(f.Docs() + QStringLiteral("/DOC1001"));

    const ProcessResult r = f.RunProgram(QStringList{"--batch"} + options +
                                         QStringList{f.Request(mode, source, "מכתב: א")});

    QCOMPARE(r.status, 1);
    QCOMPARE(r.out, QString());
    message.replace(QStringLiteral("%D"), f.Docs());
    // The console writes a message's line breaks as new lines.
    QVERIFY2(r.err.contains(message), qPrintable(r.err));
    QVERIFY(!r.err.contains(QStringLiteral("הקובץ נשמר")));
    QCOMPARE(Content(source), QByteArray("new"));
    QCOMPARE(FolderEntries(f.Docs() + QStringLiteral("/DOC1001")), before);
    if (!existing.isEmpty() && !existing.endsWith(QLatin1Char('/'))) {
        QCOMPARE(Content(f.Docs() + QLatin1Char('/') + existing), QByteArray("old"));
    }
    QVERIFY(f.DocsRows().isEmpty());
}

void TestFilingBatch::usageError() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("a.pdf"));
    const ProcessResult r = f.RunProgram({"--batch", "--case", "2", f.Request(1, source, "x")});
    QCOMPARE(r.status, 2);
    QVERIFY2(r.err.contains(QStringLiteral("--batch needs --client")), qPrintable(r.err));
    QVERIFY(r.err.contains(QStringLiteral("Usage: ")));
    QVERIFY(QFile::exists(source));
}

QTEST_MAIN(TestFilingBatch)
#include "test_filing_batch.moc"

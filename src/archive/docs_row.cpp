#include "archive/docs_row.h"

#include <QFileInfo>
#include <QRandomGenerator>
#include <QThread>
#include <QTime>
#include <functional>

#include "archive/date_values.h"
#include "archive/memo.h"
#include "archive/next_doc_id.h"
#include "archive/remark.h"
#include "data/database.h"
#include "data/record_edit.h"
#include "data/recordset.h"
#include "data/values.h"
#include "util/clock.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

// Tries at saving a row whose new identifier another filer took first (file databases).
// Every failed try means that another writer saved a row with that identifier meanwhile,
// so a filing fails at most once per other filing saved at the same moment; twenty covers
// far more people filing into one office's archive at once than there are, while the
// bound still ends the loop if the duplicates come from elsewhere, and keeps the longest
// wait under two seconds. The random pause keeps the losers from colliding again.
constexpr int kIdTries = 20;
constexpr int kMinPauseMs = 10;
constexpr int kMaxPauseMs = 100;

// A duplicate outside the save ends the recording at once.
struct Abandon {};

// The reminder time as stored: "HH:MM", and 08:00 for an empty time box (no text, or the
// box's empty mask).
QString MemoHourText(const QString& text) {
    const QString trimmed = text.trimmed();
    if (trimmed.isEmpty() || trimmed == QStringLiteral("__:__")) {
        return QStringLiteral("08:00");
    }
    const QTime time = QTime::fromString(trimmed, QStringLiteral("H:m"));
    return time.isValid() ? time.toString(QStringLiteral("hh:mm")) : text;
}

// The file's creation time; file systems that keep none give its last change.
QDateTime CreationTime(const QFileInfo& info) {
    const QDateTime born = info.birthTime();
    return born.isValid() ? born : info.lastModified();
}

class DocRowWriter {
  public:
    explicit DocRowWriter(const QString& fullPath) : fullPath_(fullPath) {}
    ~DocRowWriter() {
        GClose(rs_);
        GClose(db_);
    }
    DocRowWriter(const DocRowWriter&) = delete;
    DocRowWriter& operator=(const DocRowWriter&) = delete;

    bool Run(const DocDetails* details) {
        try {
            return Record(details);
        } catch (const Abandon&) {
            return false;
        }
    }

  private:
    bool Record(const DocDetails* details) {
        if (!IsFileExist(fullPath_)) {
            return false;
        }
        QString rel = fullPath_.mid(MainPath().size());
        rel.replace(QLatin1Char('/'), QLatin1Char('\\'));
        const bool server = IsDocs();

        Do([&] { db_ = Database::Open(QStringLiteral("MDOCS"), server); });
        if (db_) {
            Do([&] {
                rs_ = db_->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE [FullName]='") +
                                             FixQuote(rel) + QStringLiteral("'"),
                                         dbOpenDynaset);
            });
        }
        if (!rs_) {
            return false;
        }

        bool existing = false;
        Do([&] { existing = rs_->RecordCount() > 0; });
        if (existing) {
            GEdit(rs_.get());
            if (!server) {
                Do([&] {
                    if (GetLngFromStr(rs_->Value(QStringLiteral("ID"))) == 0) {
                        AssignId();
                    }
                });
            }
        } else {
            GAddNew(rs_.get());
            if (!server) {
                Do([&] { AssignId(); });
            }
            Set(QStringLiteral("IsMemo"), true);
        }

        const QFileInfo file(DiskPath(fullPath_));
        if (file.exists()) {
            Set(QStringLiteral("DateCreated"), CreationTime(file));
        }
        SetText(QStringLiteral("FULLNAME"), rel);
        SetText(QStringLiteral("ShortName"), rel.mid(rel.lastIndexOf(QLatin1Char('\\')) + 1));
        SetText(QStringLiteral("DirPath"), rel.left(rel.lastIndexOf(QLatin1Char('\\')) + 1));
        Set(QStringLiteral("DirMone"), 0);

        if (details) {
            SetFromDialog(*details);
        } else {
            SetText(QStringLiteral("Metapel"), MyUserName());
            SetText(QStringLiteral("Teur"), {});
            SetText(QStringLiteral("SecTeur"), {});
            Set(QStringLiteral("PARTOF"), 0);
            Set(QStringLiteral("Status"), 2);
        }
        Set(QStringLiteral("Source"), 9);
        if (details) {
            SetText(QStringLiteral("CLIENT_NUM"), details->clientNumber);
            SetText(QStringLiteral("SUG"), details->kindLetter);
            Set(QStringLiteral("IDTik"), int(GetIntFromStr(details->subKind)));
            SetText(QStringLiteral("TIK"), details->caseNumber);
            SetText(QStringLiteral("NUM"), details->caseCode);
        }

        if (Save() != 0) {
            return false;
        }
        CheckMemo(QStringLiteral("DOCS"), rs_.get());
        return true;
    }

    void SetFromDialog(const DocDetails& d) {
        SetText(QStringLiteral("Metapel"), d.handlers);
        SetText(QStringLiteral("Teur"), d.description);
        SetText(QStringLiteral("SecTeur"), d.moreDescription);
        Set(QStringLiteral("IsMemo"), !d.reminder);
        if (d.reminder) {
            Set(QStringLiteral("MemoDate"), DateBoxValue(d.reminderDate));
            SetText(QStringLiteral("MemoHour"), MemoHourText(d.reminderTime));
            Set(QStringLiteral("IsJumpMemo"), d.popup);
        }
        Set(QStringLiteral("RecieveDate"), DateBoxValue(d.receivedDate));
        Set(QStringLiteral("LastModificationTime"), Now());
        SetText(QStringLiteral("LastModificationUser"), MyUserName());
        if (d.createdUnlocked) {
            Set(QStringLiteral("DateCreated"), DateBoxValue(d.createdDate));
        }
        if (!d.remark.trimmed().isEmpty()) {
            Do([&] {
                rs_->SetValue(QStringLiteral("Body"),
                              AppendRemark(rs_->Value(QStringLiteral("Body")), d.remark));
            });
        }
        Set(QStringLiteral("PARTOF"), d.origin.value_or(0));
        Set(QStringLiteral("Status"), d.status.value_or(0));
    }

    void AssignId() {
        id_ = GetNextIdDOCS();
        idAssigned_ = true;
        rs_->SetValue(QStringLiteral("ID"), id_);
    }

    // Saves the row. On the file database an identifier that another writer took first is
    // replaced by a fresh one and the row saved again; any other duplicate ends the
    // recording as before. Returns 0 when saved.
    long Save() {
        long result = GUpdate(0, rs_.get());
        for (int tries = 1; result == err::JetDuplicate && idAssigned_ && tries < kIdTries;
             ++tries) {
            QThread::msleep(QRandomGenerator::global()->bounded(kMinPauseMs, kMaxPauseMs));
            const int32_t fresh = GetNextIdDOCS();
            if (fresh <= id_) {
                break;  // nobody holds our identifier: the duplicate is in another index
            }
            id_ = fresh;
            Set(QStringLiteral("ID"), id_);
            result = GUpdate(0, rs_.get());
        }
        return result;
    }

    void Set(const QString& field, const QVariant& value) {
        Do([&] { rs_->SetValue(field, value); });
    }

    // Text columns hold a string, empty rather than Null when there is no text.
    void SetText(const QString& field, const QString& text) {
        Set(field, text.isNull() ? QStringLiteral("") : text);
    }

    // One statement: a duplicate ends the recording silently, any other failure is
    // reported with the path and the next statement runs.
    void Do(const std::function<void()>& statement) {
        try {
            statement();
        } catch (const std::exception& e) {
            const VbError error = AsVbError(e);
            if (error.Number() == err::JetDuplicate) {
                throw Abandon{};
            }
            MsgBox(FormatWithLine(QStringLiteral("AddDocToListByAddIn"), error) +
                       QStringLiteral("\r\n") + fullPath_,
                   vbOKOnly);
        }
    }

    const QString fullPath_;
    std::unique_ptr<Database> db_;
    std::unique_ptr<Recordset> rs_;
    int32_t id_ = 0;
    bool idAssigned_ = false;
};

}  // namespace

bool AddDocToListByAddIn(const QString& fullPath, const DocDetails* details) {
    return DocRowWriter(fullPath).Run(details);
}

}  // namespace zv

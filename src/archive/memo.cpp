#include "archive/memo.h"

#include <QStringList>
#include <functional>

#include "archive/memo_date.h"
#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "util/clock.h"
#include "util/errors.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

enum : int16_t { PopupMemo = 31, RegularMemo = 32 };

bool IsTrueVal(const QVariant& v) {
    return !v.isNull() && v.toBool();
}
bool IsFalseVal(const QVariant& v) {
    return !v.isNull() && !v.toBool();
}

class MemoWriter {
  public:
    MemoWriter(const QString& tableName, Recordset& doc) : tableName_(tableName), doc_(doc) {}

    void Run() {
        int32_t id = 0;
        Do([&] { id = GetLngFromStr(doc_.Value(QStringLiteral("ID"))); });
        if (id == 0) {
            MsgBox(QStringLiteral("בעיה בקוד זיהוי בטבלה : ") + tableName_,
                   vbExclamation | vbOKOnly);
            return;
        }
        if (tableName_.toUpper() != QStringLiteral("DOCS")) {
            return;
        }
        const QString idText = QString::number(id);
        const bool server = IsBM();
        Do([&] { db_ = Database::Open(QStringLiteral("BM"), server); });
        if (!db_) {
            return;
        }
        Do([&] {
            db_->Execute((server ? QStringLiteral("DELETE FROM UMEMO WHERE ([MTYPE]=")
                                 : QStringLiteral("DELETE * FROM UMEMO WHERE ([MTYPE]=")) +
                         QStringLiteral("31") + QStringLiteral(" OR [MTYPE]=") +
                         QStringLiteral("32") + QStringLiteral(") AND [ID]=") + idText);
        });

        QVariant isMemo, isJumpMemo, memoDate, memoHour, handlers;
        Do([&] {
            isMemo = doc_.Value(QStringLiteral("IsMemo"));
            isJumpMemo = doc_.Value(QStringLiteral("IsJumpMemo"));
            memoDate = doc_.Value(QStringLiteral("MemoDate"));
            memoHour = doc_.Value(QStringLiteral("MemoHour"));
            handlers = doc_.Value(QStringLiteral("METAPEL"));
        });
        const bool hasReminder = IsFalseVal(isMemo);
        const auto emptyRows = server ? QStringLiteral("SELECT * FROM UMEMO WHERE 1=0")
                                      : QStringLiteral("SELECT * FROM UMEMO WHERE FALSE");
        QDateTime moment;

        Do([&] { rs_ = db_->OpenRecordset(emptyRows, dbOpenDynaset); });
        if (IsTrueVal(isJumpMemo) && hasReminder && GetmDate(memoDate, memoHour, moment, false)) {
            WriteRows(handlers, PopupMemo, 2, id, moment);
        }
        GClose(rs_);
        Do([&] { rs_ = db_->OpenRecordset(emptyRows, dbOpenDynaset); });
        if (hasReminder && GetmDate(memoDate, memoHour, moment, false)) {
            WriteRows(handlers, RegularMemo, 3, id, moment);
        }
        GClose(rs_);
        GClose(db_);
    }

  private:
    // One row per handler, empty names included; a duplicate row is skipped and the
    // remaining handlers are still written.
    void WriteRows(const QVariant& handlers, int16_t type, int16_t rtype, int32_t id,
                   const QDateTime& moment) {
        if (!rs_) {
            return;
        }
        const QString text = handlers.isNull() ? QString() : handlers.toString();
        if (text.isEmpty()) {
            return;
        }
        for (const QString& handler : text.split(QLatin1Char(';'))) {
            Do([&] {
                if (rs_->EditMode() != dbEditNone) {
                    rs_->CancelUpdate();
                }
                rs_->AddNew();
            });
            Do([&] { rs_->SetValue(QStringLiteral("USER97"), MyUser()); });
            Do([&] { rs_->SetValue(QStringLiteral("METAPEL"), handler); });
            Do([&] { rs_->SetValue(QStringLiteral("MTYPE"), int(type)); });
            Do([&] { rs_->SetValue(QStringLiteral("RTYPE"), int(rtype)); });
            Do([&] { rs_->SetValue(QStringLiteral("ID"), id); });
            Do([&] { rs_->SetValue(QStringLiteral("MEMOTIME"), moment); });
            Do([&] { rs_->SetValue(QStringLiteral("DateUpdated"), Now()); });
            Do([&] { rs_->Update(); });
        }
    }

    // One statement: a duplicate (of either back-end) is skipped silently, any other
    // failure is reported and the next statement runs.
    void Do(const std::function<void()>& statement) {
        try {
            statement();
        } catch (const std::exception& e) {
            const VbError error = AsVbError(e);
            if (error.Number() == err::JetDuplicate || error.Number() == err::ServerIntegrity) {
                return;
            }
            MsgBox(QLatin1Char(' ') + QString::number(error.Number()) +
                       QStringLiteral("-CheckMemo-\r\n") + tableName_ + QLatin1Char('-') +
                       DocumentId() + QStringLiteral("\r\n") + error.Description(),
                   vbOKOnly);
        }
    }

    QString DocumentId() const {
        try {
            return doc_.Value(QStringLiteral("ID")).toString();
        } catch (const std::exception&) {
            return QString();
        }
    }

    const QString tableName_;
    Recordset& doc_;
    std::unique_ptr<Database> db_;
    std::unique_ptr<Recordset> rs_;
};

}  // namespace

void CheckMemo(const QString& tableName, Recordset* rs) {
    try {
        if (!rs || rs->RecordCount() == 0 || rs->BOF() || rs->EOF()) {
            return;
        }
    } catch (const std::exception&) {
        return;
    }
    MemoWriter(tableName, *rs).Run();
}

}  // namespace zv

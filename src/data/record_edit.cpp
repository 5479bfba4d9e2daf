#include "data/record_edit.h"

#include "data/recordset.h"
#include "data/sql_parts.h"
#include "data/values.h"
#include "util/errors.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

// The key as a 32-bit number; a value that is no number (Null, text) counts as 0.
int32_t KeyNumber(const QVariant& v) {
    try {
        return GetLngFromStr(v);
    } catch (const VbError&) {
        return 0;
    }
}

// A server row whose key reads 0 after saving is found again: by its old key, or as the
// row of the highest key when the query no longer returns any row.
void Reposition(Recordset& rs, const QString& keyName, int32_t keyBefore) {
    if (keyName.isEmpty()) {
        return;
    }
    const int32_t keyNow = KeyNumber(rs.Value(keyName));
    if (keyNow != 0 || keyNow == keyBefore) {
        return;
    }
    rs.Requery();
    if (keyBefore > 0 && rs.RecordCount() > 0) {
        rs.Find(keyName + QLatin1Char('=') + QString::number(keyBefore));
        return;
    }
    if (rs.RecordCount() > 0) {
        return;
    }
    const auto parts = GetSqlParts(rs.Source(), false);
    const QString& select = parts[0];
    const qsizetype from = select.indexOf(QLatin1String(" FROM "));
    rs.Close();
    rs.SetSource(QStringLiteral("SELECT TOP 1 * ") + (from < 0 ? QString() : select.mid(from)) +
                 QStringLiteral(" ORDER BY ") + keyName + QStringLiteral(" DESC"));
    rs.Open();
}

}  // namespace

void GAddNew(Recordset* rs) {
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("GAddNew"), e); },
         [rs] {
             if (!rs) {
                 return;
             }
             if (rs->IsServer()) {
                 rs->AddNew();
                 return;
             }
             if (rs->EditMode() != dbEditNone && IsDevelopmentRun()) {
                 MsgBox(QStringLiteral("כבר בעריכה"), vbOKOnly);
             }
             if (rs->EditMode() == dbEditNone) {
                 rs->AddNew();
             }
         });
}

void GEdit(Recordset* rs) {
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("GEdit"), e); },
         [rs] {
             if (!rs || rs->IsServer()) {
                 return;
             }
             if (rs->EditMode() == dbEditNone) {
                 rs->Edit();
             }
         });
}

long GUpdate(int16_t mDb, Recordset* rs) {
    if (!rs) {
        return 0;
    }
    const bool server = rs->IsServer();
    try {
        if (!server && rs->EditMode() == dbEditNone) {
            return 0;
        }
        QString keyName;
        int32_t keyBefore = 0;
        if (server) {
            DoEvents();
            keyName = rs->KeyColumn();
            if (!keyName.isEmpty()) {
                keyBefore = KeyNumber(rs->Value(keyName));
            }
        }
        rs->Update();
        if (!server) {
            rs->SetBookmark(rs->LastModified());
        } else {
            Reposition(*rs, keyName, keyBefore);
        }
        return 0;
    } catch (const std::exception& ex) {
        const VbError e = AsVbError(ex);
        const bool duplicate =
            e.Number() == err::JetDuplicate || e.Number() == err::ServerIntegrity;
        const QString tail = QStringLiteral("mDb=") + QString::number(mDb);
        if (IsDevelopmentRun()) {
            QString text = QStringLiteral("Programr : ") +
                           FormatWithLine(QStringLiteral("GUpdate"), e) + QLatin1Char('\n');
            if (!server) {
                text += rs->Name() + QLatin1Char('\n');
            }
            MsgBox(text + tail, vbOKOnly);
        } else if (!duplicate) {
            MsgBox(FormatWithLine(QStringLiteral("GUpdate"), e) + QLatin1Char('\n') +
                       (server ? rs->Source() : rs->Name()) + QLatin1Char('\n') + tail,
                   vbOKOnly);
        }
        return e.Number();
    }
}

}  // namespace zv

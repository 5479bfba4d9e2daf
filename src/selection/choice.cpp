#include "selection/choice.h"

#include <QGuiApplication>
#include <QSet>
#include <QSqlRecord>

#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "selection/kind_text.h"
#include "selection/list_window.h"
#include "util/errors.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

QString Text(const QVariant& v) {
    return v.isNull() ? QString() : v.toString();
}

QString Field(const QSqlRecord& row, const char* name) {
    return Text(row.value(QLatin1String(name)));
}

// "first last", trimmed; a Null part counts as empty text.
QString JoinName(const QString& first, const QString& last) {
    return (first + QLatin1Char(' ') + last).trimmed();
}

QString RowName(const QSqlRecord& row) {
    return JoinName(Field(row, "F_NAME"), Field(row, "L_NAME"));
}

QString KindOfRow(const QSqlRecord& row) {
    return KindText(row.value(QStringLiteral("OptKey")), row.value(QStringLiteral("TIK_ID")), true);
}

QString TikIdAsInteger(const QSqlRecord& row) {
    return QString::number(GetIntFromStr(row.value(QStringLiteral("TIK_ID"))));
}

// The labels a row of the name list sets, by its kind. False for a row the dialog cannot
// take: a kind without a folder rule, or kind 17 with a letter of no known kind.
bool MapRow(const QSqlRecord& row, ChoiceLabels& labels) {
    bool isNumber = false;
    const int optKey = row.value(QStringLiteral("OptKey")).toInt(&isNumber);
    if (!isNumber) {
        return false;
    }
    const QString lakNum = Field(row, "LakNum");
    const QString tik = Field(row, "Tik");
    const QString code = Field(row, "Code");
    auto caseOf = [&](const QString& letter, const QString& sugTik) {
        labels.lblSug = letter;
        labels.lakNum = lakNum;
        labels.lTik = tik;
        labels.lTikNum = code;
        labels.lSugTik = sugTik;
    };
    switch (optKey) {
        case 0:
            labels.lblSug = QStringLiteral("F");
            labels.lakNum = lakNum;
            labels.lTikNum = lakNum;
            labels.lSugTik.clear();
            return true;
        case 1:
            caseOf(QStringLiteral("N"), {});
            return true;
        case 2:
            caseOf(QStringLiteral("W"), {});
            return true;
        case 3:
            caseOf(QStringLiteral("G"), {});
            return true;
        case 4:
        case 6:
        case 8:
        case 12:
        case 13:
        case 14:
            caseOf(QStringLiteral("H"), TikIdAsInteger(row));
            return true;
        case 5:
        case 7:
        case 10:
            caseOf(QStringLiteral("L"), {});
            return true;
        case 11:
            caseOf(QStringLiteral("T"), TikIdAsInteger(row));
            labels.lTikNum = tik;
            return true;
        case 17: {
            static const QSet<QString> known{"F", "N", "W", "G", "H", "T", "L"};
            const QString sug = Field(row, "Sug");
            if (!known.contains(sug)) {
                return false;
            }
            caseOf(sug, TikIdAsInteger(row));
            return true;
        }
        default:
            return false;
    }
}

ListVariant NamesWindow() {
    return IsZorva() ? ListVariant::FrmLookForAdo : ListVariant::FrmLookFor;
}

}  // namespace

bool ChooseClient(ChoiceLabels& labels) {
    ListWindow window(IsOffice() ? ListVariant::FrmLakAdo : ListVariant::FrmLak);
    ShowModal(window);
    if (window.IsCancel() || !window.HasCurrentRow()) {
        return false;
    }
    const auto row = window.CurrentRecord();
    labels.lakNum = Field(row, "NUM");
    labels.lblSug = QStringLiteral("F");
    labels.lakName = RowName(row);
    labels.lSugTik.clear();
    labels.lTik.clear();
    labels.lTikNum.clear();
    labels.lTeurSugTik.clear();
    labels.lTeurTik.clear();
    return true;
}

bool ChooseClientCase(ChoiceLabels& labels) {
    if (labels.lakNum.isEmpty()) {
        MsgBox(QStringLiteral("יש להגדיר תחילה לקוח, לפני פתיחת רשימת תיקי לקוח"), vbExclamation);
        return false;
    }
    ListWindow window(NamesWindow());
    window.SetClientNum(labels.lakNum);
    ShowModal(window);
    if (window.IsCancel()) {
        return false;
    }
    if (window.HasCurrentRow()) {
        const auto row = window.CurrentRecord();
        labels.lblSug = Field(row, "Sug");
        labels.lSugTik = Field(row, "TIK_ID");
        labels.lTik = Field(row, "Tik");
        labels.lTikNum = Field(row, "Code");
        Step(
            [](const VbError& e) {
                return QStringLiteral("0-") + QString::number(e.Number()) + QStringLiteral(" - ") +
                       e.Description();
            },
            [&] { labels.lTeurSugTik = KindOfRow(row); });
        labels.lTeurTik = RowName(row);
    }
    DoEvents();
    while (QGuiApplication::overrideCursor()) {
        QGuiApplication::restoreOverrideCursor();
    }
    // The folder view follows even when no row was taken.
    return true;
}

bool ChooseCaseByName(ChoiceLabels& labels) {
    ListWindow window(NamesWindow());
    ShowModal(window);
    if (window.IsCancel() || !window.HasCurrentRow()) {
        return false;
    }
    const auto row = window.CurrentRecord();
    ChoiceLabels chosen = labels;
    // A row that cannot be taken changes nothing, rather than a client number without its
    // name and folder.
    if (!MapRow(row, chosen)) {
        return false;
    }
    chosen.lakName = GetClientTeur(chosen.lakNum);
    Step(
        [](const VbError& e) {
            return QStringLiteral("0-") + QString::number(e.Number()) + QStringLiteral("--") +
                   e.Description();
        },
        [&] { chosen.lTeurSugTik = KindOfRow(row); });
    chosen.lTeurTik = RowName(row);
    labels = chosen;
    return true;
}

QString GetClientTeur(const QVariant& num) {
    const QString number = Text(num);
    QString name = number;
    Step(
        [](const VbError& e) {
            return QString::number(e.Number()) + QStringLiteral(" -GetClientTeur- ") +
                   e.Description();
        },
        [&] {
            auto db = Database::Open(QStringLiteral("OFFICE"), IsOffice());
            // The number is quoted like any other value, so an apostrophe cannot break the query.
            auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [CLIENT] WHERE [NUM]='") +
                                            FixQuote(number) + QStringLiteral("'"),
                                        dbOpenSnapshot);
            if (rs->RecordCount() > 0) {
                name = JoinName(Text(rs->Value(QStringLiteral("F_NAME"))).trimmed(),
                                Text(rs->Value(QStringLiteral("L_NAME"))).trimmed());
            }
            GClose(rs);
            GClose(db);
        });
    return name;
}

}  // namespace zv

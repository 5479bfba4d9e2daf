#include "dialog_script.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QTest>

#include "dialogs/frm_save_as.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "selection/list_model.h"
#include "selection/list_window.h"

namespace zv::test {
namespace {

template <class T>
T& Child(QWidget& w, const char* name) {
    T* child = w.findChild<T*>(QLatin1String(name));
    if (!child) {
        qFatal("no control %s", name);
    }
    return *child;
}

// In the list window: searches for text, makes the first row whose field equals value the
// current one and chooses it.
void ChooseRow(ListWindow& w, const QString& text, const char* field, const QString& value) {
    if (!text.isEmpty()) {
        auto& box = Child<QLineEdit>(w, "txtSearch");
        box.setText(text);
        QTest::keyClick(&box, Qt::Key_Return);
    }
    ListModel& model = w.Model();
    while (model.canFetchMore({})) {
        model.fetchMore({});
    }
    for (int i = 0; i < model.rowCount(); ++i) {
        if (model.Record(i).value(QLatin1String(field)).toString() == value) {
            Child<QTableView>(w, "TDBGrid1").setCurrentIndex(model.index(i, 0));
            Child<QPushButton>(w, "CmdOK").click();
            return;
        }
    }
    QFAIL(qPrintable(QStringLiteral("no row with %1 = %2").arg(QLatin1String(field), value)));
}

// The list window's script: the first row whose field equals value is chosen.
void QueueChoice(ScriptedUi& ui, const QString& text, const char* field, const QString& value) {
    ui.QueueModal(
        [=](QWidget& window) { ChooseRow(dynamic_cast<ListWindow&>(window), text, field, value); });
}

}  // namespace

void QueueFilingDialog(ScriptedUi& ui, const DialogInput& input,
                       const std::function<void(FrmGetDocDet&)>& check) {
    ui.QueueModal([input, check](QWidget& window) {
        auto& d = dynamic_cast<FrmGetDocDet&>(window);
        if (check) {
            check(d);
        }
        if (!input.confirm) {
            d.close();
            return;
        }
        Child<QPushButton>(d, "CmdLak").click();
        if (!input.tik.isEmpty()) {
            Child<QPushButton>(d, "CmdTik").click();
        }
        if (input.name) {
            Child<QLineEdit>(d, "TxtTeur").setText(*input.name);
        }
        Child<QComboBox>(d, "CboTeur").setCurrentText(input.description);
        Child<QLineEdit>(d, "TxtRemark").setText(input.remark);
        if (input.reminder) {
            Child<QCheckBox>(d, "ChkIsMemo").click();
            Child<QLineEdit>(d, "TDBTime1").setText(input.reminderTime);
            if (input.popup) {
                Child<QCheckBox>(d, "ChkIsJumpMemo").click();
            }
        }
        Child<QPushButton>(d, "CmdOK").click();
    });
    // The list windows open from inside the dialog, before any window the request shows
    // after it.
    if (input.confirm) {
        QueueChoice(ui, input.client, "NUM", input.client);
        if (!input.tik.isEmpty()) {
            QueueChoice(ui, {}, "Tik", input.tik);
        }
    }
}

void QueueSaveAs(ScriptedUi& ui, const std::function<void(FrmSaveAs&)>& check,
                 const std::optional<QString>& rename, bool cancel) {
    ui.QueueModal([check, rename, cancel](QWidget& window) {
        auto& s = dynamic_cast<FrmSaveAs&>(window);
        if (check) {
            check(s);
        }
        if (rename) {
            s.TxtName().setText(*rename);
        }
        (cancel ? s.CmdCancel() : s.CmdSave()).click();
    });
}

}  // namespace zv::test

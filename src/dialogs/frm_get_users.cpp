#include "dialogs/frm_get_users.h"

#include <QListWidget>

#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "ui/font_fix.h"
#include "ui_frm_get_users.h"
#include "util/errors.h"
#include "util/state.h"

namespace zv {

FrmGetUsers::FrmGetUsers(QWidget* parent)
    : PickerDialog(parent), ui_(std::make_unique<::Ui::FrmGetUsers>()) {
    ui_->setupUi(this);
    connect(ui_->Command1, &QPushButton::clicked, this, &FrmGetUsers::Confirm);
}

FrmGetUsers::~FrmGetUsers() = default;

QString FrmGetUsers::AllUsersText() {
    return QStringLiteral("כל המשתמשים");
}

QListWidget& FrmGetUsers::List1() const {
    return *ui_->List1;
}
QPushButton& FrmGetUsers::Command1() const {
    return *ui_->Command1;
}

void FrmGetUsers::Load() {
    FixControlsFontOnMe(*this);
    initCbo();
    ui_->List1->setFocus();
}

void FrmGetUsers::initCbo() {
    QListWidget& list = *ui_->List1;
    list.clear();
    auto add = [&list](const QString& text, int itemNumber) {
        auto* item = new QListWidgetItem(text, &list);
        item->setData(Qt::UserRole, itemNumber);
    };
    if (withAllUsers_) {
        add(AllUsersText(), 0);
    }
    std::unique_ptr<Database> db;
    std::unique_ptr<Recordset> rs;
    // A failure leaves the list with the users read so far.
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("initCbo"), e); },
         [&] {
             db = Database::OpenFile(QStringLiteral("\\PUB.MDB"));
             rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [USERS] WHERE [USERCODE] ='") +
                                        FixQuote(UserCode()) +
                                        QStringLiteral("' ORDER BY VAL([ST_NUMBER])"),
                                    dbOpenSnapshot);
             while (!rs->EOF()) {
                 add(rs->Value(QStringLiteral("UserName")).toString().trimmed(),
                     GetIntFromStr(rs->Value(QStringLiteral("ST_NUMBER"))));
                 rs->MoveNext();
             }
         });
    GClose(rs);
    GClose(db);
    list.clearSelection();
    if (startUsers_.isEmpty()) {
        return;
    }
    const QStringList pieces = startUsers_.split(u';');
    for (const QString& piece : pieces) {
        for (int i = 0; i < list.count(); ++i) {
            if (list.item(i)->text() == piece) {
                list.item(i)->setSelected(true);
                break;
            }
        }
    }
}

void FrmGetUsers::Confirm() {
    QStringList chosen;
    const QListWidget& list = *ui_->List1;
    for (int i = 0; i < list.count(); ++i) {
        if (list.item(i)->isSelected()) {
            chosen << list.item(i)->text();
        }
    }
    endUsers_ = chosen.join(u';');
    HideConfirmed();
}

}  // namespace zv

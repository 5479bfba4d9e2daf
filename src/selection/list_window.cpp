#include "selection/list_window.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QGuiApplication>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QScreen>
#include <QStyledItemDelegate>
#include <QTableView>
#include <QVBoxLayout>

#include "data/connection_string.h"
#include "data/database.h"
#include "selection/kind_text.h"
#include "selection/list_model.h"
#include "ui/font_fix.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/keyboard_layout.h"
#include "util/settings_store.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

// The row style of the current row: green, red text, 10 points; the caption bar yellow.
const QColor kRowBack(0, 255, 0);
const QColor kRowText(255, 0, 0);
const QColor kCaptionBack(255, 255, 0);
constexpr int kRowFontSize = 10;

class RowStyleDelegate : public QStyledItemDelegate {
  public:
    using QStyledItemDelegate::QStyledItemDelegate;
    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
        QStyledItemDelegate::initStyleOption(option, index);
        if (option->state & QStyle::State_Selected) {
            option->font.setPointSize(kRowFontSize);
        }
    }
};

struct Traits {
    bool names;
    bool server;
    const char* caption;
};

Traits TraitsOf(ListVariant v) {
    switch (v) {
        case ListVariant::FrmLak:
            return {false, false, "חיפוש לקוח"};
        case ListVariant::FrmLakAdo:
            return {false, true, "חיפוש לקוח"};
        case ListVariant::FrmLookFor:
            return {true, false, "קביעת לקוח / תיק לתיוק"};
        case ListVariant::FrmLookForAdo:
            return {true, true, "קביעת לקוח/תיק לתיוק"};
    }
    return {false, false, ""};
}

QString LoadFailure(const VbError& e) {
    return QString::number(e.Number()) + QStringLiteral("--") + e.Description();
}

QPushButton* MakeButton(QWidget* parent, const char* name, const QString& text) {
    auto* b = new QPushButton(text, parent);
    b->setObjectName(QLatin1String(name));
    b->setAutoDefault(false);
    return b;
}

}  // namespace

QString ListWindow::FormName(ListVariant variant) {
    switch (variant) {
        case ListVariant::FrmLak:
            return QStringLiteral("FrmLak");
        case ListVariant::FrmLakAdo:
            return QStringLiteral("FrmLakAdo");
        case ListVariant::FrmLookFor:
            return QStringLiteral("FrmLookFor");
        case ListVariant::FrmLookForAdo:
            return QStringLiteral("FrmLookForAdo");
    }
    return {};
}

ListWindow::ListWindow(ListVariant variant, QWidget* parent)
    : QWidget(parent, Qt::Window), variant_(variant), model_(new ListModel(this)) {
    setObjectName(FormName(variant));
    setWindowTitle(QString::fromUtf8(TraitsOf(variant).caption));
    setLayoutDirection(Qt::RightToLeft);
    setWindowModality(Qt::ApplicationModal);
    BuildControls();
    if (IsNames()) {
        const bool byTikId = variant == ListVariant::FrmLookFor;
        model_->SetFormatter([byTikId](const QSqlRecord& row, const GridColumn& column) {
            if (column.field.compare(QLatin1String("OPTKEY"), Qt::CaseInsensitive) != 0) {
                return QString();
            }
            try {
                return KindText(row.value(QStringLiteral("OptKey")),
                                row.value(QStringLiteral("TIK_ID")), byTikId);
            } catch (const VbError&) {
                // Shown as stored: a message box here would come back with every repaint.
                return QString();
            }
        });
    }
    // The design size (twips / 15), centred on the screen.
    resize(IsNames() ? QSize(733, 427) : QSize(640, 427));
    if (const auto* screen = QGuiApplication::primaryScreen()) {
        move(screen->availableGeometry().center() - rect().center());
    }
}

ListWindow::~ListWindow() {
    // The open query reads through the connection, so it goes first.
    model_->Clear();
}

bool ListWindow::IsNames() const {
    return TraitsOf(variant_).names;
}

bool ListWindow::IsServer() const {
    return TraitsOf(variant_).server;
}

void ListWindow::BuildControls() {
    txtSearch_ = new QLineEdit(this);
    txtSearch_->setObjectName(QStringLiteral("txtSearch"));
    txtSearch_->installEventFilter(this);
    cmdSearch_ = MakeButton(this, "cmdSearch", QStringLiteral("בצע חיפוש"));

    auto* searchRow = new QHBoxLayout;
    searchRow->addWidget(txtSearch_, 1);
    searchRow->addWidget(cmdSearch_);
    if (IsNames()) {
        check1_ = new QCheckBox(QStringLiteral("תוצאות החיפוש רק ממאגר לקוחות ותיקים"), this);
        check1_->setObjectName(QStringLiteral("Check1"));
        searchRow->addWidget(check1_);
        connect(check1_, &QCheckBox::clicked, this, [this] {
            SaveSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                        QStringLiteral("AddInOnLakTik"),
                        check1_->isChecked() ? QStringLiteral("1") : QStringLiteral("0"));
        });
    }

    gridCaption_ = new QLabel(this);
    gridCaption_->setObjectName(QStringLiteral("TDBGrid1Caption"));
    gridCaption_->setAlignment(Qt::AlignCenter);
    gridCaption_->setAutoFillBackground(true);

    grid_ = new QTableView(this);
    grid_->setObjectName(QStringLiteral("TDBGrid1"));
    grid_->setModel(model_);
    grid_->setItemDelegate(new RowStyleDelegate(grid_));
    grid_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    grid_->setSelectionBehavior(QAbstractItemView::SelectRows);
    // The file variant marks exactly the current row; the server variant marks nothing.
    grid_->setSelectionMode(IsServer() ? QAbstractItemView::NoSelection
                                       : QAbstractItemView::SingleSelection);
    grid_->verticalHeader()->setVisible(false);

    counter_ = new QLabel(this);
    counter_->setObjectName(IsServer() ? QStringLiteral("AdoData") : QStringLiteral("Data1"));
    counter_->setFrameShape(QFrame::Panel);

    cmdOK_ = MakeButton(this, "CmdOK", QStringLiteral("בחר וסגור"));
    command1_ = MakeButton(this, "Command1", QStringLiteral("שמור מבנה נוכחי"));
    cmdReset_ = MakeButton(this, "CmdReset", QStringLiteral("אתחל מבנה נוכחי"));
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(cmdOK_);
    if (IsNames()) {
        cmdAct_ = MakeButton(this, "CmdAct", QStringLiteral("הצב את התיק המסומן"));
        cmdAct_->setToolTip(QStringLiteral("בחירת התיק / הלקוח הנוכחי"));
        buttons->addWidget(cmdAct_);
        connect(cmdAct_, &QPushButton::clicked, this, &ListWindow::Choose);
    }
    buttons->addStretch(1);
    buttons->addWidget(command1_);
    buttons->addWidget(cmdReset_);

    label1_ =
        new QLabel(QStringLiteral("הקשה כפולה על השורה הרלוונטית בוחרת את הלקוח הרצוי"), this);
    label1_->setObjectName(QStringLiteral("Label1"));

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(searchRow);
    layout->addWidget(gridCaption_);
    layout->addWidget(grid_, 1);
    layout->addWidget(counter_);
    layout->addLayout(buttons);
    layout->addWidget(label1_);

    connect(txtSearch_, &QLineEdit::returnPressed, this, &ListWindow::DoSearch);
    connect(cmdSearch_, &QPushButton::clicked, this, &ListWindow::DoSearch);
    connect(cmdOK_, &QPushButton::clicked, this, &ListWindow::Choose);
    connect(grid_, &QTableView::doubleClicked, this, &ListWindow::Choose);
    connect(command1_, &QPushButton::clicked, this, &ListWindow::SaveCurrentLayout);
    connect(cmdReset_, &QPushButton::clicked, this, &ListWindow::ResetLayout);
    connect(grid_->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            &ListWindow::UpdateCounter);
}

void ListWindow::showEvent(QShowEvent* event) {
    QWidget::showEvent(event);
    if (!loaded_) {
        loaded_ = true;
        Load();
    }
}

void ListWindow::Load() {
    isCancel_ = false;
    FixControlsFontOnMe(*this);
    const QString folder = MainPath() + QStringLiteral("\\MGRX\\") + MyUser();
    layoutFile_ = DiskPath(
        folder + (IsNames() ? QStringLiteral("\\AddInLF.grx") : QStringLiteral("\\AddInLak.grx")));
    BuildDirTree(folder);
    SetGridStruct(false);

    Step(LoadFailure, [this] {
        const QString name = IsNames() ? QStringLiteral("ZORVA") : QStringLiteral("OFFICE");
        db_ = IsServer() ? Database::OpenConnectionString(GetConnectionByDbName(name))
                         : Database::OpenFile(QStringLiteral("\\") + name + QStringLiteral(".MDB"));
        model_->SetQuery(*db_, IsNames() ? NamesOpenQuery(IsServer(), clientNum_)
                                         : ClientListQuery(IsServer(), {}));
    });
    if (check1_) {
        check1_->setChecked(GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                                       QStringLiteral("AddInOnLakTik")) == QLatin1String("1"));
    }
    ShowFirstRow();
}

void ListWindow::DoSearch() {
    Step([](const VbError& e) { return FormatPlain(QStringLiteral("DoSearch"), e); },
         [this] {
             if (!db_) {
                 throw MakeError(err::ObjectRequired);
             }
             const QString text = txtSearch_->text();
             model_->SetQuery(*db_, IsNames() ? NamesSearchQuery(IsServer(), clientNum_, text)
                                              : ClientListQuery(IsServer(), text));
         });
    ShowFirstRow();
}

void ListWindow::ShowFirstRow() {
    if (model_->rowCount() > 0) {
        int column = 0;
        while (column < model_->columnCount() - 1 && grid_->isColumnHidden(column)) {
            ++column;
        }
        grid_->setCurrentIndex(model_->index(0, column));
    }
    UpdateCounter();
}

void ListWindow::UpdateCounter() {
    const QLocale grouped(QLocale::English, QLocale::UnitedStates);
    counter_->setText(QStringLiteral("רשומה מס' ") + QString::number(AbsolutePosition() + 1) +
                      QStringLiteral(" מתוך  ") + grouped.toString(model_->TotalCount()));
}

bool ListWindow::HasCurrentRow() const {
    return model_->TotalCount() > 0 && AbsolutePosition() > -1;
}

int ListWindow::AbsolutePosition() const {
    const auto current = grid_->currentIndex();
    return current.isValid() ? current.row() : -1;
}

long long ListWindow::RecordCount() const {
    return model_->TotalCount();
}

QSqlRecord ListWindow::CurrentRecord() const {
    return HasCurrentRow() ? model_->Record(AbsolutePosition()) : QSqlRecord();
}

void ListWindow::Choose() {
    hide();
}

void ListWindow::closeEvent(QCloseEvent* event) {
    isCancel_ = true;
    event->accept();
}

bool ListWindow::eventFilter(QObject* watched, QEvent* event) {
    if (watched == txtSearch_ && event->type() == QEvent::FocusIn) {
        SetKbHebrew(true);
    }
    return QWidget::eventFilter(watched, event);
}

void ListWindow::SetGridStruct(bool isReset) {
    const QString tag = IsNames() ? QStringLiteral("SetGridStruct") : QStringLiteral("GetTeurTik");
    GridColumns columns = IsNames() ? NamesColumns() : ClientColumns();
    if (!isReset && IsFileExist(layoutFile_)) {
        Step([&tag](const VbError& e) { return FormatPlain(tag, e); },
             [&] { columns = LoadLayout(layoutFile_, BasicLayoutName()); });
    }
    ApplyColumns(columns);

    gridCaption_->setText(IsNames() ? QStringLiteral("רשימת השמות במערכת")
                                    : QStringLiteral("רשימת הלקוחות במערכת"));
    auto palette = grid_->palette();
    for (auto group : {QPalette::Active, QPalette::Inactive}) {
        palette.setColor(group, QPalette::Highlight, kRowBack);
        palette.setColor(group, QPalette::HighlightedText, kRowText);
    }
    grid_->setPalette(palette);
    // Rows as high as the current row's larger font needs.
    QFont rowFont = grid_->font();
    rowFont.setPointSize(kRowFontSize);
    grid_->verticalHeader()->setDefaultSectionSize(QFontMetrics(rowFont).height() + 6);
    auto captionPalette = gridCaption_->palette();
    captionPalette.setColor(QPalette::Window, kCaptionBack);
    gridCaption_->setPalette(captionPalette);
    grid_->horizontalHeader()->setSectionsMovable(true);
}

void ListWindow::ApplyColumns(const GridColumns& columns) {
    model_->SetColumns(columns);
    auto* header = grid_->horizontalHeader();
    for (int i = 0; i < static_cast<int>(columns.size()); ++i) {
        header->moveSection(header->visualIndex(i), i);
        grid_->setColumnHidden(i, !columns[static_cast<size_t>(i)].visible);
        grid_->setColumnWidth(i, columns[static_cast<size_t>(i)].width);
    }
}

GridColumns ListWindow::ShownColumns() const {
    const auto* header = grid_->horizontalHeader();
    GridColumns shown;
    for (int visual = 0; visual < header->count(); ++visual) {
        const int logical = header->logicalIndex(visual);
        GridColumn column = model_->Columns().at(static_cast<size_t>(logical));
        column.visible = !header->isSectionHidden(logical);
        if (column.visible) {
            column.width = header->sectionSize(logical);
        }
        shown.push_back(column);
    }
    return shown;
}

void ListWindow::SaveCurrentLayout() {
    Step([](const VbError& e) { return FormatPlain(QStringLiteral("Command1_Click"), e); },
         [this] { SaveLayout(layoutFile_, BasicLayoutName(), ShownColumns()); });
}

void ListWindow::ResetLayout() {
    IsFileExist(layoutFile_, true);
    SetGridStruct(true);
}

}  // namespace zv

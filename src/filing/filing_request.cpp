#include "filing/filing_request.h"

#include <QDir>
#include <QDirIterator>
#include <QStringList>
#include <memory>

#include "archive/docs_row.h"
#include "filing/clean_file_name.h"
#include "filing/file_transfer.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

const QString kCrLf = QStringLiteral("\r\n");

qsizetype LastSeparator(const QString& path) {
    return std::max(path.lastIndexOf(QLatin1Char('\\')), path.lastIndexOf(QLatin1Char('/')));
}

// The folder part of the target, with its trailing separator.
QString FolderOf(const QString& fileNameToSave) {
    QString dir = fileNameToSave.left(LastSeparator(fileNameToSave) + 1);
    if (!dir.endsWith(QLatin1Char('\\')) && !dir.endsWith(QLatin1Char('/'))) {
        dir += QDir::separator();
    }
    return dir;
}

// The file that holds the target's name: the target itself, or else one whose name differs
// from it only in case, which the suite's tables and its other file systems take for the same
// file. Empty when there is none.
QString ExistingFile(const QString& target) {
    if (IsFileExist(target)) {
        return target;
    }
    const qsizetype cut = LastSeparator(target) + 1;
    const QString name = target.mid(cut);
    QDirIterator it(DiskPath(target.left(cut)), QDir::Files | QDir::Hidden | QDir::System);
    while (it.hasNext()) {
        it.next();
        if (it.fileName().compare(name, Qt::CaseInsensitive) == 0) {
            return target.left(cut) + it.fileName();
        }
    }
    return {};
}

// A mail keeps its source's own extension: "name.msg" from an .eml file is "name.msg.eml".
QString MailExtensionRule(const QString& target) {
    const qsizetype dot = target.lastIndexOf(QLatin1Char('.'));
    if (dot < 0 || SourceExt().isEmpty() ||
        target.mid(dot + 1).compare(SourceExt(), Qt::CaseInsensitive) == 0) {
        return target;
    }
    return target + QLatin1Char('.') + SourceExt();
}

// While it lives, messages are held instead of shown; windows and events go on as before.
// A recording that fails then tells the user once, with the reasons it was given.
class HeldMessages {
  public:
    struct Message {
        QString text;
        int style;
        QString title;
    };

    HeldMessages() { previous_ = SetUi(std::make_unique<Holder>(*this)); }
    ~HeldMessages() {
        if (previous_) {
            SetUi(std::move(previous_));
        }
    }
    HeldMessages(const HeldMessages&) = delete;
    HeldMessages& operator=(const HeldMessages&) = delete;

    // Ends the hold and returns what was held.
    std::vector<Message> Release() {
        SetUi(std::move(previous_));
        return std::move(held_);
    }

  private:
    class Holder : public Ui {
      public:
        explicit Holder(HeldMessages& hold) : hold_(hold) {}
        int MsgBox(const QString& text, int style, const QString& title) override {
            hold_.held_.push_back({text, style, title});
            return DefaultAnswer(style);
        }
        void ShowModal(QWidget& window) override { hold_.previous_->ShowModal(window); }
        void DoEvents() override { hold_.previous_->DoEvents(); }

      private:
        HeldMessages& hold_;
    };

    std::unique_ptr<Ui> previous_;
    std::vector<Message> held_;
};

// One request in progress; each step that fails ends it unless this is a development run.
class Filing {
  public:
    Filing(int mode, const QString& path, const QString& name, const FilingAnswer& answer,
           const ClashResolver& resolve)
        : mode_(mode), path_(path), name_(name), answer_(answer), resolve_(resolve) {}

    QString Run();

  private:
    bool Do(const std::function<void()>& step);
    bool ResolveClash(const QString& proposed);
    bool Copy();
    QString Record();

    int mode_;
    const QString& path_;
    const QString& name_;
    const FilingAnswer& answer_;
    const ClashResolver& resolve_;
    QString dir_;
    QString target_;
    bool replaced_ = false;  // the copy took the place of an existing file
    bool inPlace_ = false;   // the source is the target itself: nothing to copy or delete
};

bool Filing::Do(const std::function<void()>& step) {
    try {
        step();
        return true;
    } catch (const VbError& e) {
        MsgBox(FilingFailureText(e, mode_, path_, name_));
    } catch (const std::exception& e) {
        MsgBox(FilingFailureText(AsVbError(e), mode_, path_, name_));
    }
    return IsDevelopmentRun();
}

// While the target exists, asks for another name; the name proposed again (or the same
// target) replaces the file. A new name that clashes too is asked about in turn, so no
// file is replaced that the user was not shown.
bool Filing::ResolveClash(const QString& proposed) {
    const bool document = mode_ == 1;
    QString shown = proposed;
    for (QString existing = ExistingFile(target_); !existing.isEmpty();
         existing = ExistingFile(target_)) {
        const std::optional<QString> chosen = resolve_(Clash{existing, shown, dir_, document});
        if (!chosen) {
            return false;
        }
        const QString next = document ? *chosen : MailExtensionRule(*chosen);
        if (next.compare(existing, Qt::CaseInsensitive) == 0) {
            // Replaced under its own name: no second file beside it, one row for both.
            target_ = existing;
            break;
        }
        target_ = next;
        shown = *chosen;
    }
    return true;
}

bool Filing::Copy() {
    inPlace_ = IsSameFile(path_, target_);
    if (inPlace_) {
        return true;
    }
    replaced_ = IsFileExist(target_);
    // A failed copy over an existing file leaves that file there: it is not the document.
    bool copied = false;
    if (!Do([&] {
            CopyFileOver(path_, target_);
            copied = true;
        })) {
        return false;
    }
    DoEvents();
    return copied && IsFileExist(target_);
}

QString Filing::Record() {
    HeldMessages hold;
    const bool saved = AddDocToListByAddIn(target_, &answer_.details);
    const std::vector<HeldMessages::Message> held = hold.Release();
    if (!saved) {
        // Nothing is left in the archive without its row, but a file that was replaced is
        // not removed: its own row may still describe it.
        if (!inPlace_ && !replaced_) {
            Do([&] { RemoveFile(target_); });
        }
        // One message: what happened to the document, then why.
        QString text =
            QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :") + kCrLf + path_;
        for (const HeldMessages::Message& m : held) {
            text += kCrLf + kCrLf + m.text;
        }
        MsgBox(text, vbOKOnly | vbCritical);
        return {};
    }
    for (const HeldMessages::Message& m : held) {
        MsgBox(m.text, m.style, m.title);
    }
    QString sourceLeft;
    if (!inPlace_) {
        try {
            RemoveFile(path_);
        } catch (const VbError& e) {
            sourceLeft = e.Description();
        }
    }
    if (IsDevelopmentRun()) {
        MsgBox(QStringLiteral("הקובץ נשמר לכתובת : ") + kCrLf + target_, vbOKOnly | vbInformation);
    } else {
        MsgBox(QStringLiteral("הקובץ נשמר לכתובת המבוקשת"), vbOKOnly | vbInformation);
    }
    if (!sourceLeft.isEmpty()) {
        MsgBox(QStringLiteral("לא ניתן היה למחוק את קובץ המקור, והוא נשאר במקומו :") + kCrLf +
                   path_ + kCrLf + sourceLeft,
               vbOKOnly | vbExclamation);
    }
    return target_;
}

QString Filing::Run() {
    if (!Do([&] {
            dir_ = FolderOf(answer_.fileNameToSave);
            BuildDirTree(dir_);
        })) {
        return {};
    }
    if (mode_ == 1) {
        target_ = answer_.fileNameToSave;
        if (!SourceExt().isEmpty()) {
            target_ += QLatin1Char('.') + SourceExt();
        }
        if (!ResolveClash(target_)) {
            return {};
        }
    } else if (mode_ == 2) {
        // Both names are cleaned: the typed one must not lead out of the folder either.
        const QString n = CleanFileName(name_);
        const QString d = CleanFileName(answer_.nameText);
        const QString base = !d.trimmed().isEmpty() && d.compare(n, Qt::CaseInsensitive) != 0
                                 ? d.trimmed()
                                 : n.trimmed();
        const QString proposed = dir_ + base + QStringLiteral(".msg");
        // The clash is looked for under the name the file will have.
        target_ = MailExtensionRule(proposed);
        if (!ResolveClash(proposed)) {
            return {};
        }
    } else {
        return {};
    }
    if (!Copy()) {
        return {};
    }
    return Record();
}

}  // namespace

QString ExtensionOf(const QString& path) {
    const QString fileName = path.mid(LastSeparator(path) + 1);
    const qsizetype dot = fileName.lastIndexOf(QLatin1Char('.'));
    return dot < 0 ? QString() : fileName.mid(dot + 1);
}

QString FileDocument(int mode, const QString& path, const QString& name, const FilingAnswer& answer,
                     const ClashResolver& resolve) {
    return Filing(mode, path, name, answer, resolve).Run();
}

QString FilingFailureText(const VbError& e, int mode, const QString& path, const QString& name) {
    return FormatWithLine(QStringLiteral("WorkWithStr"), e) + kCrLf + e.Source() + kCrLf +
           QString::number(mode) + kCrLf + path + kCrLf + name;
}

}  // namespace zv

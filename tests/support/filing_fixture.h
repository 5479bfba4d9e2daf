#pragma once
// One filing test on a fresh sample installation of its own: the scripted Ui, a source
// document in an inbox folder outside the installation, the requests run in process
// through Main (the windows filled by scripts, as a user fills them) or as real
// zorvane-filer processes, and the rows read back with SQL.

#include <QDate>
#include <QList>
#include <QProcessEnvironment>
#include <QString>
#include <QStringList>
#include <QVariantMap>
#include <functional>
#include <optional>

#include "scripted_ui.h"
#include "table_rows.h"
#include "test_env.h"

namespace zv {
class FrmGetDocDet;
}  // namespace zv

namespace zv::test {

struct ProcessResult {
    int status = -1;  // exit status; -2 when the process crashed or timed out
    QString out;
    QString err;
};

class FilingFixture {
  public:
    // server: the installation's four server databases on the pg fixture's cluster.
    explicit FilingFixture(bool server = false) : FilingFixture(server, server) {}
    // The documents and the reminders each on the server or in a file database.
    FilingFixture(bool docsOnServer, bool bmOnServer);
    ~FilingFixture();
    FilingFixture(const FilingFixture&) = delete;
    FilingFixture& operator=(const FilingFixture&) = delete;

    // A source document in the inbox, holding content.
    QString Source(const QString& fileName, const QByteArray& content = "document") const;
    // A file below MainPath/DOCS ("DOC1001/x.pdf"), folders created.
    QString ArchiveFile(const QString& relPath, const QByteArray& content = "document") const;
    QString Docs() const { return env_.DataDir() + QStringLiteral("/DOCS"); }
    QString DataDir() const { return env_.DataDir(); }

    // The request text "mode¥path¥name".
    static QString Request(int mode, const QString& path, const QString& name);
    // Runs the request through Main with the dialog, as the program does without --batch;
    // returns the archived path.
    QString RunWithDialog(int mode, const QString& path, const QString& name);
    // Runs the built program with --batch, these options and the request.
    ProcessResult RunBatch(const QStringList& options, int mode, const QString& path,
                           const QString& name) const;
    // The environment of a program started on this installation.
    QProcessEnvironment Environment() const { return env_.ProgramEnvironment(); }

    // The DOCS rows, by FULLNAME.
    static QList<QVariantMap> DocsRows();
    // What a filing that did not complete must leave as it was: every file below MainPath
    // (documents with their size), then the number of DOCS and UMEMO rows.
    QStringList State() const;

    ScriptedUi& Ui() { return *ui_; }
    // The moment the in-process clock shows.
    static QDateTime Moment() { return QDateTime(QDate(2026, 3, 17), QTime(14, 5, 30)); }

  private:
    TestEnv env_;
    ScopedScriptedUi ui_;
};

// The FULLNAME stored for a path below DOCS ("DOC1001/x.pdf").
QString FullName(const QString& relPath);
// File content, or a null array when the file cannot be read.
QByteArray Content(const QString& path);
// The names in a folder, hidden ones too.
QStringList FolderEntries(const QString& path);

// Keeps a file from being deleted or a folder from receiving files, also for root; Holds()
// is false when this system cannot. Undone by the destructor.
class Unwritable {
  public:
    explicit Unwritable(const QString& path);
    ~Unwritable();
    bool Holds() const { return holds_; }

  private:
    bool Set(bool on) const;
    QString path_;
    bool holds_ = false;
};

// The filing dialog as a user fills it: the client 1001 chosen through its button and list.
struct DialogInput {
    bool confirm = true;            // false: closed with the close box
    QString tik{};                  // not empty: chosen through the case button and list
    std::optional<QString> name{};  // typed into the name box; none keeps the proposal
    QString description{};
    QString remark{};
    QString reminderTime{};  // not empty: a reminder at that time
    bool popup = false;
};

// Queues the filing dialog's script; check runs on the dialog before anything is changed.
void QueueFilingDialog(ScriptedUi& ui, const DialogInput& input,
                       const std::function<void(FrmGetDocDet&)>& check = {});

}  // namespace zv::test

#pragma once
// One filing test on a fresh sample installation of its own: the scripted Ui, a source
// document in an inbox folder outside the installation, the requests run in process
// through Main or as real zorvane-filer processes, and the rows read back with SQL.

#include <QDate>
#include <QList>
#include <QString>
#include <QStringList>
#include <QVariantMap>

#include "scripted_ui.h"
#include "table_rows.h"
#include "test_env.h"

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
    QString Docs() const;
    QString DataDir() const { return env_.DataDir(); }

    // The request text "mode¥path¥name".
    static QString Request(int mode, const QString& path, const QString& name);
    // Runs the request through Main with the dialog, as the program does without --batch;
    // returns the archived path.
    QString RunWithDialog(int mode, const QString& path, const QString& name);
    // Runs the built program with these arguments.
    ProcessResult RunProgram(const QStringList& args) const;

    // The DOCS rows, by FULLNAME.
    static QList<QVariantMap> DocsRows();
    // A statement on the file database MainPath/NAME.MDB.
    void ExecFile(const QString& database, const QString& sql) const;

    ScriptedUi& Ui() { return *ui_; }
    // The moment the in-process clock shows.
    static QDateTime Moment();

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

// Keeps a file or folder from being changed (a file from being deleted, a folder from
// receiving files), also for root; false when this system cannot. Undone by the destructor.
class Unwritable {
  public:
    explicit Unwritable(const QString& path);
    ~Unwritable();
    bool Holds() const { return holds_; }

  private:
    QString path_;
    bool holds_ = false;
    bool byFlag_ = false;
};

}  // namespace zv::test

#pragma once
// One filing dialog on a fresh sample installation of its own, with the scripted Ui.

#include <QApplication>
#include <QTest>
#include <memory>

#include "data/database.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "sample_install/sample_install.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/clock.h"
#include "util/state.h"

namespace zv::test {

class DialogFixture {
  public:
    explicit DialogFixture(const SampleOptions& options = {}) {
        CreateSampleInstallation(env_.DataDir(), options);
        SetClock([] { return QDateTime(QDate(2026, 3, 17), QTime(14, 5, 30)); });
    }
    ~DialogFixture() {
        dialog_.reset();
        SetClock({});
    }

    // Runs a statement on one of the installation's file databases.
    void Exec(const QString& database, const QString& sql) {
        SetMainPath(env_.DataDir());
        Database::Open(database, false)->Execute(sql);
    }

    // A new dialog with the caller's presets applied, loaded.
    FrmGetDocDet& Load(const std::function<void(FrmGetDocDet&)>& preset = {}) {
        dialog_ = std::make_unique<FrmGetDocDet>();
        dialog_->SetDefultName(QStringLiteral("מכתב ללקוח"));
        if (preset) {
            preset(*dialog_);
        }
        dialog_->Load();
        return *dialog_;
    }

    // A control of the dialog by name; the date boxes' own today buttons are not the dialog's.
    template <class T>
    T& Child(const char* name) {
        for (T* w : dialog_->findChildren<T*>(QLatin1String(name))) {
            if (!w->parent()->inherits("zv::GDate")) {
                return *w;
            }
        }
        qFatal("no control %s", name);
    }

    ScriptedUi& Ui() { return *ui_; }
    QString DataDir() const { return env_.DataDir(); }
    QString Docs() const { return env_.DataDir() + QStringLiteral("/DOCS"); }
    QString Root() const { return env_.Root(); }

  private:
    TestEnv env_;
    ScopedScriptedUi ui_;
    std::unique_ptr<FrmGetDocDet> dialog_;
};

}  // namespace zv::test

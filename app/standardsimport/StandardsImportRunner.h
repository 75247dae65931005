#pragma once

#include "app/standardsimport/StandardsImport.h"

#include <QObject>
#include <QPointer>
#include <QProgressDialog>
#include <QString>

#include <functional>
#include <memory>
#include <optional>

class QTimer;
class QWidget;

namespace vemi {

class AddObjectSet;
class MarloModel;

// Imports one CGATS file into the store without blocking the window: the file
// is read and its samples converted on a worker thread while a progress dialog
// shows how far it got, and the store writes the library and its standards
// in one command. Cancelling is possible until the write starts.
class StandardsImportRunner : public QObject
{
    Q_OBJECT

public:
    // Asked when the file names no illuminant and observer; returns the
    // condition to use, nothing when the user cancels. Runs on the GUI thread.
    using ConditionAsker =
        std::function<std::optional<StandardsImport::Condition>(QWidget* parent, const StandardsImport& file)>;

    // window: the parent of the dialogs; the store must outlive the runner.
    StandardsImportRunner(MarloModel& store, QWidget* window);
    ~StandardsImportRunner() override;

    void setConditionAsker(ConditionAsker asker) { m_asker = std::move(asker); }
    // A dialog that offers the conditions, the suggestion chosen.
    static std::optional<StandardsImport::Condition> askWithDialog(QWidget* parent, const StandardsImport& file);

    // False, and nothing started, while another import runs.
    bool start(const QString& path, const QString& folderName);
    bool isRunning() const { return m_shared != nullptr; }
    QProgressDialog* progressDialog() const { return m_progress; }

signals:
    // Once per start(): what was imported, or why nothing was.
    void finished(bool imported, const QString& message);

private:
    struct Shared;

    void onRead(std::shared_ptr<StandardsImport> file, const QString& error);
    void onBuilt(std::shared_ptr<AddObjectSet> set, const QString& error);
    void showProgress(const QString& label, int maximum, bool cancellable);
    void finish(bool imported, const QString& message);

    MarloModel& m_store;
    QPointer<QWidget> m_window;
    ConditionAsker m_asker;
    QString m_folderName;
    std::shared_ptr<StandardsImport> m_file;
    std::shared_ptr<Shared> m_shared; // set while an import runs; shared with its worker
    QPointer<QProgressDialog> m_progress;
    QTimer* m_poll;
};

} // namespace vemi

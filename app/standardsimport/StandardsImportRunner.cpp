#include "app/standardsimport/StandardsImportRunner.h"

#include "app/standardsimport/StandardsImport.h"
#include "host/store/AddObjectSet.h"
#include "host/store/CommandSender.h"
#include "host/store/ErrorInfo.h"

#include <QFileInfo>
#include <QFutureWatcher>
#include <QInputDialog>
#include <QProgressDialog>
#include <QTimer>
#include <QtConcurrent>

#include <atomic>

namespace vemi {

// What the worker and the GUI share: it outlives the runner when the window
// closes while the worker still runs.
struct StandardsImportRunner::Shared
{
    std::atomic<int> done{0};
    std::atomic<bool> cancelled{false};
};

namespace {

template <class Result, class Work, class OnDone>
void runInBackground(QObject* context, Work work, OnDone onDone)
{
    auto* watcher = new QFutureWatcher<Result>(context);
    QObject::connect(watcher, &QFutureWatcher<Result>::finished, context, [watcher, onDone]() {
        watcher->deleteLater();
        onDone(watcher->result());
    });
    watcher->setFuture(QtConcurrent::run(work));
}

struct ReadResult
{
    std::shared_ptr<StandardsImport> file;
    QString error;
};

struct BuildResult
{
    std::shared_ptr<AddObjectSet> set;
    QString error;
};

} // namespace

StandardsImportRunner::StandardsImportRunner(MarloModel& store, QWidget* window)
    : QObject(window), m_store(store), m_window(window), m_asker(&StandardsImportRunner::askWithDialog),
      m_poll(new QTimer(this))
{
    m_poll->setInterval(100);
    connect(m_poll, &QTimer::timeout, this, [this]() {
        if (m_progress && m_shared)
            m_progress->setValue(m_shared->done.load());
    });
}

StandardsImportRunner::~StandardsImportRunner()
{
    if (m_shared)
        m_shared->cancelled = true;
}

std::optional<StandardsImport::Condition> StandardsImportRunner::askWithDialog(QWidget* parent, const StandardsImport& file)
{
    const QStringList choices = StandardsImport::conditionChoices();
    const QString suggestion = QString::fromStdString(file.condition().toString());
    const QString question =
        file.isSpectral()
            ? tr("\"%1\" names no %2 to compute Lab from its spectra under.\nCompute Lab under:")
            : tr("\"%1\" names no %2 for its Lab values.\nImport them as:");
    bool accepted = false;
    const QString choice = QInputDialog::getItem(parent, tr("Import Standards"),
                                                 question.arg(file.fileName(), file.missingConditionParts()),
                                                 choices, std::max(0, int(choices.indexOf(suggestion))), false,
                                                 &accepted);
    if (!accepted)
        return std::nullopt;
    return StandardsImport::parseCondition(choice);
}

bool StandardsImportRunner::start(const QString& path, const QString& folderName)
{
    if (isRunning())
        return false;
    m_shared = std::make_shared<Shared>();
    m_folderName = folderName;
    m_file.reset();
    showProgress(tr("Reading %1…").arg(QFileInfo(path).fileName()), 0, true);
    runInBackground<ReadResult>(
        this,
        [path]() {
            ReadResult result;
            result.file = StandardsImport::readFile(path, &result.error);
            return result;
        },
        [this](const ReadResult& result) { onRead(result.file, result.error); });
    return true;
}

void StandardsImportRunner::onRead(std::shared_ptr<StandardsImport> file, const QString& error)
{
    if (m_shared->cancelled)
        return finish(false, tr("The import was cancelled."));
    if (!file)
        return finish(false, error);
    m_file = file;
    StandardsImport::Condition condition = file->condition();
    if (!file->namesCondition()) {
        // The question is modal; no progress dialog may stand in front of it.
        delete m_progress;
        const std::optional<StandardsImport::Condition> chosen = m_asker(m_window, *file);
        if (!chosen)
            return finish(false, tr("The import of \"%1\" was cancelled.").arg(file->fileName()));
        condition = *chosen;
    }
    const int count = int(file->samples().size());
    showProgress(tr("Converting %1 samples of %2…").arg(count).arg(file->fileName()), count, true);
    m_poll->start();
    const std::shared_ptr<Shared> shared = m_shared;
    const QString folderName = m_folderName;
    runInBackground<BuildResult>(
        this,
        [file, condition, folderName, shared]() {
            BuildResult result;
            result.set = file->build(condition, folderName, &result.error, &shared->done, &shared->cancelled);
            return result;
        },
        [this](const BuildResult& result) { onBuilt(result.set, result.error); });
}

void StandardsImportRunner::onBuilt(std::shared_ptr<AddObjectSet> set, const QString& error)
{
    m_poll->stop();
    if (m_shared->cancelled)
        return finish(false, tr("The import was cancelled."));
    if (!set)
        return finish(false, error);
    const int count = int(m_file->samples().size());
    showProgress(tr("Writing %1 standards to the store…").arg(count), 0, false);
    CommandSender::send(
        m_store, std::string(), set, this,
        [this, count](const std::shared_ptr<Response>&) {
            const QString standards = count == 1 ? tr("1 standard") : tr("%1 standards").arg(count);
            QString message = tr("Imported %1 from \"%2\" into the library \"%3\" in the folder \"%4\".")
                                  .arg(standards, m_file->fileName(), m_file->libraryName(), m_folderName);
            for (const QString& note : m_file->notes())
                message += QLatin1Char(' ') + note;
            finish(true, message);
        },
        [this](const std::shared_ptr<ErrorInfo>& error) {
            finish(false, error ? error->message() : tr("The store did not write the standards."));
        });
}

void StandardsImportRunner::showProgress(const QString& label, int maximum, bool cancellable)
{
    if (!m_progress) {
        m_progress = new QProgressDialog(m_window);
        m_progress->setWindowTitle(tr("Import Standards"));
        // Not modal: a modal one would run the event loop inside setValue().
        m_progress->setWindowModality(Qt::NonModal);
        m_progress->setMinimumDuration(300);
        m_progress->setAutoClose(false);
        m_progress->setAutoReset(false);
        const std::shared_ptr<Shared> shared = m_shared;
        connect(m_progress, &QProgressDialog::canceled, this, [shared]() { shared->cancelled = true; });
    }
    m_progress->setLabelText(label);
    m_progress->setRange(0, maximum);
    m_progress->setValue(0);
    if (!cancellable)
        m_progress->setCancelButton(nullptr);
}

void StandardsImportRunner::finish(bool imported, const QString& message)
{
    m_poll->stop();
    delete m_progress;
    m_shared.reset();
    m_file.reset();
    emit finished(imported, message);
}

} // namespace vemi

#include "app/ShellWindow.h"

#include "app/standardsimport/StandardsImport.h"
#include "app/standardsimport/StandardsImportRunner.h"
#include "host/client/AppWidget.h"
#include "host/client/ClientInterface.h"
#include "host/client/CorvoTopBar.h"
#include "host/store/MarloModel.h"
#include "host/widgets/ImageRepository.h"

#include <QCloseEvent>
#include <QFile>
#include <QFileDialog>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QSettings>
#include <QShortcut>
#include <QStackedWidget>
#include <QStatusBar>
#include <QTabWidget>
#include <QToolBar>

namespace vemi {

namespace {

// Where the last imported file was, so that the next import starts there.
const char* const kImportFolderKey = "shell/lastImportFolder";

} // namespace

ShellWindow::ShellWindow(MarloModel& store, const std::vector<PluginCatalog::Client>& clients, QWidget* parent)
    : QMainWindow(parent), m_tabs(new QTabWidget(this)), m_topBars(new QStackedWidget(this)),
      m_importRunner(new StandardsImportRunner(store, this)),
      m_chooseImportFile([](QWidget* parent, const QString& folder, const QString& filter) {
          return QFileDialog::getOpenFileName(parent, tr("Import Standards"), folder, filter);
      })
{
    setWindowTitle(tr("QC Host"));
    m_tabs->setDocumentMode(true);
    setCentralWidget(m_tabs);
    setMenuWidget(menuRow());
    m_importAction->setEnabled(store.isWritable());
    connect(m_importRunner, &StandardsImportRunner::finished, this, &ShellWindow::onImportFinished);
    for (const PluginCatalog::Client& client : clients)
        addClient(store, client.client);
    connect(m_tabs, &QTabWidget::currentChanged, this, &ShellWindow::onCurrentTabChanged);
    // The top bars are not the window's own menu bar, which F10 would open.
    auto* menuKey = new QShortcut(QKeySequence(Qt::Key_F10), this);
    connect(menuKey, &QShortcut::activated, this, &ShellWindow::openFirstMenu);
    onCurrentTabChanged(m_tabs->currentIndex());
}

// The client's top bar, then the shell's own menus.
QWidget* ShellWindow::menuRow()
{
    auto* row = new QWidget(this);
    auto* layout = new QHBoxLayout(row);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(m_topBars);
    auto* shellMenus = new QMenuBar(row);
    shellMenus->setObjectName(QStringLiteral("shellMenuBar"));
    QMenu* tools = shellMenus->addMenu(tr("&Tools"));
    m_importAction = tools->addAction(tr("&Import Standards…"), this, &ShellWindow::importStandards);
    m_importAction->setObjectName(QStringLiteral("importStandardsAction"));
    m_importAction->setStatusTip(tr("Import a colour standards library from a CGATS file"));
    layout->addWidget(shellMenus, 1);
    return row;
}

void ShellWindow::importStandards()
{
    QSettings settings;
    const QString path = m_chooseImportFile(this, settings.value(kImportFolderKey).toString(),
                                            tr("CGATS files (*.txt *.cgats *.it8);;All files (*)"));
    if (path.isEmpty())
        return;
    settings.setValue(kImportFolderKey, QFileInfo(path).absolutePath());
    if (m_importRunner->start(path, QString::fromLatin1(StandardsImport::kDefaultFolder)))
        m_importAction->setEnabled(false);
}

void ShellWindow::onImportFinished(bool imported, const QString& message)
{
    m_importAction->setEnabled(true);
    statusBar()->showMessage(message, 10000);
    if (imported)
        QMessageBox::information(this, tr("Import Standards"), message);
    else
        QMessageBox::warning(this, tr("Import Standards"), message);
}

void ShellWindow::addClient(MarloModel& store, ClientInterface* client)
{
    AppWidget* widget = client->createAppWidget(store, m_tabs);
    widget->createContent();
    auto* topBar = new CorvoTopBar(m_topBars);
    widget->addMenus(topBar);
    auto* toolBar = new QToolBar(client->clientTitle(), this);
    toolBar->setObjectName(client->clientTitle());
    toolBar->setMovable(false);
    toolBar->setIconSize(QSize(24, 24));
    widget->addToolBarActions(toolBar);
    addToolBar(toolBar);
    toolBar->hide();

    widget->setStyleSheet(styleSheet(client->styleSheetName()));
    m_topBars->addWidget(topBar);
    m_tabs->addTab(widget, ImageRepository::instance().appIcon(client->clientTitle().toStdString()),
                   client->clientTitle());
    m_appWidgets.push_back(widget);
    m_toolBars.push_back(toolBar);
}

QString ShellWindow::styleSheet(const QString& name)
{
    QFile file(QStringLiteral(":/StyleSheets/") + name);
    if (name.isEmpty() || !file.open(QIODevice::ReadOnly))
        return {};
    return QString::fromUtf8(file.readAll());
}

AppWidget* ShellWindow::appWidget(int tab) const
{
    return tab >= 0 && tab < int(m_appWidgets.size()) ? m_appWidgets[size_t(tab)] : nullptr;
}

CorvoTopBar* ShellWindow::topBar(int tab) const
{
    return qobject_cast<CorvoTopBar*>(m_topBars->widget(tab));
}

QToolBar* ShellWindow::toolBar(int tab) const
{
    return tab >= 0 && tab < int(m_toolBars.size()) ? m_toolBars[size_t(tab)] : nullptr;
}

void ShellWindow::onCurrentTabChanged(int tab)
{
    if (AppWidget* previous = appWidget(m_currentTab)) {
        previous->receivedFocus(false);
        toolBar(m_currentTab)->hide();
    }
    m_currentTab = tab;
    if (AppWidget* current = appWidget(tab)) {
        m_topBars->setCurrentIndex(tab);
        toolBar(tab)->show();
        current->receivedFocus(true);
    }
}

void ShellWindow::openFirstMenu()
{
    CorvoTopBar* bar = topBar(m_currentTab);
    if (bar && !bar->actions().isEmpty())
        bar->setActiveAction(bar->actions().first());
}

void ShellWindow::closeEvent(QCloseEvent* event)
{
    for (AppWidget* widget : m_appWidgets) {
        if (!widget->mayClose()) {
            event->ignore();
            return;
        }
    }
    event->accept();
}

} // namespace vemi

#pragma once

#include "app/PluginCatalog.h"

#include <QMainWindow>

#include <functional>
#include <vector>

class QAction;
class QStackedWidget;
class QTabWidget;
class QToolBar;

namespace vemi {

class AppWidget;
class CorvoTopBar;
class MarloModel;
class StandardsImportRunner;

// The host's main window: one tab per client, with the client's top bar and
// tool bar shown while its tab is current.
class ShellWindow : public QMainWindow
{
    Q_OBJECT

public:
    ShellWindow(MarloModel& store, const std::vector<PluginCatalog::Client>& clients, QWidget* parent = nullptr);

    QTabWidget* tabs() const { return m_tabs; }
    AppWidget* appWidget(int tab) const;
    CorvoTopBar* topBar(int tab) const;
    QToolBar* toolBar(int tab) const;
    // "Tools" → "Import Standards…", the shell's own menu beside the client's.
    QAction* importStandardsAction() const { return m_importAction; }
    StandardsImportRunner* importRunner() const { return m_importRunner; }
    // Asks for the file to import: (parent, start folder, name filter) -> path,
    // empty when cancelled. The file dialog by default; tests give their own.
    using FileChooser = std::function<QString(QWidget*, const QString&, const QString&)>;
    void setImportFileChooser(FileChooser chooser) { m_chooseImportFile = std::move(chooser); }

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    void addClient(MarloModel& store, ClientInterface* client);
    void onCurrentTabChanged(int tab);
    // Opens the first menu of the current tab's top bar, as F10 does in a menu bar.
    void openFirstMenu();
    QWidget* menuRow();
    void importStandards();
    void onImportFinished(bool imported, const QString& message);
    static QString styleSheet(const QString& name);

    QTabWidget* m_tabs;
    QStackedWidget* m_topBars;
    std::vector<AppWidget*> m_appWidgets;
    std::vector<QToolBar*> m_toolBars;
    int m_currentTab = -1;
    QAction* m_importAction = nullptr;
    StandardsImportRunner* m_importRunner;
    FileChooser m_chooseImportFile;
};

} // namespace vemi

#include "plugin/PellamAppWidget.h"

#include "host/client/CorvoTopBar.h"
#include "plugin/PellamWidget.h"

#include <QAction>
#include <QMenu>
#include <QVBoxLayout>

namespace vemi {

PellamAppWidget::PellamAppWidget(std::shared_ptr<PellamSettings> settings,
                                 std::shared_ptr<GeneralSettings> generalSettings, MarloModel& store,
                                 QWidget* parent)
    : AppWidget(parent)
    , m_settings(std::move(settings))
    , m_generalSettings(std::move(generalSettings))
    , m_store(store)
{
}

void PellamAppWidget::createContent()
{
    m_browser = new PellamWidget(m_settings, m_generalSettings, m_store, parentWidget());
    auto* layout = new QVBoxLayout;
    layout->addWidget(m_browser);
    layout->setContentsMargins(0, 0, 0, 0);
    setLayout(layout);
    // F2 and Del act on the browser's selection wherever the focus is in the tab.
    m_browser->setShortcutScope(this);
}

void PellamAppWidget::addMenus(CorvoTopBar* topBar)
{
    if (!m_browser)
        return;
    auto* menu = new QMenu(tr("&File"));
    m_browser->createCustomMenus(menu);
    menu->addSeparator();
    QAction* refreshAction = menu->addAction(tr("&Refresh"));
    refreshAction->setShortcut(QKeySequence(QKeySequence::Refresh));
    connect(refreshAction, &QAction::triggered, this, &AppWidget::refresh);
    topBar->addMenu(menu);
}

void PellamAppWidget::addToolBarActions(QWidget* bar)
{
    if (m_browser)
        m_browser->addBrowserActions(bar);
}

bool PellamAppWidget::mayClose()
{
    return !m_browser || m_browser->mayClose();
}

void PellamAppWidget::refresh()
{
    if (m_browser)
        m_browser->refresh();
}

} // namespace vemi

#pragma once

#include "host/client/AppWidget.h"

#include <memory>

namespace vemi {

class GeneralSettings;
class MarloModel;
class PellamSettings;
class PellamWidget;

// The client's tab: holds the job template browser and gives the host its
// "File" menu and its new, open and save tool bar actions. Before
// createContent() has made the browser, the entry points do nothing and
// mayClose() answers true.
class PellamAppWidget : public AppWidget
{
    Q_OBJECT

public:
    PellamAppWidget(std::shared_ptr<PellamSettings> settings, std::shared_ptr<GeneralSettings> generalSettings,
                    MarloModel& store, QWidget* parent);

    void createContent() override;
    // The menu has no parent: the top bar takes it over.
    void addMenus(CorvoTopBar* topBar) override;
    void addToolBarActions(QWidget* bar) override;
    bool mayClose() override;

protected slots:
    void refresh() override;

private:
    PellamWidget* m_browser = nullptr; // exists from createContent() on
    std::shared_ptr<PellamSettings> m_settings;
    std::shared_ptr<GeneralSettings> m_generalSettings;
    MarloModel& m_store;
};

} // namespace vemi

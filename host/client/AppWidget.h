#pragma once

#include "host/client/SupportedInstruments.h"

#include <QString>
#include <QWidget>

#include <memory>
#include <set>

namespace vemi {

class BaseSetting;
class CorvoTopBar;

// The content of a client's tab. The host calls createContent() once after
// construction, then addMenus() and addToolBarActions(). A host may call any
// entry point before createContent(): until the content exists each does
// nothing (mayClose() answers true), and subclasses keep it so.
class AppWidget : public QWidget, public SupportedInstruments
{
    Q_OBJECT

public:
    explicit AppWidget(QWidget* parent = nullptr);

    virtual void createContent();
    virtual void addMenus(CorvoTopBar* topBar);
    virtual void addToolBarActions(QWidget* bar);
    // Called when the tab becomes the current one (true) or stops being it.
    virtual void receivedFocus(bool focused);
    virtual bool supportsInstruments();
    virtual QString tabAccessibleName();
    virtual std::set<std::shared_ptr<BaseSetting>> appSettings();
    virtual void applySettings(const std::set<std::shared_ptr<BaseSetting>>& settings);
    // Whether the tab may close now; asks the user about unsaved work.
    virtual bool mayClose();

public slots:
    virtual void refresh();
};

} // namespace vemi

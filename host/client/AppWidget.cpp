#include "host/client/AppWidget.h"

namespace vemi {

AppWidget::AppWidget(QWidget* parent)
    : QWidget(parent)
{
}

void AppWidget::createContent()
{
}

void AppWidget::addMenus(CorvoTopBar*)
{
}

void AppWidget::addToolBarActions(QWidget*)
{
}

void AppWidget::receivedFocus(bool)
{
}

bool AppWidget::supportsInstruments()
{
    return false;
}

QString AppWidget::tabAccessibleName()
{
    return accessibleName();
}

std::set<std::shared_ptr<BaseSetting>> AppWidget::appSettings()
{
    return {};
}

void AppWidget::applySettings(const std::set<std::shared_ptr<BaseSetting>>&)
{
}

bool AppWidget::mayClose()
{
    return true;
}

void AppWidget::refresh()
{
}

} // namespace vemi

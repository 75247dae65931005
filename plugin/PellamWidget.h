#pragma once

#include "host/widgets/BaseObjectTreeModel.h"
#include "host/widgets/DirEntryBrowserInterface.h"

#include <QVector>
#include <QWidget>

#include <memory>

class QCJobTemplateModel;
class QMenu;
class QSplitter;
class QStackedWidget;

namespace vemi {

class DirEntryBrowserWidget;
class GeneralSettings;
class MarloModel;
class PellamSettings;
class QCJobTemplateDetailWidget;

// The content of the tab: the folder tree of stored job templates on the
// left, the editor of the open template (or a placeholder) on the right.
class PellamWidget : public QWidget, public DirEntryBrowserInterface
{
    Q_OBJECT

public:
    // settings is accepted and not used; generalSettings goes to the editor.
    PellamWidget(std::shared_ptr<PellamSettings> settings, std::shared_ptr<GeneralSettings> generalSettings,
                 MarloModel& store, QWidget* parent);
    // Writes the splitter state.
    ~PellamWidget() override;

    std::shared_ptr<NamedObject> newNamedObject() override;
    std::string namedObjectTypeId() override;

    void createCustomMenus(QMenu* menu);
    // The browser's keys (F2, Del) work while the focus is anywhere inside scope.
    void setShortcutScope(QWidget* scope);
    // Gives new, open and save their icons and adds them to bar in that order.
    void addBrowserActions(QWidget* bar);
    bool mayClose();
    void refresh();
    // The editing model shared with the detail editor.
    std::shared_ptr<QCJobTemplateModel> model() const { return m_model; }

protected slots:
    void onSelectionChanged(QVector<vemi::BaseObjectTreeModel::Node*> selectedNodes);

private:
    MarloModel& m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    QStackedWidget* m_pages;
    DirEntryBrowserWidget* m_browser;
    QCJobTemplateDetailWidget* m_detail;
    QSplitter* m_splitter;
};

} // namespace vemi

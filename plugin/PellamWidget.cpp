#include "plugin/PellamWidget.h"

#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "plugin/PellamSettingsKeys.h"
#include "host/domain/QCJobTemplate.h"
#include "detail/QCJobTemplateDetailWidget.h"
#include "model/QCJobTemplateModel.h"
#include "host/domain/SchematicImage.h"

#include <QAction>
#include <QIcon>
#include <QLabel>
#include <QSettings>
#include <QSplitter>
#include <QStackedWidget>
#include <QVBoxLayout>

namespace vemi {

PellamWidget::PellamWidget(std::shared_ptr<PellamSettings>, std::shared_ptr<GeneralSettings> generalSettings,
                           MarloModel& store, QWidget* parent)
    : QWidget(parent)
    , m_store(store)
    , m_pages(new QStackedWidget(this))
    , m_browser(new DirEntryBrowserWidget(parent))
{
    auto* treeModel = new DirEntryTreeModel(m_store, this);
    m_browser->initialize(treeModel, this, QCJobTemplate::typeId(), tr("Job Templates"), tr("New Job Template"),
                          "Pellam", nullptr, false);
    m_model = std::make_shared<QCJobTemplateModel>(m_store);
    m_detail = new QCJobTemplateDetailWidget(m_store, this, m_model, generalSettings);

    connect(m_detail, &QCJobTemplateDetailWidget::sgJobTemplateWasModified, m_browser,
            [browser = m_browser](std::shared_ptr<QCJobTemplate> jobTemplate) {
                browser->namedObjectWasModified(jobTemplate);
            });
    connect(m_browser, &DirEntryBrowserWidget::sgSelectionChanged, this, &PellamWidget::onSelectionChanged);
    // A rename in the browser renames the open template too: its title follows.
    connect(treeModel, &QAbstractItemModel::dataChanged, m_detail, &QCJobTemplateDetailWidget::refreshTemplateName);

    m_splitter = new QSplitter(Qt::Horizontal, this);
    m_splitter->addWidget(m_browser);
    auto* placeholder = new QLabel(tr("Please create a new job template or open an existing one."));
    placeholder->setAlignment(Qt::AlignCenter);
    m_pages->addWidget(placeholder);
    m_pages->addWidget(m_detail);
    m_pages->setCurrentIndex(0);
    m_splitter->addWidget(m_pages);
    // Keeps the default share of the width (100 : 600) as the window grows.
    m_splitter->setStretchFactor(0, 1);
    m_splitter->setStretchFactor(1, 6);
    // The browser keeps its minimum width: a collapsed browser hides every template.
    m_splitter->setCollapsible(0, false);

    if (!m_splitter->restoreState(QSettings().value(PellamKeys::MainSplitterState, QVariant()).toByteArray()))
        m_splitter->setSizes({100, 600});

    auto* layout = new QVBoxLayout;
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_splitter);
    setLayout(layout);
}

PellamWidget::~PellamWidget()
{
    QSettings().setValue(PellamKeys::MainSplitterState, m_splitter->saveState());
    // The browser (inside the splitter) goes before the tree model it shows,
    // which is a child of this widget and would otherwise die first.
    delete m_splitter;
    m_splitter = nullptr;
    m_model.reset();
}

std::shared_ptr<NamedObject> PellamWidget::newNamedObject()
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName(defaultNamedObjectName(tr("Job Template")));
    jobTemplate->setSchematicImage(std::make_shared<SchematicImage>());
    m_model->setJobTemplate(jobTemplate);
    m_detail->reloadFromModel();
    return jobTemplate;
}

std::string PellamWidget::namedObjectTypeId()
{
    return QCJobTemplate::typeId();
}

void PellamWidget::createCustomMenus(QMenu* menu)
{
    m_browser->createCustomMenus(menu, tr("Job Template"), tr("Job Templates"), true);
}

void PellamWidget::setShortcutScope(QWidget* scope)
{
    m_browser->setShortcutScope(scope);
}

void PellamWidget::addBrowserActions(QWidget* bar)
{
    m_browser->actionNew()->setIcon(QIcon(QStringLiteral(":Images/NewTemplate.png")));
    m_browser->actionOpen()->setIcon(QIcon(QStringLiteral(":Images/OpenTemplate.png")));
    m_browser->actionSave()->setIcon(QIcon(QStringLiteral(":Images/SaveTemplate.png")));
    bar->addAction(m_browser->actionNew());
    bar->addAction(m_browser->actionOpen());
    bar->addAction(m_browser->actionSave());
}

bool PellamWidget::mayClose()
{
    return m_browser->mayClose();
}

void PellamWidget::refresh()
{
    m_browser->refresh();
}

void PellamWidget::onSelectionChanged(QVector<BaseObjectTreeModel::Node*> selectedNodes)
{
    BaseObjectTreeModel::Node* node = selectedNodes.size() == 1 ? selectedNodes.first() : nullptr;
    if (!dynamic_cast<DirEntryTreeModel::DirEntryNode*>(node)) {
        m_pages->setCurrentIndex(0);
        return;
    }
    m_pages->setCurrentIndex(1);
    if (auto jobTemplate = std::dynamic_pointer_cast<QCJobTemplate>(node->object())) {
        m_model->setJobTemplate(jobTemplate);
        m_detail->reloadFromModel();
        m_model->notifyMeasurementConfigLoaded();
    }
}

} // namespace vemi

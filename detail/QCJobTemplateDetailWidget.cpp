#include "detail/QCJobTemplateDetailWidget.h"

#include "host/domain/QCJobTemplate.h"
#include "model/QCJobTemplateModel.h"

#include <QLabel>
#include <QVBoxLayout>

namespace vemi {

QCJobTemplateDetailWidget::QCJobTemplateDetailWidget(MarloModel& store, QWidget* parent,
                                                     std::shared_ptr<QCJobTemplateModel> model,
                                                     std::shared_ptr<GeneralSettings> generalSettings)
    : QWidget(parent)
    , m_store(store)
    , m_model(std::move(model))
    , m_generalSettings(std::move(generalSettings))
    , m_heading(new QLabel(this))
    , m_summary(new QLabel(this))
{
    setObjectName(QStringLiteral("QCJobTemplateDetailWidget"));
    QFont headingFont = m_heading->font();
    headingFont.setBold(true);
    headingFont.setPointSizeF(headingFont.pointSizeF() * 1.3);
    m_heading->setFont(headingFont);
    // A long name is cut at the pane's edge (the tooltip shows it whole)
    // instead of widening the window beyond the screen.
    m_heading->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
    m_heading->setTextFormat(Qt::PlainText);
    m_summary->setWordWrap(true);
    m_summary->setTextFormat(Qt::PlainText);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_heading);
    layout->addWidget(m_summary);
    layout->addStretch(1);
}

QCJobTemplateDetailWidget::~QCJobTemplateDetailWidget() = default;

void QCJobTemplateDetailWidget::reloadFromModel()
{
    const auto jobTemplate = m_model->jobTemplate();
    if (!jobTemplate) {
        m_heading->clear();
        m_heading->setToolTip(QString());
        m_summary->clear();
        return;
    }
    const QString name = QString::fromStdString(jobTemplate->name());
    m_heading->setText(name);
    m_heading->setToolTip(name);
    const QString description = QString::fromStdString(jobTemplate->description());
    m_summary->setText(tr("%1\n\nCheckpoints: %2")
                           .arg(description.isEmpty() ? tr("No description.") : description,
                                QString::number(jobTemplate->checkPoints().size())));
}

} // namespace vemi

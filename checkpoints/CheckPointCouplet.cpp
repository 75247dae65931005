#include "checkpoints/CheckPointCouplet.h"
#include "ui_CheckPointCouplet.h"

#include "checkpoints/CheckZoneListItem.h"

#include <QEvent>

CheckPointCouplet::CheckPointCouplet(QWidget* parent)
    : QWidget(parent)
    , m_ui(new Ui::CheckPointCouplet)
{
    m_ui->setupUi(this);
    m_ui->coupleLetterLabel->hide();
    m_ui->coupleLetterLabel->clear();
    m_ui->coupletFrame->setFrameShape(QFrame::NoFrame);
}

CheckPointCouplet::~CheckPointCouplet()
{
    delete m_ui;
}

void CheckPointCouplet::setFirstItem(CheckZoneListItem* item)
{
    m_firstItem = item;
    m_ui->checkPointItemFrame->addWidget(item, 0, 0);
}

void CheckPointCouplet::setSecondItem(CheckZoneListItem* item)
{
    m_secondItem = item;
    m_ui->checkPointItemFrame->addWidget(item, 1, 0);
}

CheckZoneListItem* CheckPointCouplet::item(int i) const
{
    return i == 1 ? m_firstItem : m_secondItem;
}

int CheckPointCouplet::number() const
{
    return m_firstItem ? m_firstItem->number() : -1;
}

bool CheckPointCouplet::isCoupled() const
{
    return m_coupled;
}

QString CheckPointCouplet::letter() const
{
    return m_letter;
}

int CheckPointCouplet::checkListIndex() const
{
    return m_checkListIndex;
}

void CheckPointCouplet::setCheckListIndex(int index)
{
    m_checkListIndex = index;
}

void CheckPointCouplet::setCoupled(bool on, const QString& letter)
{
    m_coupled = on;
    m_letter = letter;
    m_ui->coupleLetterLabel->setVisible(on);
    m_ui->coupleLetterLabel->setText(letter);
    m_ui->coupletFrame->setFrameShape(on ? QFrame::Panel : QFrame::NoFrame);
    if (!on && m_secondItem)
        m_ui->checkPointItemFrame->removeWidget(m_secondItem);
}

void CheckPointCouplet::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::LanguageChange) {
        m_ui->retranslateUi(this);
        // The form's letter is a placeholder; the couple's own letter stays.
        m_ui->coupleLetterLabel->setText(m_letter);
    }
    QWidget::changeEvent(event);
}

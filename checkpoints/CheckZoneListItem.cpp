#include "checkpoints/CheckZoneListItem.h"
#include "ui_CheckZoneListItem.h"

#include <QEvent>
#include <QGraphicsPixmapItem>
#include <QGraphicsScene>
#include <QStyle>

namespace {
const char* const kSelectedProperty = "isSelected";
}

CheckZoneListItem::CheckZoneListItem(QWidget* parent)
    : QWidget(parent)
    , m_ui(new Ui::CheckZoneListItem)
{
    m_ui->setupUi(this);
    setThumbnail(QPixmap());
    setSelected(false);
}

CheckZoneListItem::~CheckZoneListItem()
{
    delete m_ui;
}

void CheckZoneListItem::setNumber(int number)
{
    m_number = number;
    showNumber();
}

int CheckZoneListItem::number() const
{
    return m_number;
}

void CheckZoneListItem::setName(const QString& name)
{
    m_ui->checkZoneNameLineEdit->setText(name);
}

QString CheckZoneListItem::name() const
{
    return m_ui->checkZoneNameLineEdit->text();
}

void CheckZoneListItem::setThumbnail(const QPixmap& pixmap)
{
    // The scenes belong to this item; the replaced one goes at once.
    QGraphicsScene* previous = m_ui->checkZoneGraphicsView->scene();
    auto* scene = new QGraphicsScene(this);
    scene->setSceneRect(scene->itemsBoundingRect());
    scene->addPixmap(pixmap);
    m_ui->checkZoneGraphicsView->setScene(scene);
    delete previous;
}

void CheckZoneListItem::setSelected(bool selected)
{
    QFrame* frame = m_ui->listboxItemFrame;
    frame->setProperty(kSelectedProperty, selected);
    frame->style()->unpolish(frame);
    frame->style()->polish(frame);
}

bool CheckZoneListItem::isSelected() const
{
    return m_ui->listboxItemFrame->property(kSelectedProperty).toBool();
}

void CheckZoneListItem::focusName()
{
    m_ui->checkZoneNameLineEdit->setFocus(Qt::OtherFocusReason);
    m_ui->checkZoneNameLineEdit->setSelection(0, 99);
}

void CheckZoneListItem::setListItem(QListWidgetItem* item)
{
    m_listItem = item;
}

QListWidgetItem* CheckZoneListItem::listItem() const
{
    return m_listItem;
}

void CheckZoneListItem::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::LanguageChange) {
        m_ui->retranslateUi(this);
        // The form's text is a placeholder; keep the number once it is known.
        if (m_number >= 0)
            showNumber();
    }
    QWidget::changeEvent(event);
}

void CheckZoneListItem::on_checkZoneNameLineEdit_textChanged(QString) {}

void CheckZoneListItem::on_checkZoneNameLineEdit_editingFinished()
{
    emit sgSetListItemText(m_number, m_ui->checkZoneNameLineEdit->text());
}

void CheckZoneListItem::on_checkZoneNameLineEdit_selectionChanged() {}

void CheckZoneListItem::showNumber()
{
    m_ui->checkPointNumber->setText(QString::number(m_number + 1));
}

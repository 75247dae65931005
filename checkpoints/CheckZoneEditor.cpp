#include "checkpoints/CheckZoneEditor.h"
#include "ui_CheckZoneEditor.h"

#include "checkpoints/CheckPointCouplet.h"
#include "checkpoints/CheckZoneListItem.h"
#include "checkpoints/CheckZonePropertiesDialog.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "model/QCJobTemplateModel.h"

#include <QBuffer>
#include <QCursor>
#include <QEvent>
#include <QImageReader>
#include <QPixmap>

namespace {

const QSize kSingleRowSize(250, 82);
const QSize kCoupleRowSize(250, 160);
// A click below this height in a couple row picks the second member.
constexpr int kSecondMemberTop = 80;
// Image data of this many bytes or fewer is no area picture.
constexpr std::size_t kMinimumImageBytes = 10;
// Cut-outs are small; a stored one that declares more is refused unread.
constexpr qint64 kMaxThumbnailPixels = 4096LL * 4096LL;

QRect areaOf(const vemi::CheckPoint& checkPoint)
{
    const auto position = checkPoint.position();
    const auto size = checkPoint.size();
    return QRect(position ? position->x() : 0, position ? position->y() : 0, size ? size->width() : 0,
                 size ? size->height() : 0);
}

bool hasAreaImage(const vemi::CheckPoint& checkPoint)
{
    const auto image = checkPoint.schematicImage();
    return image && image->imageData().size() > kMinimumImageBytes;
}

QPixmap thumbnailOf(const vemi::CheckPoint& checkPoint)
{
    const auto& data = checkPoint.schematicImage()->imageData();
    QByteArray bytes(reinterpret_cast<const char*>(data.data()), int(data.size()));
    QBuffer buffer(&bytes);
    QImageReader reader(&buffer, "PNG");
    const QSize declared = reader.size();
    if (!declared.isValid() || qint64(declared.width()) * declared.height() > kMaxThumbnailPixels)
        return QPixmap();
    return QPixmap::fromImage(reader.read());
}

} // namespace

CheckZoneEditor::CheckZoneEditor(QWidget* parent)
    : QWidget(parent)
    , m_ui(new Ui::CheckZoneEditor)
{
    m_ui->setupUi(this);
}

CheckZoneEditor::~CheckZoneEditor()
{
    delete m_ui;
}

void CheckZoneEditor::init(vemi::MarloModel& store, std::shared_ptr<QCJobTemplateModel> model)
{
    m_store = &store;
    m_model = std::move(model);
    connect(m_model.get(), &QCJobTemplateModel::sgMeasurementConfigLoaded, this,
            &CheckZoneEditor::onMeasurementConfigLoaded);
}

void CheckZoneEditor::onMeasurementConfigLoaded()
{
    m_ui->addCheckZoneButton->setEnabled(m_model->measurementConfiguration() != nullptr);
    m_ui->checkZoneListWidget->clearSelection();
    rebuild();
}

void CheckZoneEditor::setCurrentThumbnail(int, QPixmap pixmap)
{
    if (CheckZoneListItem* item = selectedPartItem())
        item->setThumbnail(pixmap);
}

void CheckZoneEditor::publishCheckPoints()
{
    if (!m_model || !m_model->jobTemplate())
        return;
    int cpIndex = 0;
    int coupleOrdinal = 1;
    for (const auto& entry : m_model->jobTemplate()->checkListItems()) {
        if (const auto couple = std::dynamic_pointer_cast<vemi::CheckPointCouple>(entry)) {
            for (const auto& member : couple->checkPoints()) {
                if (member)
                    emit sgAddCheckpointToSchematic(cpIndex++, coupleOrdinal, areaOf(*member));
            }
            ++coupleOrdinal;
        } else if (const auto checkPoint = std::dynamic_pointer_cast<vemi::CheckPoint>(entry)) {
            emit sgAddCheckpointToSchematic(cpIndex++, 0, areaOf(*checkPoint));
        }
    }
}

void CheckZoneEditor::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::LanguageChange)
        m_ui->retranslateUi(this);
    QWidget::changeEvent(event);
}

void CheckZoneEditor::on_addCheckZoneButton_clicked()
{
    const QString name = tr("New Checkpoint");
    const int cpIndex = m_model->checkPointCount();
    addCheckPointRow(nullptr, name, 0, cpIndex);
    const auto checkPoint = m_model->addCheckPoint(name);
    // Settings come from the checkpoint just before the new one in checkpoint
    // order; a couple before it holds two checkpoints but only one row.
    if (cpIndex > 0) {
        const auto previous = m_model->checkPointAt(cpIndex - 1);
        checkPoint->setStandard(previous->standard());
        // The choice comes with the standard: a new checkpoint is automatic by
        // default, and the dialog would show (and keep) "Auto Select" instead.
        checkPoint->setAutoStandard(previous->autoStandard());
        checkPoint->setTagDefinitions(previous->tagDefinitions());
        checkPoint->setTagValues(previous->tagValues());
        if (previous->skippable())
            checkPoint->setSkippable(true);
    }
    on_checkZonePropertiesButton_clicked();
}

void CheckZoneEditor::on_deleteCheckZoneButton_clicked()
{
    // The row the buttons act on, not the list's keyboard-driven current row.
    const int row = m_currentRow ? m_ui->checkZoneListWidget->row(m_currentRow) : -1;
    if (row < 0)
        return;
    m_model->removeCheckListItem(row);
    deleteRowWidget(m_currentRow);
    delete m_currentRow;
    for (QWidget* button : {m_ui->deleteCheckZoneButton, m_ui->moveCheckZoneDownButton, m_ui->moveCheckZoneUpButton,
                            m_ui->addImageButton, m_ui->checkZonePropertiesButton, m_ui->coupleCheckPointsButton,
                            m_ui->deCoupleCheckPointsButton})
        button->setEnabled(false);
    m_currentRow = nullptr;
    m_selectedItem = nullptr;
    rebuild();
}

void CheckZoneEditor::on_checkZoneListWidget_itemPressed(QListWidgetItem* item)
{
    selectRow(item);
}

void CheckZoneEditor::on_checkZoneListWidget_itemClicked(QListWidgetItem* item)
{
    selectRow(item);
}

void CheckZoneEditor::on_addImageButton_clicked()
{
    const CheckZoneListItem* item = selectedPartItem();
    if (item && item->number() >= 0)
        emit sgGrabRubberBandedArea(item->number());
}

void CheckZoneEditor::on_moveCheckZoneUpButton_clicked()
{
    moveCurrentRow(-1);
}

void CheckZoneEditor::on_moveCheckZoneDownButton_clicked()
{
    moveCurrentRow(+1);
}

void CheckZoneEditor::on_checkZonePropertiesButton_clicked()
{
    // The dialog runs an event loop; the item may go with a rebuild meanwhile.
    const QPointer<CheckZoneListItem> item = selectedPartItem();
    if (!item || item->number() < 0 || item->number() >= m_model->checkPointCount())
        return;
    const auto checkPoint = m_model->checkPointAt(item->number());
    CheckZonePropertiesDialog dialog(checkPoint, m_model, this);
    dialog.setWindowTitle(QString::fromStdString(checkPoint->name()) + tr(" properties"));
    dialog.setMarloModel(m_store);
    if (dialog.exec() != QDialog::Accepted)
        return;
    checkPoint->setSkippable(dialog.skippable());
    const auto standard = dialog.standard();
    checkPoint->setStandard(standard);
    checkPoint->setAutoStandard(standard == nullptr);
    checkPoint->setTagDefinitions(dialog.tagDefinitions());
    checkPoint->setTagValues(dialog.tagValues());
    checkPoint->setName(dialog.name().toStdString());
    if (item)
        item->setName(dialog.name());
    emit sgSetTemplateSavable();
}

void CheckZoneEditor::on_coupleCheckPointsButton_clicked()
{
    const QList<QListWidgetItem*> rows = m_ui->checkZoneListWidget->selectedItems();
    if (rows.size() != 2)
        return;
    coupleRows(rows[0], rows[1], false, nextCoupleLetter());
}

void CheckZoneEditor::on_deCoupleCheckPointsButton_clicked()
{
    if (!m_currentRow)
        return;
    const CheckPointCouplet* couplet = coupletOf(m_currentRow);
    m_usedLetters.removeAll(couplet->letter());
    m_model->decoupleCheckPoints(couplet->checkListIndex());
    rebuild();
}

void CheckZoneEditor::on_swapCoupledCheckPoints_clicked()
{
    if (!m_currentRow || !coupletOf(m_currentRow)->isCoupled())
        return;
    const int row = m_ui->checkZoneListWidget->row(m_currentRow);
    m_model->swapCoupledCheckPoints(coupletOf(m_currentRow)->checkListIndex());
    rebuild();
    m_ui->checkZoneListWidget->clearSelection();
    m_ui->checkZoneListWidget->setCurrentRow(row);
    selectRow(m_ui->checkZoneListWidget->item(row));
}

void CheckZoneEditor::selectRow(QListWidgetItem* item)
{
    m_currentRow = item;
    m_selectedPart = 0;
    if (item) {
        CheckPointCouplet* couplet = coupletOf(item);
        if (!couplet)
            return;
        if (couplet->isCoupled() && couplet->mapFromGlobal(QCursor::pos()).y() > kSecondMemberTop)
            m_selectedPart = 1;
        CheckZoneListItem* selected = couplet->item(m_selectedPart + 1);
        if (selected)
            selected->setSelected(true);
        if (m_selectedItem && m_selectedItem != selected)
            m_selectedItem->setSelected(false);
        m_selectedItem = selected;
    }
    updateButtons(true);
}

void CheckZoneEditor::updateButtons(bool enabled)
{
    if (m_currentRow) {
        const bool coupled = coupletOf(m_currentRow)->isCoupled();
        m_ui->coupleCheckPointsButton->setEnabled(enabled && selectionCanBeCoupled());
        m_ui->deCoupleCheckPointsButton->setEnabled(enabled && coupled);
        m_ui->swapCoupledCheckPoints->setEnabled(enabled && coupled);
    } else if (!enabled) {
        m_ui->deCoupleCheckPointsButton->setEnabled(false);
        m_ui->swapCoupledCheckPoints->setEnabled(false);
    }
    for (QWidget* button : {m_ui->deleteCheckZoneButton, m_ui->addImageButton, m_ui->moveCheckZoneDownButton,
                            m_ui->moveCheckZoneUpButton, m_ui->checkZonePropertiesButton})
        button->setEnabled(enabled);
}

bool CheckZoneEditor::selectionCanBeCoupled() const
{
    const QList<QListWidgetItem*> rows = m_ui->checkZoneListWidget->selectedItems();
    return rows.size() == 2 && !coupletOf(rows[0])->isCoupled() && !coupletOf(rows[1])->isCoupled();
}

void CheckZoneEditor::rebuild()
{
    m_usedLetters.clear();
    m_currentRow = nullptr;
    m_selectedItem = nullptr;
    // A shown list lays out every row and places every row widget again for
    // each row added; hidden, it does so once when it is shown again.
    QListWidget* list = m_ui->checkZoneListWidget;
    const bool wasHidden = list->isHidden();
    list->hide();
    clearRows();
    emit sgRefreshCheckPointLayer();

    int coupleOrdinal = 1;
    int cpIndex = 0;
    for (const auto& entry : m_model->jobTemplate()->checkListItems()) {
        if (const auto couple = std::dynamic_pointer_cast<vemi::CheckPointCouple>(entry)) {
            cpIndex = addCoupleRows(couple, coupleOrdinal++, cpIndex);
        } else if (const auto checkPoint = std::dynamic_pointer_cast<vemi::CheckPoint>(entry)) {
            addCheckPointRow(checkPoint, QString(), 0, cpIndex++);
        }
    }

    list->setHidden(wasHidden);
    // Adding rows left the last one selected; no row is chosen until the user
    // clicks one, and a stray selection would be coupled with the next click.
    list->clearSelection();

    if (m_currentRow)
        m_ui->coupleCheckPointsButton->setEnabled(false);
    for (QWidget* button : {m_ui->deCoupleCheckPointsButton, m_ui->swapCoupledCheckPoints,
                            m_ui->deleteCheckZoneButton, m_ui->addImageButton, m_ui->moveCheckZoneDownButton,
                            m_ui->moveCheckZoneUpButton, m_ui->checkZonePropertiesButton})
        button->setEnabled(false);
}

void CheckZoneEditor::clearRows()
{
    QListWidget* list = m_ui->checkZoneListWidget;
    for (int row = 0; row < list->count(); ++row)
        deleteRowWidget(list->item(row));
    list->clear();
}

void CheckZoneEditor::deleteRowWidget(QListWidgetItem* row)
{
    // The widget goes at once, and an item whose name is still being edited
    // must not rename by an index of the old list as it goes.
    CheckPointCouplet* couplet = coupletOf(row);
    if (!couplet)
        return;
    for (int part = 1; part <= 2; ++part) {
        if (CheckZoneListItem* item = couplet->item(part))
            item->disconnect(this);
    }
    // The view forgets the widget first: it keeps row widgets by plain pointer.
    m_ui->checkZoneListWidget->removeItemWidget(row);
    delete couplet;
}

int CheckZoneEditor::addCheckPointRow(const std::shared_ptr<vemi::CheckPoint>& checkPoint, const QString& name,
                                      int coupletId, int cpIndex)
{
    auto* item = new CheckZoneListItem;
    auto* couplet = new CheckPointCouplet(this);
    item->setNumber(cpIndex);
    connect(item, &CheckZoneListItem::sgSetListItemText, this, &CheckZoneEditor::renameCheckPoint);
    connect(item, &CheckZoneListItem::sgSetListItemSelected, this, &CheckZoneEditor::selectRow);

    QString shownName = name;
    if (checkPoint) {
        shownName = QString::fromStdString(checkPoint->name());
        if (hasAreaImage(*checkPoint)) {
            item->setThumbnail(thumbnailOf(*checkPoint));
            emit sgAddCheckpointToSchematic(cpIndex, coupletId, areaOf(*checkPoint));
        }
    }
    item->setName(shownName);
    couplet->setFirstItem(item);

    QListWidget* list = m_ui->checkZoneListWidget;
    auto* row = new QListWidgetItem(list);
    item->setListItem(row);
    row->setSizeHint(kSingleRowSize);
    couplet->setCheckListIndex(list->count() - 1);
    list->setItemWidget(row, couplet);
    list->clearSelection();
    list->setCurrentItem(row);

    if (!checkPoint) {
        item->focusName();
        selectRow(row);
    }
    return list->count() - 1;
}

int CheckZoneEditor::addCoupleRows(const std::shared_ptr<vemi::CheckPointCouple>& couple, int coupletId,
                                   int cpIndex)
{
    // Members are numbered in walking order, which is what checkZoneIndex
    // gives for each without searching the whole list again.
    for (const auto& member : couple->checkPoints()) {
        if (member)
            addCheckPointRow(member, QString(), coupletId, cpIndex++);
    }
    QListWidget* list = m_ui->checkZoneListWidget;
    const int lastRow = list->count() - 1;
    if (lastRow >= 1) {
        const QString letter = QString::fromStdString(couple->name());
        coupleRows(list->item(lastRow - 1), list->item(lastRow), true, letter);
        m_usedLetters.append(letter);
    }
    return cpIndex;
}

void CheckZoneEditor::coupleRows(QListWidgetItem* first, QListWidgetItem* second, bool fromTemplate,
                                 const QString& letter)
{
    CheckPointCouplet* c0 = coupletOf(first);
    CheckPointCouplet* c1 = coupletOf(second);
    const bool secondComesFirst = c0->number() >= c1->number();
    CheckPointCouplet* target = secondComesFirst ? c1 : c0;
    CheckPointCouplet* source = secondComesFirst ? c0 : c1;
    QListWidgetItem* removedRow = secondComesFirst ? first : second;
    QListWidgetItem* keptRow = secondComesFirst ? second : first;
    const int targetNumber = target->number();
    const int sourceNumber = source->number();

    target->setCoupled(true, letter);
    CheckZoneListItem* moved = source->item(1);
    target->setSecondItem(moved);
    moved->setListItem(keptRow);
    // The source's item lives on in the target, so it keeps its connections.
    m_ui->checkZoneListWidget->removeItemWidget(removedRow);
    delete source;
    delete removedRow;
    keptRow->setSizeHint(kCoupleRowSize);
    m_ui->coupleCheckPointsButton->setEnabled(false);

    if (!fromTemplate) {
        m_model->coupleCheckPoints(targetNumber, sourceNumber, letter.toStdString());
        // The couple now stands where its first member stood, so the
        // checkpoints between the two members moved one place down.
        renumberRows();
        redrawSchematicOverlay();
    }
    selectRow(keptRow);
}

void CheckZoneEditor::renumberRows()
{
    QListWidget* list = m_ui->checkZoneListWidget;
    int cpIndex = 0;
    for (int row = 0; row < list->count(); ++row) {
        CheckPointCouplet* couplet = coupletOf(list->item(row));
        couplet->setCheckListIndex(row);
        couplet->item(1)->setNumber(cpIndex++);
        if (couplet->isCoupled() && couplet->item(2))
            couplet->item(2)->setNumber(cpIndex++);
    }
}

void CheckZoneEditor::redrawSchematicOverlay()
{
    emit sgRefreshCheckPointLayer();
    int cpIndex = 0;
    int coupleOrdinal = 1;
    for (const auto& entry : m_model->jobTemplate()->checkListItems()) {
        if (const auto couple = std::dynamic_pointer_cast<vemi::CheckPointCouple>(entry)) {
            for (const auto& member : couple->checkPoints()) {
                if (member && hasAreaImage(*member))
                    emit sgAddCheckpointToSchematic(cpIndex, coupleOrdinal, areaOf(*member));
                cpIndex += member ? 1 : 0;
            }
            ++coupleOrdinal;
        } else if (const auto checkPoint = std::dynamic_pointer_cast<vemi::CheckPoint>(entry)) {
            if (hasAreaImage(*checkPoint))
                emit sgAddCheckpointToSchematic(cpIndex, 0, areaOf(*checkPoint));
            ++cpIndex;
        }
    }
}

QString CheckZoneEditor::nextCoupleLetter()
{
    QChar candidate(65);
    while (m_usedLetters.contains(QString(candidate)))
        candidate = QChar(candidate.unicode() + 1);
    m_usedLetters.append(QString(candidate));
    return QString(candidate);
}

void CheckZoneEditor::moveCurrentRow(int direction)
{
    if (!m_currentRow)
        return;
    QListWidget* list = m_ui->checkZoneListWidget;
    const int row = list->row(m_currentRow);
    const int other = row + direction;
    if (row < 0 || other < 0 || other >= list->count())
        return;
    m_model->swapCheckListItems(row, other);
    rebuild();
    list->clearSelection();
    list->setCurrentRow(other);
    selectRow(list->selectedItems().value(0));
    emit sgSetTemplateSavable();
}

void CheckZoneEditor::renameCheckPoint(int cpIndex, const QString& name)
{
    // Editing finishes on Return and again on leaving the field; only a
    // real change is a rename.
    if (cpIndex < 0 || cpIndex >= m_model->checkPointCount())
        return;
    if (QString::fromStdString(m_model->checkPointAt(cpIndex)->name()) == name)
        return;
    m_model->renameCheckPoint(cpIndex, name);
}

CheckPointCouplet* CheckZoneEditor::coupletOf(QListWidgetItem* row) const
{
    return row ? qobject_cast<CheckPointCouplet*>(m_ui->checkZoneListWidget->itemWidget(row)) : nullptr;
}

CheckZoneListItem* CheckZoneEditor::selectedPartItem() const
{
    const CheckPointCouplet* couplet = coupletOf(m_currentRow);
    return couplet ? couplet->item(m_selectedPart + 1) : nullptr;
}

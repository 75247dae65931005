#include "tests/common/CheckListText.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/QCJobTemplate.h"

#include <QStringList>

namespace {

QString checkPointText(const vemi::CheckPoint& checkPoint)
{
    return QString::fromStdString(checkPoint.name() + checkPoint.matchPoint());
}

QString itemText(const std::shared_ptr<vemi::CheckListItem>& item)
{
    if (const auto checkPoint = std::dynamic_pointer_cast<vemi::CheckPoint>(item))
        return checkPointText(*checkPoint);
    const auto couple = std::dynamic_pointer_cast<vemi::CheckPointCouple>(item);
    if (!couple)
        return QStringLiteral("?");
    QStringList members;
    for (const auto& member : couple->checkPoints())
        members << (member ? checkPointText(*member) : QStringLiteral("null"));
    return QString::fromStdString(couple->name()) + '[' + members.join(' ') + ']';
}

} // namespace

QString checkListText(const vemi::QCJobTemplate& jobTemplate)
{
    QStringList items;
    for (const auto& item : jobTemplate.checkListItems())
        items << itemText(item);
    return items.join(QStringLiteral(", "));
}

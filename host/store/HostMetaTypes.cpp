#include "HostMetaTypes.h"

#include "BaseObjectTreeModel.h"

#include <QtGlobal>

namespace {

// Registered when the host library is loaded, so that queued connections and
// item data can carry these handles everywhere.
void registerHostMetaTypes()
{
    qRegisterMetaType<std::shared_ptr<vemi::Response>>("std::shared_ptr<vemi::Response>");
    qRegisterMetaType<std::shared_ptr<vemi::ErrorInfo>>("std::shared_ptr<vemi::ErrorInfo>");
    qRegisterMetaType<std::shared_ptr<vemi::Progress>>("std::shared_ptr<vemi::Progress>");
    qRegisterMetaType<std::shared_ptr<vemi::BaseObject>>("std::shared_ptr<vemi::BaseObject>");
    qRegisterMetaType<QVector<vemi::BaseObjectTreeModel::Node*>>("QVector<vemi::BaseObjectTreeModel::Node*>");
}

} // namespace

Q_CONSTRUCTOR_FUNCTION(registerHostMetaTypes)

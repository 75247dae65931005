#include "host/store/HostMetaTypes.h"

#include "host/domain/BaseObject.h"
#include "host/store/ErrorInfo.h"
#include "host/store/Progress.h"
#include "host/store/Response.h"

#include <QtGlobal>

namespace {

// Registered when the host library is loaded, so that queued connections
// can carry the store's answers and objects everywhere.
void registerHostMetaTypes()
{
    qRegisterMetaType<std::shared_ptr<vemi::Response>>("std::shared_ptr<vemi::Response>");
    qRegisterMetaType<std::shared_ptr<vemi::ErrorInfo>>("std::shared_ptr<vemi::ErrorInfo>");
    qRegisterMetaType<std::shared_ptr<vemi::Progress>>("std::shared_ptr<vemi::Progress>");
    qRegisterMetaType<std::shared_ptr<vemi::BaseObject>>("std::shared_ptr<vemi::BaseObject>");
    qRegisterMetaType<std::string>("std::string");
}

} // namespace

Q_CONSTRUCTOR_FUNCTION(registerHostMetaTypes)

#include "host/store/GetMarloObject.h"

#include "host/domain/BaseObject.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/StoredObjectReader.h"

namespace vemi {

std::shared_ptr<Response> GetMarloObject::execute(StoreDatabase& database)
{
    StoredObjectReader reader(database);
    auto object = reader.read(m_id, m_type, m_depth);
    return std::make_shared<GetMarloObjectResponse>(std::move(object), reader.problems());
}

std::string GetMarloObject::description() const
{
    return "read the object " + m_id;
}

} // namespace vemi

#include "host/store/GetMarloObject.h"

#include "host/store/GetMarloObjectResponse.h"
#include "host/store/StoredObjectReader.h"

namespace vemi {

std::shared_ptr<Response> GetMarloObject::execute(StoreDatabase& database)
{
    return std::make_shared<GetMarloObjectResponse>(StoredObjectReader(database).read(m_id, m_type, m_depth));
}

std::string GetMarloObject::description() const
{
    return "read the object " + m_id;
}

} // namespace vemi

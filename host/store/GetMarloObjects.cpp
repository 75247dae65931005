#include "host/store/GetMarloObjects.h"

#include "host/domain/BaseObject.h"
#include "host/store/GetMarloObjectsResponse.h"
#include "host/store/StoredObjectReader.h"

namespace vemi {

std::shared_ptr<Response> GetMarloObjects::execute(StoreDatabase& database)
{
    StoredObjectReader reader(database);
    if (m_ids.empty())
        return std::make_shared<GetMarloObjectsResponse>(reader.readAll(m_type, m_depth));
    std::vector<std::shared_ptr<BaseObject>> objects;
    objects.reserve(m_ids.size());
    for (const std::string& id : m_ids)
        objects.push_back(reader.read(id, m_type, m_depth));
    return std::make_shared<GetMarloObjectsResponse>(std::move(objects));
}

std::string GetMarloObjects::description() const
{
    return "read the objects of type " + m_type;
}

} // namespace vemi

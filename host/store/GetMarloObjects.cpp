#include "host/store/GetMarloObjects.h"

#include "host/domain/BaseObject.h"
#include "host/store/GetMarloObjectsResponse.h"
#include "host/store/StoredObjectReader.h"

namespace vemi {

std::shared_ptr<Response> GetMarloObjects::execute(StoreDatabase& database)
{
    StoredObjectReader reader(database);
    std::vector<std::shared_ptr<BaseObject>> objects;
    if (m_ids.empty()) {
        objects = reader.readAll(m_type, m_depth);
    } else {
        objects.reserve(m_ids.size());
        for (const std::string& id : m_ids) {
            if (auto object = reader.readIntact(id, m_type, m_depth))
                objects.push_back(std::move(object));
        }
    }
    return std::make_shared<GetMarloObjectsResponse>(std::move(objects), reader.problems());
}

std::string GetMarloObjects::description() const
{
    return "read the objects of type " + m_type;
}

} // namespace vemi

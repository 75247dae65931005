#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// An entry of the store's folder tree: it names a stored object by id and
// type and the folder it sits in. Its display name is the header's name.
class DirEntry : public BaseObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::string entryObjectId() const { return m_entryObjectId; }
    void setEntryObjectId(const std::string& id) { m_entryObjectId = id; }
    std::string entryObjectType() const { return m_entryObjectType; }
    void setEntryObjectType(const std::string& type) { m_entryObjectType = type; }
    // Empty for an entry at the top level.
    std::string folderId() const { return m_folderId; }
    void setFolderId(const std::string& id) { m_folderId = id; }

    // The stored revision of the named object when the entry was listed; 0
    // when unknown. Not part of the entry's content.
    std::int64_t entryObjectRevision() const { return m_entryObjectRevision; }
    void setEntryObjectRevision(std::int64_t revision) { m_entryObjectRevision = revision; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_entryObjectId;
    std::string m_entryObjectType;
    std::string m_folderId;
    std::int64_t m_entryObjectRevision = 0;
};

} // namespace vemi

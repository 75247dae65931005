#pragma once

#include <QCborMap>
#include <QUuid>

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace vemi {

class Header;

// Root of every object the store keeps. Each object has a UUID string id that
// survives serialisation, a type id naming its class, and a header with its
// display name and description. Objects are held by std::shared_ptr.
class BaseObject
{
public:
    BaseObject();
    BaseObject(const BaseObject&) = delete;
    BaseObject& operator=(const BaseObject&) = delete;
    virtual ~BaseObject();

    std::string id() const { return m_id; }
    void setId(const std::string& id) { m_id = id; }
    QUuid uuid() const;

    // The store's revision of the object when it was read or last saved here;
    // 0 for an object the store has not seen. Not part of the object's
    // content: a save states it, and the store refuses the save when another
    // one was stored since. Safe to read and set from a store's worker.
    std::int64_t storedRevision() const { return m_storedRevision.load(); }
    void setStoredRevision(std::int64_t revision) { m_storedRevision.store(revision); }

    // The type id of the object's own class, equal to that class's static typeId().
    virtual std::string objectTypeId() const = 0;
    virtual std::shared_ptr<Header> header() const { return m_header; }

    // Writes the fields of the object's class (not type, id or header) into map;
    // ObjectCodec adds those three.
    virtual void writeFields(QCborMap& map) const;
    // Reads what writeFields wrote. Throws DecodeError on a malformed field.
    virtual void readFields(const QCborMap& map);

    // Ids of objects stored on their own that this object refers to (the
    // members of a library). Such members are stored as ids and decoded as
    // stand-ins that carry only their id, until resolveReferences replaces them.
    virtual std::vector<std::string> referencedIds() const;
    // The type id of the objects that referencedIds() names; empty when there are none.
    virtual std::string referencedTypeId() const;
    using ObjectLookup = std::function<std::shared_ptr<BaseObject>(const std::string& id)>;
    // Replaces each stand-in by lookup(id); a stand-in whose lookup is empty stays.
    virtual void resolveReferences(const ObjectLookup& lookup);
    // Removes the members with these ids, e.g. those deleted since the object was stored.
    virtual void dropReferences(const std::vector<std::string>& ids);

private:
    std::string m_id;
    std::shared_ptr<Header> m_header;
    std::atomic<std::int64_t> m_storedRevision{0};
};

} // namespace vemi

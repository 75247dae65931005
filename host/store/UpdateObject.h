#pragma once

#include "host/store/Command.h"
#include "host/domain/ObjectSnapshot.h"

#include <QByteArray>

#include <optional>

namespace vemi {

class BaseObject;
class DirEntry;

// Stores an object: creates it or replaces the stored one with the same id.
// Replacing states the revision the object was read at: when another save
// came since, the command is refused (StoreError::conflict) and writes
// nothing. After a save the object carries the revision it wrote.
// The object's snapshot is taken when the command is dispatched (cheap: image
// bytes are shared, not copied) and encoded on the worker; later edits of
// the object are not part of this write.
class UpdateObject : public Command
{
public:
    void setObject(std::shared_ptr<BaseObject> object) { m_object = std::move(object); }
    std::shared_ptr<BaseObject> object() const { return m_object; }
    // Files an object that has no folder entry yet in this folder ("" = top level).
    void setFolderId(const std::string& folderId) { m_folderId = folderId; }

    void prepare() override;
    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override;

    // For a command that writes several objects in one transaction: encode
    // each first (on the worker, outside the transaction), then write each
    // inside the caller's transaction. write() returns the folder entry, if any.
    QByteArray encode() const;
    std::shared_ptr<DirEntry> write(StoreDatabase& database, const QByteArray& data);
    // Gives the object the revision write() stored; call once the transaction committed.
    void commitRevision();

private:
    std::shared_ptr<DirEntry> fileInFolder(StoreDatabase& database);
    // Throws StoreError::conflict when the stored revision is not the one read.
    qint64 nextRevision(StoreDatabase& database);

    std::shared_ptr<BaseObject> m_object;
    std::optional<std::string> m_folderId;
    std::optional<ObjectSnapshot> m_snapshot;
    std::string m_id;
    std::string m_type;
    std::string m_name;
    qint64 m_writtenRevision = 0;
};

} // namespace vemi

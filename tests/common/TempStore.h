#pragma once

#include "host/store/CommandSender.h"
#include "host/store/MarloModel.h"

#include <QTemporaryDir>

#include <memory>
#include <string>
#include <vector>

namespace vemi {
class BaseObject;
class Command;
class Response;
} // namespace vemi

// A real store on a file in a temporary folder, with helpers that run a
// command and wait for its answer.
class TempStore
{
public:
    using Answer = vemi::CommandSender::Answer;

    // The kind of store that TempStore makes from now on.
    enum class Backend { Sqlite, Postgres };
    static void setBackend(Backend backend);
    static Backend backend();

    explicit TempStore(vemi::StoreOptions options = {});
    ~TempStore();

    // The store's file, or its postgresql:// address.
    QString path() const { return m_path; }
    QString folder() const { return m_dir.path(); }
    vemi::MarloModel& model() { return *m_model; }
    // Closes the store (its worker finishes first) and opens the same file anew.
    void reopen(vemi::StoreOptions options = {});
    // The same, opened read-only as with the shell's --read-only.
    void reopenReadOnly();

    // Waits at most 20 s; dispatcherId "" is the default store.
    Answer run(std::shared_ptr<vemi::Command> command, const std::string& dispatcherId = std::string());
    // Both return null (and print the error) when the store refuses.
    std::shared_ptr<vemi::Response> save(std::shared_ptr<vemi::BaseObject> object, const std::string* folderId = nullptr);
    std::shared_ptr<vemi::BaseObject> fetch(const std::string& type, const std::string& id, int depth = 1);
    // Every stored object of the type; empty when the store refuses.
    std::vector<std::shared_ptr<vemi::BaseObject>> fetchAllOfType(const std::string& type, int depth = 1);
    template <class T>
    std::vector<std::shared_ptr<T>> fetchAll(int depth = 1)
    {
        std::vector<std::shared_ptr<T>> objects;
        for (const auto& object : fetchAllOfType(T::typeId(), depth))
            objects.push_back(std::dynamic_pointer_cast<T>(object));
        return objects;
    }

private:
    QTemporaryDir m_dir;
    QString m_path;
    std::unique_ptr<vemi::MarloModel> m_model;
};

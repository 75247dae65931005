#include "tests/common/TempStore.h"

#include "tests/common/TestPostgresServer.h"

#include "host/domain/BaseObject.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObject.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/GetMarloObjects.h"
#include "host/store/GetMarloObjectsResponse.h"
#include "host/store/UpdateObject.h"

#include <cstdio>

namespace {
TempStore::Backend s_backend = TempStore::Backend::Sqlite;
} // namespace

void TempStore::setBackend(Backend backend)
{
    s_backend = backend;
}

TempStore::Backend TempStore::backend()
{
    return s_backend;
}

TempStore::TempStore(vemi::StoreOptions options)
    : m_path(s_backend == Backend::Postgres && TestPostgresServer::shared()
                 ? TestPostgresServer::shared()->createDatabase()
                 : m_dir.filePath(QStringLiteral("store.sqlite")))
{
    reopen(options);
}

TempStore::~TempStore() = default;

void TempStore::reopen(vemi::StoreOptions options)
{
    m_model.reset();
    m_model = std::make_unique<vemi::MarloModel>(m_path, options);
    const QString error = m_model->open();
    if (!error.isEmpty())
        std::fprintf(stderr, "TempStore: %s\n", qPrintable(error));
}

void TempStore::reopenReadOnly()
{
    vemi::StoreOptions readOnly;
    readOnly.readOnly = true;
    reopen(readOnly);
}

TempStore::Answer TempStore::run(std::shared_ptr<vemi::Command> command, const std::string& dispatcherId)
{
    return vemi::CommandSender::sendAndWait(*m_model, dispatcherId, std::move(command), 20000);
}

std::shared_ptr<vemi::Response> TempStore::save(std::shared_ptr<vemi::BaseObject> object, const std::string* folderId)
{
    auto update = std::make_shared<vemi::UpdateObject>();
    update->setObject(std::move(object));
    if (folderId)
        update->setFolderId(*folderId);
    const Answer answer = run(update);
    if (answer.error)
        std::fprintf(stderr, "TempStore: %s\n", qPrintable(answer.error->message()));
    return answer.response;
}

std::shared_ptr<vemi::BaseObject> TempStore::fetch(const std::string& type, const std::string& id, int depth)
{
    auto get = std::make_shared<vemi::GetMarloObject>();
    get->setType(type);
    get->setId(id);
    get->setDepth(depth);
    const Answer answer = run(get);
    if (answer.error)
        std::fprintf(stderr, "TempStore: %s\n", qPrintable(answer.error->message()));
    const auto response = std::dynamic_pointer_cast<vemi::GetMarloObjectResponse>(answer.response);
    return response ? response->object() : nullptr;
}

std::vector<std::shared_ptr<vemi::BaseObject>> TempStore::fetchAllOfType(const std::string& type, int depth)
{
    auto command = std::make_shared<vemi::GetMarloObjects>();
    command->setType(type);
    command->setDepth(depth);
    const auto response = std::dynamic_pointer_cast<vemi::GetMarloObjectsResponse>(run(command).response);
    return response ? response->objects() : std::vector<std::shared_ptr<vemi::BaseObject>>();
}

// A second program on a store, for tests of two programs saving the same
// object: opens the store, reads the object, says "read", waits for a line
// on stdin, saves the object under a new name and says "saved" or "refused:
// <message>". Arguments: store path, object type, object id, new name.

#include "host/domain/BaseObject.h"
#include "host/domain/NamedObject.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObject.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/CommandSender.h"
#include "host/store/MarloModel.h"
#include "host/store/UpdateObject.h"

#include <QCoreApplication>
#include <QStringList>

#include <cstdio>
#include <iostream>
#include <string>

using namespace vemi;

namespace {

constexpr int kDeadlineMs = 20000;

std::shared_ptr<NamedObject> read(MarloModel& store, const std::string& type, const std::string& id)
{
    auto get = std::make_shared<GetMarloObject>();
    get->setType(type);
    get->setId(id);
    const auto answer = CommandSender::sendAndWait(store, std::string(), get, kDeadlineMs);
    const auto response = std::dynamic_pointer_cast<GetMarloObjectResponse>(answer.response);
    return response ? std::dynamic_pointer_cast<NamedObject>(response->object()) : nullptr;
}

} // namespace

int main(int argc, char** argv)
{
    QCoreApplication app(argc, argv);
    const QStringList args = app.arguments();
    if (args.size() != 5) {
        std::puts("usage: storesaver STORE TYPE ID NEWNAME");
        return 2;
    }
    MarloModel store(args[1]);
    const QString openError = store.open();
    const auto object = openError.isEmpty() ? read(store, args[2].toStdString(), args[3].toStdString()) : nullptr;
    if (!object) {
        std::printf("failed: %s\n", qPrintable(openError.isEmpty() ? QStringLiteral("cannot read") : openError));
        return 1;
    }
    std::puts("read");
    std::fflush(stdout);
    std::string go;
    std::getline(std::cin, go);

    object->setName(args[4].toStdString());
    auto update = std::make_shared<UpdateObject>();
    update->setObject(object);
    const auto answer = CommandSender::sendAndWait(store, std::string(), update, kDeadlineMs);
    if (answer.error)
        std::printf("refused: %s\n", qPrintable(answer.error->message()));
    else
        std::puts("saved");
    std::fflush(stdout);
    return 0;
}

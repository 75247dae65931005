#pragma once

#include "host/domain/BaseObject.h"
#include "host/store/GetMarloObjectResponse.h"

#include <QString>

#include <functional>
#include <memory>
#include <string>
#include <vector>

class QObject;
class QWidget;

namespace vemi {

class MarloModel;
class SelectedPath;

// The library pickers of the template editor and the checkpoint dialog: the
// host's object browser for one object type, opened at a remembered place,
// and one fetch per chosen entry. GUI thread only; the store must outlive
// every fetch's context.
class ObjectPicker
{
public:
    struct Request
    {
        QString title;
        std::string typeId;
        bool firstEntryOnly = false;
        int depth = 0; // 0: the store's default depth
        std::vector<std::string> dispatchers; // empty: the default store alone
    };
    // Gets each fetched object as a fetch answer, later, while context lives.
    using OnAnswer = std::function<void(const std::shared_ptr<Response>&)>;

    // Runs the browser modally, opened at position. On OK: position becomes
    // the browser's last place, onAccepted runs (to remember it), and each
    // chosen entry is fetched from the store that holds it; a failed fetch
    // changes nothing and is logged. False when the user cancelled.
    static bool run(MarloModel& store, QWidget* parent, const Request& request, std::shared_ptr<SelectedPath>& position,
                    const std::function<void()>& onAccepted, QObject* context, OnAnswer onAnswer);

    // The object of a fetch answer when it has exactly T's type id, else null.
    template <class T>
    static std::shared_ptr<T> answerObject(const std::shared_ptr<Response>& response)
    {
        const auto answer = std::dynamic_pointer_cast<GetMarloObjectResponse>(response);
        const auto object = answer ? answer->object() : nullptr;
        if (!object || object->objectTypeId() != T::typeId())
            return nullptr;
        return std::dynamic_pointer_cast<T>(object);
    }

    // The place remembered under group of the default settings; never null.
    static std::shared_ptr<SelectedPath> loadPosition(const QString& group);
    // Writes position under group; a null position is not written.
    static void savePosition(const QString& group, const std::shared_ptr<SelectedPath>& position);
};

} // namespace vemi

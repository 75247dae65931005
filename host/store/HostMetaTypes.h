#pragma once

#include <QMetaType>

#include <memory>
#include <string>

namespace vemi {
class BaseObject;
class ErrorInfo;
class Progress;
class Response;
} // namespace vemi

Q_DECLARE_METATYPE(std::shared_ptr<vemi::Response>)
Q_DECLARE_METATYPE(std::shared_ptr<vemi::ErrorInfo>)
Q_DECLARE_METATYPE(std::shared_ptr<vemi::Progress>)
Q_DECLARE_METATYPE(std::shared_ptr<vemi::BaseObject>)
// Carried by the tag display's double-click signal.
Q_DECLARE_METATYPE(std::string)

#pragma once

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/store/GetMarloObjectResponse.h"

#include <QString>
#include <QStringList>

#include <memory>
#include <string>
#include <vector>

// Small builders and readers for tests of the property lists.
namespace PropertyFixtures {

template <class T>
std::shared_ptr<T> named(const std::string& name)
{
    auto object = std::make_shared<T>();
    object->setName(name);
    return object;
}

inline std::shared_ptr<vemi::TagDefinition> definition(const std::string& name, const std::string& defaultValue = {})
{
    auto d = named<vemi::TagDefinition>(name);
    d->setDefaultValue(defaultValue);
    return d;
}

// A fetch answer carrying object, as the store gives it.
inline std::shared_ptr<vemi::Response> answer(std::shared_ptr<vemi::BaseObject> object)
{
    return std::make_shared<vemi::GetMarloObjectResponse>(std::move(object));
}

inline QStringList names(const std::vector<std::shared_ptr<vemi::TagDefinition>>& definitions)
{
    QStringList result;
    for (const auto& d : definitions)
        result << QString::fromStdString(d->name());
    return result;
}

// A value is written as "<definition name>=<value>"; a value whose
// definition is not in the list shows as "?=<value>".
inline QStringList valueTexts(const std::vector<std::shared_ptr<vemi::TagDefinition>>& definitions,
                              const std::vector<std::shared_ptr<vemi::TagValue>>& values)
{
    QStringList result;
    for (const auto& v : values) {
        QString text = "?=" + QString::fromStdString(v->value());
        for (const auto& d : definitions) {
            if (d->id() == v->definitionId())
                text = QString::fromStdString(d->name() + "=" + v->value());
        }
        result << text;
    }
    return result;
}

} // namespace PropertyFixtures

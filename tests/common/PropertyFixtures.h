#pragma once

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/store/GetMarloObjectResponse.h"

#include <QList>
#include <QString>
#include <QtTest>
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

// Rows for removing properties: four definitions P0..P3, of which "values"
// names those that have a value, in the order the values are stored; the
// rows clicked; what remains.
inline void addRemovalRows()
{
    QTest::addColumn<QList<int>>("clickedRows");
    QTest::addColumn<QStringList>("values");
    QTest::addColumn<QStringList>("remainingDefinitions");
    QTest::addColumn<QStringList>("remainingValues");
    const QStringList all{"P0", "P1", "P2", "P3"};
    QTest::newRow("rows 0 and 2 clicked downwards")
        << QList<int>{0, 2} << all << QStringList{"P1", "P3"} << QStringList{"P1=v1", "P3=v3"};
    QTest::newRow("rows 2 and 0 clicked upwards")
        << QList<int>{2, 0} << all << QStringList{"P1", "P3"} << QStringList{"P1=v1", "P3=v3"};
    QTest::newRow("row 3 when only two values exist")
        << QList<int>{3} << QStringList{"P0", "P1"} << QStringList{"P0", "P1", "P2"} << QStringList{"P0=v0", "P1=v1"};
    QTest::newRow("row 1 when P0 and P2 have no value")
        << QList<int>{1} << QStringList{"P1", "P3"} << QStringList{"P0", "P2", "P3"} << QStringList{"P3=v3"};
    QTest::newRow("values stored in another order than the definitions")
        << QList<int>{0, 3} << QStringList{"P3", "P2", "P0"} << QStringList{"P1", "P2"} << QStringList{"P2=v2"};
}

// The definitions P0..P3 and a value "v<i>" for each Pi that values names.
inline void numberedProperties(const QStringList& values, std::vector<std::shared_ptr<vemi::TagDefinition>>* definitions,
                               std::vector<std::shared_ptr<vemi::TagValue>>* tagValues)
{
    for (int i = 0; i < 4; ++i)
        definitions->push_back(definition("P" + std::to_string(i)));
    for (const QString& name : values) {
        const int i = name.mid(1).toInt();
        tagValues->push_back(vemi::TagValue::forDefinition(*(*definitions)[std::size_t(i)], "v" + std::to_string(i)));
    }
}

} // namespace PropertyFixtures

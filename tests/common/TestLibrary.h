#pragma once

#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"

#include <QString>

#include <memory>
#include <vector>

// A library "Interior" of the members "Signal Red", "Ocean Blue" and "Sand
// Yellow": colour standards or property definitions, so that one test covers
// both kinds of library.
struct TestLibrary
{
    using Members = std::vector<std::shared_ptr<vemi::NamedObject>>;

    // kind is "standards" or "properties".
    static TestLibrary make(const QString& kind)
    {
        TestLibrary result;
        std::vector<std::shared_ptr<vemi::Standard>> standards;
        std::vector<std::shared_ptr<vemi::TagDefinition>> definitions;
        for (const char* name : {"Signal Red", "Ocean Blue", "Sand Yellow"}) {
            if (kind == QLatin1String("standards"))
                result.members.push_back(standards.emplace_back(std::make_shared<vemi::Standard>()));
            else
                result.members.push_back(definitions.emplace_back(std::make_shared<vemi::TagDefinition>()));
            result.members.back()->setName(name);
        }
        if (kind == QLatin1String("standards")) {
            auto library = std::make_shared<vemi::ColorStandardsLibrary>();
            library->setStandards(standards);
            result.library = library;
            result.idsField = QStringLiteral("standardIds");
        } else {
            auto library = std::make_shared<vemi::PropertyLibrary>();
            library->setProperties(definitions);
            result.library = library;
            result.idsField = QStringLiteral("propertyIds");
        }
        result.library->setName("Interior");
        return result;
    }

    // The members of a library of either kind.
    static Members membersOf(const vemi::BaseObject& object)
    {
        if (const auto* standards = dynamic_cast<const vemi::ColorStandardsLibrary*>(&object)) {
            const auto members = standards->standards();
            return Members(members.begin(), members.end());
        }
        const auto members = dynamic_cast<const vemi::PropertyLibrary&>(object).properties();
        return Members(members.begin(), members.end());
    }

    std::shared_ptr<vemi::NamedObject> library;
    Members members;
    QString idsField; // the field of the stored bytes that lists the members' ids
};

#pragma once

#include "host/domain/NamedObject.h"

#include <memory>
#include <vector>

namespace vemi {

class Standard;

// A named collection of standards. The standards are stored on their own and
// referred to by id: a decoded library holds stand-ins that carry only their
// ids until resolveReferences swaps in the stored standards.
class ColorStandardsLibrary : public NamedObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::vector<std::shared_ptr<Standard>> standards() const { return m_standards; }
    void setStandards(const std::vector<std::shared_ptr<Standard>>& standards);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;
    std::vector<std::string> referencedIds() const override;
    std::string referencedTypeId() const override;
    void resolveReferences(const ObjectLookup& lookup) override;
    void dropReferences(const std::vector<std::string>& ids) override;

private:
    std::vector<std::shared_ptr<Standard>> m_standards;
};

} // namespace vemi

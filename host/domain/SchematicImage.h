#pragma once

#include "host/domain/BaseObject.h"
#include "host/domain/SharedBytes.h"

namespace vemi {

// An encoded image file (the picture of a part, or a checkpoint's cut-out of
// it) kept byte for byte, with the format name needed to decode it.
class SchematicImage : public BaseObject
{
public:
    SchematicImage();

    static const std::string& typeId();
    std::string objectTypeId() const override;

    // The header's name.
    std::string name() const;
    void setName(const std::string& name);
    std::string originalFilename() const { return m_originalFilename; }
    void setOriginalFilename(const std::string& filename) { m_originalFilename = filename; }
    std::string format() const { return m_format; }
    void setFormat(const std::string& format) { m_format = format; }
    const std::vector<unsigned char>& imageData() const;
    void setImageData(std::vector<unsigned char> data);
    // The same bytes as a shared, immutable buffer: for copies that must not cost.
    SharedBytes sharedImageData() const { return m_imageData; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_originalFilename;
    std::string m_format;
    SharedBytes m_imageData; // never null
};

} // namespace vemi

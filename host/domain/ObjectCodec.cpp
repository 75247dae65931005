#include "ObjectCodec.h"

#include "Header.h"
#include "ObjectRegistry.h"

namespace vemi {

namespace {

const QString kType = QStringLiteral("type");
const QString kId = QStringLiteral("id");
const QString kName = QStringLiteral("name");
const QString kDescription = QStringLiteral("description");

void requireKind(const QCborValue& value, bool ok, const QString& key, const char* kind)
{
    if (!ok && !value.isUndefined())
        throw DecodeError("field \"" + key.toStdString() + "\" is not " + kind);
}

} // namespace

QCborValue ObjectCodec::encode(const std::shared_ptr<const BaseObject>& object)
{
    if (!object)
        return QCborValue(QCborValue::Null);
    return encode(*object);
}

QCborValue ObjectCodec::encode(const BaseObject& object)
{
    QCborMap map;
    map.insert(kType, text(object.objectTypeId()));
    map.insert(kId, text(object.id()));
    const auto header = object.header();
    map.insert(kName, text(header ? header->name() : std::string()));
    map.insert(kDescription, text(header ? header->description() : std::string()));
    object.writeFields(map);
    return map;
}

std::shared_ptr<BaseObject> ObjectCodec::decode(const QCborValue& value)
{
    if (value.isNull())
        return {};
    if (!value.isMap())
        throw DecodeError("an object is not a CBOR map");
    const QCborMap map = value.toMap();
    const std::string type = readText(map, kType);
    auto object = ObjectRegistry::create(type);
    if (!object)
        throw DecodeError("unknown object type \"" + type + "\"");
    object->setId(readText(map, kId));
    object->header()->setName(readText(map, kName));
    object->header()->setDescription(readText(map, kDescription));
    object->readFields(map);
    return object;
}

QByteArray ObjectCodec::serialize(const BaseObject& object)
{
    return encode(object).toCbor();
}

std::shared_ptr<BaseObject> ObjectCodec::deserialize(const QByteArray& bytes)
{
    QCborParserError error;
    const QCborValue value = QCborValue::fromCbor(bytes, &error);
    if (error.error != QCborError::NoError)
        throw DecodeError("invalid CBOR at byte " + std::to_string(error.offset) + ": "
                          + error.errorString().toStdString());
    auto object = decode(value);
    if (!object)
        throw DecodeError("stored value is empty");
    return object;
}

QCborValue ObjectCodec::text(const std::string& value)
{
    return QCborValue(QString::fromStdString(value));
}

QCborValue ObjectCodec::bytes(const std::vector<unsigned char>& value)
{
    return QCborValue(QByteArray(reinterpret_cast<const char*>(value.data()), int(value.size())));
}

QCborArray ObjectCodec::textList(const std::vector<std::string>& values)
{
    QCborArray array;
    for (const std::string& value : values)
        array.append(text(value));
    return array;
}

std::string ObjectCodec::readText(const QCborMap& map, const QString& key)
{
    const QCborValue value = map.value(key);
    requireKind(value, value.isString(), key, "text");
    return value.toString().toStdString();
}

qint64 ObjectCodec::readInteger(const QCborMap& map, const QString& key, qint64 fallback)
{
    const QCborValue value = map.value(key);
    requireKind(value, value.isInteger(), key, "an integer");
    return value.toInteger(fallback);
}

double ObjectCodec::readDouble(const QCborMap& map, const QString& key, double fallback)
{
    const QCborValue value = map.value(key);
    requireKind(value, value.isDouble() || value.isInteger(), key, "a number");
    return value.isUndefined() ? fallback : value.toDouble();
}

bool ObjectCodec::readBool(const QCborMap& map, const QString& key, bool fallback)
{
    const QCborValue value = map.value(key);
    requireKind(value, value.isBool(), key, "a boolean");
    return value.toBool(fallback);
}

std::vector<unsigned char> ObjectCodec::readBytes(const QCborMap& map, const QString& key)
{
    const QCborValue value = map.value(key);
    requireKind(value, value.isByteArray(), key, "a byte string");
    const QByteArray data = value.toByteArray();
    return std::vector<unsigned char>(data.begin(), data.end());
}

std::vector<std::string> ObjectCodec::readTextList(const QCborMap& map, const QString& key)
{
    const QCborValue value = map.value(key);
    requireKind(value, value.isArray(), key, "a list");
    std::vector<std::string> values;
    const QCborArray array = value.toArray();
    values.reserve(size_t(array.size()));
    for (const QCborValue& element : array) {
        if (!element.isString())
            throw DecodeError("an element of field \"" + key.toStdString() + "\" is not text");
        values.push_back(element.toString().toStdString());
    }
    return values;
}

} // namespace vemi

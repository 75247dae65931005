#include "host/domain/ObjectCodec.h"

#include "host/domain/CborStream.h"
#include "host/domain/Header.h"
#include "host/domain/ObjectRegistry.h"

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

ObjectSnapshot ObjectCodec::snapshot(const BaseObject& object)
{
    ObjectSnapshot snapshot;
    DetachedBytes::Scope scope(snapshot.bytes);
    snapshot.tree = encode(object);
    return snapshot;
}

QByteArray ObjectCodec::serialize(const BaseObject& object)
{
    return snapshot(object).toCbor();
}

std::shared_ptr<BaseObject> ObjectCodec::deserialize(const QByteArray& bytes)
{
    DetachedBytes table;
    const QCborValue value = CborStream::read(bytes, table);
    DetachedBytes::Scope scope(table);
    auto object = decode(value);
    if (!object)
        throw DecodeError("stored value is empty");
    return object;
}

QCborValue ObjectCodec::text(const std::string& value)
{
    return QCborValue(QString::fromStdString(value));
}

QCborValue ObjectCodec::bytes(const SharedBytes& value)
{
    if (DetachedBytes* table = DetachedBytes::current())
        return table->add(value);
    if (!value)
        return QCborValue(QByteArray());
    return QCborValue(QByteArray(reinterpret_cast<const char*>(value->data()), int(value->size())));
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

SharedBytes ObjectCodec::readBytes(const QCborMap& map, const QString& key)
{
    const QCborValue value = map.value(key);
    if (DetachedBytes::isPlaceholder(value)) {
        if (!DetachedBytes::current())
            throw DecodeError("field \"" + key.toStdString() + "\" refers to bytes that are not there");
        return DetachedBytes::current()->bytesOf(value);
    }
    requireKind(value, value.isByteArray(), key, "a byte string");
    const QByteArray data = value.toByteArray();
    const auto* begin = reinterpret_cast<const unsigned char*>(data.constData());
    return std::make_shared<const std::vector<unsigned char>>(begin, begin + data.size());
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

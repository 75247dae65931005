#pragma once

#include "host/domain/BaseObject.h"
#include "host/domain/DecodeError.h"
#include "host/domain/ObjectSnapshot.h"
#include "host/domain/SharedBytes.h"

#include <QByteArray>
#include <QCborArray>
#include <QCborMap>
#include <QCborValue>

#include <memory>
#include <string>
#include <vector>

namespace vemi {

// Turns domain objects into CBOR and back. An object is a map with "type",
// "id", "header" and its class's fields; nested objects are maps of their own,
// so a template travels with everything it holds. Byte fields are CBOR byte
// strings, so image data is stored as it is; they are shared, never copied,
// between objects, snapshots and clones. Decoding throws DecodeError.
class ObjectCodec
{
public:
    static QCborValue encode(const std::shared_ptr<const BaseObject>& object);
    static QCborValue encode(const BaseObject& object);
    // An empty handle for CBOR null; throws for anything else that is not an object.
    static std::shared_ptr<BaseObject> decode(const QCborValue& value);

    // Cheap: copies no byte field. The object may change afterwards.
    static ObjectSnapshot snapshot(const BaseObject& object);
    static QByteArray serialize(const BaseObject& object);
    static std::shared_ptr<BaseObject> deserialize(const QByteArray& bytes);

    // A deep copy that keeps every id (and shares the immutable byte fields).
    template <class T>
    static std::shared_ptr<T> clone(const T& object)
    {
        ObjectSnapshot copy = snapshot(object);
        DetachedBytes::Scope scope(copy.bytes);
        return std::dynamic_pointer_cast<T>(decode(copy.tree));
    }

    template <class T>
    static std::shared_ptr<T> decodeAs(const QCborValue& value)
    {
        auto object = decode(value);
        if (!object)
            return {};
        auto typed = std::dynamic_pointer_cast<T>(object);
        if (!typed)
            throw DecodeError("unexpected object type " + object->objectTypeId());
        return typed;
    }

    template <class T>
    static QCborArray encodeList(const std::vector<std::shared_ptr<T>>& objects)
    {
        QCborArray array;
        for (const auto& object : objects)
            array.append(encode(std::shared_ptr<const BaseObject>(object)));
        return array;
    }

    template <class T>
    static std::vector<std::shared_ptr<T>> decodeList(const QCborValue& value)
    {
        std::vector<std::shared_ptr<T>> objects;
        if (value.isUndefined() || value.isNull())
            return objects;
        if (!value.isArray())
            throw DecodeError("a list field is not an array");
        const QCborArray array = value.toArray();
        objects.reserve(size_t(array.size()));
        for (const QCborValue& element : array)
            objects.push_back(decodeAs<T>(element));
        return objects;
    }

    static QCborValue text(const std::string& value);
    static QCborValue bytes(const SharedBytes& value);
    static QCborArray textList(const std::vector<std::string>& values);

    // Field readers: a missing field gives the default; a field of the wrong kind throws.
    static std::string readText(const QCborMap& map, const QString& key);
    static qint64 readInteger(const QCborMap& map, const QString& key, qint64 fallback = 0);
    static double readDouble(const QCborMap& map, const QString& key, double fallback = 0.0);
    static bool readBool(const QCborMap& map, const QString& key, bool fallback = false);
    // Never null: a missing field gives empty bytes.
    static SharedBytes readBytes(const QCborMap& map, const QString& key);
    static std::vector<std::string> readTextList(const QCborMap& map, const QString& key);
};

} // namespace vemi

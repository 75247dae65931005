#include "host/domain/CborStream.h"

#include "host/domain/DecodeError.h"
#include "host/domain/DetachedBytes.h"

#include <QCborArray>
#include <QCborMap>
#include <QCborStreamReader>
#include <QCborStreamWriter>

#include <limits>

namespace vemi {

namespace {

constexpr int kMaxDepth = 256;

void writeValue(QCborStreamWriter& writer, const QCborValue& value, const DetachedBytes& bytes)
{
    if (DetachedBytes::isPlaceholder(value)) {
        const SharedBytes data = bytes.bytesOf(value);
        writer.appendByteString(reinterpret_cast<const char*>(data->data()), qsizetype(data->size()));
        return;
    }
    switch (value.type()) {
    case QCborValue::Integer: writer.append(value.toInteger()); return;
    case QCborValue::Double: writer.append(value.toDouble()); return;
    case QCborValue::False:
    case QCborValue::True: writer.append(value.toBool()); return;
    case QCborValue::Null: writer.appendNull(); return;
    case QCborValue::Undefined: writer.appendUndefined(); return;
    case QCborValue::SimpleType: writer.append(value.toSimpleType()); return;
    case QCborValue::String: writer.append(value.toString()); return;
    case QCborValue::ByteArray: {
        const QByteArray data = value.toByteArray();
        writer.appendByteString(data.constData(), data.size());
        return;
    }
    case QCborValue::Array: {
        const QCborArray array = value.toArray();
        writer.startArray(quint64(array.size()));
        for (const QCborValue& element : array)
            writeValue(writer, element, bytes);
        writer.endArray();
        return;
    }
    case QCborValue::Map: {
        const QCborMap map = value.toMap();
        writer.startMap(quint64(map.size()));
        for (auto it = map.cbegin(); it != map.cend(); ++it) {
            writeValue(writer, it.key(), bytes);
            writeValue(writer, it.value(), bytes);
        }
        writer.endMap();
        return;
    }
    default:
        if (value.isTag()) {
            writer.append(value.tag());
            writeValue(writer, value.taggedValue(), bytes);
        } else {
            writer.appendUndefined();
        }
    }
}

[[noreturn]] void fail(QCborStreamReader& reader)
{
    throw DecodeError("invalid CBOR at byte " + std::to_string(reader.currentOffset()) + ": "
                      + reader.lastError().toString().toStdString());
}

// inputSize bounds what a chunk may declare: a damaged length must not
// make us allocate more than the input could hold.
SharedBytes readByteString(QCborStreamReader& reader, qint64 inputSize)
{
    auto data = std::make_shared<std::vector<unsigned char>>();
    QCborStreamReader::StringResult<qsizetype> chunk;
    do {
        const qsizetype size = reader.currentStringChunkSize();
        if (size < 0)
            fail(reader);
        if (size > inputSize - reader.currentOffset())
            throw DecodeError("a byte string at byte " + std::to_string(reader.currentOffset())
                              + " is longer than the data");
        const size_t offset = data->size();
        data->resize(offset + size_t(size));
        chunk = reader.readStringChunk(reinterpret_cast<char*>(data->data() + offset), size);
        data->resize(offset + size_t(qMax<qsizetype>(chunk.data, 0)));
    } while (chunk.status == QCborStreamReader::Ok);
    if (chunk.status == QCborStreamReader::Error)
        fail(reader);
    return data;
}

QString readTextString(QCborStreamReader& reader)
{
    QString text;
    auto chunk = reader.readString();
    while (chunk.status == QCborStreamReader::Ok) {
        text += chunk.data;
        chunk = reader.readString();
    }
    if (chunk.status == QCborStreamReader::Error)
        fail(reader);
    return text;
}

// Reads one value and everything in it; byte strings go to the detached table.
struct TreeReader
{
    QCborStreamReader& reader;
    DetachedBytes& bytes;
    qint64 inputSize;

    QCborValue value(int depth);
    QCborValue container(int depth);
};

QCborValue TreeReader::container(int depth)
{
    const bool isMap = reader.isMap();
    if (!reader.enterContainer())
        fail(reader);
    QCborArray array;
    QCborMap map;
    while (reader.hasNext()) {
        QCborValue first = value(depth + 1);
        if (isMap)
            map.insert(first, value(depth + 1));
        else
            array.append(first);
    }
    if (reader.lastError() != QCborError::NoError || !reader.leaveContainer())
        fail(reader);
    return isMap ? QCborValue(map) : QCborValue(array);
}

QCborValue TreeReader::value(int depth)
{
    if (depth > kMaxDepth)
        throw DecodeError("CBOR nested too deeply");
    QCborValue result;
    switch (reader.type()) {
    case QCborStreamReader::UnsignedInteger:
    case QCborStreamReader::NegativeInteger: result = QCborValue(reader.toInteger()); break;
    case QCborStreamReader::ByteString: return bytes.add(readByteString(reader, inputSize));
    case QCborStreamReader::TextString: return QCborValue(readTextString(reader));
    case QCborStreamReader::Array:
    case QCborStreamReader::Map: return container(depth);
    case QCborStreamReader::Tag: {
        const QCborTag tag = reader.toTag();
        reader.next();
        return QCborValue(tag, value(depth + 1));
    }
    case QCborStreamReader::SimpleType: result = QCborValue(reader.toSimpleType()); break;
    case QCborStreamReader::Float16: result = QCborValue(double(reader.toFloat16())); break;
    case QCborStreamReader::Float: result = QCborValue(double(reader.toFloat())); break;
    case QCborStreamReader::Double: result = QCborValue(reader.toDouble()); break;
    default: fail(reader);
    }
    if (!reader.next())
        fail(reader);
    return result;
}

} // namespace

QByteArray CborStream::write(const QCborValue& tree, const DetachedBytes& bytes)
{
    QByteArray output;
    output.reserve(int(qMin<qint64>(bytes.totalSize() + 64 * 1024, std::numeric_limits<int>::max())));
    QCborStreamWriter writer(&output);
    writeValue(writer, tree, bytes);
    return output;
}

QCborValue CborStream::read(const QByteArray& data, DetachedBytes& bytes)
{
    QCborStreamReader reader(data);
    QCborValue tree = TreeReader{reader, bytes, data.size()}.value(0);
    if (reader.lastError() != QCborError::NoError)
        fail(reader);
    return tree;
}

} // namespace vemi

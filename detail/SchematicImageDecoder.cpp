#include "detail/SchematicImageDecoder.h"

#include <QBuffer>
#include <QImageReader>

bool SchematicImageDecoder::isAcceptableSize(const QSize& size)
{
    return size.isValid() && size.width() <= MaximumSide && size.height() <= MaximumSide
        && qint64(size.width()) * size.height() <= MaximumPixels;
}

SchematicImageDecoder::Result SchematicImageDecoder::decode(const QByteArray& bytes, const QByteArray& format,
                                                           QImage* image, QSize* declaredSize)
{
    QBuffer buffer;
    buffer.setData(bytes);
    buffer.open(QIODevice::ReadOnly);
    QImageReader reader(&buffer, format);
    // A buffer has no file name, so nothing but the stored format and the
    // bytes themselves choose the decoder.
    reader.setDecideFormatFromContent(format.isEmpty());
    const QSize size = reader.size();
    if (declaredSize)
        *declaredSize = size;
    // A decoder that cannot tell the size before decoding could allocate
    // anything; such pictures are refused as unreadable.
    if (!size.isValid())
        return Result::NotAnImage;
    if (!isAcceptableSize(size))
        return Result::TooLarge;
    QImage decoded;
    if (!reader.read(&decoded) || decoded.isNull())
        return Result::NotAnImage;
    *image = std::move(decoded);
    return Result::Decoded;
}

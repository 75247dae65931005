#pragma once

#include <QByteArray>
#include <QImage>
#include <QSize>

// Decodes schematic pictures, which come from files the user picked or from
// stored templates and so are not trusted: the picture's declared size is read
// from its header first, and a picture larger than any real schematic is
// refused before a single pixel is allocated.
class SchematicImageDecoder
{
public:
    // At most this many pixels on either side and in all (100 megapixels
    // take 400 MB once decoded).
    static constexpr int MaximumSide = 20'000;
    static constexpr qint64 MaximumPixels = 100'000'000;

    enum class Result { Decoded, NotAnImage, TooLarge };

    // format names the stored format ("jpg", "PNG", ...); empty, or one that
    // Qt does not know, lets the content decide. *declaredSize receives the
    // size that the header declares, when it could be read.
    static Result decode(const QByteArray& bytes, const QByteArray& format, QImage* image,
                         QSize* declaredSize = nullptr);
    static bool isAcceptableSize(const QSize& size);
};

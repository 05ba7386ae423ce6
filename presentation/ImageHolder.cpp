#include "presentation/ImageHolder.h"

QString BitmapResourcePath(int id)
{
    return QStringLiteral(":/bitmaps/%1.bmp").arg(id);
}

void ImageHolder::Load(int resourceId)
{
    // Converted once to a direct-colour format so that every paint copies
    // without palette look-ups; nearest-neighbour scaling keeps it sharp.
    image = QImage(BitmapResourcePath(resourceId)).convertToFormat(QImage::Format_RGB32);
    inverted = image;
    inverted.invertPixels();
}

void ImageHolder::Reset()
{
    image = QImage();
    inverted = QImage();
}

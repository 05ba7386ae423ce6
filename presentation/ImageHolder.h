#pragma once

#include <QImage>
#include <cstdint>

// Width and height of a loaded bitmap, as the layout reads them.
struct BitmapInfo {
    int32_t bmWidth = 0;
    int32_t bmHeight = 0;
};

// Resource ids of the game's bitmaps.
enum BitmapId : int {
    kBitmapBoardNormal = 166,
    kBitmapBoardWooden = 200,
    kBitmapBoardEmbossed = 135,
    kBitmapFaceSpades = 130,
    kBitmapFaceDiamonds = 133,
    kBitmapFaceHearts = 134,
    kBitmapFaceClubs = 132,
    kBitmapBack = 164,
    kBitmapRankGlyphs = 161,
    kBitmapPlayerPeg = 162,
    kBitmapOpponentPeg = 163,
    kBitmapDigits = 165,
};

// The resource path of a bitmap of the executable.
QString BitmapResourcePath(int id);

// One bitmap of the executable. A highlighted card is drawn from the inverted
// copy, made once at load, so painting never inverts pixels itself.
class ImageHolder {
public:
    void Load(int resourceId);
    void Reset();

    bool IsNull() const { return image.isNull(); }
    const QImage& Image() const { return image; }
    const QImage& Inverted() const { return inverted; }
    BitmapInfo Info() const { return {image.width(), image.height()}; }

private:
    QImage image;
    QImage inverted;
};

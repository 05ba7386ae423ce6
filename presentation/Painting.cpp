#include "game/GameBoard.h"

#include <QPaintEvent>
#include <QPainter>

namespace {

const QColor kTableGreen(0, 128, 0);

} // namespace

void GameBoard::FirstPaintSetup()
{
    record.firstPaintPending = 0;
    // Whole factors of device pixels, so a fractional ratio still enlarges
    // every art pixel to a whole block of screen pixels.
    const qreal ratio = devicePixelRatioF();
    record.scaleX = ScaleFactorX(qRound(width() * ratio));
    record.scaleY = ScaleFactorY(qRound(height() * ratio));
    CreateActionButtons();
    LoadSettings();
    ReloadBoardBitmap();
}

void GameBoard::PaintImage(QPainter& painter, const QImage& image, QRect source, QPoint target)
{
    const int sx = record.scaleX;
    const int sy = record.scaleY;
    painter.drawImage(QRect(target.x() * sx, target.y() * sy, source.width() * sx, source.height() * sy), image, source);
}

void GameBoard::PaintCard(QPainter& painter, const CardSprite& sprite)
{
    if (sprite.suit1 < 1 || sprite.suit1 > kSuitBack)
        return;
    const bool inverted = sprite.highlighted != 0;
    const int w = cardInfo.bmWidth;
    const int h = cardInfo.bmHeight;
    const QPoint at(sprite.rect.left, sprite.rect.top);
    if (sprite.faceDown || sprite.suit1 == kSuitBack) {
        PaintImage(painter, inverted ? backBitmap.Inverted() : backBitmap.Image(), QRect(0, 0, w, h), at);
        return;
    }
    if (sprite.rank1 < 1 || sprite.rank1 > 13)
        return;
    const ImageHolder& face = suitFaceBitmaps[sprite.suit1 - 1];
    PaintImage(painter, inverted ? face.Inverted() : face.Image(), QRect(0, 0, w, h), at);

    // Black suits (spades, clubs) take rows 0 and 3 of the glyph strip, red ones rows 1 and 2;
    // the ace sits at the far end of the upright rows.
    const QImage& glyphs = inverted ? rankGlyphBitmap.Inverted() : rankGlyphBitmap.Image();
    const bool black = sprite.suit1 == 1 || sprite.suit1 == 4;
    const int uprightX = sprite.rank1 == 1 ? 8 * 13 : 8 * (sprite.rank1 - 1);
    const int turnedX = sprite.rank1 == 1 ? 0 : 8 * (14 - sprite.rank1);
    PaintImage(painter, glyphs, QRect(uprightX, black ? 0 : 10, 8, 10), at + QPoint(2, 3));
    PaintImage(painter, glyphs, QRect(turnedX, black ? 30 : 20, 8, 10), at + QPoint(w - 10, h - 13));
}

void GameBoard::paintEvent(QPaintEvent* event)
{
    if (record.firstPaintPending)
        FirstPaintSetup();

    QPainter painter(this);
    painter.setClipRegion(event->region());
    painter.fillRect(rect(), kTableGreen);
    // From here on coordinates are device pixels: every image is copied at
    // exactly the whole factors, without resampling by the ratio.
    const qreal ratio = devicePixelRatioF();
    painter.scale(1 / ratio, 1 / ratio);

    PaintImage(painter, boardBitmap.Image(), QRect(0, 0, boardInfo.bmWidth, boardInfo.bmHeight), QPoint(0, 0));

    const QRect peg(0, 0, pegInfo.bmWidth, pegInfo.bmHeight);
    const GameRecord& r = record;
    for (const Rect* place : {&r.opponentBackPegRect, &r.opponentFrontPegRect})
        PaintImage(painter, opponentPegBitmap.Image(), peg, QPoint(place->left, place->top));
    for (const Rect* place : {&r.playerBackPegRect, &r.playerFrontPegRect})
        PaintImage(painter, playerPegBitmap.Image(), peg, QPoint(place->left, place->top));

    for (const CardSprite& sprite : r.opponentHandSprites)
        PaintCard(painter, sprite);
    for (const CardSprite& sprite : r.playerHandSprites)
        PaintCard(painter, sprite);
    for (const CardSprite& sprite : r.opponentPileSprites)
        PaintCard(painter, sprite);
    for (const CardSprite& sprite : r.playerPileSprites)
        PaintCard(painter, sprite);
    PaintCard(painter, r.starterSprite);

    if (r.countVisible) {
        const int n = r.shownCount;
        const QPoint at(r.countRect.left, r.countRect.top);
        if (n >= 0 && n < 10) {
            PaintImage(painter, digitBitmap.Image(), QRect(8 * n, 0, 8, 8), at + QPoint(4, 0));
        } else if (n >= 10 && n < 100) {
            PaintImage(painter, digitBitmap.Image(), QRect(8 * (n / 10), 0, 8, 8), at);
            PaintImage(painter, digitBitmap.Image(), QRect(8 * (n % 10), 0, 8, 8), at + QPoint(8, 0));
        }
    }
}

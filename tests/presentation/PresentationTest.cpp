#include "presentation/HoleMap.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QCryptographicHash>
#include <QDataStream>
#include <QListWidget>
#include <QPainter>
#include <QPushButton>
#include <QScreen>

#include <span>

namespace {

// One of the program's bitmaps as it must reach the screen, or its inverse.
QImage Art(int id, bool inverted = false)
{
    QImage image = QImage(QStringLiteral(":/bitmaps/%1.bmp").arg(id)).convertToFormat(QImage::Format_RGB32);
    if (inverted)
        image.invertPixels();
    return image;
}

// A card place as the record describes it: empty, a back, or the suit's face
// with the rank in two corners (black suits from rows 0 and 3 of the glyph
// strip, red ones from rows 1 and 2; the ace at the far end), inverted when chosen.
void DrawCard(QPainter& scene, const CardSprite& s, bool chosen = false)
{
    static const int faces[] = {kBitmapFaceSpades, kBitmapFaceDiamonds, kBitmapFaceHearts, kBitmapFaceClubs};
    const QPoint at(s.rect.left, s.rect.top);
    const bool back = s.faceDown || s.suit1 == kSuitBack;
    if (s.suit1 != kSuitEmpty)
        scene.drawImage(at, Art(back ? kBitmapBack : faces[s.suit1 - 1], chosen));
    if (s.suit1 == kSuitEmpty || back)
        return;
    const QImage glyphs = Art(kBitmapRankGlyphs, chosen);
    const bool black = s.suit1 == 1 || s.suit1 == 4;
    scene.drawImage(at + QPoint(2, 3), glyphs, QRect(8 * (s.rank1 == 1 ? 13 : s.rank1 - 1), black ? 0 : 10, 8, 10));
    scene.drawImage(at + QPoint(13, 28), glyphs, QRect(8 * (s.rank1 == 1 ? 0 : 14 - s.rank1), black ? 30 : 20, 8, 10));
}

// Lets the event loop repaint what was invalidated, reads the window back from
// the screen and compares it, outside the shown buttons and log, with the scene
// the record describes, drawn in board pixels and enlarged by the scale factors.
void CheckScreen(GameBoard& board, int boardId)
{
    QCoreApplication::processEvents();
    const QImage shot = board.screen()->grabWindow(board.winId()).toImage().convertToFormat(QImage::Format_RGB32);
    const GameRecord& r = board.record;
    const int sx = r.scaleX, sy = r.scaleY;
    QVERIFY(sx >= 1 && sy >= 1 && shot.size() == board.size());

    QImage expected(shot.width() / sx + 1, shot.height() / sy + 1, QImage::Format_RGB32);
    expected.fill(qRgb(0, 128, 0));
    QPainter scene(&expected);
    scene.drawImage(0, 0, Art(boardId));
    // Each peg (5 x 5) centred on its hole.
    const HolePoint pegs[] = {r.opponentHoles[r.opponentBackHole], r.opponentHoles[r.opponentFrontHole],
                              r.playerHoles[r.playerBackHole], r.playerHoles[r.playerFrontHole]};
    for (int i = 0; i < 4; ++i)
        scene.drawImage(pegs[i].x - 2, pegs[i].y - 2, Art(i < 2 ? kBitmapOpponentPeg : kBitmapPlayerPeg));
    for (int i = 0; i < 6; ++i)  // of all places, the user's chosen cards alone show inverted
        DrawCard(scene, r.playerHandSprites[i], r.selected[i] != 0);
    using Places = std::span<const CardSprite>;
    for (Places group : {Places(r.opponentHandSprites), Places(r.opponentPileSprites), Places(r.playerPileSprites),
                         Places(&r.starterSprite, 1)})
        for (const CardSprite& s : group)
            DrawCard(scene, s);
    for (const int n = r.shownCount; const QPoint cell : n < 10 ? QList<QPoint>{{4, n}} : QList<QPoint>{{0, n / 10}, {8, n % 10}})
        if (r.countVisible)
            scene.drawImage(r.countRect.left + cell.x(), r.countRect.top, Art(kBitmapDigits), 8 * cell.y(), 0, 8, 8);
    scene.end();

    QRegion children;
    for (const QWidget* child : board.findChildren<QWidget*>(Qt::FindDirectChildrenOnly))
        children += child->isHidden() ? QRect() : child->geometry();
    for (int y = 0; y < shot.height(); ++y)
        for (int x = 0; x < shot.width(); ++x)
            if (!children.contains(QPoint(x, y)) && shot.pixel(x, y) != expected.pixel(x / sx, y / sy))
                QFAIL(qPrintable(QStringLiteral("board pixel (%1, %2) is not as the record says").arg(x / sx).arg(y / sy)));
}

} // namespace

// What the window shows and where: the fixed geometry, and the screen read
// back after each change.
class PresentationTest : public QObject {
    Q_OBJECT

private slots:
    // Hole centres, card places, controls, scale factors and window sizes: fixed
    // values the board images and every tap depend on, held by one checksum.
    void geometryChecksum()
    {
        QByteArray all;
        QDataStream out(&all, QIODevice::WriteOnly);
        HolePoint player[kHoleCount], opponent[kHoleCount];
        BuildHoleTables(player, opponent);
        for (int i = 0; i < kHoleCount; ++i)
            out << player[i].x << player[i].y << opponent[i].x << opponent[i].y;
        for (int n : {0, 240, 268, 479, 480, 587, 588, 907, 908})
            out << GameBoard::ScaleFactorX(n) << GameBoard::ScaleFactorY(n);
        for (int scale : {1, 2, 3}) {
            auto board = MakeBoard(scale);
            const GameRecord& r = board->record;
            const QListWidget* log = board->MessageLog();
            out << r.scaleX << r.scaleY << board->DeviceWindowSize(scale) << log->geometry() << log->font().pixelSize()
                << int(log->selectionMode()) << int(log->focusPolicy());
            out << board->ScaledRect(r.starterSprite.rect) << board->ScaledRect(r.countRect);
            for (int i = 0; i < 6; ++i)
                out << board->ScaledRect(r.opponentHandSprites[i].rect) << board->ScaledRect(r.playerHandSprites[i].rect);
            for (int i = 0; i < 4; ++i)
                out << board->ScaledRect(r.opponentPileSprites[i].rect) << board->ScaledRect(r.playerPileSprites[i].rect);
            for (int id : {kCmdDeal, kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk})
                out << board->ActionButton(id)->geometry() << board->ActionButton(id)->text();
        }
        QCOMPARE(QCryptographicHash::hash(all, QCryptographicHash::Md5).toHex(), QByteArray("969b633a9b539fb62cf7226e9c945a12"));
    }

    // What the window shows after each change, read back from the screen.
    void screenFollowsTheRecord()
    {
        auto board = MakeBoard(2);
        GameRecord& r = board->record;
        CheckScreen(*board, kBitmapBoardNormal);

        // Aces, tens and kings of both colours, all four suits; the second one chosen.
        StackDeck(*board, {Card(1, 1), Card(10, 2), Card(13, 3), Card(13, 4), Card(1, 3), Card(10, 4),
                           Card(2, 1), Card(3, 2), Card(4, 3), Card(5, 4), Card(6, 1), Card(7, 2), Card(8, 3)});
        ClickButton(*board, kCmdDeal);
        TapHand(*board, 2);
        QVERIFY(r.playerHandSprites[1].highlighted && r.starterSprite.suit1 == kSuitBack);
        CheckScreen(*board, kBitmapBoardNormal);

        // The starter turned, a card laid by each side, the count shown.
        TapHand(*board, 5);
        ClickButton(*board, kCmdSendToCrib);
        TapHand(*board, 2);
        QVERIFY(r.playerPileSprites[0].suit1 && r.opponentPileSprites[0].suit1 && r.countVisible);
        CheckScreen(*board, kBitmapBoardNormal);

        board->MovePlayerPegs(12);
        board->MoveOpponentPegs(40);
        for (int count : {9, 10, 31}) {
            r.runningCount = count;
            board->RefreshCount();
            CheckScreen(*board, kBitmapBoardNormal);
        }

        // A style chosen in Options shows at once, and stays through New game.
        board->ApplyBoardStyle(2);
        CheckScreen(*board, kBitmapBoardWooden);
        board->NewGame();
        CheckScreen(*board, kBitmapBoardWooden);
    }
};

VENNICK_TEST(PresentationTest);
#include "PresentationTest.moc"

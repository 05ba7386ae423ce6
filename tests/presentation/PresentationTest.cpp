#include "presentation/HoleMap.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QCryptographicHash>
#include <QDataStream>
#include <QDir>
#include <QListWidget>
#include <QPainter>
#include <QPushButton>
#include <QScreen>

namespace {

// Lets the event loop repaint what was invalidated, reads the window back from
// the screen and compares it with the picture recorded for that state: the
// board, pegs, cards and count, all drawn from the program's bitmaps. The shown
// buttons and log, drawn by Qt with the system's fonts, are blacked out. The
// pictures were checked by eye and against a scene drawn from the record; a
// picture that differs is saved for a look.
void CheckScreen(GameBoard& board, const char* expected)
{
    QCoreApplication::processEvents();
    QImage shot = board.screen()->grabWindow(board.winId()).toImage().convertToFormat(QImage::Format_RGB32);
    QPainter mask(&shot);
    for (const QWidget* child : board.findChildren<QWidget*>(Qt::FindDirectChildrenOnly))
        if (!child->isHidden())
            mask.fillRect(child->geometry(), Qt::black);
    mask.end();
    const QByteArray md5 =
        QCryptographicHash::hash(QByteArrayView(shot.constBits(), shot.sizeInBytes()), QCryptographicHash::Md5).toHex();
    if (md5 != expected)
        shot.save(QDir::temp().filePath(QStringLiteral("vennick-%1.png").arg(QLatin1String(md5))));
    QCOMPARE(md5, QByteArray(expected));
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
        const GameBoard unshown;
        for (int n : {0, 240, 268, 479, 480, 537, 538, 587, 588, 806, 807, 907, 908})
            out << GameBoard::ScaleFactorX(n) << unshown.ScaleFactorY(n);
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
        QCOMPARE(QCryptographicHash::hash(all, QCryptographicHash::Md5).toHex(), QByteArray("4e9bd59cd9bbfb0d4bbc61bf21cc2b3e"));
    }

    // What the window shows after each change, read back from the screen.
    void screenFollowsTheRecord()
    {
        auto board = MakeBoard(2);
        CheckScreen(*board, "a02250d908645c74ebe7ff3b20ad18e1");

        // Aces, tens and kings of both colours, all four suits; the second one chosen.
        StackDeck(*board, {Card(1, 1), Card(10, 2), Card(13, 3), Card(13, 4), Card(1, 3), Card(10, 4),
                           Card(2, 1), Card(3, 2), Card(4, 3), Card(5, 4), Card(6, 1), Card(7, 2), Card(8, 3)});
        ClickButton(*board, kCmdDeal);
        TapHand(*board, 2);
        CheckScreen(*board, "66c21b9d7e0035281e48f8cbf403ecfe");

        // The starter turned, a card laid by each side, the count shown.
        TapHand(*board, 5);
        ClickButton(*board, kCmdSendToCrib);
        TapHand(*board, 2);
        CheckScreen(*board, "73ca2df78aca4b5659c67a6eb2c0108b");

        board->MovePlayerPegs(12);
        board->MoveOpponentPegs(40);
        for (const auto& [count, picture] : {std::pair(9, "e4370057cb168a6aa0b09c36b133505d"),
                                             std::pair(10, "af406513f38afde34725d4fdba4594a7"),
                                             std::pair(31, "eea3a0bfcbbab622cea44678a04823c2")}) {
            board->record.runningCount = count;
            board->RefreshCount();
            CheckScreen(*board, picture);
        }

        // A style chosen in Options shows at once, and stays through New game.
        board->ApplyBoardStyle(2);
        CheckScreen(*board, "6e34c8a7ffbb1bc7061fec19b55d029a");
        board->NewGame();
        CheckScreen(*board, "4fbbf7e675049ed794e01306b60ae7c4");
    }
};

VENNICK_TEST(PresentationTest);
#include "PresentationTest.moc"

#include "presentation/HoleMap.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QCryptographicHash>
#include <QDataStream>
#include <QListWidget>
#include <QPushButton>

// Hole centres, card places, controls, scale factors and window sizes: fixed
// values the board images and every tap depend on, held by one checksum.
class LayoutTest : public QObject {
    Q_OBJECT

private slots:
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
            out << r.scaleX << r.scaleY << board->DeviceWindowSize(scale) << board->MessageLog()->geometry();
            out << board->ScaledRect(r.starterSprite.rect) << board->ScaledRect(r.countRect);
            for (int i = 0; i < 6; ++i)
                out << board->ScaledRect(r.opponentHandSprites[i].rect) << board->ScaledRect(r.playerHandSprites[i].rect);
            for (int i = 0; i < 4; ++i)
                out << board->ScaledRect(r.opponentPileSprites[i].rect) << board->ScaledRect(r.playerPileSprites[i].rect);
            for (int id : {kCmdDeal, kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk})
                out << board->ActionButton(id)->geometry() << board->ActionButton(id)->text();
        }
        QCOMPARE(QCryptographicHash::hash(all, QCryptographicHash::Md5).toHex(), QByteArray("a322c907bf6e901b352fde0bfb952c78"));
    }
};

VENNICK_TEST(LayoutTest);
#include "LayoutTest.moc"

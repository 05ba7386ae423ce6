#include "presentation/HoleMap.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QListWidget>
#include <QPushButton>

// Hole centres, card places, controls and scale factors: fixed values the
// board images and every tap depend on.
class LayoutTest : public QObject {
    Q_OBJECT

private slots:
    void holeTable()
    {
        HolePoint player[kHoleCount];
        HolePoint opponent[kHoleCount];
        BuildHoleTables(player, opponent);

        const int columnY[35] = {179, 175, 171, 167, 163, 158, 154, 150, 146, 142, 136, 132,
                                 128, 124, 120, 115, 111, 107, 103, 99,  93,  89,  85,  81,
                                 77,  72,  68,  64,  60,  56,  50,  46,  42,  38,  34};
        for (int i = 0; i < 35; ++i) {
            QCOMPARE(player[1 + i], (HolePoint{12, columnY[i]}));
            QCOMPARE(opponent[1 + i], (HolePoint{21, columnY[i]}));
            QCOMPARE(player[86 + i], (HolePoint{37, columnY[i]}));
            QCOMPARE(opponent[86 + i], (HolePoint{46, columnY[i]}));
            QCOMPARE(player[80 - i], (HolePoint{71, columnY[i]}));
            QCOMPARE(opponent[80 - i], (HolePoint{63, columnY[i]}));
        }
        const HolePoint playerTop[10] = {{12, 29}, {13, 20}, {19, 14}, {27, 10}, {36, 8},
                                         {46, 8},  {55, 10}, {63, 14}, {69, 20}, {71, 29}};
        const HolePoint opponentTop[10] = {{21, 29}, {22, 23}, {27, 19}, {33, 17}, {39, 16},
                                           {45, 16}, {51, 17}, {57, 19}, {62, 23}, {63, 29}};
        for (int i = 0; i < 10; ++i) {
            QCOMPARE(player[36 + i], playerTop[i]);
            QCOMPARE(opponent[36 + i], opponentTop[i]);
        }
        const HolePoint playerBottom[5] = {{71, 185}, {64, 197}, {54, 200}, {43, 197}, {37, 185}};
        const HolePoint opponentBottom[5] = {{63, 185}, {61, 190}, {55, 191}, {49, 190}, {46, 185}};
        for (int i = 0; i < 5; ++i) {
            QCOMPARE(player[81 + i], playerBottom[i]);
            QCOMPARE(opponent[81 + i], opponentBottom[i]);
        }
        QCOMPARE(player[kGameHole], (HolePoint{41, 26}));
        QCOMPARE(opponent[kGameHole], (HolePoint{42, 26}));
        QCOMPARE(player[kStartHole], (HolePoint{12, 190}));
        QCOMPARE(player[kBackStartHole], (HolePoint{12, 195}));
        QCOMPARE(opponent[kStartHole], (HolePoint{21, 190}));
        QCOMPARE(opponent[kBackStartHole], (HolePoint{21, 195}));
    }

    void cardPlaces()
    {
        auto board = MakeBoard();
        const GameRecord& r = board->record;
        const int columns[6] = {88, 113, 138, 163, 188, 213};
        for (int i = 0; i < 6; ++i) {
            QCOMPARE(r.opponentHandSprites[i].rect, (Rect{columns[i], 0, columns[i] + 23, 41}));
            QCOMPARE(r.playerHandSprites[i].rect, (Rect{columns[i], 152, columns[i] + 23, 193}));
        }
        for (int i = 0; i < 4; ++i) {
            QCOMPARE(r.opponentPileSprites[i].rect, (Rect{columns[i + 1], 45, columns[i + 1] + 23, 86}));
            QCOMPARE(r.playerPileSprites[i].rect, (Rect{columns[i + 1], 107, columns[i + 1] + 23, 148}));
        }
        QCOMPARE(r.starterSprite.rect, (Rect{88, 105, 111, 146}));
        QCOMPARE(r.countRect, (Rect{91, 87, 107, 103}));
    }

    void controls_data()
    {
        QTest::addColumn<int>("scale");
        QTest::newRow("scale 1") << 1;
        QTest::newRow("scale 2") << 2;
        QTest::newRow("scale 3") << 3;
    }

    void controls()
    {
        QFETCH(int, scale);
        auto board = MakeBoard(scale);
        QCOMPARE(board->record.scaleX, scale);
        QCOMPARE(board->record.scaleY, scale);
        const struct {
            int id;
            const char* caption;
            QRect logical;
        } expected[] = {
            {kCmdDeal, "Deal", QRect(QPoint(137, 195), QPoint(186, 210))},
            {kCmdSendToCrib, "Send To Crib", QRect(QPoint(112, 195), QPoint(211, 210))},
            {kCmdScorePlayerHand, "Score Player's Hand", QRect(QPoint(92, 195), QPoint(231, 210))},
            {kCmdScoreOpponentHand, "Score Opponent's Hand", QRect(QPoint(87, 195), QPoint(236, 210))},
            {kCmdScoreCrib, "Score Crib", QRect(QPoint(122, 195), QPoint(201, 210))},
            {kCmdOk, "Ok", QRect(QPoint(137, 195), QPoint(186, 210))},
        };
        for (const auto& e : expected) {
            QPushButton* button = board->ActionButton(e.id);
            QVERIFY(button);
            QCOMPARE(button->text(), QString::fromLatin1(e.caption));
            QCOMPARE(button->geometry(), QRect(e.logical.x() * scale, e.logical.y() * scale,
                                               e.logical.width() * scale, e.logical.height() * scale));
        }
        QCOMPARE(board->MessageLog()->geometry(), QRect(3 * scale, 213 * scale, 233 * scale, 56 * scale));
    }

    void scaleFactors_data()
    {
        QTest::addColumn<QSize>("window");
        QTest::addColumn<int>("sx");
        QTest::addColumn<int>("sy");
        QTest::newRow("240 x 268") << QSize(240, 268) << 1 << 1;
        QTest::newRow("480 x 588") << QSize(480, 588) << 2 << 2;
        QTest::newRow("479 wide") << QSize(479, 588) << 1 << 2;
        QTest::newRow("720 x 908") << QSize(720, 908) << 3 << 3;
        QTest::newRow("too small is clamped to 1") << QSize(100, 100) << 1 << 1;
        QTest::newRow("empty is clamped to 1") << QSize(0, 0) << 1 << 1;
    }

    void scaleFactors()
    {
        QFETCH(QSize, window);
        QFETCH(int, sx);
        QFETCH(int, sy);
        QCOMPARE(GameBoard::ScaleFactorX(window.width()), sx);
        QCOMPARE(GameBoard::ScaleFactorY(window.height()), sy);
    }

    void scaledRect()
    {
        auto board = MakeBoard(2);
        QCOMPARE(board->ScaledRect(board->record.starterSprite.rect), QRect(QPoint(176, 210), QPoint(221, 291)));
    }
};

VENNICK_TEST(LayoutTest);
#include "LayoutTest.moc"

#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QListWidget>
#include <QPushButton>
#include <QScrollBar>

#include <set>

// The deal, the discard and New game, driven as the user drives them.
class DealTest : public QObject {
    Q_OBJECT

private:
    static void CheckStartState(const GameBoard& board)
    {
        const GameRecord& r = board.record;
        QCOMPARE(r.phase, int(kPhaseNoDeal));
        QCOMPARE(board.PlayerScore(), 0);
        QCOMPARE(board.OpponentScore(), 0);
        QCOMPARE(r.playerBackHole, kBackStartHole);
        QCOMPARE(r.opponentBackHole, kBackStartHole);
        QCOMPARE(r.gameOver, 0);
        QCOMPARE(r.countVisible, 0);
        for (int i = 0; i < 6; ++i) {
            QCOMPARE(r.playerHandSprites[i].suit1, kSuitEmpty);
            QCOMPARE(r.opponentHandSprites[i].suit1, kSuitEmpty);
            QCOMPARE(r.opponentHandSprites[i].faceDown, 1);
            QCOMPARE(r.playerHandSprites[i].faceDown, 0);
            QCOMPARE(r.playerHandSprites[i].highlighted, 0);
        }
        for (int i = 0; i < 4; ++i) {
            QCOMPARE(r.playerPileSprites[i].suit1, kSuitEmpty);
            QCOMPARE(r.opponentPileSprites[i].suit1, kSuitEmpty);
        }
        QCOMPARE(r.starterSprite.suit1, kSuitEmpty);
        QCOMPARE(ShownButtons(board), QList<int>{kCmdDeal});
        QCOMPARE(LogLines(board).size(), 3);
        QCOMPARE(LogLines(board).last(), QStringLiteral("Click Deal to start a new game."));
    }

private slots:
    void startStateAfterConstructionAndNewGame()
    {
        auto board = MakeBoard();
        CheckStartState(*board);
        QCOMPARE(board->record.playerCrib, 1);
        QCOMPARE(board->record.savedPlayerCrib, 1);

        ReleaseEnter(*board);
        TapHand(*board, 1);
        board->NewGame();
        CheckStartState(*board);
        QCOMPARE(board->record.savedPlayerCrib, 0);
        QCOMPARE(board->record.playerCrib, 0);
    }

    void dealsAreDistinctSortedAndAlternate()
    {
        auto board = MakeBoard();
        std::srand(12345);
        QString previousCrib;
        for (int n = 0; n < 300; ++n) {
            board->NewGame();
            const auto before = LogLines(*board).size();
            board->OnDeal();
            const GameRecord& r = board->record;
            std::set<CardId> cards(std::begin(r.deal), std::end(r.deal));
            QCOMPARE(int(cards.size()), 13);
            QVERIFY(*cards.begin() >= 0 && *cards.rbegin() <= 51);
            for (int i = 0; i < 5; ++i)
                QVERIFY(CardRank(r.deal[i]) <= CardRank(r.deal[i + 1]));
            QCOMPARE(r.phase, int(kPhaseDiscard));
            const QStringList lines = LogLines(*board).mid(before);
            QCOMPARE(lines.value(0), QStringLiteral("Shuffling..."));
            QCOMPARE(lines.value(1), r.playerCrib ? QStringLiteral("Your Crib.") : QStringLiteral("Opponent's Crib."));
            // New game alternates the first crib from game to game.
            QVERIFY(lines.value(1) != previousCrib);
            previousCrib = lines.value(1);
            for (int i = 0; i < 6; ++i) {
                QCOMPARE(r.playerHandSprites[i].rank1, CardRank(r.deal[i]) + 1);
                QCOMPARE(r.playerHandSprites[i].suit1, CardSuit(r.deal[i]) + 1);
            }
            QCOMPARE(r.starterSprite.suit1, kSuitBack);
            QVERIFY(ShownButtons(*board).isEmpty());
        }
    }

    void dealsAlternateTheCribWithinAGame()
    {
        auto board = MakeBoard();
        QStringList cribLines;
        for (int n = 0; n < 4; ++n) {
            board->record.phase = kPhaseCribCounted;  // as after the crib was counted
            board->OnDeal();
            cribLines.append(LogLines(*board).last());
        }
        QCOMPARE(cribLines, (QStringList{"Opponent's Crib.", "Your Crib.", "Opponent's Crib.", "Your Crib."}));
    }

    void equalRanksKeepTheirDrawingOrder()
    {
        auto board = MakeBoard();
        // Two sevens and two kings among the user's six, each pair drawn hearts first.
        StackDeck(*board, {Card(7, 3), Card(13, 3), Card(2, 1), Card(7, 1), Card(13, 2), Card(1, 4),
                           Card(3, 2), Card(4, 2), Card(5, 2), Card(6, 2), Card(8, 2), Card(9, 2), Card(10, 4)});
        ReleaseEnter(*board);
        const CardId expected[6] = {Card(1, 4), Card(2, 1), Card(7, 3), Card(7, 1), Card(13, 3), Card(13, 2)};
        for (int i = 0; i < 6; ++i)
            QCOMPARE(board->record.deal[i], expected[i]);
    }

    void sendToCribMovesTheChosenCards_data()
    {
        QTest::addColumn<int>("first");   // 0-based hand positions chosen
        QTest::addColumn<int>("second");
        QTest::addColumn<QList<int>>("order");  // resulting ranks of positions 0..5

        // The user holds A 2 3 4 5 6 (ranks 1..6), all of different suits' mixes.
        QTest::newRow("1 and 3: 1 to 0, 3 to 5, then 1..4 sorted") << 1 << 3 << QList<int>{2, 1, 3, 5, 6, 4};
        QTest::newRow("0 and 5: nothing moves") << 0 << 5 << QList<int>{1, 2, 3, 4, 5, 6};
        QTest::newRow("0 and 4: 4 and 5 change places") << 0 << 4 << QList<int>{1, 2, 3, 4, 6, 5};
        QTest::newRow("4 and 5: 4 goes to 0") << 4 << 5 << QList<int>{5, 1, 2, 3, 4, 6};
        QTest::newRow("2 and 3") << 2 << 3 << QList<int>{3, 1, 2, 5, 6, 4};
    }

    void sendToCribMovesTheChosenCards()
    {
        QFETCH(int, first);
        QFETCH(int, second);
        QFETCH(QList<int>, order);
        auto board = MakeBoard();
        StackDeck(*board, {Card(1, 1), Card(2, 2), Card(3, 3), Card(4, 4), Card(5, 1), Card(6, 2),
                           Card(8, 1), Card(9, 2), Card(10, 3), Card(11, 4), Card(12, 1), Card(13, 2), Card(7, 3)});
        ReleaseEnter(*board);
        TapHand(*board, first + 1);
        TapHand(*board, second + 1);
        QCOMPARE(ShownButtons(*board), QList<int>{kCmdSendToCrib});
        ClickButton(*board, kCmdSendToCrib);

        const GameRecord& r = board->record;
        QCOMPARE(r.phase == kPhasePlay || r.phase == kPhaseGameOver, true);
        for (int i = 0; i < 6; ++i)
            QCOMPARE(CardRank(r.deal[i]) + 1, order[i]);
        QCOMPARE(r.playerHandSprites[0].suit1, kSuitEmpty);
        QCOMPARE(r.playerHandSprites[5].suit1, kSuitEmpty);
        QCOMPARE(r.opponentHandSprites[0].suit1, kSuitEmpty);
        QCOMPARE(r.opponentHandSprites[5].suit1, kSuitEmpty);
        QCOMPARE(r.starterSprite.suit1, CardSuit(Card(7, 3)) + 1);
        QCOMPARE(r.starterSprite.rank1, 7);
        QVERIFY(!board->IsButtonShown(kCmdSendToCrib));
        for (int i = 0; i < 6; ++i)
            QCOMPARE(r.playerHandSprites[i].highlighted, 0);
    }
};

VENNICK_TEST(DealTest);
#include "DealTest.moc"

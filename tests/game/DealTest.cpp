#include "support/TestBoard.h"
#include "support/TestMain.h"

// The deal and the discard, driven as the user drives them.
class DealTest : public QObject {
    Q_OBJECT

private slots:
    void dealSortsByRankKeepingEqualRanksInDrawingOrder()
    {
        auto board = MakeBoard();
        // Two sevens and two kings (one the last card of the pack) among the
        // user's six, each pair drawn hearts first.
        StackDeck(*board, {Card(7, 3), Card(13, 3), Card(2, 1), Card(7, 1), Card(13, 4), Card(1, 4),
                           Card(3, 2), Card(4, 2), Card(5, 2), Card(6, 2), Card(8, 2), Card(9, 2), Card(10, 4)});
        ReleaseEnter(*board);
        const CardId expected[6] = {Card(1, 4), Card(2, 1), Card(7, 3), Card(7, 1), Card(13, 3), Card(13, 4)};
        for (int i = 0; i < 6; ++i) {  // each also shown in its place
            const CardSprite& place = board->record.playerHandSprites[i];
            QCOMPARE(QList<int>({board->record.deal[i], place.rank1, place.suit1}),
                     QList<int>({expected[i], CardRank(expected[i]) + 1, CardSuit(expected[i]) + 1}));
        }
        QCOMPARE(LogLines(*board).mid(3), (QStringList{"Shuffling...", "Opponent's Crib."}));
    }

    void sendToCribMovesTheChosenCards_data()
    {
        QTest::addColumn<QList<int>>("chosen");  // 0-based hand positions
        QTest::addColumn<QList<int>>("order");  // resulting ranks of positions 0..5
        QTest::newRow("1 and 3: 1 to 0, 3 to 5, then 1..4 sorted") << QList<int>{1, 3} << QList<int>{2, 1, 3, 5, 6, 4};
        QTest::newRow("0 and 4: 4 and 5 change places") << QList<int>{0, 4} << QList<int>{1, 2, 3, 4, 6, 5};
        QTest::newRow("4 and 5: 4 goes to 0") << QList<int>{4, 5} << QList<int>{5, 1, 2, 3, 4, 6};
    }

    // The kept four show their own rank and suit, the crib places and the
    // chosen marks are cleared, the starter (seven of hearts) is turned.
    void sendToCribMovesTheChosenCards()
    {
        QFETCH(QList<int>, chosen);
        QFETCH(QList<int>, order);
        auto board = MakeBoard();
        StackDeck(*board, {Card(1, 1), Card(2, 2), Card(3, 3), Card(4, 4), Card(5, 1), Card(6, 2),
                           Card(8, 1), Card(9, 2), Card(10, 3), Card(11, 4), Card(12, 1), Card(13, 2), Card(7, 3)});
        ReleaseEnter(*board);
        TapHand(*board, chosen[0] + 1);
        TapHand(*board, chosen[1] + 1);
        ClickButton(*board, kCmdSendToCrib);
        const GameRecord& r = board->record;
        for (int i = 0; i < 6; ++i) {
            const CardSprite& place = r.playerHandSprites[i];
            QCOMPARE(QList<int>({CardRank(r.deal[i]) + 1, place.rank1, place.suit1, place.highlighted}),
                     QList<int>({order[i], order[i], i == 0 || i == 5 ? kSuitEmpty : CardSuit(r.deal[i]) + 1, 0}));
        }
        QCOMPARE(QList<int>({r.starterSprite.rank1, r.starterSprite.suit1}), QList<int>({7, 3}));
    }
};

VENNICK_TEST(DealTest);
#include "DealTest.moc"

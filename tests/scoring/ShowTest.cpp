#include "play/PlaySupport.h"
#include "support/TestMain.h"

#include <QtTest>

// The show: the order of the counts for either dealer, their announcements,
// the crib laid face up, and a game won before the other counts are made.
class ShowTest : public QObject {
    Q_OBJECT

private slots:
    void show_data();
    void show();
};

void ShowTest::show_data()
{
    QTest::addColumn<bool>("userDeals");
    QTest::addColumn<bool>("byKey");
    QTest::addColumn<int>("youBefore");  // scores before the deal
    QTest::addColumn<int>("opponentBefore");
    QTest::addColumn<QList<Step>>("steps");

    // The play leaves the user 1 and the computer 2.
    QTest::newRow("computer deals") << false << false << 0 << 0
        << QList<Step>{{kPress, {"You peg 6 for your hand."}, 0, 7, 2, {kCmdScoreOpponentHand}},
                       {kPress, {"Opponent pegs 12 for his hand."}, 0, 7, 14, {kCmdScoreCrib}},
                       {kPress, {"Opponent pegs 6 for the crib."}, 0, 7, 20, {kCmdDeal}}};
    // The play leaves the user 1. Four hearts with a club starter are no
    // flush in the crib, though the same four count 4 as a hand.
    QTest::newRow("user deals, by keyboard") << true << true << 0 << 0
        << QList<Step>{{kPress, {"Opponent pegs 12 for his hand."}, 0, 1, 12, {kCmdScorePlayerHand}},
                       {kPress, {"You peg 4 for your hand."}, 0, 5, 12, {kCmdScoreCrib}},
                       {kPress, {"You peg 0 for the crib."}, 0, 5, 12, {kCmdDeal}}};
    // The other counts never happen: no buttons, and keys do nothing.
    QTest::newRow("user wins on the first count") << false << false << 115 << 0
        << QList<Step>{{kPress, {"You peg 6 for your hand.", "You won.", "Please click New to play again."}, 0, 121, 2, {}},
                       {kTapEverything, {}, 0, 121, 2, {}}};
    QTest::newRow("computer wins on the first count") << true << false << 0 << 110
        << QList<Step>{{kPress, {"Opponent pegs 12 for his hand.", "You lost.", "Please click New to play again."}, 0, 1, 121, {}},
                       {kTapEverything, {}, 0, 1, 121, {}}};
}

void ShowTest::show()
{
    QFETCH(bool, userDeals);
    QFETCH(bool, byKey);
    QFETCH(int, youBefore);
    QFETCH(int, opponentBefore);
    QFETCH(QList<Step>, steps);
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    const TableCards cards = userDeals ? Deals::UserLastCardGo() : Deals::ComputerRunsToThirtyOne();
    StartDeal(b, userDeals, cards);
    b.MovePlayerPegs(youBefore);
    b.MoveOpponentPegs(opponentBefore);
    for (CardId card : cards.player)
        LayCard(b, card);
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    RunSteps(b, steps, byKey, LogLines(b).size());
    // A hand count that wins still marks the hand counted.
    QCOMPARE(r.phase, int32_t(r.gameOver ? kPhaseHandCounted : kPhaseCribCounted));

    // Once counted, the crib lies face up in its owner's row, the user's
    // discards first, and the other row is cleared; a game won before leaves
    // the cards of the play. The starter stays where it was.
    const CardSprite* own = userDeals ? r.playerPileSprites : r.opponentPileSprites;
    const CardSprite* other = userDeals ? r.opponentPileSprites : r.playerPileSprites;
    const CardId crib[4] = {cards.playerCrib[0], cards.playerCrib[1], cards.computerCrib[0], cards.computerCrib[1]};
    for (int i = 0; i < 4; ++i) {
        QCOMPARE(own[i].rank1 == CardRank(crib[i]) + 1 && own[i].suit1 == CardSuit(crib[i]) + 1, !r.gameOver);
        QCOMPARE(own[i].faceDown, 0);
        QCOMPARE(other[i].suit1 == kSuitEmpty, !r.gameOver);
    }
    QCOMPARE(r.starterSprite.rank1, CardRank(cards.starter) + 1);
    QCOMPARE(r.starterSprite.suit1, CardSuit(cards.starter) + 1);
}

VENNICK_TEST(ShowTest);
#include "ShowTest.moc"

#include "play/PlaySupport.h"
#include "support/TestMain.h"

#include <QtTest>

namespace {

// Plays the deal out by laying the user's four cards in rank order; both deals
// of the shared set end the play that way.
void PlayOut(GameBoard& board, const TableCards& cards)
{
    for (CardId card : cards.player)
        LayCard(board, card);
}

// Presses the one visible button, by mouse or by Enter.
void PressShown(GameBoard& board, bool byKey)
{
    const QList<int> shown = ShownButtons(board);
    QCOMPARE(shown.size(), 1);
    if (byKey)
        ReleaseEnter(board);
    else
        ClickButton(board, shown.first());
}

} // namespace

// The show: the order of the counts for either dealer, their announcements,
// the crib laid face up, and a game won before the other counts are made.
class ShowTest : public QObject {
    Q_OBJECT

private slots:
    void countsInTheDealersOrder_data();
    void countsInTheDealersOrder();
    void gameWonOnTheFirstCount_data();
    void gameWonOnTheFirstCount();
};

void ShowTest::countsInTheDealersOrder_data()
{
    QTest::addColumn<bool>("userDeals");
    QTest::addColumn<bool>("byKey");
    QTest::addColumn<QList<int>>("buttons");
    QTest::addColumn<QStringList>("lines");
    QTest::addColumn<int>("playerScore");
    QTest::addColumn<int>("opponentScore");

    // The play left the user 1 and the computer 2.
    QTest::newRow("computer deals")
        << false << false
        << QList<int>{kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdDeal}
        << QStringList{"You peg 6 for your hand.", "Opponent pegs 12 for his hand.", "Opponent pegs 6 for the crib."}
        << 7 << 20;
    // The play left the user 1. The crib is four hearts with a club starter:
    // no flush in a crib, though the same four would count 4 as a hand.
    QTest::newRow("user deals, by keyboard")
        << true << true
        << QList<int>{kCmdScoreOpponentHand, kCmdScorePlayerHand, kCmdScoreCrib, kCmdDeal}
        << QStringList{"Opponent pegs 12 for his hand.", "You peg 4 for your hand.", "You peg 0 for the crib."}
        << 5 << 12;
}

void ShowTest::countsInTheDealersOrder()
{
    QFETCH(bool, userDeals);
    QFETCH(bool, byKey);
    QFETCH(QList<int>, buttons);
    QFETCH(QStringList, lines);
    QFETCH(int, playerScore);
    QFETCH(int, opponentScore);
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    const TableCards cards = userDeals ? Deals::UserLastCardGo() : Deals::ComputerRunsToThirtyOne();
    StartDeal(b, userDeals, cards);
    PlayOut(b, cards);
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    const qsizetype mark = LogLines(b).size();

    for (qsizetype step = 0; step < 3; ++step) {
        QCOMPARE(ShownButtons(b), QList<int>{buttons[step]});
        PressShown(b, byKey);
        QCOMPARE(LinesSince(b, mark), lines.mid(0, step + 1));
        QCOMPARE(r.phase, int32_t(step < 2 ? kPhaseHandCounted : kPhaseCribCounted));
    }
    QCOMPARE(ShownButtons(b), QList<int>{buttons[3]});
    QCOMPARE(b.PlayerScore(), playerScore);
    QCOMPARE(b.OpponentScore(), opponentScore);

    // The crib lies face up in its owner's row, the user's discards first;
    // the other row is cleared and the starter stays where it was.
    const CardSprite* own = userDeals ? r.playerPileSprites : r.opponentPileSprites;
    const CardSprite* other = userDeals ? r.opponentPileSprites : r.playerPileSprites;
    const CardId crib[4] = {cards.playerCrib[0], cards.playerCrib[1], cards.computerCrib[0], cards.computerCrib[1]};
    for (int i = 0; i < 4; ++i) {
        QCOMPARE(own[i].rank1, CardRank(crib[i]) + 1);
        QCOMPARE(own[i].suit1, CardSuit(crib[i]) + 1);
        QCOMPARE(own[i].faceDown, 0);
        QCOMPARE(other[i].suit1, kSuitEmpty);
    }
    QCOMPARE(r.starterSprite.rank1, CardRank(cards.starter) + 1);
    QCOMPARE(r.starterSprite.suit1, CardSuit(cards.starter) + 1);
}

void ShowTest::gameWonOnTheFirstCount_data()
{
    QTest::addColumn<bool>("userDeals");
    QTest::addColumn<QStringList>("ending");
    QTest::addColumn<int>("gamesFor");
    QTest::addColumn<int>("gamesAgainst");

    // The user stands at 116 after the play and counts 6; the computer has 2.
    QTest::newRow("user counts first")
        << false << QStringList{"You peg 6 for your hand.", "You won.", "Please click New to play again."} << 4 << 0;
    // The computer stands at 110 and counts 12; the user has 1.
    QTest::newRow("computer counts first")
        << true << QStringList{"Opponent pegs 12 for his hand.", "You lost.", "Please click New to play again."} << 0
        << 4;
}

void ShowTest::gameWonOnTheFirstCount()
{
    QFETCH(bool, userDeals);
    QFETCH(QStringList, ending);
    QFETCH(int, gamesFor);
    QFETCH(int, gamesAgainst);
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    const TableCards cards = userDeals ? Deals::UserLastCardGo() : Deals::ComputerRunsToThirtyOne();
    StartDeal(b, userDeals, cards);
    if (userDeals)
        SetScores(b, 0, 110);
    else
        SetScores(b, 115, 0);
    PlayOut(b, cards);
    const qsizetype mark = LogLines(b).size();
    const CardSprite* cribRow = userDeals ? r.playerPileSprites : r.opponentPileSprites;
    const int played[4] = {cribRow[0].rank1, cribRow[1].rank1, cribRow[2].rank1, cribRow[3].rank1};

    PressShown(b, false);

    // The other counts never happen: their buttons stay hidden, keys do nothing.
    QCOMPARE(LinesSince(b, mark), ending);
    QVERIFY(ShownButtons(b).isEmpty());
    ReleaseEnter(b);
    QCOMPARE(LinesSince(b, mark), ending);
    QCOMPARE(userDeals ? b.OpponentScore() : b.PlayerScore(), 121);
    QCOMPARE(r.gameOver, 1);
    QCOMPARE(r.gamesFor, gamesFor);
    QCOMPARE(r.gamesAgainst, gamesAgainst);
    for (int i = 0; i < 4; ++i)
        QCOMPARE(cribRow[i].rank1, played[i]);  // the crib is never laid
}

VENNICK_TEST(ShowTest);
#include "ShowTest.moc"

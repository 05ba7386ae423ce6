#include "support/TestBoard.h"
#include "support/TestMain.h"

#include "play/PlaySequence.h"

#include <QList>

#include <cstdlib>

namespace {

// Sets the play as the computer sees it: its hand positions 1..4 hold these
// ranks (negative: a card of that rank already laid), and the count is made
// of the ranks laid.
void SetUpPlay(GameBoard& board, const QList<int>& hand, const QList<int>& laid)
{
    GameRecord& record = board.record;
    record.phase = kPhasePlay;
    record.playSequence = PlaySequence();
    record.runningCount = 0;
    for (int rank1 : laid) {
        SequenceAppend(record.playSequence, rank1);
        record.runningCount += Rank1Value(rank1);
    }
    for (int p = 1; p <= 4; ++p) {
        const int rank1 = std::abs(hand[p - 1]);
        record.deal[6 + p] = Card(rank1, p);  // a suit per position: no card twice
        record.opponentHandSprites[p].rank1 = rank1;
        record.opponentHandSprites[p].suit1 = hand[p - 1] < 0 ? kSuitEmpty : p;
    }
    record.opponentHandSprites[0].suit1 = kSuitEmpty;
    record.opponentHandSprites[5].suit1 = kSuitEmpty;
}

} // namespace

class ComputerChoiceTest : public QObject {
    Q_OBJECT

private slots:
    void choice_data();
    void choice();
    void answersTheUsersCard();
};

void ComputerChoiceTest::choice_data()
{
    QTest::addColumn<QList<int>>("hand");    // rank1 at positions 1..4, negative = laid
    QTest::addColumn<QList<int>>("laid");    // ranks of the current count
    QTest::addColumn<int>("expected");       // position, 0 = none

    QTest::newRow("no card fits") << QList<int>{5, 9, 13, 4} << QList<int>{10, 10, 8} << 0;
    QTest::newRow("every card laid") << QList<int>{-1, -2, -6, -4} << QList<int>{3} << 0;
    QTest::newRow("only the six fits under 31") << QList<int>{9, 6, 13, 8} << QList<int>{10, 10, 5} << 2;
    QTest::newRow("a laid five is not offered") << QList<int>{-5, 2, 9, 12} << QList<int>{10} << 2;
    QTest::newRow("the five makes fifteen") << QList<int>{5, 9, 2, 13} << QList<int>{10} << 1;
    QTest::newRow("a later scorer takes the lead") << QList<int>{2, 9, 5, 13} << QList<int>{10} << 3;
    QTest::newRow("a run of 3 beats 31; the earlier run wins")
        << QList<int>{4, 7, 13, 2} << QList<int>{10, 6, 5} << 1;
    QTest::newRow("equal scores keep the earlier without looking ahead")
        << QList<int>{10, 5, 2, 3} << QList<int>{10} << 1;
    QTest::newRow("lead: the four gives least away, the two only ties")
        << QList<int>{5, 13, 4, 2} << QList<int>{} << 3;
    QTest::newRow("lead: the first of two equal cards") << QList<int>{13, 4, 4, 5} << QList<int>{} << 2;
    // The two is judged against the replies the five leaves room for (a five
    // or a six), not those the two itself would allow (a two or a nine).
    QTest::newRow("replies are those the chosen card leaves room for")
        << QList<int>{5, 2, -3, -4} << QList<int>{10, 13} << 2;
}

void ComputerChoiceTest::choice()
{
    QFETCH(QList<int>, hand);
    QFETCH(QList<int>, laid);
    QFETCH(int, expected);

    auto board = MakeBoard();
    SetUpPlay(*board, hand, laid);
    QCOMPARE(board->ChooseComputerCard(), expected);
}

// In a real deal: the user leads a king by tapping it and the computer
// answers with the five it kept, for fifteen.
void ComputerChoiceTest::answersTheUsersCard()
{
    auto board = MakeBoard();
    const GameRecord& r = board->record;
    // With nothing stored the first deal is the computer's crib: the user leads.
    StackDeck(*board, {Card(13, 1), Card(2, 2), Card(3, 3), Card(7, 4), Card(8, 1), Card(12, 2), Card(5, 3),
                       Card(4, 1), Card(6, 2), Card(1, 4), Card(12, 3), Card(9, 4), Card(10, 2)});
    ClickButton(*board, kCmdDeal);
    TapHand(*board, 1);
    TapHand(*board, 2);
    ClickButton(*board, kCmdSendToCrib);
    QCOMPARE(r.phase, int(kPhasePlay));
    TapHand(*board, 5);  // the king, highest of the four kept
    QCOMPARE(r.playerPileSprites[0].rank1, 13);
    QCOMPARE(r.opponentPileSprites[0].rank1, 5);
    QCOMPARE(board->OpponentScore(), 2);
    QCOMPARE(r.runningCount, 15);
}

VENNICK_TEST(ComputerChoiceTest);

#include "ComputerChoiceTest.moc"

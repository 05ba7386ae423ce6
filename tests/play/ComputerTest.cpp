#include "play/PlaySequence.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QtTest>

#include <array>
#include <cstdlib>

using Hand = std::array<CardId, 6>;
Q_DECLARE_METATYPE(Hand)

// The computer's two decisions, each on hands laid out to show one of its rules.
class ComputerTest : public QObject {
    Q_OBJECT

private slots:
    void discard_data();
    void discard();
    void card_data();
    void card();
};

void ComputerTest::discard_data()
{
    QTest::addColumn<Hand>("hand");
    QTest::addColumn<int>("playerCrib");
    QTest::addColumn<Hand>("expected");  // the thrown pair at places 0 and 5

    const CardId a1 = Card(1, 1), a3 = Card(1, 3), e8 = Card(8, 1), f1 = Card(5, 1), f2 = Card(5, 2), f4 = Card(4, 2);
    // By the count alone the aces and the eight are the best throw; the
    // fives' worth to the crib turns that around when the crib is the
    // computer's. For the user's crib the two aces tie, and the first stays.
    QTest::newRow("pair of fives thrown to the computer's crib") << Hand{a1, a3, e8, f1, f2, f4} << 0
                                                                  << Hand{f1, a3, e8, a1, f4, f2};
    QTest::newRow("pair of fives kept from the user's crib") << Hand{a1, a3, e8, f1, f2, f4} << 1
                                                              << Hand{a1, a3, f4, f1, f2, e8};
    const Hand c{Card(11, 2), Card(3, 3), Card(5, 2), Card(6, 2), Card(12, 1), Card(5, 1)};
    QTest::newRow("best split 1 and 3") << c << 0 << Hand{c[1], c[0], c[2], c[5], c[4], c[3]};
    const Hand outer{Card(2, 2), Card(2, 1), Card(6, 3), Card(7, 4), Card(2, 4), Card(8, 2)};
    QTest::newRow("discards already outside") << outer << 1 << outer;
    // Equal totals: the three in the earlier place goes, whichever suit.
    const CardId t = Card(10, 3), s = Card(7, 2), x = Card(3, 3), y = Card(3, 1), e = Card(8, 2), six = Card(6, 2);
    QTest::newRow("equal totals: the earlier split") << Hand{t, s, x, e, six, y} << 1 << Hand{t, s, y, e, six, x};
    QTest::newRow("equal totals, threes swapped") << Hand{t, s, y, e, six, x} << 1 << Hand{t, s, x, e, six, y};
    // Both sevens thrown with the eight total the same exactly; summed
    // starter by starter in doubles, rounding puts the second seven ahead.
    const Hand r{Card(7, 3), Card(7, 1), Card(10, 4), Card(8, 4), Card(3, 2), Card(2, 4)};
    QTest::newRow("rounding of the running sum decides") << r << 0 << Hand{r[1], r[0], r[2], r[5], r[4], r[3]};
}

void ComputerTest::discard()
{
    QFETCH(Hand, hand);
    QFETCH(int, playerCrib);
    QFETCH(Hand, expected);
    auto board = MakeBoard();
    GameRecord& r = board->record;
    for (int p = 0; p < 6; ++p) {
        r.deal[6 + p] = hand[p];
        r.opponentHandSprites[p].suit1 = CardSuit(hand[p]) + 1;
    }
    r.playerCrib = playerCrib;
    r.phase = kPhaseDiscard;
    r.opponentDiscarded = 0;
    board->ChooseComputerDiscards();
    board->ChooseComputerDiscards();  // once per deal: a second call changes nothing
    for (int p = 0; p < 6; ++p) {
        QCOMPARE(r.deal[6 + p], expected[p]);
        QCOMPARE(r.opponentHandSprites[p].suit1, p % 5 == 0 ? kSuitEmpty : CardSuit(expected[p]) + 1);
    }
}

void ComputerTest::card_data()
{
    QTest::addColumn<QList<int>>("hand");  // rank1 at places 1..4; negative: already laid
    QTest::addColumn<QList<int>>("laid");  // the ranks of the count so far
    QTest::addColumn<int>("expected");     // the place chosen, 0 for none

    QTest::newRow("no card fits") << QList<int>{5, 9, 13, 4} << QList<int>{10, 10, 8} << 0;
    QTest::newRow("every card laid") << QList<int>{-1, -2, -6, -4} << QList<int>{3} << 0;
    QTest::newRow("only the six fits under 31") << QList<int>{9, 6, 13, 8} << QList<int>{10, 10, 5} << 2;
    QTest::newRow("a laid five is not offered") << QList<int>{-5, 2, 9, 12} << QList<int>{10} << 2;
    QTest::newRow("the five makes fifteen") << QList<int>{5, 9, 2, 13} << QList<int>{10} << 1;
    QTest::newRow("a later scorer takes the lead") << QList<int>{2, 9, 5, 13} << QList<int>{10} << 3;
    QTest::newRow("a run of 3 beats 31; the earlier run wins") << QList<int>{4, 7, 13, 2} << QList<int>{10, 6, 5} << 1;
    QTest::newRow("equal scores keep the earlier") << QList<int>{10, 5, 2, 3} << QList<int>{10} << 1;
    QTest::newRow("lead: the four gives least away") << QList<int>{5, 13, 4, 2} << QList<int>{} << 3;
    QTest::newRow("lead: the first of two equal cards") << QList<int>{13, 4, 4, 5} << QList<int>{} << 2;
    // The two is judged against the replies the five leaves room for (a five
    // or a six), not those the two itself would allow (a two or a nine).
    QTest::newRow("replies those the chosen card leaves room for") << QList<int>{5, 2, -3, -4} << QList<int>{10, 13} << 2;
}

void ComputerTest::card()
{
    QFETCH(QList<int>, hand);
    QFETCH(QList<int>, laid);
    QFETCH(int, expected);
    auto board = MakeBoard();
    GameRecord& r = board->record;
    r.phase = kPhasePlay;
    for (int rank1 : laid) {
        SequenceAppend(r.playSequence, rank1);
        r.runningCount += Rank1Value(rank1);
    }
    for (int p = 1; p <= 4; ++p) {
        r.deal[6 + p] = Card(std::abs(hand[p - 1]), p);  // a suit per place: no card twice
        r.opponentHandSprites[p].suit1 = hand[p - 1] < 0 ? kSuitEmpty : p;
    }
    r.opponentHandSprites[0].suit1 = r.opponentHandSprites[5].suit1 = kSuitEmpty;
    QCOMPARE(board->ChooseComputerCard(), expected);
}

VENNICK_TEST(ComputerTest);
#include "ComputerTest.moc"

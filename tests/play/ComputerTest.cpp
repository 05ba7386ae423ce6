#include "play/PlaySequence.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QtTest>

#include <cstdlib>

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
    QTest::addColumn<QString>("hand");
    QTest::addColumn<int>("playerCrib");
    QTest::addColumn<QString>("expected");  // the thrown pair at places 0 and 5

    // By the count alone the aces and the eight are the best throw; the
    // fives' worth to the crib turns that around when the crib is the
    // computer's. For the user's crib the two aces tie, and the first stays.
    QTest::newRow("pair of fives thrown to the computer's crib") << "AS AH 8S 5S 5D 4D" << 0 << "5S AH 8S AS 4D 5D";
    QTest::newRow("pair of fives kept from the user's crib") << "AS AH 8S 5S 5D 4D" << 1 << "AS AH 4D 5S 5D 8S";
    QTest::newRow("best split 1 and 3") << "JD 3H 5D 6D QS 5S" << 0 << "3H JD 5D 5S QS 6D";
    QTest::newRow("discards already outside") << "2D 2S 6H 7C 2C 8D" << 1 << "2D 2S 6H 7C 2C 8D";
    // Equal totals: the three in the earlier place goes, whichever suit.
    QTest::newRow("equal totals: the earlier split") << "TH 7D 3H 8D 6D 3S" << 1 << "TH 7D 3S 8D 6D 3H";
    QTest::newRow("equal totals, threes swapped") << "TH 7D 3S 8D 6D 3H" << 1 << "TH 7D 3H 8D 6D 3S";
    // Both sevens thrown with the eight total the same exactly; summed
    // starter by starter in doubles, rounding puts the second seven ahead.
    QTest::newRow("rounding of the running sum decides") << "7H 7S TC 8C 3D 2C" << 0 << "7S 7H TC 2C 3D 8C";
}

void ComputerTest::discard()
{
    QFETCH(QString, hand);
    QFETCH(int, playerCrib);
    QFETCH(QString, expected);
    auto board = MakeBoard();
    GameRecord& r = board->record;
    for (int p = 0; p < 6; ++p) {
        r.deal[6 + p] = CardNamed(hand.split(' ').value(p));
        r.opponentHandSprites[p].suit1 = CardSuit(r.deal[6 + p]) + 1;
    }
    r.playerCrib = playerCrib;
    r.phase = kPhaseDiscard;
    r.opponentDiscarded = 0;
    board->ChooseComputerDiscards();
    board->ChooseComputerDiscards();  // once per deal: a second call changes nothing
    for (int p = 0; p < 6; ++p) {
        const CardId card = CardNamed(expected.split(' ').value(p));
        QCOMPARE(r.deal[6 + p], card);
        QCOMPARE(r.opponentHandSprites[p].suit1, p % 5 == 0 ? kSuitEmpty : CardSuit(card) + 1);
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

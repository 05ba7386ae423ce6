#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QList>
#include <QRandomGenerator>

#include <algorithm>
#include <array>
#include <numeric>
#include <vector>

using Hand = std::array<CardId, 6>;
Q_DECLARE_METATYPE(Hand)

namespace {

// For the computer's crib its best throw is the cards at positions 1 and 3.
const Hand kSplitOneThree{Card(11, 2), Card(3, 3), Card(5, 2), Card(6, 2), Card(12, 1), Card(5, 1)};

// Gives the computer these six cards, as the deal leaves them before it
// discards. The user's cards and the starter are the first others in the
// pack; the choice must not look at them.
void SetUpDiscard(GameBoard& board, const Hand& hand, int playerCrib)
{
    GameRecord& record = board.record;
    int next = 0;
    for (int slot : {0, 1, 2, 3, 4, 5, 12}) {
        while (std::find(hand.begin(), hand.end(), next) != hand.end())
            ++next;
        record.deal[slot] = next++;
    }
    for (int p = 0; p < 6; ++p) {
        record.deal[6 + p] = hand[p];
        record.opponentHandSprites[p].suit1 = CardSuit(hand[p]) + 1;
    }
    record.playerCrib = playerCrib;
    record.phase = kPhaseDiscard;
    record.opponentDiscarded = 0;
}

Hand ComputerHand(const GameBoard& board)
{
    Hand hand;
    std::copy(board.record.deal + 6, board.record.deal + 12, hand.begin());
    return hand;
}

// Whether the computer threw the best split by the plain rule, worked out apart
// from the program's loop: for every split, each card not kept is tried as
// the starter, one count at a time, and the discards' worth is added or taken
// once per starter. The first of equal totals stands. Both discards must end
// at positions 0 and 5 and the other four at 1..4.
bool ThrewBestSplit(const GameBoard& board, const Hand& before, int playerCrib)
{
    std::pair<int, int> best{-1, -1};
    double bestTotal = 0.0;
    for (int i = 0; i < 6; ++i) {
        for (int j = i + 1; j < 6; ++j) {
            std::vector<CardId> kept;
            for (int p = 0; p < 6; ++p)
                if (p != i && p != j)
                    kept.push_back(before[p]);
            const double worth = GameBoard::DiscardValue(CardRank(before[i]) + 1, CardRank(before[j]) + 1);
            double total = 0.0;
            for (CardId starter = 0; starter < 52; ++starter) {
                if (std::count(kept.begin(), kept.end(), starter) == 0) {
                    const CardId cards[5] = {kept[0], kept[1], kept[2], kept[3], starter};
                    total = static_cast<double>(board.CountHand(cards)) + total;
                    total = playerCrib == 1 ? total - worth : total + worth;
                }
            }
            if (best.first < 0 || total > bestTotal) {
                best = {i, j};
                bestTotal = total;
            }
        }
    }
    const Hand after = ComputerHand(board);
    Hand sortedBefore = before;
    Hand sortedAfter = after;
    std::sort(sortedBefore.begin(), sortedBefore.end());
    std::sort(sortedAfter.begin(), sortedAfter.end());
    const auto thrown = std::minmax(after[0], after[5]);
    return thrown == std::minmax(before[best.first], before[best.second]) && sortedBefore == sortedAfter;
}

} // namespace

class ComputerDiscardTest : public QObject {
    Q_OBJECT

private slots:
    void discardValue_data();
    void discardValue();
    void choice_data();
    void choice();
    void agreesWithPlainAverage();
    void runsOncePerDeal();
    void startsThePlayIfTheUserDiscardedFirst();
    void dealLeavesTheCribOut();
};

void ComputerDiscardTest::discardValue_data()
{
    QTest::addColumn<int>("rank1a");
    QTest::addColumn<int>("rank1b");
    QTest::addColumn<double>("expected");

    QTest::newRow("pair of fives") << 5 << 5 << 6.0;
    QTest::newRow("pair of kings") << 13 << 13 << 3.0;
    QTest::newRow("five and king: fifteen, no five on top") << 5 << 13 << 3.9;
    QTest::newRow("seven and eight") << 7 << 8 << 4.9;
    QTest::newRow("six and nine") << 6 << 9 << 3.9;
    QTest::newRow("four and five") << 4 << 5 << 4.0;
    QTest::newRow("five and seven") << 5 << 7 << 4.0;
    QTest::newRow("jack and king") << 11 << 13 << 1.0;
    QTest::newRow("ace and four: three apart") << 1 << 4 << 0.0;
    QTest::newRow("queen and king: neighbours worth 20") << 12 << 13 << 1.0;
    QTest::newRow("five and nine") << 5 << 9 << 3.0;
}

void ComputerDiscardTest::discardValue()
{
    QFETCH(int, rank1a);
    QFETCH(int, rank1b);
    QFETCH(double, expected);
    QCOMPARE(GameBoard::DiscardValue(rank1a, rank1b), expected);
    QCOMPARE(GameBoard::DiscardValue(rank1b, rank1a), expected);
}

void ComputerDiscardTest::choice_data()
{
    QTest::addColumn<Hand>("hand");
    QTest::addColumn<int>("playerCrib");
    QTest::addColumn<Hand>("expected");

    const CardId ace1 = Card(1, 1), ace3 = Card(1, 3), eight = Card(8, 1);
    const CardId five1 = Card(5, 1), five2 = Card(5, 2), four = Card(4, 2);
    // By the count alone the aces and the eight are the best throw; the
    // fives' worth to the crib turns that around when the crib is the
    // computer's. For the user's crib the two aces tie, and the first stays.
    QTest::newRow("pair of fives favoured for the computer's crib")
        << Hand{ace1, ace3, eight, five1, five2, four} << 0 << Hand{five1, ace3, eight, ace1, four, five2};
    QTest::newRow("pair of fives kept from the user's crib")
        << Hand{ace1, ace3, eight, five1, five2, four} << 1 << Hand{ace1, ace3, four, five1, five2, eight};

    const Hand& c = kSplitOneThree;
    QTest::newRow("best split 1 and 3") << c << 0 << Hand{c[1], c[0], c[2], c[5], c[4], c[3]};

    const Hand outer{Card(2, 2), Card(2, 1), Card(6, 3), Card(7, 4), Card(2, 4), Card(8, 2)};
    QTest::newRow("discards already outside") << outer << 1 << outer;

    // Throwing the ten with either three totals the same; the three in the
    // earlier place goes, whichever suit it is.
    const CardId ten = Card(10, 3), threeA = Card(3, 3), threeB = Card(3, 1);
    const CardId seven2 = Card(7, 2), eight2 = Card(8, 2), six2 = Card(6, 2);
    QTest::newRow("equal totals: the earlier split")
        << Hand{ten, seven2, threeA, eight2, six2, threeB} << 1 << Hand{ten, seven2, threeB, eight2, six2, threeA};
    QTest::newRow("equal totals: the earlier split, threes swapped")
        << Hand{ten, seven2, threeB, eight2, six2, threeA} << 1 << Hand{ten, seven2, threeA, eight2, six2, threeB};

    // Both sevens thrown with the eight make the same total in exact
    // arithmetic; summed starter by starter in doubles, the 4.9 a starter
    // rounds the second seven's total above the first's, and that decides.
    const CardId seven3 = Card(7, 3), seven1 = Card(7, 1), ten4 = Card(10, 4), eight4 = Card(8, 4),
                 three2 = Card(3, 2), two4 = Card(2, 4);
    QTest::newRow("rounding of the running sum decides")
        << Hand{seven3, seven1, ten4, eight4, three2, two4} << 0 << Hand{seven1, seven3, ten4, two4, three2, eight4};
}

void ComputerDiscardTest::choice()
{
    QFETCH(Hand, hand);
    QFETCH(int, playerCrib);
    QFETCH(Hand, expected);

    auto board = MakeBoard();
    SetUpDiscard(*board, hand, playerCrib);
    board->ChooseComputerDiscards();

    QCOMPARE(ComputerHand(*board), expected);
    QCOMPARE(board->record.opponentDiscarded, 1);
    // The discards' places empty; each kept card's place still shows its suit.
    QCOMPARE(board->record.opponentHandSprites[0].suit1, kSuitEmpty);
    QCOMPARE(board->record.opponentHandSprites[5].suit1, kSuitEmpty);
    for (int p = 1; p <= 4; ++p) {
        QCOMPARE(board->record.opponentHandSprites[p].suit1, CardSuit(expected[p]) + 1);
        QCOMPARE(board->record.opponentHandSprites[p].rank1, CardRank(expected[p]) + 1);
    }
}

// Hands where the counts per starter vary most with the starter's suit
// (flushes, jacks), ranks held four times, the poorest hand there is (its
// best throw still totals 96 for the user's crib, tied three ways), then
// random hands, each for either crib.
void ComputerDiscardTest::agreesWithPlainAverage()
{
    QList<Hand> hands{{Card(11, 2), Card(2, 2), Card(9, 2), Card(4, 2), Card(13, 2), Card(7, 2)},
                      {Card(3, 4), Card(12, 4), Card(1, 1), Card(6, 4), Card(11, 4), Card(8, 4)},
                      {Card(11, 1), Card(2, 3), Card(11, 2), Card(11, 3), Card(9, 1), Card(11, 4)},
                      {Card(5, 1), Card(10, 2), Card(5, 2), Card(5, 3), Card(10, 3), Card(5, 4)},
                      {Card(13, 1), Card(13, 2), Card(12, 1), Card(13, 3), Card(13, 4), Card(12, 2)},
                      {Card(1, 1), Card(3, 2), Card(7, 3), Card(9, 4), Card(12, 1), Card(13, 2)}};
    QRandomGenerator random(20240611);
    while (hands.size() < 156) {
        std::vector<CardId> pack(52);
        std::iota(pack.begin(), pack.end(), 0);
        Hand hand;
        for (CardId& card : hand) {
            const auto pick = random.bounded(static_cast<quint32>(pack.size()));
            card = pack[pick];
            pack.erase(pack.begin() + pick);
        }
        hands.append(hand);
    }
    auto board = MakeBoard();
    for (qsizetype h = 0; h < hands.size(); ++h)
        for (int playerCrib : {0, 1}) {
            SetUpDiscard(*board, hands[h], playerCrib);
            board->ChooseComputerDiscards();
            QVERIFY2(ThrewBestSplit(*board, hands[h], playerCrib),
                     qPrintable(QStringLiteral("hand %1, crib %2").arg(h).arg(playerCrib)));
        }
}

// A second call in the same deal leaves even a hand the choice would
// rearrange as it is.
void ComputerDiscardTest::runsOncePerDeal()
{
    auto board = MakeBoard();
    SetUpDiscard(*board, kSplitOneThree, 0);
    board->record.opponentDiscarded = 1;
    board->ChooseComputerDiscards();
    QCOMPARE(ComputerHand(*board), kSplitOneThree);
    QCOMPARE(board->record.opponentHandSprites[0].suit1, CardSuit(kSplitOneThree[0]) + 1);
}

// Should the user's discards ever come first, the computer's finish the
// discarding and the play begins: with the user's crib the computer leads.
void ComputerDiscardTest::startsThePlayIfTheUserDiscardedFirst()
{
    auto board = MakeBoard();
    GameRecord& r = board->record;
    SetUpDiscard(*board, kSplitOneThree, 1);
    for (int p = 1; p <= 4; ++p)
        r.playerHandSprites[p].suit1 = CardSuit(r.deal[p]) + 1;
    r.phase = kPhasePlay;
    r.playerPlayIndex = r.opponentPlayIndex = 1;
    board->ChooseComputerDiscards();
    QCOMPARE(r.countVisible, 1);
    QCOMPARE(r.opponentPlayIndex, 2);
    QVERIFY(r.opponentPileSprites[0].suit1 != kSuitEmpty);
}

// Through the window: the deal ends with the computer's discards at its
// outer places, emptied on the table, before the user has chosen anything.
void ComputerDiscardTest::dealLeavesTheCribOut()
{
    auto board = MakeBoard();
    const Hand& c = kSplitOneThree;
    StackDeck(*board, {Card(1, 4), Card(2, 4), Card(4, 4), Card(8, 3), Card(9, 3), Card(10, 4), c[0], c[1], c[2],
                       c[3], c[4], c[5], Card(13, 4)});
    ClickButton(*board, kCmdDeal);
    const GameRecord& r = board->record;
    QCOMPARE(r.playerCrib, 0);
    QCOMPARE(r.phase, int(kPhaseDiscard));
    QCOMPARE(ComputerHand(*board), (Hand{c[1], c[0], c[2], c[5], c[4], c[3]}));
    for (int p = 0; p < 6; ++p)
        QCOMPARE(r.opponentHandSprites[p].suit1 == kSuitEmpty, p == 0 || p == 5);
    QCOMPARE(r.starterSprite.suit1, kSuitBack);
}

VENNICK_TEST(ComputerDiscardTest);

#include "ComputerDiscardTest.moc"

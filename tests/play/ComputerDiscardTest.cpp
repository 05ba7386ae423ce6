#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QList>
#include <QRandomGenerator>

#include <algorithm>
#include <array>
#include <vector>

using Hand = std::array<CardId, 6>;
Q_DECLARE_METATYPE(Hand)

namespace {

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

// The best split by the plain rule, worked out apart from the program's
// loop: for every split, each card of the pack that is not kept is tried as
// the starter, one count at a time, and the worth of the discards is added or
// taken once per starter. The first of equal totals stands.
std::pair<int, int> ReferenceSplit(const GameBoard& board, const Hand& hand, int playerCrib)
{
    std::pair<int, int> best{-1, -1};
    double bestTotal = 0.0;
    for (int i = 0; i < 6; ++i) {
        for (int j = i + 1; j < 6; ++j) {
            std::vector<CardId> kept;
            for (int p = 0; p < 6; ++p)
                if (p != i && p != j)
                    kept.push_back(hand[p]);
            const double worth = GameBoard::DiscardValue(CardRank(hand[i]) + 1, CardRank(hand[j]) + 1);
            double total = 0.0;
            int starters = 0;
            for (CardId starter = 0; starter < 52; ++starter) {
                if (std::count(kept.begin(), kept.end(), starter) != 0)
                    continue;
                const CardId cards[5] = {kept[0], kept[1], kept[2], kept[3], starter};
                total = static_cast<double>(board.CountHand(cards)) + total;
                total = playerCrib == 1 ? total - worth : total + worth;
                ++starters;
            }
            if (starters != 48)
                return {-1, -1};
            if (best.first < 0 || total > bestTotal) {
                best = {i, j};
                bestTotal = total;
            }
        }
    }
    return best;
}

// Both discards stand at positions 0 and 5 and the other four at 1..4.
bool DiscardsOut(const Hand& before, const Hand& after, std::pair<int, int> split)
{
    QList<CardId> thrown{after[0], after[5]};
    QList<CardId> expectedThrown{before[split.first], before[split.second]};
    std::sort(thrown.begin(), thrown.end());
    std::sort(expectedThrown.begin(), expectedThrown.end());
    Hand sortedBefore = before;
    Hand sortedAfter = after;
    std::sort(sortedBefore.begin(), sortedBefore.end());
    std::sort(sortedAfter.begin(), sortedAfter.end());
    return thrown == expectedThrown && sortedBefore == sortedAfter;
}

} // namespace

class ComputerDiscardTest : public QObject {
    Q_OBJECT

private slots:
    void discardValue_data();
    void discardValue();
    void choice_data();
    void choice();
    void agreesWithPlainAverage_data();
    void agreesWithPlainAverage();
    void agreesOnRandomHands();
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
    QTest::newRow("ace and king") << 1 << 13 << 0.0;
    QTest::newRow("ace and four: three apart") << 1 << 4 << 0.0;
    QTest::newRow("queen and king: neighbours worth 20") << 12 << 13 << 1.0;
    QTest::newRow("five and ten") << 5 << 10 << 3.9;
    QTest::newRow("five and six") << 5 << 6 << 4.0;
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

    const CardId c0 = Card(11, 2), c1 = Card(3, 3), c2 = Card(5, 2), c3 = Card(6, 2), c4 = Card(12, 1),
                 c5 = Card(5, 1);
    QTest::newRow("best split 1 and 3") << Hand{c0, c1, c2, c3, c4, c5} << 0 << Hand{c1, c0, c2, c5, c4, c3};

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
// (flushes, jacks), a rank held four times, and the poorest hand there is.
void ComputerDiscardTest::agreesWithPlainAverage_data()
{
    QTest::addColumn<Hand>("hand");

    QTest::newRow("six hearts with the jack")
        << Hand{Card(11, 2), Card(2, 2), Card(9, 2), Card(4, 2), Card(13, 2), Card(7, 2)};
    QTest::newRow("five of a suit and an odd card")
        << Hand{Card(3, 4), Card(12, 4), Card(1, 1), Card(6, 4), Card(11, 4), Card(8, 4)};
    QTest::newRow("four jacks") << Hand{Card(11, 1), Card(2, 3), Card(11, 2), Card(11, 3), Card(9, 1), Card(11, 4)};
    QTest::newRow("four fives and two tens")
        << Hand{Card(5, 1), Card(10, 2), Card(5, 2), Card(5, 3), Card(10, 3), Card(5, 4)};
    QTest::newRow("all four kings and two queens of a suit")
        << Hand{Card(13, 1), Card(13, 2), Card(12, 1), Card(13, 3), Card(13, 4), Card(12, 2)};
    // No six cards keep less over the 48 starters: the best throw of this
    // hand still totals 96 for the user's crib, tied three ways.
    QTest::newRow("the poorest hand")
        << Hand{Card(1, 1), Card(3, 2), Card(7, 3), Card(9, 4), Card(12, 1), Card(13, 2)};
}

void ComputerDiscardTest::agreesWithPlainAverage()
{
    QFETCH(Hand, hand);
    auto board = MakeBoard();
    for (int playerCrib : {0, 1}) {
        SetUpDiscard(*board, hand, playerCrib);
        const auto split = ReferenceSplit(*board, hand, playerCrib);
        board->ChooseComputerDiscards();
        QVERIFY2(DiscardsOut(hand, ComputerHand(*board), split),
                 qPrintable(QStringLiteral("crib %1: expected split %2, %3").arg(playerCrib).arg(split.first).arg(split.second)));
    }
}

void ComputerDiscardTest::agreesOnRandomHands()
{
    auto board = MakeBoard();
    QRandomGenerator random(20240611);
    for (int round = 0; round < 300; ++round) {
        std::vector<CardId> pack(52);
        for (int c = 0; c < 52; ++c)
            pack[c] = c;
        Hand hand;
        for (int p = 0; p < 6; ++p) {
            const auto pick = random.bounded(static_cast<quint32>(pack.size()));
            hand[p] = pack[pick];
            pack.erase(pack.begin() + pick);
        }
        const int playerCrib = round % 2;
        SetUpDiscard(*board, hand, playerCrib);
        const auto split = ReferenceSplit(*board, hand, playerCrib);
        board->ChooseComputerDiscards();
        QVERIFY2(DiscardsOut(hand, ComputerHand(*board), split), qPrintable(QStringLiteral("round %1").arg(round)));
    }
}

// A second call in the same deal leaves the hand as it is, even a hand the
// choice would rearrange.
void ComputerDiscardTest::runsOncePerDeal()
{
    auto board = MakeBoard();
    const Hand hand{Card(11, 2), Card(3, 3), Card(5, 2), Card(6, 2), Card(12, 1), Card(5, 1)};
    SetUpDiscard(*board, hand, 0);
    board->record.opponentDiscarded = 1;
    board->ChooseComputerDiscards();
    QCOMPARE(ComputerHand(*board), hand);
    QCOMPARE(board->record.opponentHandSprites[0].suit1, CardSuit(hand[0]) + 1);
}

// Should the user's discards ever come first, the computer's finish the
// discarding and the play begins: with the user's crib the computer leads.
void ComputerDiscardTest::startsThePlayIfTheUserDiscardedFirst()
{
    auto board = MakeBoard();
    SetUpDiscard(*board, {Card(11, 2), Card(3, 3), Card(5, 2), Card(6, 2), Card(12, 1), Card(5, 1)}, 1);
    for (int p = 1; p <= 4; ++p)
        board->record.playerHandSprites[p].suit1 = CardSuit(board->record.deal[p]) + 1;
    board->record.phase = kPhasePlay;
    board->record.playerPlayIndex = 1;
    board->record.opponentPlayIndex = 1;
    board->ChooseComputerDiscards();
    QCOMPARE(board->record.countVisible, 1);
    QCOMPARE(board->record.opponentPlayIndex, 2);
    QVERIFY(board->record.opponentPileSprites[0].suit1 != kSuitEmpty);
}

// Through the window: the deal ends with the computer's discards at its
// outer places, emptied on the table, before the user has chosen anything.
void ComputerDiscardTest::dealLeavesTheCribOut()
{
    auto board = MakeBoard();
    const CardId c0 = Card(11, 2), c1 = Card(3, 3), c2 = Card(5, 2), c3 = Card(6, 2), c4 = Card(12, 1),
                 c5 = Card(5, 1);
    StackDeck(*board, {Card(1, 4), Card(2, 4), Card(4, 4), Card(8, 3), Card(9, 3), Card(10, 4),
                       c0, c1, c2, c3, c4, c5, Card(13, 4)});
    ClickButton(*board, kCmdDeal);
    QCOMPARE(board->record.playerCrib, 0);
    QCOMPARE(board->record.phase, int(kPhaseDiscard));
    QCOMPARE(ComputerHand(*board), (Hand{c1, c0, c2, c5, c4, c3}));
    QCOMPARE(board->record.opponentHandSprites[0].suit1, kSuitEmpty);
    QCOMPARE(board->record.opponentHandSprites[5].suit1, kSuitEmpty);
    for (int p = 1; p <= 4; ++p)
        QVERIFY(board->record.opponentHandSprites[p].suit1 != kSuitEmpty);
    QCOMPARE(board->record.starterSprite.suit1, kSuitBack);
}

VENNICK_TEST(ComputerDiscardTest);

#include "ComputerDiscardTest.moc"

#include "scoring/HandCount.h"
#include "scoring/ReferenceCount.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QtTest>

#include <algorithm>
#include <array>
#include <numeric>
#include <random>

namespace {

// Cards written as rank then suit: "5H", "TC", "JD" (T ten; suits C D H S).
std::array<CardId, 5> Cards(const QString& text)
{
    std::array<CardId, 5> cards{};
    const QStringList names = text.split(QLatin1Char(' '));
    for (int i = 0; i < 5; ++i) {
        const auto rank1 = QStringLiteral("A23456789TJQK").indexOf(names.value(i).left(1)) + 1;
        const auto suit1 = QStringLiteral("CDHS").indexOf(names.value(i).mid(1)) + 1;
        if (names.size() != 5 || rank1 == 0 || suit1 == 0)
            qFatal("five cards expected: %s", qPrintable(text));
        cards[i] = Card(static_cast<int>(rank1), static_cast<int>(suit1));
    }
    return cards;
}

} // namespace

class CountHandTest : public QObject {
    Q_OBJECT

private slots:
    void countsBothRules_data();
    void countsBothRules();
    void agreesWithReference();
    void cribRuleOnlyInPhaseTen();
    void wholeSpaceAgreesWithReference();
};

void CountHandTest::countsBothRules_data()
{
    // The four cards, then the starter; points under the hand and the crib rule.
    QTest::addColumn<QString>("cards");
    QTest::addColumn<int>("hand");
    QTest::addColumn<int>("crib");

    QTest::newRow("29: three fives, jack of the starter's suit, five turned") << "5C 5D 5S JH 5H" << 29 << 29;
    QTest::newRow("28: four fives, king turned") << "5C 5D 5S 5H KC" << 28 << 28;
    QTest::newRow("28: four fives, jack turned earns nothing more") << "5C 5D 5S 5H JC" << 28 << 28;
    QTest::newRow("24: sevens and eights doubled with a nine") << "7C 7D 8S 8H 9C" << 24 << 24;
    QTest::newRow("double run of three") << "3C 3D 4H 5S KC" << 12 << 12;
    QTest::newRow("triple run of three") << "3C 3D 3H 4S 5C" << 21 << 21;
    QTest::newRow("double-double run") << "AC AD 2H 2S 3C" << 16 << 16;
    QTest::newRow("double run of four") << "3C 4D 5H 6S 6C" << 16 << 16;
    QTest::newRow("run of four with a doubled three") << "AC 2D 3H 3S 4C" << 10 << 10;
    QTest::newRow("run of five, one fifteen") << "AC 2D 3H 4S 5C" << 7 << 7;
    QTest::newRow("pair below a run is no part of it") << "AC AD 3H 4S 5C" << 5 << 5;
    QTest::newRow("no wrap from king to ace") << "QC KD AH 2S 3C" << 7 << 7;
    QTest::newRow("ten to king and a five") << "TC JD QH KS 5C" << 12 << 12;
    QTest::newRow("ten and king are no pair") << "TC KD 5H 5S 2C" << 10 << 10;
    QTest::newRow("four of a kind") << "2C 2D 2H 2S 9C" << 20 << 20;
    QTest::newRow("nothing at all") << "2C 4D 6H 8S TC" << 0 << 0;
    QTest::newRow("flush of four, starter of another suit") << "2H 4H 6H 8H TS" << 4 << 0;
    QTest::newRow("flush of five") << "2H 4H 6H 8H TH" << 5 << 5;
    QTest::newRow("flush reached only with the starter") << "2H 4H 6H 8S TH" << 0 << 0;
    QTest::newRow("jack of the starter's suit") << "2C 4D 8S JH 6H" << 1 << 1;
    QTest::newRow("jack of another suit") << "2C 4D 8S JD 6H" << 0 << 0;
    QTest::newRow("jack as starter") << "2C 4D 8S 6H JH" << 0 << 0;
    QTest::newRow("jack in a five-card flush") << "JH 2H 4H 8H 6H" << 6 << 6;
    QTest::newRow("jack in a four-card flush") << "JH 2H 4H 8H 6S" << 4 << 0;
}

void CountHandTest::countsBothRules()
{
    QFETCH(QString, cards);
    QFETCH(int, hand);
    QFETCH(int, crib);
    const std::array<CardId, 5> five = Cards(cards);
    const std::array<CardId, 5> before = five;
    QCOMPARE(CountHandCards(five.data(), false), hand);
    QCOMPARE(CountHandCards(five.data(), true), crib);
    QCOMPARE(ReferenceCountHand(five.data(), false), hand);
    QCOMPARE(ReferenceCountHand(five.data(), true), crib);
    QVERIFY(five == before);
}

// Random hands in every order of the four cards, then every way five ranks
// can fall (at most four of each, copies in different suits) with each card
// taking each position in turn: the count never depends on the order and
// always agrees with the reference.
void CountHandTest::agreesWithReference()
{
    std::mt19937 random(20240611);
    std::array<CardId, 52> deck{};
    std::iota(deck.begin(), deck.end(), 0);
    for (int trial = 0; trial < 3000; ++trial) {
        std::shuffle(deck.begin(), deck.end(), random);
        std::array<CardId, 5> order = {deck[0], deck[1], deck[2], deck[3], deck[4]};
        std::sort(order.begin(), order.begin() + 4);
        do {
            for (bool crib : {false, true})
                QCOMPARE(CountHandCards(order.data(), crib), ReferenceCountHand(order.data(), crib));
        } while (std::next_permutation(order.begin(), order.begin() + 4));
    }

    int multisets = 0;
    int rank[5] = {};
    for (rank[0] = 0; rank[0] < 13; ++rank[0])
        for (rank[1] = rank[0]; rank[1] < 13; ++rank[1])
            for (rank[2] = rank[1]; rank[2] < 13; ++rank[2])
                for (rank[3] = rank[2]; rank[3] < 13; ++rank[3])
                    for (rank[4] = rank[3]; rank[4] < 13; ++rank[4]) {
                        if (rank[0] == rank[4])
                            continue;
                        ++multisets;
                        for (int shift = 0; shift < 5; ++shift) {
                            CardId cards[5] = {};
                            for (int i = 0; i < 5; ++i) {
                                const int at = (i + shift) % 5;
                                cards[i] = static_cast<int>(std::count(rank, rank + at, rank[at])) * 13 + rank[at];
                            }
                            for (bool crib : {false, true})
                                QCOMPARE(CountHandCards(cards, crib), ReferenceCountHand(cards, crib));
                        }
                    }
    QCOMPARE(multisets, 6175);
}

// Only the crib count, in phase 10, denies a flush of four.
void CountHandTest::cribRuleOnlyInPhaseTen()
{
    auto board = MakeBoard();
    const std::array<CardId, 5> cards = Cards(QStringLiteral("2H 4H 6H 8H TS"));
    for (int phase : {kPhaseNoDeal, kPhaseDiscard, kPhasePlay, kPhasePlayOver, kPhaseHandCounted,
                      kPhaseCribCounted, kPhaseGameOver}) {
        board->record.phase = phase;
        QCOMPARE(board->CountHand(cards.data()), phase == kPhaseCribCounted ? 0 : 4);
    }
}

// All 12,994,800 hands of four with a starter, under both rules. Slow under
// the sanitizers, so only on request: VENNICK_EXHAUSTIVE=1.
void CountHandTest::wholeSpaceAgreesWithReference()
{
    if (qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") == 0)
        QSKIP("set VENNICK_EXHAUSTIVE=1 to count every hand");
    long long hands = 0;
    long long mismatches = 0;
    ForEveryHand([&](const CardId* cards) {
        ++hands;
        for (bool crib : {false, true})
            if (CountHandCards(cards, crib) != ReferenceCountHand(cards, crib) && mismatches++ == 0)
                qWarning("first difference: cards %d %d %d %d %d, crib %d", cards[0], cards[1], cards[2], cards[3],
                         cards[4], int(crib));
    });
    QCOMPARE(mismatches, 0LL);
    QCOMPARE(hands, 12994800LL);
}

VENNICK_TEST(CountHandTest);
#include "CountHandTest.moc"

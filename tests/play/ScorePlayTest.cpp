#include "play/PlaySequence.h"
#include "play/ReferencePlay.h"
#include "support/TestMain.h"

#include <QtTest>

#include <climits>
#include <cstring>
#include <random>

namespace {

PlaySequence Laid(const QList<int>& ranks)
{
    PlaySequence sequence;
    for (int rank1 : ranks)
        SequenceAppend(sequence, rank1);
    return sequence;
}

QString Describe(const PlaySequence& sequence)
{
    QStringList entries;
    for (int entry : sequence.entries)
        entries.append(QString::number(entry));
    return entries.join(QLatin1Char(' '));
}

bool SameEntries(const PlaySequence& a, const PlaySequence& b)
{
    return std::memcmp(a.entries, b.entries, sizeof a.entries) == 0;
}

} // namespace

class ScorePlayTest : public QObject {
    Q_OBJECT

private slots:
    void appendLengthAndCopy();
    void scoresLastCard_data();
    void scoresLastCard();
    void anyEntriesAgreeWithReference();
    void everyPlayAgreesWithReference();
};

void ScorePlayTest::appendLengthAndCopy()
{
    // Emptying is writing -1 into the first entry; the old cards behind it
    // must not come back.
    PlaySequence sequence = Laid({10, 11, 5, 5});
    sequence.entries[0] = -1;
    QCOMPARE(SequenceLength(sequence), 0);
    SequenceAppend(sequence, 7);
    QCOMPARE(SequenceLength(sequence), 1);
    QCOMPARE(sequence.entries[0], 7);
    QCOMPARE(sequence.entries[1], -1);
    QCOMPARE(ScorePlay(sequence), 0);

    // A ninth card is not taken.
    sequence = Laid({1, 1, 2, 2, 3, 3, 4, 4});
    QCOMPARE(SequenceLength(sequence), 8);
    QCOMPARE(sequence.entries[8], -1);
    SequenceAppend(sequence, 5);
    QVERIFY(SameEntries(sequence, Laid({1, 1, 2, 2, 3, 3, 4, 4})));
    QCOMPARE(ScorePlay(sequence), 2);

    // A copy takes all nine entries, also those past an end marker.
    const PlaySequence source{{4, -1, 9, 9, 2, -1, 6, 1, -1}};
    SequenceCopy(source, sequence);
    QVERIFY2(SameEntries(source, sequence), qPrintable(Describe(sequence)));

    // Nine entries without an end marker: ace to nine, a run of nine, total 45.
    sequence = PlaySequence{{1, 2, 3, 4, 5, 6, 7, 8, 9}};
    QCOMPARE(SequenceLength(sequence), 9);
    QCOMPARE(ScorePlay(sequence), 9);
}

void ScorePlayTest::scoresLastCard_data()
{
    QTest::addColumn<QList<int>>("ranks");
    QTest::addColumn<int>("points");

    QTest::newRow("nothing laid") << QList<int>{} << 0;
    QTest::newRow("five on a ten: fifteen") << QList<int>{5, 10} << 2;
    QTest::newRow("seven, eight, nine: run, total 24") << QList<int>{7, 8, 9} << 3;
    QTest::newRow("pair") << QList<int>{4, 4} << 2;
    QTest::newRow("three of a kind") << QList<int>{4, 4, 4} << 6;
    QTest::newRow("four of a kind") << QList<int>{4, 4, 4, 4} << 12;
    QTest::newRow("three fives: three of a kind and fifteen") << QList<int>{5, 5, 5} << 8;
    QTest::newRow("fours split by a three: fifteen only") << QList<int>{4, 4, 3, 4} << 2;
    QTest::newRow("pair after a split pair") << QList<int>{6, 3, 6, 6} << 2;
    QTest::newRow("pair split by another rank") << QList<int>{9, 9, 2, 9} << 0;
    QTest::newRow("jack on a queen is no pair") << QList<int>{12, 11} << 0;
    QTest::newRow("queen on a queen") << QList<int>{12, 12} << 2;
    QTest::newRow("ten, jack, ten: no pair, no run, 30") << QList<int>{10, 11, 10} << 0;
    QTest::newRow("ace to thirty-one") << QList<int>{10, 10, 11, 1} << 2;
    QTest::newRow("pair to thirty-one") << QList<int>{13, 12, 7, 2, 2} << 4;
    QTest::newRow("pair to fifteen") << QList<int>{7, 4, 2, 2} << 4;
    QTest::newRow("run laid out of order") << QList<int>{3, 5, 4} << 3;
    QTest::newRow("run of four laid out of order") << QList<int>{2, 3, 5, 4} << 4;
    QTest::newRow("run of five laid out of order") << QList<int>{4, 2, 6, 3, 5} << 5;
    QTest::newRow("run of seven") << QList<int>{1, 2, 3, 4, 5, 6, 7} << 7;
    QTest::newRow("six breaks the longer window") << QList<int>{6, 2, 3, 4} << 5;
    QTest::newRow("repeat inside the window breaks the run") << QList<int>{3, 4, 4, 5} << 0;
    QTest::newRow("repeat before the window leaves the run") << QList<int>{5, 6, 5, 7} << 3;
    QTest::newRow("run of three to thirty-one") << QList<int>{13, 12, 5, 1, 2, 3} << 5;
    QTest::newRow("jack, queen, king") << QList<int>{13, 11, 12} << 3;
    QTest::newRow("queen, king, ace: no wrap") << QList<int>{12, 13, 1} << 0;
    QTest::newRow("king, ace, two: no wrap") << QList<int>{13, 1, 2} << 0;
}

void ScorePlayTest::scoresLastCard()
{
    QFETCH(QList<int>, ranks);
    QFETCH(int, points);
    const PlaySequence sequence = Laid(ranks);
    QCOMPARE(SequenceLength(sequence), static_cast<int>(ranks.size()));
    QCOMPARE(ScorePlay(sequence), points);
    QCOMPARE(ReferenceScorePlay(sequence), points);
}

// The scorer takes any record, not only the game's own: unusual ranks, no end
// marker, extreme values, old entries left past the marker. It must agree with
// the literal rule and stay within the nine entries. Half the records hold
// only ranks 1..13 before the marker, as the play makes them.
void ScorePlayTest::anyEntriesAgreeWithReference()
{
    std::mt19937 random(31);
    std::uniform_int_distribution<int> length(0, 9);
    std::uniform_int_distribution<int> anyRank(-2, 22);
    std::uniform_int_distribution<int> rank(1, 13);
    std::uniform_int_distribution<int> pick(0, 15);
    const int extremes[4] = {INT_MIN, INT_MIN + 1, INT_MAX - 1, INT_MAX};
    for (int trial = 0; trial < 200000; ++trial) {
        const bool playLike = trial % 2 == 0;
        PlaySequence sequence;
        for (int& entry : sequence.entries) {
            const int choice = pick(random);
            entry = choice < 4 ? extremes[choice] : anyRank(random);
            if (entry == -1)
                entry = 0;
        }
        const int n = length(random);
        if (playLike)
            for (int i = 0; i < n; ++i)
                sequence.entries[i] = rank(random);
        if (n < 9)
            sequence.entries[n] = -1;
        if (ScorePlay(sequence) != ReferenceScorePlay(sequence))
            QFAIL(qPrintable(QStringLiteral("%1: %2, expected %3")
                                 .arg(Describe(sequence))
                                 .arg(ScorePlay(sequence))
                                 .arg(ReferenceScorePlay(sequence))));
    }
}

// Every sequence the play can produce of up to four cards; all 12,892,167 of
// up to eight on request (VENNICK_EXHAUSTIVE=1), as that is slow under the
// sanitizers.
void ScorePlayTest::everyPlayAgreesWithReference()
{
    const bool everything = qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") != 0;
    long long visited = 0;
    long long mismatches = 0;
    PlaySequence first;
    ForEveryLegalPlay(everything ? 8 : 4, [&](const PlaySequence& sequence) {
        ++visited;
        if (ScorePlay(sequence) != ReferenceScorePlay(sequence) && mismatches++ == 0)
            first = sequence;
    });
    QVERIFY2(mismatches == 0, qPrintable(Describe(first)));
    QCOMPARE(visited, everything ? 12892167LL : 24982LL);
}

VENNICK_TEST(ScorePlayTest);
#include "ScorePlayTest.moc"

#include "scoring/HandCount.h"
#include "scoring/ReferenceCount.h"
#include "scoring/ScoreReasons.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

// The hand counter and the reasons against the plain reference: a sample of
// hands always, all 12,994,800 under both rules on request
// (VENNICK_EXHAUSTIVE=1), as that is slow under the sanitizers. The sample is
// every 97th hand.
class CountHandTest : public QObject {
    Q_OBJECT

private slots:
    void agreesWithReference()
    {
        const long long every = qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") != 0 ? 1 : 97;
        long long hands = 0;
        QString first;
        ForEveryHand([&](const CardId* c) {
            for (bool crib : {false, true}) {
                if (hands % every != 0 || !first.isEmpty())
                    continue;
                const int points = ReferenceCountHand(c, crib);
                if (CountHandCards(c, crib) != points || ItemsTotal(ItemiseHand(c, crib)) != points)
                    first = QStringLiteral("%1 %2 %3 %4 %5, crib %6")
                                .arg(c[0]).arg(c[1]).arg(c[2]).arg(c[3]).arg(c[4]).arg(crib);
            }
            ++hands;
        });
        QVERIFY2(first.isEmpty(), qPrintable(first));
        QCOMPARE(hands, 12994800LL);
    }

    // The names and their order, which the totals above cannot see.
    void reasons_data()
    {
        QTest::addColumn<QString>("cards");  // the four, then the starter
        QTest::addColumn<bool>("crib");
        QTest::addColumn<QString>("expected");

        QTest::newRow("fifteens, a pair, a run, his nobs") << "JH JS 3C 4D 5H" << false
            << "fifteen 2, fifteen 4, a pair 6, a run of three 9, his nobs 10";
        QTest::newRow("a double run: each run after the pair") << "4H 5S 5D 6C KH" << false
            << "fifteen 2, fifteen 4, fifteen 6, fifteen 8, a pair 10, a run of three 13, a run of three 16";
        QTest::newRow("three of a kind, not three pairs") << "7H 7S 7D AC KH" << false
            << "fifteen 2, fifteen 4, fifteen 6, three of a kind 12";
        QTest::newRow("four of a kind and the jack: 29") << "5H 5S 5C JD 5D" << true
            << "fifteen 2, fifteen 4, fifteen 6, fifteen 8, fifteen 10, fifteen 12, fifteen 14, fifteen 16, "
               "four of a kind 28, his nobs 29";
        QTest::newRow("a run of four, a starter's jack of another suit") << "9C TD JH QS 2D" << false << "a run of four 4";
        QTest::newRow("a flush of four in a hand") << "2H 4H 6H 8H TS" << false << "a flush of four 4";
        QTest::newRow("no flush of four in the crib") << "2H 4H 6H 8H TS" << true << "";
        QTest::newRow("a flush of five in the crib") << "2H 4H 6H 8H TH" << true << "a flush of five 5";
    }

    void reasons()
    {
        QFETCH(QString, cards);
        QFETCH(bool, crib);
        QFETCH(QString, expected);
        CardId c[5] = {};
        for (int i = 0; i < 5; ++i)
            c[i] = CardNamed(cards.split(' ').value(i));
        QCOMPARE(ReasonsLine(ItemiseHand(c, crib)), expected);
    }
};

VENNICK_TEST(CountHandTest);
#include "CountHandTest.moc"

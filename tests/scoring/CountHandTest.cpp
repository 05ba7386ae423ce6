#include "scoring/HandCount.h"
#include "scoring/ReferenceCount.h"
#include "support/TestMain.h"

#include <QtTest>

// The hand counter against the plain reference: a sample of hands always, all
// 12,994,800 under both rules on request (VENNICK_EXHAUSTIVE=1), as that is
// slow under the sanitizers. The sample is every 97th hand.
class CountHandTest : public QObject {
    Q_OBJECT

private slots:
    void agreesWithReference();
};

void CountHandTest::agreesWithReference()
{
    const long long every = qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") != 0 ? 1 : 97;
    long long hands = 0;
    QString first;
    ForEveryHand([&](const CardId* cards) {
        if (hands++ % every != 0 || !first.isEmpty())
            return;
        for (bool crib : {false, true})
            if (CountHandCards(cards, crib) != ReferenceCountHand(cards, crib))
                first = QStringLiteral("%1 %2 %3 %4 %5, crib %6")
                            .arg(cards[0]).arg(cards[1]).arg(cards[2]).arg(cards[3]).arg(cards[4]).arg(crib);
    });
    QVERIFY2(first.isEmpty(), qPrintable(first));
    QCOMPARE(hands, 12994800LL);
}

VENNICK_TEST(CountHandTest);
#include "CountHandTest.moc"

#include "scoring/HandCount.h"
#include "scoring/ReferenceCount.h"
#include "support/TestMain.h"

// The hand counter against the plain reference: a sample of hands always, all
// 12,994,800 under both rules on request (VENNICK_EXHAUSTIVE=1), as that is
// slow under the sanitizers. The sample is every 97th hand.
class CountHandTest : public QObject {
    Q_OBJECT

private slots:
    void agreesWithReference()
    {
        const long long every = qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") != 0 ? 1 : 97;
        long long hands = 0;
        QString first;
        ForEveryHand([&](const CardId* c) {
            for (bool crib : {false, true})
                if (hands % every == 0 && first.isEmpty() && CountHandCards(c, crib) != ReferenceCountHand(c, crib))
                    first = QStringLiteral("%1 %2 %3 %4 %5, crib %6")
                                .arg(c[0]).arg(c[1]).arg(c[2]).arg(c[3]).arg(c[4]).arg(crib);
            ++hands;
        });
        QVERIFY2(first.isEmpty(), qPrintable(first));
        QCOMPARE(hands, 12994800LL);
    }
};

VENNICK_TEST(CountHandTest);
#include "CountHandTest.moc"

#include "play/PlaySequence.h"
#include "play/ReferencePlay.h"
#include "support/TestMain.h"

#include <QtTest>

// The play scorer against the plain reference: every sequence the play can
// produce of up to five cards always, all of up to eight on request
// (VENNICK_EXHAUSTIVE=1), as that is slow under the sanitizers.
class ScorePlayTest : public QObject {
    Q_OBJECT

private slots:
    void agreesWithReference();
};

void ScorePlayTest::agreesWithReference()
{
    const bool everything = qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") != 0;
    long long visited = 0;
    QString first;
    ForEveryLegalPlay(everything ? 8 : 5, [&](const PlaySequence& sequence) {
        ++visited;
        PlaySequence rebuilt;  // the same cards appended one by one
        for (int i = 0; i < SequenceLength(sequence); ++i)
            SequenceAppend(rebuilt, sequence.entries[i]);
        if (first.isEmpty() && (ScorePlay(rebuilt) != ReferenceScorePlay(sequence) || rebuilt.entries[8] != -1))
            for (int entry : sequence.entries)
                first += QString::number(entry) + QLatin1Char(' ');
    });
    QVERIFY2(first.isEmpty(), qPrintable(first));
    QCOMPARE(visited, everything ? 12892167LL : 182587LL);
}

VENNICK_TEST(ScorePlayTest);
#include "ScorePlayTest.moc"

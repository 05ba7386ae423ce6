#include "support/TestBoard.h"
#include "support/TestMain.h"

// The deal and Send To Crib as the user sees them: the six dealt in rank
// order (equal ranks as drawn), the two sent moved to the crib's places 1 and
// 6, the four kept sorted again, every place showing its own card.
class DealTest : public QObject {
    Q_OBJECT

private slots:
    void dealAndSend_data()
    {
        QTest::addColumn<QList<int>>("chosen");  // places tapped before Send To Crib
        QTest::addColumn<QString>("expected");   // the user's six in order | what places 1..6 and the starter show
        // Drawn 7H KH 2S 7S KC AC; the starter is the five of diamonds.
        QTest::newRow("dealt") << QList<int>{} << "AC 2S 7H 7S KH KC | AC 2S 7H 7S KH KC ##";
        QTest::newRow("2 and 4 sent") << QList<int>{2, 4} << "2S AC 7H KC KH 7S | -- AC 7H KC KH -- 5D";
        QTest::newRow("1 and 6 stay") << QList<int>{1, 6} << "AC 2S 7H 7S KH KC | -- 2S 7H 7S KH -- 5D";
        QTest::newRow("5 to place 1") << QList<int>{5, 6} << "KH AC 2S 7H 7S KC | -- AC 2S 7H 7S -- 5D";
        QTest::newRow("5 to place 6, its king shown") << QList<int>{1, 5} << "AC 2S 7H 7S KC KH | -- 2S 7H 7S KC -- 5D";
    }

    void dealAndSend()
    {
        QFETCH(QList<int>, chosen);
        QFETCH(QString, expected);
        auto board = MakeBoard();
        StackDeck(*board, {Card(7, 3), Card(13, 3), Card(2, 1), Card(7, 1), Card(13, 4), Card(1, 4), Card(3, 2),
                           Card(4, 2), Card(6, 2), Card(8, 2), Card(9, 2), Card(10, 2), Card(5, 2)});
        PressKey(*board, Qt::Key_Return);
        QCOMPARE(LogLines(*board).mid(3), (QStringList{"Shuffling...", "Opponent's Crib."}));
        for (int p : chosen)
            TapHand(*board, p);
        if (!chosen.isEmpty())
            ClickButton(*board, kCmdSendToCrib);
        const GameRecord& r = board->record;
        QStringList dealt;
        for (int i = 0; i < 6; ++i)
            dealt.append(CardName(r.deal[i]));
        QCOMPARE(dealt.join(' ') + " | " + ShownCards(r.playerHandSprites) + ' ' + ShownCards({&r.starterSprite, 1}),
                 expected);
    }
};

VENNICK_TEST(DealTest);
#include "DealTest.moc"

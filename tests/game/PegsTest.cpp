#include "support/TestBoard.h"
#include "support/TestMain.h"

// The two pegs of each side leapfrog along their track and stop at the game hole.
class PegsTest : public QObject {
    Q_OBJECT

private slots:
    void leapfrog_data()
    {
        QTest::addColumn<QList<int>>("moves");  // each made by the user, then by the computer
        QTest::addColumn<QList<int>>("holes");  // user's front and back, computer's front and back
        QTest::newRow("5 then 3") << QList<int>{5, 3} << QList<int>{8, 5, 8, 5};
        QTest::newRow("zero and negative do nothing") << QList<int>{0, -4} << QList<int>{0, 122, 0, 122};
        QTest::newRow("zero between moves") << QList<int>{4, 0, 6} << QList<int>{10, 4, 10, 4};
        QTest::newRow("past the game hole, then frozen") << QList<int>{20, 110, 9} << QList<int>{121, 20, 20, 0};
    }

    // The holes, and each peg's 5 x 5 rectangle centred on its hole.
    void leapfrog()
    {
        QFETCH(QList<int>, moves);
        QFETCH(QList<int>, holes);
        auto board = MakeBoard();
        const GameRecord& r = board->record;
        for (int n : moves) {
            board->MovePlayerPegs(n);
            board->MoveOpponentPegs(n);
        }
        QCOMPARE(QList<int>({r.playerFrontHole, r.playerBackHole, r.opponentFrontHole, r.opponentBackHole}), holes);
        const auto centred = [](const Rect& peg, HolePoint h) { return peg == Rect{h.x - 2, h.y - 2, h.x + 3, h.y + 3}; };
        QVERIFY(centred(r.playerFrontPegRect, r.playerHoles[holes[0]]) && centred(r.playerBackPegRect, r.playerHoles[holes[1]]));
        QVERIFY(centred(r.opponentFrontPegRect, r.opponentHoles[holes[2]]) && centred(r.opponentBackPegRect, r.opponentHoles[holes[3]]));
    }
};

VENNICK_TEST(PegsTest);
#include "PegsTest.moc"

#include "support/TestBoard.h"
#include "support/TestMain.h"

// The two pegs of each side leapfrog along their track and stop at the game hole.
class PegsTest : public QObject {
    Q_OBJECT

private slots:
    void leapfrog_data()
    {
        QTest::addColumn<QList<int>>("moves");
        QTest::addColumn<int>("front");
        QTest::addColumn<int>("back");
        QTest::newRow("first points") << QList<int>{5} << 5 << 0;
        QTest::newRow("5 then 3") << QList<int>{5, 3} << 8 << 5;
        QTest::newRow("2 then 3") << QList<int>{2, 3} << 5 << 2;
        QTest::newRow("zero and negative do nothing") << QList<int>{0, -4} << 0 << int(kBackStartHole);
        QTest::newRow("zero between moves") << QList<int>{4, 0, 6} << 10 << 4;
        QTest::newRow("119 plus 5 stops in the game hole") << QList<int>{60, 59, 5} << 121 << 119;
        QTest::newRow("far past the end") << QList<int>{500} << 121 << 0;
    }

    void leapfrog()
    {
        QFETCH(QList<int>, moves);
        QFETCH(int, front);
        QFETCH(int, back);
        auto board = MakeBoard();
        for (int n : moves)
            board->MovePlayerPegs(n);
        QCOMPARE(board->PlayerScore(), front);
        QCOMPARE(board->record.playerBackHole, back);
        QCOMPARE(board->OpponentScore(), 0);

        // The computer's pegs follow the same rule on their own track.
        board->NewGame();
        for (int n : moves)
            board->MoveOpponentPegs(n);
        QCOMPARE(board->OpponentScore(), front);
        QCOMPARE(board->record.opponentBackHole, back);
    }

    void everythingFreezesOnceAPegIsHome()
    {
        auto board = MakeBoard();
        board->MovePlayerPegs(30);
        board->MoveOpponentPegs(115);
        board->MoveOpponentPegs(10);
        QCOMPARE(board->OpponentScore(), 121);
        const Rect playerFront = board->record.playerFrontPegRect;
        board->MovePlayerPegs(7);
        board->MoveOpponentPegs(3);
        QCOMPARE(board->PlayerScore(), 30);
        QCOMPARE(board->record.playerBackHole, 0);
        QCOMPARE(board->OpponentScore(), 121);
        QCOMPARE(board->record.opponentBackHole, 115);
        QCOMPARE(board->record.playerFrontPegRect, playerFront);
    }

    void pegRectanglesAreCentredOnTheirHoles()
    {
        auto board = MakeBoard();
        const GameRecord& r = board->record;
        // Start: front pegs in hole 0, back pegs in hole 122.
        QCOMPARE(r.playerFrontPegRect, (Rect{10, 188, 15, 193}));
        QCOMPARE(r.playerBackPegRect, (Rect{10, 193, 15, 198}));
        QCOMPARE(r.opponentFrontPegRect, (Rect{19, 188, 24, 193}));
        QCOMPARE(r.opponentBackPegRect, (Rect{19, 193, 24, 198}));
        board->MovePlayerPegs(121);
        QCOMPARE(r.playerFrontPegRect, (Rect{39, 24, 44, 29}));  // the game hole (41, 26)
        QCOMPARE(r.playerBackPegRect, (Rect{10, 188, 15, 193}));
        board->NewGame();
        QCOMPARE(r.playerFrontPegRect, (Rect{10, 188, 15, 193}));
        QCOMPARE(r.playerBackHole, kBackStartHole);
    }

    void refreshCountShowsTheRunningCount()
    {
        auto board = MakeBoard();
        board->record.runningCount = 23;
        QCOMPARE(board->record.shownCount, 0);
        board->RefreshCount();
        QCOMPARE(board->record.shownCount, 23);
    }
};

VENNICK_TEST(PegsTest);
#include "PegsTest.moc"

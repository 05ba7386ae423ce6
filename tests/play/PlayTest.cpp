#include "play/PlaySupport.h"
#include "support/TestMain.h"

#include <QtTest>

// The play driven as the user plays it: taps or keys on the cards, "Ok" by
// mouse or Enter. Each deal is laid out so that the computer's answers follow
// from its rules; the comments give the count as it goes.
class PlayTest : public QObject {
    Q_OBJECT

private slots:
    void userThirtyOneThenComputerLeadsAfterOk();
    void computerRunsOnToThirtyOneAndUserLeads();
    void goIsRepeatedUntilUserPegsIt();
    void computerLastCardPointIsNotAnnounced();
    void computerGoLetsUserLead();
    void computerWaitsForOkAfterScoringWhileUserIsStuck();
    void userLastCardGoEndsThePlay();
    void cardPassingThirtyOneIsRefused();
    void hisHeels_data();
    void hisHeels();
    void goPointThatWinsStopsThePlay_data();
    void goPointThatWinsStopsThePlay();
};

void PlayTest::userThirtyOneThenComputerLeadsAfterOk()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false,
              {{Card(2, 1), Card(4, 1), Card(8, 1), Card(12, 1)},
               {Card(9, 3), Card(10, 3)},
               {Card(7, 2), Card(13, 2), Card(7, 3), Card(7, 4)},
               {Card(3, 4), Card(6, 4)},
               Card(5, 2)});
    const qsizetype mark = LogLines(b).size();
    QCOMPARE(r.countVisible, 1);
    QCOMPARE(r.opponentPlayIndex, 1);  // the user leads

    LayCard(b, Card(2, 1));   // 2, 7: 9
    LayCard(b, Card(4, 1));   // 4, K: 23
    QCOMPARE(r.runningCount, 23);
    QCOMPARE(r.opponentPileSprites[1].rank1, 13);

    LayCard(b, Card(8, 1));   // 31
    QCOMPARE(LinesSince(b, mark), QStringList{"You peg 2."});
    QCOMPARE(b.PlayerScore(), 2);
    QCOMPARE(ShownButtons(b), QList<int>{kCmdOk});
    QCOMPARE(r.runningCount, 0);
    QVERIFY(SequenceRanks(b).isEmpty());
    QCOMPARE(r.shownCount, 31);  // the display holds 31 until the next card
    QCOMPARE(r.opponentPlayIndex, 3);  // the computer waits for "Ok"

    // While "Ok" shows the user's cards stay put.
    TapHand(b, HandPosition(b, Card(12, 1)));
    QCOMPARE(r.playerPlayIndex, 4);
    QVERIFY(HandPosition(b, Card(12, 1)) != 0);

    ClickButton(b, kCmdOk);
    QVERIFY(ShownButtons(b).isEmpty());
    QCOMPARE(r.runningCount, 7);  // the computer leads the new count
    QCOMPARE(SequenceRanks(b), QList<int>{7});

    // Q, 7 make 24; nobody can play, and the computer's go is 1, never 2.
    LayCard(b, Card(12, 1));
    QCOMPARE(LinesSince(b, mark), (QStringList{"You peg 2.", "Opponent pegs 1 for a go."}));
    QCOMPARE(b.OpponentScore(), 1);
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScorePlayerHand});
    QCOMPARE(r.runningCount, 0);
}

void PlayTest::computerRunsOnToThirtyOneAndUserLeads()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false, Deals::ComputerRunsToThirtyOne());
    const qsizetype mark = LogLines(b).size();

    LayCard(b, Card(2, 1));   // 2, K: 12
    LayCard(b, Card(8, 2));   // 8: 20; the user's 10 and Q no longer fit
    // The computer lays 6 and 5 one after the other, with no pause, to 31.
    QCOMPARE(r.opponentPlayIndex, 4);
    QCOMPARE(r.opponentPileSprites[1].rank1, 6);
    QCOMPARE(r.opponentPileSprites[2].rank1, 5);
    QCOMPARE(LinesSince(b, mark), QStringList{"Opponent pegs 2."});
    QCOMPARE(b.OpponentScore(), 2);  // 31 takes no go point
    QCOMPARE(r.runningCount, 0);
    QCOMPARE(r.shownCount, 31);
    QVERIFY(ShownButtons(b).isEmpty());  // the user leads the next count

    LayCard(b, Card(10, 3));  // 10, K: 20
    QCOMPARE(r.runningCount, 20);
    LayCard(b, Card(12, 4));  // 30: the last card, the user's go
    QCOMPARE(LinesSince(b, mark), (QStringList{"Opponent pegs 2.", "You peg 1 for a go."}));
    QCOMPARE(b.PlayerScore(), 1);
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScorePlayerHand});
}

void PlayTest::goIsRepeatedUntilUserPegsIt()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false,
              {{Card(1, 1), Card(2, 1), Card(7, 2), Card(13, 3)},
               {Card(3, 3), Card(4, 3)},
               {Card(12, 2), Card(11, 4), Card(10, 1), Card(9, 3)},
               {Card(5, 4), Card(6, 4)},
               Card(8, 4)});
    const qsizetype mark = LogLines(b).size();
    const QString go = QStringLiteral("Opponent says: 'Go'");

    // Played with the keyboard alone.
    LayCard(b, Card(13, 3), true);  // K, 10: 20
    LayCard(b, Card(7, 2), true);   // 27: the computer cannot follow
    QCOMPARE(LinesSince(b, mark), QStringList{go});
    LayCard(b, Card(1, 1), true);   // 28
    QCOMPARE(LinesSince(b, mark), (QStringList{go, go}));
    QCOMPARE(r.opponentPlayIndex, 2);
    LayCard(b, Card(2, 1), true);   // 30: neither side can lay a card
    QCOMPARE(LinesSince(b, mark), (QStringList{go, go, "You peg 1 for a go."}));
    QCOMPARE(b.PlayerScore(), 1);
    QCOMPARE(r.runningCount, 0);
    QCOMPARE(ShownButtons(b), QList<int>{kCmdOk});
    QCOMPARE(r.opponentPlayIndex, 2);  // the computer leads only after "Ok"

    // Enter presses "Ok"; the computer then lays its last three cards alone
    // (Q 10, 9 19, J 29) and takes the go.
    ReleaseEnter(b);
    QCOMPARE(r.opponentPlayIndex, 5);
    QCOMPARE(LinesSince(b, mark), (QStringList{go, go, "You peg 1 for a go.", "Opponent pegs 1 for a go."}));
    QCOMPARE(b.OpponentScore(), 1);
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScorePlayerHand});
}

void PlayTest::computerLastCardPointIsNotAnnounced()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false,
              {{Card(1, 1), Card(1, 2), Card(2, 3), Card(3, 4)},
               {Card(9, 1), Card(10, 1)},
               {Card(3, 2), Card(7, 1), Card(5, 3), Card(7, 3)},
               {Card(13, 2), Card(12, 2)},
               Card(6, 4)});
    const qsizetype mark = LogLines(b).size();

    LayCard(b, Card(1, 1));  // A, 7: 8
    LayCard(b, Card(1, 2));  // A, 7: 16
    LayCard(b, Card(2, 3));  // 2, 5: 23
    QVERIFY(LinesSince(b, mark).isEmpty());
    LayCard(b, Card(3, 4));  // 3, 3: 29, a pair on the last of the eight cards
    QCOMPARE(LinesSince(b, mark), QStringList{"Opponent pegs 2."});
    QCOMPARE(b.OpponentScore(), 3);  // the pair and the last card in one move
    QCOMPARE(r.opponentBackHole, 0);
    QCOMPARE(r.runningCount, 0);
    QVERIFY(SequenceRanks(b).isEmpty());
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScorePlayerHand});
}

void PlayTest::computerGoLetsUserLead()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false,
              {{Card(1, 4), Card(7, 4), Card(10, 2), Card(11, 2)},
               {Card(2, 3), Card(3, 3)},
               {Card(8, 3), Card(11, 1), Card(12, 1), Card(10, 1)},
               {Card(4, 2), Card(5, 2)},
               Card(6, 4)});
    const qsizetype mark = LogLines(b).size();

    LayCard(b, Card(1, 4));   // A, 8: 9
    LayCard(b, Card(7, 4));   // 7, J: 26, and neither side has a card that fits
    QCOMPARE(LinesSince(b, mark), QStringList{"Opponent pegs 1 for a go."});
    QCOMPARE(b.OpponentScore(), 1);
    QCOMPARE(r.runningCount, 0);
    // The computer laid the last card, so the user leads without a pause.
    QVERIFY(ShownButtons(b).isEmpty());
    QCOMPARE(r.opponentPlayIndex, 3);

    LayCard(b, Card(10, 2));  // 10, 10: 20, a pair
    QCOMPARE(LinesSince(b, mark).last(), QStringLiteral("Opponent pegs 2."));
    QCOMPARE(b.OpponentScore(), 3);  // the user's jack still fits: no last card
    QVERIFY(ShownButtons(b).isEmpty());
    LayCard(b, Card(11, 2));  // 30; the computer's Q does not fit
    QCOMPARE(LinesSince(b, mark).last(), QStringLiteral("You peg 1 for a go."));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdOk});
    ClickButton(b, kCmdOk);   // the computer leads its Q alone and takes the go
    QCOMPARE(LinesSince(b, mark).last(), QStringLiteral("Opponent pegs 1 for a go."));
    QCOMPARE(b.OpponentScore(), 4);
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScorePlayerHand});
}

void PlayTest::computerWaitsForOkAfterScoringWhileUserIsStuck()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false,
              {{Card(8, 1), Card(9, 1), Card(10, 1), Card(13, 1)},
               {Card(1, 4), Card(3, 4)},
               {Card(5, 2), Card(2, 2), Card(2, 3), Card(2, 4)},
               {Card(6, 3), Card(7, 3)},
               Card(4, 2)});
    const qsizetype mark = LogLines(b).size();

    LayCard(b, Card(8, 1));  // 8, 5: 13
    LayCard(b, Card(9, 1));  // 9: 22; the user cannot lay 10 or K
    // The computer lays a two (24) and pairs it (26), then waits.
    QCOMPARE(r.opponentPlayIndex, 4);
    QCOMPARE(LinesSince(b, mark), QStringList{"Opponent pegs 2."});
    QCOMPARE(ShownButtons(b), QList<int>{kCmdOk});
    QCOMPARE(r.runningCount, 26);

    // Three twos (6) with both sides out of cards that fit: 7 pegged, 6 said.
    ClickButton(b, kCmdOk);
    QCOMPARE(LinesSince(b, mark), (QStringList{"Opponent pegs 2.", "Opponent pegs 6."}));
    QCOMPARE(b.OpponentScore(), 9);
    QCOMPARE(r.opponentBackHole, 2);
    QCOMPARE(r.runningCount, 0);
    QVERIFY(ShownButtons(b).isEmpty());  // the user leads after the computer's go

    LayCard(b, Card(10, 1));  // the computer's hand is empty: it says go
    QCOMPARE(LinesSince(b, mark).last(), QStringLiteral("Opponent says: 'Go'"));
    LayCard(b, Card(13, 1));  // 20, the last card
    QCOMPARE(LinesSince(b, mark).last(), QStringLiteral("You peg 1 for a go."));
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScorePlayerHand});
}

void PlayTest::userLastCardGoEndsThePlay()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, true, Deals::UserLastCardGo());
    const qsizetype mark = LogLines(b).size();
    // The user dealt, so the computer has led already.
    QCOMPARE(r.opponentPlayIndex, 2);
    QCOMPARE(r.runningCount, 4);

    LayCard(b, Card(1, 1));   // A, 4: 9
    LayCard(b, Card(1, 3));   // A, 2: 12
    LayCard(b, Card(6, 2));   // 6, 2: 20
    QVERIFY(LinesSince(b, mark).isEmpty());
    LayCard(b, Card(12, 3));  // 30, scoring nothing
    QCOMPARE(LinesSince(b, mark), QStringList{"You peg 1 for a go."});
    QCOMPARE(b.PlayerScore(), 1);
    QCOMPARE(r.phase, int32_t(kPhasePlayOver));
    // The non-dealer counts first; "Ok" is not left behind.
    QCOMPARE(ShownButtons(b), QList<int>{kCmdScoreOpponentHand});
    for (int i = 0; i < 4; ++i) {
        QVERIFY(r.playerPileSprites[i].suit1 != kSuitEmpty);
        QVERIFY(r.opponentPileSprites[i].suit1 != kSuitEmpty);
    }
}

void PlayTest::cardPassingThirtyOneIsRefused()
{
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    StartDeal(b, false,
              {{Card(4, 4), Card(5, 4), Card(7, 4), Card(10, 4)},
               {Card(1, 3), Card(2, 3)},
               {Card(12, 2), Card(13, 2), Card(12, 3), Card(10, 3)},
               {Card(3, 1), Card(6, 1)},
               Card(8, 1)});
    const qsizetype mark = LogLines(b).size();

    LayCard(b, Card(7, 4));   // 7, Q: 17
    LayCard(b, Card(10, 4));  // 27
    QCOMPARE(r.runningCount, 27);
    const qsizetype lines = LogLines(b).size();

    LayCard(b, Card(5, 4));   // would make 32
    QCOMPARE(r.runningCount, 27);
    QCOMPARE(r.playerPlayIndex, 3);
    QVERIFY(HandPosition(b, Card(5, 4)) != 0);
    QCOMPARE(LogLines(b).size(), lines);

    LayCard(b, Card(4, 4));   // 31
    QCOMPARE(LinesSince(b, mark), (QStringList{"Opponent says: 'Go'", "You peg 2."}));
    QCOMPARE(ShownButtons(b), QList<int>{kCmdOk});
}

void PlayTest::hisHeels_data()
{
    QTest::addColumn<bool>("userDeals");
    QTest::addColumn<QString>("line");
    QTest::addColumn<bool>("okShown");
    QTest::newRow("user deals") << true << "You peg 2 for His Heels." << true;
    QTest::newRow("computer deals") << false << "Opponent pegs 2 for His Heels." << false;
}

void PlayTest::hisHeels()
{
    QFETCH(bool, userDeals);
    QFETCH(QString, line);
    QFETCH(bool, okShown);
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    TableCards cards = userDeals ? Deals::UserLastCardGo() : Deals::ComputerRunsToThirtyOne();
    cards.starter = Card(11, 2);
    const qsizetype mark = LogLines(b).size();
    StartDeal(b, userDeals, cards);

    QCOMPARE(LinesSince(b, mark).last(), line);
    QCOMPARE(userDeals ? b.PlayerScore() : b.OpponentScore(), 2);
    QCOMPARE(r.starterSprite.rank1, 11);
    // The non-dealer leads: the computer only once "Ok" is pressed.
    QCOMPARE(r.opponentPlayIndex, 1);
    QCOMPARE(ShownButtons(b), okShown ? QList<int>{kCmdOk} : QList<int>{});
    if (okShown) {
        ClickButton(b, kCmdOk);
        QCOMPARE(r.opponentPlayIndex, 2);
        QCOMPARE(r.runningCount, 4);
    } else {
        LayCard(b, Card(2, 1));
        QCOMPARE(r.playerPlayIndex, 2);
        QCOMPARE(r.opponentPlayIndex, 2);
    }
}

void PlayTest::goPointThatWinsStopsThePlay_data()
{
    QTest::addColumn<bool>("cardsLeft");
    QTest::newRow("on the last card") << false;
    QTest::newRow("with cards still in hand") << true;
}

void PlayTest::goPointThatWinsStopsThePlay()
{
    QFETCH(bool, cardsLeft);
    auto board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    if (cardsLeft) {
        // The go of the repeated-go deal: the computer still holds three cards.
        StartDeal(b, false,
                  {{Card(1, 1), Card(2, 1), Card(7, 2), Card(13, 3)},
                   {Card(3, 3), Card(4, 3)},
                   {Card(12, 2), Card(11, 4), Card(10, 1), Card(9, 3)},
                   {Card(5, 4), Card(6, 4)},
                   Card(8, 4)});
        SetScores(b, 120, 70);
        for (CardId card : {Card(13, 3), Card(7, 2), Card(1, 1), Card(2, 1)})
            LayCard(b, card);
    } else {
        StartDeal(b, true, Deals::UserLastCardGo());
        SetScores(b, 120, 70);
        for (CardId card : {Card(1, 1), Card(1, 3), Card(6, 2), Card(12, 3)})
            LayCard(b, card);
    }
    QCOMPARE(LogLines(b).mid(LogLines(b).size() - 3),
             (QStringList{"You peg 1 for a go.", "You won.", "Please click New to play again."}));
    QCOMPARE(b.PlayerScore(), 121);
    QCOMPARE(r.gameOver, 1);
    QCOMPARE(r.phase, int32_t(kPhaseGameOver));
    QVERIFY(ShownButtons(b).isEmpty());

    // Nothing moves any more: not the user's cards, nor the computer's.
    const int opponentPlayed = r.opponentPlayIndex;
    const qsizetype lines = LogLines(b).size();
    for (int position = 1; position <= 6; ++position) {
        TapHand(b, position);
        PressKey(b, Qt::Key_1 + position - 1);
    }
    ReleaseEnter(b);
    QCOMPARE(r.opponentPlayIndex, opponentPlayed);
    QCOMPARE(LogLines(b).size(), lines);
    QCOMPARE(r.phase, int32_t(kPhaseGameOver));
}

VENNICK_TEST(PlayTest);
#include "PlayTest.moc"

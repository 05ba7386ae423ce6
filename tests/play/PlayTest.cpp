#include "play/PlaySupport.h"
#include "support/TestMain.h"

#include <QtTest>

namespace {

const QString kGo = QStringLiteral("Opponent says: 'Go'");
const QStringList kUserWins{"You peg 1 for a go.", "You won.", "Please click New to play again."};

// The user leads K and 7 to 27 against Q J 10 9: the computer says go twice.
TableCards RepeatedGo()
{
    return {{Card(1, 1), Card(2, 1), Card(7, 2), Card(13, 3)}, {Card(3, 3), Card(4, 3)},
            {Card(12, 2), Card(11, 4), Card(10, 1), Card(9, 3)}, {Card(5, 4), Card(6, 4)}, Card(8, 4)};
}

TableCards JackTurned(TableCards cards)
{
    cards.starter = Card(11, 2);
    return cards;
}

} // namespace

// The play as the user plays it: taps or keys on the cards, "Ok" by mouse or
// Enter. Each deal is laid out so that the computer's answers follow from its
// rules; the steps give the count and the scores as they go.
class PlayTest : public QObject {
    Q_OBJECT

private slots:
    void play_data();
    void play();
};

void PlayTest::play_data()
{
    QTest::addColumn<bool>("userDeals");
    QTest::addColumn<bool>("byKey");
    QTest::addColumn<int>("youBefore");  // the user's score before the deal
    QTest::addColumn<TableCards>("cards");
    QTest::addColumn<QList<Step>>("steps");

    QTest::newRow("user's 31; the computer leads after Ok") << false << false << 0
        << TableCards{{Card(2, 1), Card(4, 1), Card(8, 1), Card(12, 1)}, {Card(9, 3), Card(10, 3)},
                      {Card(7, 2), Card(13, 2), Card(7, 3), Card(7, 4)}, {Card(3, 4), Card(6, 4)}, Card(5, 2)}
        << QList<Step>{{Card(2, 1), {}, 9, 0, 0, {}},   // 2, 7
                       {Card(4, 1), {}, 23, 0, 0, {}},  // 4, K
                       {Card(8, 1), {"You peg 2."}, 0, 2, 0, {kCmdOk}, 31},
                       {Card(12, 1), {}, 0, 2, 0, {kCmdOk}, 31},  // no card while "Ok" shows
                       {kPress, {}, 7, 2, 0, {}},
                       // Q, 7: 24, nobody can go on; a go is never doubled.
                       {Card(12, 1), {"Opponent pegs 1 for a go."}, 0, 2, 1, {kCmdScorePlayerHand}}};
    QTest::newRow("computer's 31; the user leads") << false << false << 0 << Deals::ComputerRunsToThirtyOne()
        << QList<Step>{{Card(2, 1), {}, 12, 0, 0, {}},
                       {Card(8, 2), {"Opponent pegs 2."}, 0, 0, 2, {}, 31},  // 6 and 5 at once; no go
                       {Card(10, 3), {}, 20, 0, 2, {}},
                       {Card(12, 4), {"You peg 1 for a go."}, 0, 1, 2, {kCmdScorePlayerHand}}};
    QTest::newRow("Go repeated until the user pegs it, by keyboard") << false << true << 0 << RepeatedGo()
        << QList<Step>{{Card(13, 3), {}, 20, 0, 0, {}},
                       {Card(7, 2), {kGo}, 27, 0, 0, {}},
                       {Card(1, 1), {kGo}, 28, 0, 0, {}},
                       {Card(2, 1), {"You peg 1 for a go."}, 0, 1, 0, {kCmdOk}},
                       // Q 10, 9 19, J 29 laid alone.
                       {kPress, {"Opponent pegs 1 for a go."}, 0, 1, 1, {kCmdScorePlayerHand}}};
    QTest::newRow("computer's last-card point unannounced") << false << false << 0
        << TableCards{{Card(1, 1), Card(1, 2), Card(2, 3), Card(3, 4)}, {Card(9, 1), Card(10, 1)},
                      {Card(3, 2), Card(7, 1), Card(5, 3), Card(7, 3)}, {Card(13, 2), Card(12, 2)}, Card(6, 4)}
        << QList<Step>{{Card(1, 1), {}, 8, 0, 0, {}},
                       {Card(1, 2), {}, 16, 0, 0, {}},
                       {Card(2, 3), {}, 23, 0, 0, {}},
                       {Card(3, 4), {"Opponent pegs 2."}, 0, 0, 3, {kCmdScorePlayerHand}, 29}};
    QTest::newRow("after the computer's go the user leads") << false << false << 0
        << TableCards{{Card(1, 4), Card(7, 4), Card(10, 2), Card(11, 2)}, {Card(2, 3), Card(3, 3)},
                      {Card(8, 3), Card(11, 1), Card(12, 1), Card(10, 1)}, {Card(4, 2), Card(5, 2)}, Card(6, 4)}
        << QList<Step>{{Card(1, 4), {}, 9, 0, 0, {}},
                       {Card(7, 4), {"Opponent pegs 1 for a go."}, 0, 0, 1, {}},  // J: 26
                       {Card(10, 2), {"Opponent pegs 2."}, 20, 0, 3, {}},  // the user's J still fits
                       {Card(11, 2), {"You peg 1 for a go."}, 0, 1, 3, {kCmdOk}},
                       {kPress, {"Opponent pegs 1 for a go."}, 0, 1, 4, {kCmdScorePlayerHand}}};
    QTest::newRow("computer waits for Ok after scoring while the user is stuck") << false << false << 0
        << TableCards{{Card(8, 1), Card(9, 1), Card(10, 1), Card(13, 1)}, {Card(1, 4), Card(3, 4)},
                      {Card(5, 2), Card(2, 2), Card(2, 3), Card(2, 4)}, {Card(6, 3), Card(7, 3)}, Card(4, 2)}
        << QList<Step>{{Card(8, 1), {}, 13, 0, 0, {}},
                       {Card(9, 1), {"Opponent pegs 2."}, 26, 0, 2, {kCmdOk}},  // 2, 2
                       {kPress, {"Opponent pegs 6."}, 0, 0, 9, {}, 28},  // the third two and the last card
                       {Card(10, 1), {kGo}, 10, 0, 9, {}},
                       {Card(13, 1), {"You peg 1 for a go."}, 0, 1, 9, {kCmdScorePlayerHand}}};
    QTest::newRow("user's last card ends the play; the computer counts first") << true << false << 0
        << Deals::UserLastCardGo()
        << QList<Step>{{kLook, {}, 4, 0, 0, {}},
                       {Card(1, 1), {}, 9, 0, 0, {}},
                       {Card(1, 3), {}, 12, 0, 0, {}},
                       {Card(6, 2), {}, 20, 0, 0, {}},
                       {Card(12, 3), {"You peg 1 for a go."}, 0, 1, 0, {kCmdScoreOpponentHand}}};
    QTest::newRow("a card past 31 is refused") << false << false << 0
        << TableCards{{Card(4, 4), Card(5, 4), Card(7, 4), Card(10, 4)}, {Card(1, 3), Card(2, 3)},
                      {Card(12, 2), Card(13, 2), Card(12, 3), Card(10, 3)}, {Card(3, 1), Card(6, 1)}, Card(8, 1)}
        << QList<Step>{{Card(7, 4), {}, 17, 0, 0, {}},
                       {Card(10, 4), {kGo}, 27, 0, 0, {}},
                       {Card(5, 4), {}, 27, 0, 0, {}},
                       {Card(4, 4), {"You peg 2."}, 0, 2, 0, {kCmdOk}, 31}};
    // The non-dealer leads: the computer only once "Ok" is pressed.
    QTest::newRow("His Heels for the user") << true << false << 0 << JackTurned(Deals::UserLastCardGo())
        << QList<Step>{{kLook, {"You peg 2 for His Heels."}, 0, 2, 0, {kCmdOk}}, {kPress, {}, 4, 2, 0, {}}};
    QTest::newRow("His Heels for the computer") << false << false << 0
        << JackTurned(Deals::ComputerRunsToThirtyOne())
        << QList<Step>{{kLook, {"Opponent pegs 2 for His Heels."}, 0, 0, 2, {}}, {Card(2, 1), {}, 12, 0, 2, {}}};
    // Once won, nothing moves: not the user's cards, nor the computer's.
    QTest::newRow("a go point wins on the last card") << true << false << 120 << Deals::UserLastCardGo()
        << QList<Step>{{Card(1, 1), {}, 9, 120, 0, {}},
                       {Card(1, 3), {}, 12, 120, 0, {}},
                       {Card(6, 2), {}, 20, 120, 0, {}},
                       {Card(12, 3), kUserWins, 0, 121, 0, {}, 30},
                       {kTapEverything, {}, 0, 121, 0, {}, 30}};
    QTest::newRow("a go point wins with the computer's cards in hand") << false << false << 120 << RepeatedGo()
        << QList<Step>{{Card(13, 3), {}, 20, 120, 0, {}},
                       {Card(7, 2), {kGo}, 27, 120, 0, {}},
                       {Card(1, 1), {kGo}, 28, 120, 0, {}},
                       {Card(2, 1), kUserWins, 0, 121, 0, {}, 30},
                       {kTapEverything, {}, 0, 121, 0, {}, 30}};
}

void PlayTest::play()
{
    QFETCH(bool, userDeals);
    QFETCH(bool, byKey);
    QFETCH(int, youBefore);
    QFETCH(TableCards, cards);
    QFETCH(QList<Step>, steps);
    auto board = MakeBoard();
    // The deal's own lines, "Shuffling..." and whose crib, are not steps.
    const qsizetype mark = LogLines(*board).size() + 2;
    StartDeal(*board, userDeals, cards);
    board->MovePlayerPegs(youBefore);
    QCOMPARE(board->record.countVisible, 1);
    RunSteps(*board, steps, byKey, mark);
    const QList<int> last = steps.last().buttons;
    const bool over = last.contains(kCmdScorePlayerHand) || last.contains(kCmdScoreOpponentHand);
    QCOMPARE(board->record.phase, int32_t(board->record.gameOver ? kPhaseGameOver : over ? kPhasePlayOver : kPhasePlay));
}

VENNICK_TEST(PlayTest);
#include "PlayTest.moc"

#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QSettings>
#include <QtTest>

#include <cstdint>
#include <limits>

namespace {

// Gives each side one ace at hand position 1 that fits, or none, so that
// PlayerCannotPlay and ComputerCannotPlay answer as a test needs.
void SetHands(GameBoard& board, bool playerCanPlay, bool computerCanPlay)
{
    GameRecord& r = board.record;
    for (int p = 0; p < 6; ++p)
        r.playerHandSprites[p].suit1 = r.opponentHandSprites[p].suit1 = kSuitEmpty;
    r.deal[1] = Card(1, 1);
    r.deal[7] = Card(1, 2);
    r.playerHandSprites[1] = {r.playerHandSprites[1].rect, 0, 0, 1, playerCanPlay ? 1 : kSuitEmpty};
    r.opponentHandSprites[1] = {r.opponentHandSprites[1].rect, 1, 0, 1, computerCanPlay ? 2 : kSuitEmpty};
}

int StoredValue(const char* name)
{
    return QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).value(QLatin1String(name), -1).toInt();
}

} // namespace

// The one path by which points reach the board: what is announced, what is
// pegged, when the computer waits, and how a game ends and is tallied. The
// play's and the show's tests drive the common cases through real deals.
class PeggingTest : public QObject {
    Q_OBJECT

private slots:
    void noughtAnnouncedOnlyInTheShow_data();
    void noughtAnnouncedOnlyInTheShow();
    void computerScoreDuringPlay_data();
    void computerScoreDuringPlay();
    void gameEndTally_data();
    void gameEndTally();
};

void PeggingTest::noughtAnnouncedOnlyInTheShow_data()
{
    QTest::addColumn<int>("phase");
    QTest::addColumn<int>("side");
    QTest::addColumn<QString>("line");  // empty: nothing is logged

    QTest::newRow("the play") << int(kPhasePlay) << int(kSidePlayer) << "";
    QTest::newRow("the first hand") << int(kPhasePlayOver) << int(kSidePlayer) << "You peg 0.";
    QTest::newRow("the second hand") << int(kPhaseHandCounted) << int(kSideOpponent) << "Opponent pegs 0.";
    QTest::newRow("the crib") << int(kPhaseCribCounted) << int(kSidePlayer) << "You peg 0.";
}

void PeggingTest::noughtAnnouncedOnlyInTheShow()
{
    QFETCH(int, phase);
    QFETCH(int, side);
    QFETCH(QString, line);
    auto board = MakeBoard();
    board->record.phase = phase;
    SetHands(*board, true, true);
    const qsizetype mark = LogLines(*board).size();

    board->PegPoints(side, 0, QString());

    QCOMPARE(LogLines(*board).mid(mark), line.isEmpty() ? QStringList{} : QStringList{line});
    QCOMPARE(board->PlayerScore() + board->OpponentScore(), 0);
    QVERIFY(!board->IsButtonShown(kCmdOk));
}

void PeggingTest::computerScoreDuringPlay_data()
{
    QTest::addColumn<bool>("playerCanPlay");
    QTest::addColumn<bool>("computerCanPlay");
    QTest::addColumn<int>("count");
    QTest::addColumn<int>("points");
    QTest::addColumn<int>("pegged");
    QTest::addColumn<bool>("okShown");
    QTest::addColumn<bool>("countReset");

    // The last card of a count takes its go point with it, in one move and
    // unannounced.
    QTest::newRow("pair with nobody able to go on") << false << false << 20 << 2 << 3 << false << true;
    QTest::newRow("thirty-one takes no last card") << false << false << 31 << 2 << 2 << false << true;
    QTest::newRow("a go is never doubled") << false << false << 25 << 1 << 1 << false << true;
    // The user is stuck but the computer has more: it waits for "Ok".
    QTest::newRow("computer plays on after Ok") << false << true << 20 << 2 << 2 << true << false;
    QTest::newRow("user can answer") << true << false << 20 << 2 << 2 << false << false;
    QTest::newRow("both can go on") << true << true << 20 << 2 << 2 << false << false;
}

void PeggingTest::computerScoreDuringPlay()
{
    QFETCH(bool, playerCanPlay);
    QFETCH(bool, computerCanPlay);
    QFETCH(int, count);
    QFETCH(int, points);
    QFETCH(int, pegged);
    QFETCH(bool, okShown);
    QFETCH(bool, countReset);
    auto board = MakeBoard();
    GameRecord& r = board->record;
    r.phase = kPhasePlay;
    SetHands(*board, playerCanPlay, computerCanPlay);
    r.runningCount = count;
    r.playSequence = {{10, 10, 1, -1, -1, -1, -1, -1, -1}};
    const qsizetype mark = LogLines(*board).size();

    board->PegPoints(kSideOpponent, points, QString());

    QCOMPARE(LogLines(*board).mid(mark), QStringList{QStringLiteral("Opponent pegs %1.").arg(points)});
    QCOMPARE(board->OpponentScore(), pegged);
    QCOMPARE(r.opponentBackHole, 0);
    QCOMPARE(board->IsButtonShown(kCmdOk), okShown);
    QCOMPARE(r.runningCount, countReset ? 0 : count);
    QCOMPARE(r.playSequence.entries[0], countReset ? -1 : 10);
}

void PeggingTest::gameEndTally_data()
{
    constexpr int32_t kMax = std::numeric_limits<int32_t>::max();
    QTest::addColumn<int>("winner");
    QTest::addColumn<int>("loserScore");
    QTest::addColumn<int>("before");  // the winner's tally
    QTest::addColumn<int>("after");

    QTest::newRow("user wins, computer at 91") << int(kSidePlayer) << 91 << 5 << 6;
    QTest::newRow("user wins, computer at 90") << int(kSidePlayer) << 90 << 5 << 7;
    QTest::newRow("user wins, computer at 61") << int(kSidePlayer) << 61 << 5 << 7;
    QTest::newRow("user wins, computer at 60") << int(kSidePlayer) << 60 << 5 << 9;
    QTest::newRow("computer wins, user at 91") << int(kSideOpponent) << 91 << 7 << 8;
    QTest::newRow("computer wins, user at 90") << int(kSideOpponent) << 90 << 7 << 9;
    QTest::newRow("computer wins, user at 0") << int(kSideOpponent) << 0 << 7 << 11;
    // The tally stops at its ceiling rather than wrapping.
    QTest::newRow("room for all four") << int(kSidePlayer) << 0 << kMax - 4 << kMax;
    QTest::newRow("room for one of four") << int(kSideOpponent) << 0 << kMax - 1 << kMax;
    QTest::newRow("already at the top") << int(kSidePlayer) << 0 << kMax << kMax;
}

void PeggingTest::gameEndTally()
{
    QFETCH(int, winner);
    QFETCH(int, loserScore);
    QFETCH(int, before);
    QFETCH(int, after);
    auto board = MakeBoard();
    GameBoard& b = *board;
    GameRecord& r = b.record;
    const bool userWins = winner == kSidePlayer;
    int32_t& winnerTally = userWins ? r.gamesFor : r.gamesAgainst;
    int32_t& loserTally = userWins ? r.gamesAgainst : r.gamesFor;
    winnerTally = before;
    loserTally = 3;
    r.phase = kPhaseHandCounted;
    // The winner stands at 115 and counts a hand of 9: the 3 beyond 121 are lost.
    b.MovePlayerPegs(userWins ? 115 : loserScore);
    b.MoveOpponentPegs(userWins ? loserScore : 115);
    // The second hand's count is due; its button must not survive the end.
    b.SetButtonShown(b.ActionButton(kCmdDeal), false);
    b.ShowScoreOpponentHand();
    const qsizetype mark = LogLines(b).size();

    b.PegPoints(winner, 9, QStringLiteral(" for the crib"));

    QCOMPARE(userWins ? b.PlayerScore() : b.OpponentScore(), 121);
    QCOMPARE(userWins ? b.OpponentScore() : b.PlayerScore(), loserScore);
    QCOMPARE(LogLines(b).mid(mark),
             (QStringList{userWins ? "You peg 9 for the crib." : "Opponent pegs 9 for the crib.",
                          userWins ? "You won." : "You lost.", "Please click New to play again."}));
    QCOMPARE(r.gameOver, 1);
    QCOMPARE(r.phase, int32_t(kPhaseGameOver));
    QCOMPARE(winnerTally, after);
    QCOMPARE(loserTally, 3);
    // Saved at once, not at exit.
    QCOMPARE(StoredValue("For"), r.gamesFor);
    QCOMPARE(StoredValue("Against"), r.gamesAgainst);
    QVERIFY(ShownButtons(b).isEmpty());
}

VENNICK_TEST(PeggingTest);
#include "PeggingTest.moc"

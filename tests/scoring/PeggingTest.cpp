#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QSettings>
#include <QtTest>

#include <cstdint>
#include <limits>

namespace {

// Puts one card that fits (or none) in each hand, at hand position 1, so that
// PlayerCannotPlay and ComputerCannotPlay answer as a test needs.
void SetHands(GameBoard& board, bool playerCanPlay, bool computerCanPlay)
{
    GameRecord& r = board.record;
    for (int p = 0; p < 6; ++p) {
        r.playerHandSprites[p].suit1 = kSuitEmpty;
        r.opponentHandSprites[p].suit1 = kSuitEmpty;
    }
    r.deal[1] = Card(1, 1);
    r.deal[7] = Card(1, 2);
    r.playerHandSprites[1] = {r.playerHandSprites[1].rect, 0, 0, 1, playerCanPlay ? 1 : kSuitEmpty};
    r.opponentHandSprites[1] = {r.opponentHandSprites[1].rect, 1, 0, 1, computerCanPlay ? 2 : kSuitEmpty};
}

int StoredValue(const char* name)
{
    QSettings settings(QStringLiteral("Quorvan"), QStringLiteral("Vennick"));
    return settings.value(QLatin1String(name), -1).toInt();
}

} // namespace

// The one path by which points reach the board: what is announced, what is
// pegged, when the computer waits, and how a game ends and is tallied.
class PeggingTest : public QObject {
    Q_OBJECT

private slots:
    void announcement_data();
    void announcement();
    void computerScoreDuringPlay_data();
    void computerScoreDuringPlay();
    void gameEndTally_data();
    void gameEndTally();
    void tallyStopsAtItsCeiling_data();
    void tallyStopsAtItsCeiling();
};

void PeggingTest::announcement_data()
{
    QTest::addColumn<int>("phase");
    QTest::addColumn<int>("side");
    QTest::addColumn<int>("points");
    QTest::addColumn<QString>("suffix");
    QTest::addColumn<QString>("line");  // empty: nothing is logged
    QTest::addColumn<bool>("okShown");

    QTest::newRow("user's card scores") << int(kPhasePlay) << int(kSidePlayer) << 2 << "" << "You peg 2." << true;
    QTest::newRow("user's go") << int(kPhasePlay) << int(kSidePlayer) << 1 << " for a go" << "You peg 1 for a go."
                               << true;
    QTest::newRow("card scoring nothing") << int(kPhasePlay) << int(kSidePlayer) << 0 << "" << "" << false;
    QTest::newRow("computer's card scoring nothing") << int(kPhasePlay) << int(kSideOpponent) << 0 << "" << ""
                                                     << false;
    QTest::newRow("user's hand, no pause") << int(kPhasePlayOver) << int(kSidePlayer) << 12 << " for your hand"
                                           << "You peg 12 for your hand." << false;
    QTest::newRow("empty user's hand") << int(kPhasePlayOver) << int(kSidePlayer) << 0 << " for your hand"
                                       << "You peg 0 for your hand." << false;
    QTest::newRow("empty computer's hand") << int(kPhaseHandCounted) << int(kSideOpponent) << 0 << " for his hand"
                                           << "Opponent pegs 0 for his hand." << false;
    QTest::newRow("empty crib") << int(kPhaseCribCounted) << int(kSidePlayer) << 0 << " for the crib"
                                << "You peg 0 for the crib." << false;
}

void PeggingTest::announcement()
{
    QFETCH(int, phase);
    QFETCH(int, side);
    QFETCH(int, points);
    QFETCH(QString, suffix);
    QFETCH(QString, line);
    QFETCH(bool, okShown);
    auto board = MakeBoard();
    GameBoard& b = *board;
    b.record.phase = phase;
    SetHands(b, true, true);
    const qsizetype mark = LogLines(b).size();

    b.PegPoints(side, points, suffix);

    QCOMPARE(LogLines(b).mid(mark), line.isEmpty() ? QStringList{} : QStringList{line});
    QCOMPARE(side == kSidePlayer ? b.PlayerScore() : b.OpponentScore(), points);
    QCOMPARE(b.IsButtonShown(kCmdOk), okShown);
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

    // The last card of a count takes its go point with it, unannounced.
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
    GameBoard& b = *board;
    GameRecord& r = b.record;
    r.phase = kPhasePlay;
    SetHands(b, playerCanPlay, computerCanPlay);
    r.runningCount = count;
    r.playSequence = {{10, 10, 1, -1, -1, -1, -1, -1, -1}};
    const qsizetype mark = LogLines(b).size();

    b.PegPoints(kSideOpponent, points, QString());

    QCOMPARE(LogLines(b).mid(mark), QStringList{QStringLiteral("Opponent pegs %1.").arg(points)});
    QCOMPARE(b.OpponentScore(), pegged);
    QCOMPARE(b.IsButtonShown(kCmdOk), okShown);
    QCOMPARE(r.runningCount, countReset ? 0 : count);
    QCOMPARE(r.playSequence.entries[0], countReset ? -1 : 10);
}

void PeggingTest::gameEndTally_data()
{
    QTest::addColumn<int>("winner");
    QTest::addColumn<int>("loserScore");
    QTest::addColumn<int>("games");

    QTest::newRow("user wins, computer at 91") << int(kSidePlayer) << 91 << 1;
    QTest::newRow("user wins, computer at 90") << int(kSidePlayer) << 90 << 2;
    QTest::newRow("user wins, computer at 61") << int(kSidePlayer) << 61 << 2;
    QTest::newRow("user wins, computer at 60") << int(kSidePlayer) << 60 << 4;
    QTest::newRow("user wins, computer at 0") << int(kSidePlayer) << 0 << 4;
    QTest::newRow("computer wins, user at 91") << int(kSideOpponent) << 91 << 1;
    QTest::newRow("computer wins, user at 90") << int(kSideOpponent) << 90 << 2;
    QTest::newRow("computer wins, user at 60") << int(kSideOpponent) << 60 << 4;
}

void PeggingTest::gameEndTally()
{
    QFETCH(int, winner);
    QFETCH(int, loserScore);
    QFETCH(int, games);
    auto board = MakeBoard();
    GameBoard& b = *board;
    GameRecord& r = b.record;
    r.gamesFor = 5;
    r.gamesAgainst = 7;
    r.phase = kPhaseHandCounted;
    const bool userWins = winner == kSidePlayer;
    // The winner stands at 115 and counts a hand of 9: the 3 beyond 121 are lost.
    b.MovePlayerPegs(userWins ? 115 : loserScore);
    b.MoveOpponentPegs(userWins ? loserScore : 115);
    // The second hand's count is due; its button must not survive the end.
    b.SetButtonShown(b.ActionButton(kCmdDeal), false);
    b.ShowScoreOpponentHand();
    const qsizetype mark = LogLines(b).size();

    b.PegPoints(winner, 9, userWins ? QStringLiteral(" for your hand") : QStringLiteral(" for his hand"));

    QCOMPARE(userWins ? b.PlayerScore() : b.OpponentScore(), 121);
    QCOMPARE(userWins ? b.OpponentScore() : b.PlayerScore(), loserScore);
    const QString announced = userWins ? QStringLiteral("You peg 9 for your hand.")
                                       : QStringLiteral("Opponent pegs 9 for his hand.");
    QCOMPARE(LogLines(b).mid(mark), (QStringList{announced, userWins ? "You won." : "You lost.",
                                                 "Please click New to play again."}));
    QCOMPARE(r.gameOver, 1);
    QCOMPARE(r.phase, int32_t(kPhaseGameOver));
    QCOMPARE(r.gamesFor, userWins ? 5 + games : 5);
    QCOMPARE(r.gamesAgainst, userWins ? 7 : 7 + games);
    // Saved at once, not at exit.
    QCOMPARE(StoredValue("For"), r.gamesFor);
    QCOMPARE(StoredValue("Against"), r.gamesAgainst);
    QVERIFY(ShownButtons(b).isEmpty());
}

void PeggingTest::tallyStopsAtItsCeiling_data()
{
    constexpr int32_t kMax = std::numeric_limits<int32_t>::max();
    QTest::addColumn<int>("before");
    QTest::addColumn<int>("after");
    QTest::newRow("room for all four") << kMax - 4 << kMax;
    QTest::newRow("room for one of four") << kMax - 1 << kMax;
    QTest::newRow("already at the top") << kMax << kMax;
}

void PeggingTest::tallyStopsAtItsCeiling()
{
    QFETCH(int, before);
    QFETCH(int, after);
    auto board = MakeBoard();
    GameBoard& b = *board;
    b.record.gamesFor = before;
    b.record.phase = kPhaseHandCounted;
    b.MovePlayerPegs(120);

    b.PegPoints(kSidePlayer, 4, QStringLiteral(" for your hand"));  // a win by 4 games

    QCOMPARE(b.record.gamesFor, after);
    QCOMPARE(StoredValue("For"), after);
}

VENNICK_TEST(PeggingTest);
#include "PeggingTest.moc"

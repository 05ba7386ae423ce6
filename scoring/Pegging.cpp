#include "game/GameBoard.h"

#include <cstdint>
#include <limits>

namespace {

// The tally is kept across runs; a counter at its ceiling stays there rather
// than wrapping to a negative number of games.
int32_t AddGames(int32_t tally, int32_t games)
{
    constexpr int32_t kMax = std::numeric_limits<int32_t>::max();
    return tally > kMax - games ? kMax : tally + games;
}

bool IsShowPhase(int32_t phase)
{
    return phase == kPhaseHandCounted || phase == kPhaseCribCounted || phase == kPhasePlayOver;
}

} // namespace

int32_t GameBoard::GamesForWin(int loserScore)
{
    int32_t games = 1;
    if (loserScore <= 90)
        games += 1;
    if (loserScore <= 60)
        games += 2;
    return games;
}

void GameBoard::PegPoints(int side, int points, const QString& suffix, const QList<ScoreItem>& reasons)
{
    const QString announced = (side == kSidePlayer ? QStringLiteral("You peg ") : QStringLiteral("Opponent pegs "))
        + QString::number(points) + suffix + QLatin1Char('.');

    if (points <= 0) {
        // During the play a card that scores nothing passes in silence; in the
        // show every count is announced, even a nought.
        if (points == 0 && IsShowPhase(record.phase))
            LogMessage(announced);
    } else if (side == kSidePlayer) {
        MovePlayerPegs(points);
        LogMessage(announced);
        LogReasons(reasons);
        // The computer waits until the user has seen the points.
        if (record.phase < kPhaseCountStart)
            ShowOk();
    } else {
        MoveOpponentPegs(points);
        LogMessage(announced);
        LogReasons(reasons);
        if (record.phase < kPhaseCountStart && PlayerCannotPlay()) {
            if (!ComputerCannotPlay()) {
                ShowOk();
            } else {
                // The computer's scoring card leaves nobody able to play: the
                // count starts again, and below 31 that card also takes the go.
                const bool go = points != 1 && record.runningCount < 31;
                ResetCount();
                if (go)
                    PegPoints(kSideOpponent, 1, QStringLiteral(" for a go"));
            }
        }
    }

    // The first side home ends the game once: the verdict, and the winner's
    // tally grown by what the loser's score earns it, saved at once.
    auto endGame = [this](const QString& verdict, int32_t& tally, int loserScore) {
        record.gameOver = 1;
        LogMessage(verdict);
        LogMessage(QStringLiteral("Please click New to play again."));
        tally = AddGames(tally, GamesForWin(loserScore));
        SaveSettings();
    };
    if (PlayerScore() == kGameHole && record.gameOver == 0)
        endGame(QStringLiteral("You won."), record.gamesFor, OpponentScore());
    if (OpponentScore() == kGameHole && record.gameOver == 0)
        endGame(QStringLiteral("You lost."), record.gamesAgainst, PlayerScore());
    if (PlayerScore() == kGameHole || OpponentScore() == kGameHole) {
        // Only New starts another game; "Deal" keeps whatever state it had.
        for (int id : {kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk})
            SetButtonShown(ActionButton(id), false);
        record.phase = kPhaseGameOver;
    }
}

#include "game/GameBoard.h"

#include <QHelpEvent>
#include <QTimerEvent>
#include <QToolTip>

QString GameBoard::BoardTip() const
{
    const GameRecord& r = record;
    // Before a deal the crib named is the one the next deal gives.
    const bool yourCrib = r.phase == kPhaseNoDeal ? r.playerCrib == 0 : r.playerCrib != 0;
    return r.ownerName + QLatin1Char(' ') + QString::number(PlayerScore()) + QStringLiteral(" \u00b7 Opponent ")
           + QString::number(OpponentScore()) + QStringLiteral(" \u00b7 ")
           + (yourCrib ? QStringLiteral("Your crib") : QStringLiteral("Opponent's crib"));
}

bool GameBoard::GameInProgress() const
{
    return record.phase != kPhaseNoDeal && record.gameOver == 0;
}

QString GameBoard::StatusLine() const
{
    const GameRecord& r = record;
    if (r.gameOver != 0) {
        const bool won = PlayerScore() == kGameHole;
        const int loser = won ? OpponentScore() : PlayerScore();
        const int32_t games = GamesForWin(loser);
        const QString margin = games == 4 ? QStringLiteral("a double skunk, ") : games == 2 ? QStringLiteral("a skunk, ") : QString();
        return (won ? QStringLiteral("You won 121 to %1: ") : QStringLiteral("You lost %1 to 121: ")).arg(loser) + margin
               + (games == 1 ? QStringLiteral("1 game.") : QStringLiteral("%1 games.").arg(games))
               + QStringLiteral(" Click New to play again.");
    }
    // The button shown tells the next step; without one the user is to choose or lay a card.
    QString waiting;
    if (IsButtonShown(kCmdSendToCrib))
        waiting = QStringLiteral("Click Send To Crib");
    else if (IsButtonShown(kCmdOk))
        waiting = QStringLiteral("Press Ok");
    else if (IsButtonShown(kCmdScorePlayerHand))
        waiting = QStringLiteral("Score your hand");
    else if (IsButtonShown(kCmdScoreOpponentHand))
        waiting = QStringLiteral("Score the computer's hand");
    else if (IsButtonShown(kCmdScoreCrib))
        waiting = QStringLiteral("Score the crib");
    else if (r.phase == kPhaseDiscard)
        waiting = SelectedCount() == 0 ? QStringLiteral("Choose two cards for the crib") : QStringLiteral("Choose one more card for the crib");
    else if (r.phase == kPhasePlay)
        waiting = r.runningCount == 0 ? QStringLiteral("Your lead") : QStringLiteral("Your turn");
    else
        waiting = r.phase == kPhaseNoDeal ? QStringLiteral("Click Deal to start") : QStringLiteral("Click Deal for the next hand");
    return BoardTip() + QStringLiteral(" \u00b7 ") + waiting;
}

void GameBoard::NoteStatusChange()
{
    if (!pendingStatus.isActive())
        pendingStatus.start(0, this);
}

bool GameBoard::event(QEvent* event)
{
    if (event->type() != QEvent::ToolTip)
        return QWidget::event(event);
    const auto* help = static_cast<QHelpEvent*>(event);
    // Empty until the first paint sets the factors.
    const QRect boardArea = ScaledRect(Rect{0, 0, boardInfo.bmWidth, boardInfo.bmHeight});
    if (boardArea.contains(help->pos()))
        QToolTip::showText(help->globalPos(), BoardTip(), this, boardArea);
    else
        QToolTip::hideText();
    return true;
}

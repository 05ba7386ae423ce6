#include "game/GameBoard.h"

#include <QHelpEvent>
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

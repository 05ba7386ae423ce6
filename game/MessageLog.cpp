#include "game/GameBoard.h"

#include <QListWidget>

void GameBoard::LogMessage(const QString& text)
{
    // The list exists from the first paint on; nothing is logged before it.
    if (messageLog == nullptr)
        return;
    messageLog->addItem(text);
    messageLog->scrollToBottom();
    NoteStatusChange();
    Announce(text);
}

void GameBoard::LogReasons(const QList<ScoreItem>& reasons)
{
    if (record.explainScores != 0 && !reasons.isEmpty())
        LogMessage(ReasonsLine(reasons));
}

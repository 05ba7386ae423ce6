#include "game/GameBoard.h"

#include <QListWidget>

void GameBoard::LogMessage(const QString& text)
{
    // The list exists from the first paint on; nothing is logged before it.
    if (messageLog == nullptr)
        return;
    auto* item = new QListWidgetItem(text, messageLog);
    // A line wider than the list can still be read whole by hovering over it.
    if (messageLog->fontMetrics().horizontalAdvance(text) > messageLog->viewport()->width())
        item->setToolTip(text);
    messageLog->scrollToBottom();
    NoteStatusChange();
}

void GameBoard::LogReasons(const QList<ScoreItem>& reasons)
{
    if (record.explainScores != 0 && !reasons.isEmpty())
        LogMessage(ReasonsLine(reasons));
}

#include "game/GameBoard.h"
#include "scoring/HandCount.h"

// The show sets phase 10 before it counts the crib; that alone selects the
// crib's flush rule.
int GameBoard::CountHand(const CardId cards[5]) const
{
    return CountHandCards(cards, record.phase == kPhaseCribCounted);
}

QList<ScoreItem> GameBoard::HandReasons(const CardId cards[5]) const
{
    return ItemiseHand(cards, record.phase == kPhaseCribCounted);
}

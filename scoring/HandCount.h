#pragma once

#include "game/GameRecord.h"

// Points of four cards (positions 0 to 3) with the starter (position 4):
// fifteens, pairs, runs, a flush and the jack of the starter's suit.
// Under the crib rule a flush counts only when all five cards share a suit;
// under the hand rule the four cards alone make a flush (4, or 5 with the
// starter). The cards (0..51) are read only; nothing is allocated.
int CountHandCards(const CardId cards[5], bool cribRule);

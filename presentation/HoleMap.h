#pragma once

#include "game/GameRecord.h"

// Fills the hole centres of both tracks (hole numbers 0..122). The board
// images are drawn from the same table, so pegs always sit in the holes.
void BuildHoleTables(HolePoint playerHoles[kHoleCount], HolePoint opponentHoles[kHoleCount]);

#pragma once

#include "game/GameRecord.h"
#include "scoring/ScoreReasons.h"

// The reasons the last card of the sequence scores, in this order: fifteen or
// thirty-one, the pair group ("a pair", "three of a kind", "four of a kind"),
// the run ("a run of three" and longer, laid in any order). For every sequence
// the play can make their points add up to ScorePlay. Plain code: a few
// hundred nanoseconds, once for each card laid.
QList<ScoreItem> ItemisePlay(const PlaySequence& sequence);

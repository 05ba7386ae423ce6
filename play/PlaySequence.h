#pragma once

#include "game/GameRecord.h"

// The cards laid since the running count was last reset, as rank1 values
// (1 ace .. 13 king), and the points the last of them scores.

// Number of ranks before the end marker (0..8).
int SequenceLength(const PlaySequence& sequence);

// Adds a rank after the last; does nothing once eight are held.
void SequenceAppend(PlaySequence& sequence, int rank1);

// Copies every entry, end marker included.
void SequenceCopy(const PlaySequence& source, PlaySequence& target);

// Points for the card just laid (the last entry): pairs, runs, fifteen and
// thirty-one, judged on the sequence's own ranks.
int ScorePlay(const PlaySequence& sequence);

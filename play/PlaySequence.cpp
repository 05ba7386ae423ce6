#include "play/PlaySequence.h"

#include <cstdint>

namespace {

constexpr int kEnd = -1;
constexpr int kMaxCards = 8;
constexpr int kEntries = 9;

// Any record, whatever its entries hold: one walk back from the last card.
// The play calls it a few dozen times a deal, so plain code beats fast code.
// - Pairs: cards of the last card's rank immediately before it; the k-th adds
//   2k (2 for a pair, 6 for three, 12 for four).
// - Runs: the last L cards form a run exactly when they are all different and
//   their highest and lowest differ by L - 1, whatever the order laid. The
//   longest such L of 3 or more counts. Once the window holds a repeated rank
//   or a rank more than 8 away from the last card, no longer window can be a
//   run (at most nine cards fit), so the search stops there.
// - Fifteen and thirty-one: on the sequence's own total.
int ScoreAnySequence(const PlaySequence& sequence, int length)
{
    if (length == 0)
        return 0;
    const int64_t last = sequence.entries[length - 1];

    int points = 0;
    int64_t total = Rank1Value(sequence.entries[length - 1]);
    int matches = 0;
    bool matching = true;

    // Ranks seen so far as bits offset from the last card's rank (bit 8 is
    // the last card itself), with the lowest and highest offset seen.
    uint32_t seen = 1u << 8;
    int64_t lowest = 0;
    int64_t highest = 0;
    bool runPossible = true;
    int run = 0;

    for (int i = length - 2; i >= 0; --i) {
        const int64_t rank1 = sequence.entries[i];
        total += Rank1Value(sequence.entries[i]);

        if (matching && rank1 == last)
            points += 2 * ++matches;
        else
            matching = false;

        if (runPossible) {
            const int64_t offset = rank1 - last;
            const uint32_t bit = (offset >= -8 && offset <= 8) ? 1u << (offset + 8) : 0u;
            if (bit == 0 || (seen & bit) != 0) {
                runPossible = false;
            } else {
                seen |= bit;
                lowest = offset < lowest ? offset : lowest;
                highest = offset > highest ? offset : highest;
                const int cards = length - i;
                if (cards >= 3 && highest - lowest == cards - 1)
                    run = cards;
            }
        }
    }

    points += run;
    if (total == 15 || total == 31)
        points += 2;
    return points;
}


} // namespace

int SequenceLength(const PlaySequence& sequence)
{
    for (int i = 0; i < kEntries; ++i)
        if (sequence.entries[i] == kEnd)
            return i;
    return kEntries;
}

void SequenceAppend(PlaySequence& sequence, int rank1)
{
    for (int i = 0; i < kMaxCards; ++i) {
        if (sequence.entries[i] == kEnd) {
            sequence.entries[i] = rank1;
            sequence.entries[i + 1] = kEnd;
            return;
        }
    }
}

void SequenceCopy(const PlaySequence& source, PlaySequence& target)
{
    target = source;
}

int ScorePlay(const PlaySequence& sequence)
{
    return ScoreAnySequence(sequence, SequenceLength(sequence));
}

#pragma once

#include "game/GameRecord.h"

#include <cstdint>

// The points of the last card of a play sequence worked out literally, window
// by window with a bubble sort, to check the game's one-pass scorer.
inline int ReferenceScorePlay(const PlaySequence& sequence)
{
    int n = 9;
    for (int i = 0; i < 9; ++i)
        if (sequence.entries[i] == -1) {
            n = i;
            break;
        }
    if (n == 0)
        return 0;
    const int last = sequence.entries[n - 1];
    int points = 0;

    int step = 2;
    for (int i = n - 2; i >= 0 && sequence.entries[i] == last; --i) {
        points += step;
        step += 2;
    }

    for (int length = n; length >= 3; --length) {
        int64_t window[9] = {};
        for (int i = 0; i < length; ++i)
            window[i] = sequence.entries[n - 1 - i];
        for (int pass = 0; pass < length; ++pass)
            for (int i = 0; i + 1 < length; ++i)
                if (window[i] > window[i + 1]) {
                    const int64_t swapped = window[i];
                    window[i] = window[i + 1];
                    window[i + 1] = swapped;
                }
        bool run = true;
        for (int i = 1; i < length; ++i)
            run = run && window[i] == window[i - 1] + 1;
        if (run) {
            points += length;
            break;
        }
    }

    int64_t total = 0;
    for (int i = 0; i < n; ++i)
        total += Rank1Value(sequence.entries[i]);
    if (total == 15 || total == 31)
        points += 2;
    return points;
}

namespace reference_detail {

template <typename Visit>
void ExtendPlay(PlaySequence& sequence, int cards, int total, int copies[14], int maxCards, Visit& visit)
{
    if (cards > 0)
        visit(static_cast<const PlaySequence&>(sequence));
    if (cards == maxCards)
        return;
    for (int rank1 = 1; rank1 <= 13; ++rank1) {
        if (copies[rank1] == 4 || total + Rank1Value(rank1) > 31)
            continue;
        ++copies[rank1];
        sequence.entries[cards] = rank1;
        sequence.entries[cards + 1] = -1;
        ExtendPlay(sequence, cards + 1, total + Rank1Value(rank1), copies, maxCards, visit);
        sequence.entries[cards] = -1;
        --copies[rank1];
    }
}

} // namespace reference_detail

// Calls visit(sequence) for every sequence the play can produce, 1 to
// maxCards cards long: at most four cards of a rank, the count never past 31.
// There are 12,892,167 of up to eight cards.
template <typename Visit>
void ForEveryLegalPlay(int maxCards, Visit visit)
{
    PlaySequence sequence;
    int copies[14] = {};
    reference_detail::ExtendPlay(sequence, 0, 0, copies, maxCards, visit);
}

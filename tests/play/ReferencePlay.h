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

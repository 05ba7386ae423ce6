#pragma once

#include "game/GameRecord.h"

#include <algorithm>
#include <cstdint>
#include <vector>

// The points of the last card of a play sequence worked out literally, window
// by sorted window, to check the game's one-pass scorer.
inline int ReferenceScorePlay(const PlaySequence& sequence)
{
    const int32_t* e = sequence.entries;
    const int n = static_cast<int>(std::find(e, e + 9, -1) - e);
    int points = 0, total = 0;
    for (int i = n - 2, step = 2; i >= 0 && e[i] == e[n - 1]; --i, step += 2)
        points += step;
    for (int length = n; length >= 3; --length) {
        std::vector<int64_t> window(e + n - length, e + n);
        std::sort(window.begin(), window.end());
        if (std::adjacent_find(window.begin(), window.end(), [](int64_t a, int64_t b) { return b != a + 1; })
            == window.end()) {
            points += length;
            break;
        }
    }
    for (int i = 0; i < n; ++i)
        total += Rank1Value(e[i]);
    return points + (total == 15 || total == 31 ? 2 : 0);
}

// Calls visit(sequence) for every sequence the play can produce, 1 to
// maxCards cards long: at most four cards of a rank, the count never past 31.
// There are 12,892,167 of up to eight cards.
template <typename Visit>
void ForEveryLegalPlay(int maxCards, Visit visit, PlaySequence sequence = {}, int cards = 0, int total = 0)
{
    if (cards > 0)
        visit(static_cast<const PlaySequence&>(sequence));
    for (int rank1 = 1; cards < maxCards && rank1 <= 13; ++rank1) {
        if (std::count(sequence.entries, sequence.entries + cards, rank1) == 4 || total + Rank1Value(rank1) > 31)
            continue;
        sequence.entries[cards] = rank1;
        ForEveryLegalPlay(maxCards, visit, sequence, cards + 1, total + Rank1Value(rank1));
        sequence.entries[cards] = -1;
    }
}

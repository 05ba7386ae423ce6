#pragma once

#include "game/GameRecord.h"

// A second hand counter, written the slow and obvious way, to check the game's
// own: every subset for fifteens, a rank histogram for pairs and runs.
// Positions 0 to 3 are the four cards, 4 the starter.
inline int ReferenceCountHand(const CardId cards[5], bool cribRule)
{
    int points = 0, count[14] = {};  // one beyond the king, always 0, ends the last stretch
    for (int subset = 1; subset < 32; ++subset) {
        int sum = 0;
        for (int i = 0; i < 5; ++i)
            sum += subset & (1 << i) ? CardValue(cards[i]) : 0;
        points += sum == 15 ? 2 : 0;
    }
    for (int i = 0; i < 5; ++i)
        ++count[CardRank(cards[i])];
    // Two points for each way of choosing two cards of one rank; each stretch
    // of three or more ranks present, ace low, counts its length once for
    // every way of picking one card of each of its ranks.
    for (int low = 0, high = 0, ways = 1; high < 14; ++high) {
        points += count[high] * (count[high] - 1);
        ways *= count[high] > 0 ? count[high] : 1;
        if (count[high] == 0) {
            points += high - low >= 3 ? (high - low) * ways : 0;
            low = high + 1;
            ways = 1;
        }
    }
    int sameSuit = 0;
    for (int i = 0; i < 4; ++i) {
        sameSuit += CardSuit(cards[i]) == CardSuit(cards[0]);
        points += CardRank(cards[i]) == 10 && CardSuit(cards[i]) == CardSuit(cards[4]);  // the starter's jack
    }
    if (sameSuit == 4)
        points += CardSuit(cards[4]) == CardSuit(cards[0]) ? 5 : cribRule ? 0 : 4;
    return points;
}

// Calls visit(cards) for all 12,994,800 hands: four cards in ascending order,
// then every other card as starter.
template <typename Visit>
void ForEveryHand(Visit visit)
{
    CardId c[5] = {};
    for (c[0] = 0; c[0] < 52; ++c[0])
        for (c[1] = c[0] + 1; c[1] < 52; ++c[1])
            for (c[2] = c[1] + 1; c[2] < 52; ++c[2])
                for (c[3] = c[2] + 1; c[3] < 52; ++c[3])
                    for (c[4] = 0; c[4] < 52; ++c[4])
                        if (c[4] != c[0] && c[4] != c[1] && c[4] != c[2] && c[4] != c[3])
                            visit(static_cast<const CardId*>(c));
}

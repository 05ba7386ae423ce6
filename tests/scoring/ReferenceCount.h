#pragma once

#include "game/GameRecord.h"

// A second hand counter, written the slow and obvious way, to check the game's
// own: every subset for fifteens, a rank histogram for pairs and runs.
// Positions 0 to 3 are the four cards, 4 the starter.
inline int ReferenceCountHand(const CardId cards[5], bool cribRule)
{
    int points = 0;

    for (int subset = 1; subset < 32; ++subset) {
        int sum = 0;
        for (int i = 0; i < 5; ++i)
            if (subset & (1 << i))
                sum += CardValue(cards[i]);
        if (sum == 15)
            points += 2;
    }

    int count[13] = {};
    for (int i = 0; i < 5; ++i)
        ++count[CardRank(cards[i])];

    // Two points for each way of choosing two cards of one rank.
    for (int c : count)
        points += c * (c - 1);

    // Each stretch of three or more ranks present, ace low, counts its length
    // once for every way of picking one card of each of its ranks.
    for (int low = 0; low < 13;) {
        int high = low;
        int ways = 1;
        while (high < 13 && count[high] > 0)
            ways *= count[high++];
        if (high - low >= 3)
            points += (high - low) * ways;
        low = high + 1;
    }

    const int suit = CardSuit(cards[0]);
    int sameSuit = 0;
    for (int i = 0; i < 4; ++i)
        sameSuit += CardSuit(cards[i]) == suit ? 1 : 0;
    const bool starterToo = CardSuit(cards[4]) == suit;
    if (sameSuit == 4 && starterToo)
        points += 5;
    else if (sameSuit == 4 && !cribRule)
        points += 4;

    for (int i = 0; i < 4; ++i)
        if (CardRank(cards[i]) == 10 && CardSuit(cards[i]) == CardSuit(cards[4]))
            points += 1;

    return points;
}

// Calls visit(cards) for all 12,994,800 hands: four cards in ascending order,
// then every other card as starter.
template <typename Visit>
void ForEveryHand(Visit visit)
{
    CardId cards[5] = {};
    for (cards[0] = 0; cards[0] < 52; ++cards[0])
        for (cards[1] = cards[0] + 1; cards[1] < 52; ++cards[1])
            for (cards[2] = cards[1] + 1; cards[2] < 52; ++cards[2])
                for (cards[3] = cards[2] + 1; cards[3] < 52; ++cards[3])
                    for (cards[4] = 0; cards[4] < 52; ++cards[4])
                        if (cards[4] != cards[0] && cards[4] != cards[1] && cards[4] != cards[2]
                            && cards[4] != cards[3])
                            visit(static_cast<const CardId*>(cards));
}

#include "scoring/HandCount.h"

#include <array>
#include <cassert>
#include <cstdint>

// Fifteens, pairs and runs depend only on the five ranks, not on their order
// or suits. They are worked out at compile time by the plain rules below for
// every way five ranks can fall, and each count then only looks them up and
// judges the flush and the jack itself.
//
// The look-up goes through multisets of ranks, so that the cards never need
// sorting: the first two cards name one of the 91 multisets of two ranks, so
// do the next two; those two name one of the 1820 multisets of four ranks;
// that with the starter's rank gives the points.

namespace {

constexpr int kRanks = 13;
constexpr int kJackRank = 10;

// Binomial coefficients n choose k for n up to 17 and k up to 5, all the
// multiset places below need.
constexpr auto kChoose = [] {
    std::array<std::array<int, 6>, 18> table{};
    for (int n = 0; n < 18; ++n) {
        table[n][0] = 1;
        for (int k = 1; k < 6 && k <= n; ++k)
            table[n][k] = table[n - 1][k - 1] + (k < n ? table[n - 1][k] : 0);
    }
    return table;
}();

constexpr int Choose(int n, int k) { return kChoose[n][k]; }

constexpr int Multisets(int size) { return Choose(kRanks + size - 1, size); }

// Puts a few ranks in ascending order (insertion sort; compile time only).
// Plain arrays throughout: the compiler evaluates them far faster than
// std::array.
template <size_t N>
constexpr void SortRanks(int (&rank)[N])
{
    for (size_t i = 1; i < N; ++i)
        for (size_t j = i; j > 0 && rank[j - 1] > rank[j]; --j) {
            const int swapped = rank[j];
            rank[j] = rank[j - 1];
            rank[j - 1] = swapped;
        }
}

// The place of a multiset of ranks, given sorted ascending, among all
// multisets of its size: adding i to the i-th rank makes the ranks strictly
// ascending, and those have their place in the combinatorial number system.
template <size_t N>
constexpr int MultisetIndex(const int (&sorted)[N])
{
    int index = 0;
    for (size_t i = 0; i < N; ++i)
        index += Choose(sorted[i] + static_cast<int>(i), static_cast<int>(i) + 1);
    return index;
}

// Runs, pairs and fifteens of five ranks sorted ascending, rule by rule.
constexpr int RankPoints(const int (&rank)[5])
{
    int points = 0;

    // Runs: walk up from each of the first three places; equal neighbours
    // multiply the run (a second card of a rank doubles it, a third triples
    // it). Only one run fits in five cards, so the first of 3 or more counts.
    for (int start = 0; start <= 2; ++start) {
        int length = 1;
        int multiplier = 1;
        bool lastWasEqual = false;
        for (int i = start; i < 4; ++i) {
            if (rank[i + 1] == rank[i] + 1) {
                ++length;
                lastWasEqual = false;
            } else if (rank[i + 1] == rank[i]) {
                multiplier = lastWasEqual ? multiplier + 1 : multiplier * 2;
                lastWasEqual = true;
            } else {
                break;
            }
        }
        if (length >= 3) {
            points += length * multiplier;
            break;
        }
    }

    // Pairs: by rank, every two places.
    for (int i = 0; i < 5; ++i)
        for (int j = i + 1; j < 5; ++j)
            if (rank[i] == rank[j])
                points += 2;

    // Fifteens: every combination of two or more cards.
    int value[5] = {};
    for (int i = 0; i < 5; ++i)
        value[i] = Rank1Value(rank[i] + 1);
    for (int i = 0; i < 5; ++i)
        for (int j = i + 1; j < 5; ++j) {
            if (value[i] + value[j] == 15)
                points += 2;
            for (int k = j + 1; k < 5; ++k) {
                if (value[i] + value[j] + value[k] == 15)
                    points += 2;
                for (int l = k + 1; l < 5; ++l)
                    if (value[i] + value[j] + value[k] + value[l] == 15)
                        points += 2;
            }
        }
    if (value[0] + value[1] + value[2] + value[3] + value[4] == 15)
        points += 2;

    return points;
}

// Multiset of two ranks, by two cards in either order.
constexpr auto kPairIndex = [] {
    std::array<std::array<uint8_t, 52>, 52> table{};
    for (CardId a = 0; a < 52; ++a)
        for (CardId b = 0; b < 52; ++b) {
            int two[2] = {CardRank(a), CardRank(b)};
            SortRanks(two);
            table[a][b] = static_cast<uint8_t>(MultisetIndex(two));
        }
    return table;
}();

// Multiset of four ranks, by the multisets of its two halves.
constexpr auto kFourIndex = [] {
    std::array<std::array<uint16_t, Multisets(2)>, Multisets(2)> table{};
    for (int a = 0; a < kRanks; ++a)
        for (int b = a; b < kRanks; ++b)
            for (int c = 0; c < kRanks; ++c)
                for (int d = c; d < kRanks; ++d) {
                    const int firstHalf[2] = {a, b};
                    const int secondHalf[2] = {c, d};
                    int four[4] = {a, b, c, d};
                    SortRanks(four);
                    table[MultisetIndex(firstHalf)][MultisetIndex(secondHalf)] = static_cast<uint16_t>(MultisetIndex(four));
                }
    return table;
}();

// Fifteens, pairs and runs, by the multiset of the four cards' ranks and the
// starter's rank. Each multiset of five ranks, taken in ascending order, is
// counted once; its starter may be any of its five ranks, and the other four,
// still in order, name the row.
constexpr auto kRankPoints = [] {
    std::array<std::array<uint8_t, kRanks>, Multisets(4)> table{};
    for (int a = 0; a < kRanks; ++a)
        for (int b = a; b < kRanks; ++b)
            for (int c = b; c < kRanks; ++c)
                for (int d = c; d < kRanks; ++d)
                    for (int e = d; e < kRanks; ++e) {
                        const int five[5] = {a, b, c, d, e};
                        const auto points = static_cast<uint8_t>(RankPoints(five));
                        for (int starter = 0; starter < 5; ++starter) {
                            int four[4] = {};
                            for (int i = 0, j = 0; i < 5; ++i)
                                if (i != starter)
                                    four[j++] = five[i];
                            table[MultisetIndex(four)][five[starter]] = points;
                        }
                    }
    return table;
}();

// Per card: its rank; its suit as a bit, so that four cards share a suit
// exactly when their bits have one in common; the jack of its suit.
constexpr auto kRankOf = [] {
    std::array<uint8_t, 52> table{};
    for (CardId card = 0; card < 52; ++card)
        table[card] = static_cast<uint8_t>(CardRank(card));
    return table;
}();

constexpr auto kSuitBit = [] {
    std::array<uint8_t, 52> table{};
    for (CardId card = 0; card < 52; ++card)
        table[card] = static_cast<uint8_t>(1 << CardSuit(card));
    return table;
}();

constexpr auto kJackOfSuit = [] {
    std::array<CardId, 52> table{};
    for (CardId card = 0; card < 52; ++card)
        table[card] = CardSuit(card) * 13 + kJackRank;
    return table;
}();

} // namespace

int CountHandCards(const CardId cards[5], bool cribRule)
{
    for (int i = 0; i < 5; ++i)
        assert(cards[i] >= 0 && cards[i] < 52);

    // The jack of the starter's suit, among the four cards only.
    const CardId jack = kJackOfSuit[cards[4]];
    int points = (cards[0] == jack ? 1 : 0) + (cards[1] == jack ? 1 : 0) + (cards[2] == jack ? 1 : 0)
        + (cards[3] == jack ? 1 : 0);

    // A flush: four in the hand (one more with the starter); the crib needs all five.
    const int fourSuit = kSuitBit[cards[0]] & kSuitBit[cards[1]] & kSuitBit[cards[2]] & kSuitBit[cards[3]];
    if ((fourSuit & kSuitBit[cards[4]]) != 0)
        points += 5;
    else if (fourSuit != 0 && !cribRule)
        points += 4;

    const int four = kFourIndex[kPairIndex[cards[0]][cards[1]]][kPairIndex[cards[2]][cards[3]]];
    return points + kRankPoints[four][kRankOf[cards[4]]];
}

#include "game/GameBoard.h"

#include <cmath>
#include <cstdint>
#include <limits>
#include <utility>

namespace {

constexpr int kRanks = 13;
constexpr int kSuits = 4;
constexpr int kCards = 52;

// The sum over every starter the kept four leave in the pack of the points
// the hand counts with it, plus or minus the discards' worth once per
// starter. The sum runs over the starters in ascending card order, in double
// precision, so that splits whose totals differ only in rounding are ranked
// the same way every time.
//
// A starter's rank and its suit add their points independently: the suit
// only ever matters for a flush and for the jack of the starter's suit. So
// one count for each rank and one for each suit give the counts of all 48
// starters, and the hand is counted 16 times instead of 48.
double SplitTotal(const GameBoard& board, const CardId kept[4], double signedWorth)
{
    uint64_t keptMask = 0;
    int keptOfRank[kRanks] = {};
    for (int k = 0; k < 4; ++k) {
        keptMask |= uint64_t{1} << kept[k];
        ++keptOfRank[CardRank(kept[k])];
    }
    const auto isKept = [keptMask](int card) { return ((keptMask >> card) & 1U) != 0; };

    CardId cards[5] = {kept[0], kept[1], kept[2], kept[3], 0};

    // A rank the hand does not hold: all four of its cards are starters, and
    // their counts differ only by what the suit adds.
    int probe = 0;
    while (keptOfRank[probe] != 0)
        ++probe;
    int suitPart[kSuits] = {};
    int probeCount[kSuits] = {};
    for (int suit = 0; suit < kSuits; ++suit) {
        cards[4] = suit * kRanks + probe;
        probeCount[suit] = board.CountHand(cards);
        suitPart[suit] = probeCount[suit] - probeCount[0];
    }

    // What each rank counts, taken as a starter of suit 0.
    int rankPart[kRanks] = {};
    for (int rank = 0; rank < kRanks; ++rank) {
        if (rank == probe) {
            rankPart[rank] = probeCount[0];
            continue;
        }
        for (int suit = 0; suit < kSuits; ++suit) {
            const CardId starter = suit * kRanks + rank;
            if (!isKept(starter)) {
                cards[4] = starter;
                rankPart[rank] = board.CountHand(cards) - suitPart[suit];
                break;
            }
        }
    }

    // With a whole-numbered worth every partial sum is a small whole number,
    // which doubles hold exactly; the total is then the plain sum.
    if (signedWorth == std::floor(signedWorth)) {
        int points = 0;
        for (int card = 0; card < kCards; ++card)
            if (!isKept(card))
                points += rankPart[CardRank(card)] + suitPart[CardSuit(card)];
        return static_cast<double>(points) + static_cast<double>(kCards - 4) * signedWorth;
    }

    double total = 0.0;
    for (int card = 0; card < kCards; ++card)
        if (!isKept(card))
            total = (static_cast<double>(rankPart[CardRank(card)] + suitPart[CardSuit(card)]) + total) + signedWorth;
    return total;
}

} // namespace

double GameBoard::DiscardValue(int rank1a, int rank1b)
{
    double worth = rank1a == rank1b ? 3.0 : 0.0;
    const int gap = rank1a > rank1b ? rank1a - rank1b : rank1b - rank1a;
    if (gap == 1 || gap == 2)
        worth += 1.0;
    if (Rank1Value(rank1a) + Rank1Value(rank1b) == 15)
        worth += 3.9;
    else if (Rank1Value(rank1a) == 5 || Rank1Value(rank1b) == 5)
        worth += 3.0;
    return worth;
}

void GameBoard::ChooseComputerDiscards()
{
    if (record.opponentDiscarded == 1)
        return;

    CardId* hand = record.deal + 6;
    // Below every possible total, so that some split is always chosen even
    // if none came out above zero.
    double bestTotal = -std::numeric_limits<double>::infinity();
    int bestFirst = 0;
    int bestSecond = 5;
    for (int first = 0; first < 5; ++first) {
        for (int second = first + 1; second < 6; ++second) {
            CardId kept[4];
            int count = 0;
            for (int p = 0; p < 6; ++p)
                if (p != first && p != second)
                    kept[count++] = hand[p];
            const double worth = DiscardValue(CardRank(hand[first]) + 1, CardRank(hand[second]) + 1);
            // The discards go to the computer's own crib, or help the user's.
            const double total = SplitTotal(*this, kept, record.playerCrib == 1 ? -worth : worth);
            if (total > bestTotal) {
                bestTotal = total;
                bestFirst = first;
                bestSecond = second;
            }
        }
    }

    record.opponentDiscarded = 1;

    // The crib is taken from the outer places. The hand's sprites move with
    // their cards so each place keeps showing the card it holds.
    CardSprite* sprites = record.opponentHandSprites;
    if (bestFirst != 0) {
        std::swap(hand[bestFirst], hand[0]);
        std::swap(sprites[bestFirst].suit1, sprites[0].suit1);
    }
    if (bestSecond != 5) {
        std::swap(hand[bestSecond], hand[5]);
        std::swap(sprites[bestSecond].suit1, sprites[5].suit1);
    }

    if (record.phase != kPhaseDiscard)
        StartPlay();
    SyncCardSprites();
}

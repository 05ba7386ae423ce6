#include "game/GameBoard.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace {

// The points the kept four count with every starter the pack may still hold,
// plus or minus the discards' worth once per starter. The sum runs over the
// starters in ascending card order in double precision: splits whose totals
// differ only in rounding are then ranked the same way every time.
double SplitTotal(const GameBoard& board, const CardId kept[4], double signedWorth)
{
    CardId cards[5] = {kept[0], kept[1], kept[2], kept[3], 0};
    double total = 0.0;
    for (CardId starter = 0; starter < 52; ++starter) {
        if (std::find(kept, kept + 4, starter) != kept + 4)
            continue;
        cards[4] = starter;
        total = (static_cast<double>(board.CountHand(cards)) + total) + signedWorth;
    }
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

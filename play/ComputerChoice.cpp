#include "game/GameBoard.h"
#include "play/PlaySequence.h"

namespace {

constexpr int kMaxCount = 31;

// The points the user's possible replies (each rank once, unweighted) would
// score after the cards laid so far and the computer's card of rank1. The
// replies counted are those with room under 31 after the card currently
// chosen, and the same replies are counted for every card compared with it.
int ReplyPoints(const PlaySequence& laid, int rank1, int replyRoom)
{
    PlaySequence withCard;
    SequenceCopy(laid, withCard);
    SequenceAppend(withCard, rank1);
    int points = 0;
    for (int reply = 1; reply <= 13; ++reply) {
        if (Rank1Value(reply) > replyRoom)
            continue;
        PlaySequence withReply;
        SequenceCopy(withCard, withReply);
        SequenceAppend(withReply, reply);
        points += ScorePlay(withReply);
    }
    return points;
}

} // namespace

int GameBoard::ChooseComputerCard() const
{
    const CardId* hand = record.deal + 6;
    const auto fits = [this, hand](int p) {
        return record.opponentHandSprites[p].suit1 != kSuitEmpty
            && record.runningCount + CardValue(hand[p]) <= kMaxCount;
    };
    const auto pointsNow = [this, hand](int p) {
        PlaySequence laid;
        SequenceCopy(record.playSequence, laid);
        SequenceAppend(laid, CardRank(hand[p]) + 1);
        return ScorePlay(laid);
    };

    int best = 0;
    for (int p = 1; p <= 4 && best == 0; ++p)
        if (fits(p))
            best = p;
    if (best == 0)
        return 0;

    // Later cards take the lead only by strictly more: ties keep the earlier.
    int bestPoints = pointsNow(best);
    int bestReplies = -1;  // not counted yet for this best
    for (int p = best + 1; p <= 4; ++p) {
        if (!fits(p))
            continue;
        const int points = pointsNow(p);
        if (points > bestPoints) {
            best = p;
            bestPoints = points;
            bestReplies = -1;
            continue;
        }
        // Neither scores now: lay the card that leaves the user less.
        if (bestPoints == 0) {
            const int replyRoom = kMaxCount - record.runningCount - CardValue(hand[best]);
            if (bestReplies < 0)
                bestReplies = ReplyPoints(record.playSequence, CardRank(hand[best]) + 1, replyRoom);
            if (ReplyPoints(record.playSequence, CardRank(hand[p]) + 1, replyRoom) < bestReplies) {
                best = p;
                bestReplies = -1;
            }
        }
    }
    return best;
}

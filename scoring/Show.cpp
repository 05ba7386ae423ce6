#include "game/GameBoard.h"

namespace {

bool GameWon(const GameBoard& board)
{
    return board.PlayerScore() == kGameHole || board.OpponentScore() == kGameHole;
}

} // namespace

// The non-dealer's hand is counted first, the dealer's second; phase 9 is how
// a hand count knows it is the second one and the crib comes next.
void GameBoard::ScorePlayerHand()
{
    const CardId cards[5] = {record.deal[1], record.deal[2], record.deal[3], record.deal[4], record.deal[12]};
    PegPoints(kSidePlayer, CountHand(cards), QStringLiteral(" for your hand"));
    if (!GameWon(*this)) {
        if (record.phase == kPhaseHandCounted)
            ShowScoreCrib();
        else
            ShowScoreOpponentHand();
    }
    record.phase = kPhaseHandCounted;
}

void GameBoard::ScoreOpponentHand()
{
    const CardId cards[5] = {record.deal[7], record.deal[8], record.deal[9], record.deal[10], record.deal[12]};
    PegPoints(kSideOpponent, CountHand(cards), QStringLiteral(" for his hand"));
    if (!GameWon(*this)) {
        if (record.phase == kPhaseHandCounted)
            ShowScoreCrib();
        else
            ShowScorePlayerHand();
    }
    record.phase = kPhaseHandCounted;
}

void GameBoard::ScoreCrib()
{
    // Phase 10 makes the count apply the crib's rule for flushes.
    record.phase = kPhaseCribCounted;
    const CardId cards[5] = {record.deal[0], record.deal[5], record.deal[6], record.deal[11], record.deal[12]};
    const int points = CountHand(cards);

    // The crib is laid face up in its owner's row; the other row is cleared.
    const bool playersCrib = record.playerCrib == 1;
    CardSprite* ownRow = playersCrib ? record.playerPileSprites : record.opponentPileSprites;
    CardSprite* otherRow = playersCrib ? record.opponentPileSprites : record.playerPileSprites;
    for (int i = 0; i < 4; ++i) {
        ownRow[i].rank1 = CardRank(cards[i]) + 1;
        ownRow[i].suit1 = CardSuit(cards[i]) + 1;
        otherRow[i].suit1 = kSuitEmpty;
        Invalidate(ownRow[i].rect);
        Invalidate(otherRow[i].rect);
    }

    PegPoints(playersCrib ? kSidePlayer : kSideOpponent, points, QStringLiteral(" for the crib"));
    SetButtonShown(ActionButton(kCmdScoreCrib), false);
    if (!GameWon(*this))
        SetButtonShown(ActionButton(kCmdDeal), true);
}

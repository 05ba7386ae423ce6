#include "game/GameBoard.h"

namespace {

bool GameWon(const GameBoard& board)
{
    return board.PlayerScore() == kGameHole || board.OpponentScore() == kGameHole;
}

// One side's hand of four with the starter, counted and pegged. The
// non-dealer's hand is counted first, the dealer's second; phase 9 is how a
// hand count knows it is the second one and the crib comes next.
void ScoreHand(GameBoard& board, int side, int firstSlot, const QString& suffix, void (GameBoard::*showOtherHand)())
{
    GameRecord& r = board.record;
    const CardId* hand = r.deal + firstSlot;
    const CardId cards[5] = {hand[0], hand[1], hand[2], hand[3], r.deal[12]};
    board.AnnounceTable(GameBoard::Turned::Hand, side);
    board.PegPoints(side, board.CountHand(cards), suffix, board.HandReasons(cards));
    if (!GameWon(board)) {
        if (r.phase == kPhaseHandCounted)
            board.ShowScoreCrib();
        else
            (board.*showOtherHand)();
    }
    r.phase = kPhaseHandCounted;
}

} // namespace

void GameBoard::ScorePlayerHand()
{
    ScoreHand(*this, kSidePlayer, 1, QStringLiteral(" for your hand"), &GameBoard::ShowScoreOpponentHand);
}

void GameBoard::ScoreOpponentHand()
{
    ScoreHand(*this, kSideOpponent, 7, QStringLiteral(" for his hand"), &GameBoard::ShowScorePlayerHand);
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

    AnnounceTable(Turned::Crib);
    PegPoints(playersCrib ? kSidePlayer : kSideOpponent, points, QStringLiteral(" for the crib"), HandReasons(cards));
    SetButtonShown(ActionButton(kCmdScoreCrib), false);
    if (!GameWon(*this))
        SetButtonShown(ActionButton(kCmdDeal), true);
}

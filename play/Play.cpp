#include "game/GameBoard.h"
#include "play/PlayReasons.h"
#include "play/PlaySequence.h"

namespace {

constexpr int kMaxCount = 31;

bool Fits(int runningCount, int rank1)
{
    return runningCount + Rank1Value(rank1) <= kMaxCount;
}

// A side cannot play when none of the cards still in its hand (positions 1..4)
// fits under 31; an empty hand cannot play either.
bool CannotPlay(const CardSprite hand[6], const CardId cards[6], int runningCount)
{
    for (int p = 1; p <= 4; ++p)
        if (hand[p].suit1 != kSuitEmpty && runningCount + CardValue(cards[p]) <= kMaxCount)
            return false;
    return true;
}

} // namespace

void GameBoard::ResetCount()
{
    // The running count, the cards it is made of and its display start again together.
    record.runningCount = 0;
    record.playSequence.entries[0] = -1;
    RefreshCount();
}

void GameBoard::StartPlay()
{
    if (CardRank(record.deal[12]) == 10)
        PegPoints(record.playerCrib == 1 ? kSidePlayer : kSideOpponent, 2, QStringLiteral(" for His Heels"));
    record.countVisible = 1;
    RefreshCount();
    // The non-dealer leads; when that is the computer it waits for "Ok" if the
    // user has just pegged His Heels.
    if (record.playerCrib == 1)
        ComputerTurn();
}

void GameBoard::PlayerLaysCard(CardSprite& sprite)
{
    if (record.gameOver != 0 || record.phase != kPhasePlay || sprite.suit1 == kSuitEmpty
        || IsButtonShown(kCmdOk) || !Fits(record.runningCount, sprite.rank1))
        return;
    // Four cards fill the row; a fifth index would mean the record is broken.
    if (record.playerPlayIndex < 1 || record.playerPlayIndex > 4)
        return;

    CardSprite& pile = record.playerPileSprites[record.playerPlayIndex - 1];
    pile.suit1 = sprite.suit1;
    pile.rank1 = sprite.rank1;
    sprite.suit1 = kSuitEmpty;
    Invalidate(pile.rect);
    Invalidate(sprite.rect);
    PlayerPlaysCard(sprite.rank1);
    ++record.playerPlayIndex;
    ComputerTurn();
}

void GameBoard::PlayerPlaysCard(int rank1)
{
    record.runningCount += Rank1Value(rank1);
    record.lastToPlay = kSidePlayer;
    SequenceAppend(record.playSequence, rank1);
    AnnounceTable(Turned::Laid, kSidePlayer);
    PegPoints(kSidePlayer, ScorePlay(record.playSequence), QString(), ItemisePlay(record.playSequence));
    RefreshCount();
    if (record.runningCount == kMaxCount)
        ResetCount();
}

void GameBoard::ComputerTurn()
{
    if (record.gameOver != 0 || IsButtonShown(kCmdOk))
        return;

    const int p = ChooseComputerCard();
    if (p != 0) {
        if (p < 1 || p > 4 || record.opponentPlayIndex < 1 || record.opponentPlayIndex > 4)
            return;
        CardSprite& hand = record.opponentHandSprites[p];
        CardSprite& pile = record.opponentPileSprites[record.opponentPlayIndex - 1];
        pile.suit1 = CardSuit(record.deal[6 + p]) + 1;
        pile.rank1 = hand.rank1;
        hand.suit1 = kSuitEmpty;
        Invalidate(pile.rect);
        Invalidate(hand.rect);
        ++record.opponentPlayIndex;
        ComputerPlaysCard(hand.rank1);
        // The user is passed over while no card of theirs fits.
        if (PlayerCannotPlay())
            ComputerTurn();
        return;
    }

    if (!PlayerCannotPlay()) {
        LogMessage(QStringLiteral("Opponent says: 'Go'"));
        return;
    }
    // Neither side can lay a card: the go, unless 31 has already scored.
    if (record.runningCount > 0 && record.runningCount < kMaxCount)
        PegPoints(record.lastToPlay, 1, QStringLiteral(" for a go"));
    ResetCount();
    // A go point that won the game ends the play where it stands.
    if (record.gameOver != 0)
        return;

    if (PlayerCannotPlay() && ComputerCannotPlay()) {
        // All eight cards are laid: the non-dealer's hand is counted first.
        if (PlayerScore() == kGameHole || OpponentScore() == kGameHole)
            return;
        record.phase = kPhasePlayOver;
        // The show has no running count.
        record.countVisible = 0;
        RefreshCount();
        if (record.playerCrib == 0)
            ShowScorePlayerHand();
        else
            ShowScoreOpponentHand();
        return;
    }
    // The side that did not lay the last card leads the new count; the
    // computer leads only once the user has pressed "Ok".
    if (record.lastToPlay == kSidePlayer || PlayerCannotPlay())
        ShowOk();
}

void GameBoard::ComputerPlaysCard(int rank1)
{
    record.runningCount += Rank1Value(rank1);
    SequenceAppend(record.playSequence, rank1);
    record.lastToPlay = kSideOpponent;
    AnnounceTable(Turned::Laid, kSideOpponent);
    RefreshCount();
    PegPoints(kSideOpponent, ScorePlay(record.playSequence), QString(), ItemisePlay(record.playSequence));
}

bool GameBoard::PlayerCannotPlay() const
{
    return CannotPlay(record.playerHandSprites, &record.deal[0], record.runningCount);
}

bool GameBoard::ComputerCannotPlay() const
{
    return CannotPlay(record.opponentHandSprites, &record.deal[6], record.runningCount);
}

void GameBoard::OnOk()
{
    SetButtonShown(ActionButton(kCmdOk), false);
    ComputerTurn();
}

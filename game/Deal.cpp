#include "game/GameBoard.h"

#include <QListWidget>
#include <QPushButton>

#include <algorithm>
#include <utility>

void GameBoard::OnDeal()
{
    SetButtonShown(dealButton, false);
    DealHand();
}

void GameBoard::DealHand()
{
    GameRecord& r = record;
    // Thirteen distinct cards: a card already dealt is simply drawn again.
    for (int k = 0; k < 13; ++k) {
        CardId n;
        do
            n = randomSource() % 52;
        while (std::find(r.deal, r.deal + k, n) != r.deal + k);
        r.deal[k] = n;
    }
    for (int& flag : r.selected)
        flag = 0;
    SortByRank(1, 6);
    LogMessage(QStringLiteral("Shuffling..."));

    r.runningCount = 0;
    r.countVisible = 0;
    RefreshCount();

    r.playerPlayIndex = 1;
    r.playSequence.entries[0] = -1;
    r.phase = kPhaseDiscard;
    r.opponentPlayIndex = 1;
    r.opponentDiscarded = 0;

    r.playerCrib = r.playerCrib ? 0 : 1;
    LogMessage(r.playerCrib ? QStringLiteral("Your Crib.") : QStringLiteral("Opponent's Crib."));

    for (int i = 0; i < 4; ++i) {
        r.playerPileSprites[i].suit1 = kSuitEmpty;
        r.opponentPileSprites[i].suit1 = kSuitEmpty;
    }
    for (int i = 0; i < 6; ++i) {
        r.playerHandSprites[i].highlighted = 0;
        r.playerHandSprites[i].suit1 = CardSuit(r.deal[i]) + 1;
        r.opponentHandSprites[i].suit1 = CardSuit(r.deal[6 + i]) + 1;
    }
    SyncCardSprites();
    ChooseComputerDiscards();
    AnnounceTable(Turned::Deal);
}

void GameBoard::SortByRank(int first, int last)
{
    // Positions are 1-based. A stable exchange sort: equal ranks keep their order.
    if (first > last)
        return;
    for (int pass = 0; pass < last - first + 1; ++pass)
        for (int j = first; j < last; ++j)
            if (CardRank(record.deal[j - 1]) > CardRank(record.deal[j]))
                std::swap(record.deal[j - 1], record.deal[j]);
}

void GameBoard::OnSendToCrib()
{
    GameRecord& r = record;
    r.phase = kPhasePlay;
    // The two chosen cards go to hand positions 0 and 5, where the crib is taken from.
    for (int j = 1; j <= 4; ++j) {
        if (!r.selected[j])
            continue;
        const int target = r.selected[0] ? 5 : 0;
        std::swap(r.deal[target], r.deal[j]);
        r.selected[j] = 0;
        r.selected[target] = 1;
    }
    for (CardSprite& sprite : r.playerHandSprites)
        sprite.highlighted = 0;
    SortByRank(2, 5);
    for (int i = 1; i <= 4; ++i)
        r.playerHandSprites[i].suit1 = CardSuit(r.deal[i]) + 1;
    SyncCardSprites();
    AnnounceTable(Turned::Starter);
    if (r.opponentDiscarded)
        StartPlay();
    SetButtonShown(sendToCribButton, false);
}

void GameBoard::SyncCardSprites()
{
    GameRecord& r = record;
    for (int i = 0; i < 6; ++i) {
        r.playerHandSprites[i].rank1 = CardRank(r.deal[i]) + 1;
        r.opponentHandSprites[i].rank1 = CardRank(r.deal[6 + i]) + 1;
        Invalidate(r.playerHandSprites[i].rect);
        Invalidate(r.opponentHandSprites[i].rect);
    }
    if (r.phase > kPhaseDiscard) {
        r.playerHandSprites[0].suit1 = kSuitEmpty;
        r.playerHandSprites[5].suit1 = kSuitEmpty;
    }
    if (r.opponentDiscarded) {
        r.opponentHandSprites[0].suit1 = kSuitEmpty;
        r.opponentHandSprites[5].suit1 = kSuitEmpty;
    }
    if (r.opponentDiscarded && r.phase > kPhaseDiscard) {
        r.starterSprite.rank1 = CardRank(r.deal[12]) + 1;
        r.starterSprite.suit1 = CardSuit(r.deal[12]) + 1;
    } else {
        r.starterSprite.suit1 = kSuitBack;
    }
    Invalidate(r.starterSprite.rect);
    for (int i = 0; i < 4; ++i) {
        Invalidate(r.playerPileSprites[i].rect);
        Invalidate(r.opponentPileSprites[i].rect);
    }
}

void GameBoard::NewGame()
{
    GameRecord& r = record;
    InvalidatePegRects();

    // The log starts afresh before the save, which may have to say it failed.
    if (messageLog)
        messageLog->clear();
    r.savedPlayerCrib = r.savedPlayerCrib ? 0 : 1;
    SaveSettings();
    ResetTable();
    RefreshCount();
    SyncCardSprites();
    r.starterSprite.suit1 = kSuitEmpty;
    UpdatePegRects(true);
    LoadSettings();

    SetButtonShown(sendToCribButton, false);
    SetButtonShown(scorePlayerHandButton, false);
    SetButtonShown(scoreOpponentHandButton, false);
    SetButtonShown(scoreCribButton, false);
    SetButtonShown(okButton, false);
    SetButtonShown(dealButton, true);
}

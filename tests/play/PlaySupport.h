#pragma once

// Deals laid out card by card for the play and the show, and the user's moves
// made through real taps and keys.

#include "support/TestBoard.h"

#include <QtTest>

#include <array>

// One deal as it stands after both sides have discarded.
struct TableCards {
    std::array<CardId, 4> player;        // the user's kept hand, in rank order
    std::array<CardId, 2> playerCrib;    // the user's two discards
    std::array<CardId, 4> computer;      // the computer's kept hand, in its own order
    std::array<CardId, 2> computerCrib;  // the computer's two discards
    CardId starter;
};

// Deals, replaces the cards dealt with these (the computer's own discard choice
// is overruled so the hands are known), then makes the user's discard with two
// taps and "Send To Crib", which turns the starter and starts the play.
// userDeals decides whose crib it is.
inline void StartDeal(GameBoard& board, bool userDeals, const TableCards& cards)
{
    GameRecord& r = board.record;
    r.playerCrib = userDeals ? 0 : 1;  // every deal passes the crib over
    ClickButton(board, kCmdDeal);
    QCOMPARE(r.phase, int32_t(kPhaseDiscard));

    r.deal[0] = cards.playerCrib[0];
    r.deal[5] = cards.playerCrib[1];
    r.deal[6] = cards.computerCrib[0];
    r.deal[11] = cards.computerCrib[1];
    for (int i = 0; i < 4; ++i) {
        r.deal[1 + i] = cards.player[i];
        r.deal[7 + i] = cards.computer[i];
    }
    r.deal[12] = cards.starter;
    for (int i = 0; i < 6; ++i)
        r.playerHandSprites[i].suit1 = CardSuit(r.deal[i]) + 1;
    for (int i = 1; i <= 4; ++i)
        r.opponentHandSprites[i].suit1 = CardSuit(r.deal[6 + i]) + 1;
    board.SyncCardSprites();

    TapHand(board, 1);
    TapHand(board, 6);
    ClickButton(board, kCmdSendToCrib);
    QCOMPARE(r.phase, int32_t(kPhasePlay));
}

// The input position (1..6) of a card in the user's hand, or 0 once laid.
inline int HandPosition(const GameBoard& board, CardId card)
{
    for (int p = 1; p <= 4; ++p)
        if (board.record.deal[p] == card && board.record.playerHandSprites[p].suit1 != kSuitEmpty)
            return p + 1;
    return 0;
}

// Lays a card of the user's hand with a tap on it, or with its digit key.
inline void LayCard(GameBoard& board, CardId card, bool byKey = false)
{
    const int position = HandPosition(board, card);
    QVERIFY2(position != 0, "the card is not in the hand");
    if (byKey)
        PressKey(board, Qt::Key_1 + position - 1);
    else
        TapHand(board, position);
}

// Scores made before this deal: pegged the way the board pegs any points.
inline void SetScores(GameBoard& board, int player, int opponent)
{
    board.MovePlayerPegs(player);
    board.MoveOpponentPegs(opponent);
}

// Lines the log received since it held `from` lines.
inline QStringList LinesSince(const GameBoard& board, qsizetype from)
{
    return LogLines(board).mid(from);
}

// The rank1 values of the cards laid since the count was last reset.
inline QList<int> SequenceRanks(const GameBoard& board)
{
    QList<int> ranks;
    for (int entry : board.record.playSequence.entries) {
        if (entry == -1)
            break;
        ranks.append(entry);
    }
    return ranks;
}

// Deals used by more than one suite. The computer deals in the first, the user
// in the second; each is played out by laying the user's four cards in order.
namespace Deals {

// Computer's crib. The user leads 2, the computer answers K; after the user's 8
// the computer lays 6 and 5 in a row for 31 (2) and the user leads again; the
// user's Q at 30 ends the play with the user's go.
inline TableCards ComputerRunsToThirtyOne()
{
    return {{Card(2, 1), Card(8, 2), Card(10, 3), Card(12, 4)},
            {Card(1, 2), Card(4, 2)},
            {Card(13, 1), Card(13, 2), Card(6, 3), Card(5, 1)},
            {Card(9, 2), Card(13, 4)},
            Card(5, 3)};
}

// User's crib. The computer leads a four; the user's Q, last card of the eight,
// makes 30 and pegs the go. The crib is four hearts with a club starter.
inline TableCards UserLastCardGo()
{
    return {{Card(1, 1), Card(1, 3), Card(6, 2), Card(12, 3)},
            {Card(1, 2), Card(3, 2)},
            {Card(4, 1), Card(2, 1), Card(2, 4), Card(4, 3)},
            {Card(7, 2), Card(12, 2)},
            Card(9, 4)};
}

} // namespace Deals

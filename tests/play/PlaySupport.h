#pragma once

// Deals laid out card by card for the play and the show, and scripts of the
// user's moves made through real taps, keys and clicks.

#include "support/TestBoard.h"

#include <QtTest>

#include <array>

// One deal as it stands after both sides have discarded.
struct TableCards {
    std::array<CardId, 4> player;        // the user's kept hand, in rank order
    std::array<CardId, 2> playerCrib;
    std::array<CardId, 4> computer;      // the computer's kept hand, in its own order
    std::array<CardId, 2> computerCrib;
    CardId starter;
};
Q_DECLARE_METATYPE(TableCards)

// Deals, replaces the cards dealt with these (overruling the computer's own
// discard so the hands are known), then discards with two taps and "Send To
// Crib", which turns the starter and starts the play.
inline void StartDeal(GameBoard& board, bool userDeals, const TableCards& cards)
{
    GameRecord& r = board.record;
    r.playerCrib = userDeals ? 0 : 1;  // every deal passes the crib over
    ClickButton(board, kCmdDeal);
    QCOMPARE(r.phase, int32_t(kPhaseDiscard));
    const CardId deal[13] = {cards.playerCrib[0], cards.player[0], cards.player[1], cards.player[2],
                             cards.player[3], cards.playerCrib[1], cards.computerCrib[0], cards.computer[0],
                             cards.computer[1], cards.computer[2], cards.computer[3], cards.computerCrib[1],
                             cards.starter};
    for (int i = 0; i < 13; ++i)
        r.deal[i] = deal[i];
    for (int i = 0; i < 6; ++i)
        r.playerHandSprites[i].suit1 = CardSuit(deal[i]) + 1;
    for (int i = 1; i <= 4; ++i)
        r.opponentHandSprites[i].suit1 = CardSuit(deal[6 + i]) + 1;
    board.SyncCardSprites();

    TapHand(board, 1);
    TapHand(board, 6);
    ClickButton(board, kCmdSendToCrib);
    QCOMPARE(r.phase, int32_t(kPhasePlay));
}

// Lays a card of the user's hand with a tap on it, or with its digit key.
inline void LayCard(GameBoard& board, CardId card, bool byKey = false)
{
    int position = 0;
    for (int p = 1; p <= 4; ++p)
        if (board.record.deal[p] == card && board.record.playerHandSprites[p].suit1 != kSuitEmpty)
            position = p + 1;
    QVERIFY2(position != 0, "the card is not in the hand");
    if (byKey)
        PressKey(board, Qt::Key_1 + position - 1);
    else
        TapHand(board, position);
}

// What a step of a script does besides laying a card (CardIds are 0..51).
enum StepAction : int {
    kLook = -1,           // nothing: the table as the deal left it
    kPress = -2,          // the one button shown: a click, or Enter by keyboard
    kTapEverything = -3,  // every hand position by tap and key, then Enter
};

// One move of the user and the table after it.
struct Step {
    int action;          // a card to lay, or a StepAction
    QStringList said;    // the lines the log received
    int count;           // the running count
    int you;
    int opponent;
    QList<int> buttons;  // the action buttons shown
    int shown = 0;       // the number on display, when it differs from a count just reset
};
Q_DECLARE_METATYPE(QList<Step>)

// Plays the steps and compares the table after each; the log is read from
// the line numbered `mark` on.
inline void RunSteps(GameBoard& board, const QList<Step>& steps, bool byKey, qsizetype mark)
{
    const GameRecord& r = board.record;
    const auto describe = [](qsizetype n, const QStringList& said, int count, int you, int opponent,
                             const QList<int>& buttons) {
        QStringList ids;
        for (int id : buttons)
            ids.append(QString::number(id));
        return QStringLiteral("step %1: [%2] count %3, %4 to %5, buttons [%6]")
            .arg(n).arg(said.join(QStringLiteral(" / "))).arg(count).arg(you).arg(opponent).arg(ids.join(' '));
    };
    for (qsizetype n = 1; n <= steps.size(); ++n) {
        const Step& step = steps[n - 1];
        if (step.action == kPress) {
            const QList<int> shown = ShownButtons(board);
            QCOMPARE(shown.size(), 1);
            byKey ? ReleaseEnter(board) : ClickButton(board, shown.first());
        } else if (step.action == kTapEverything) {
            for (int position = 1; position <= 6; ++position) {
                TapHand(board, position);
                PressKey(board, Qt::Key_1 + position - 1);
            }
            ReleaseEnter(board);
        } else if (step.action != kLook) {
            LayCard(board, step.action, byKey);
        }
        const QStringList lines = LogLines(board);
        QCOMPARE(describe(n, lines.mid(mark), r.runningCount, board.PlayerScore(), board.OpponentScore(),
                          ShownButtons(board)),
                 describe(n, step.said, step.count, step.you, step.opponent, step.buttons));
        if (const int shown = step.shown ? step.shown : step.count)
            QCOMPARE(r.shownCount, shown);
        mark = lines.size();
    }
}

// Deals used by more than one suite, played out by laying the user's four
// cards in order. The computer deals in the first, the user in the second.
namespace Deals {

// The user leads 2, the computer answers K; after the user's 8 the computer
// lays 6 and 5 in a row for 31 (2) and the user leads again; the user's Q at
// 30 ends the play with the user's go.
inline TableCards ComputerRunsToThirtyOne()
{
    return {{Card(2, 1), Card(8, 2), Card(10, 3), Card(12, 4)}, {Card(1, 2), Card(4, 2)},
            {Card(13, 1), Card(13, 2), Card(6, 3), Card(5, 1)}, {Card(9, 2), Card(13, 4)}, Card(5, 3)};
}

// The computer leads a four; the user's Q, last card of the eight, makes 30
// and pegs the go. The crib is four hearts with a club starter.
inline TableCards UserLastCardGo()
{
    return {{Card(1, 1), Card(1, 3), Card(6, 2), Card(12, 3)}, {Card(1, 2), Card(3, 2)},
            {Card(4, 1), Card(2, 1), Card(2, 4), Card(4, 3)}, {Card(7, 2), Card(12, 2)}, Card(9, 4)};
}

} // namespace Deals

#include "accessibility/TableAccessible.h"
#include "game/GameBoard.h"

#include <QPushButton>

namespace {

// The window's interface, made now if a client has not asked for it yet.
TableAccessible* Table(GameBoard* board)
{
    return dynamic_cast<TableAccessible*>(QAccessible::queryAccessibleInterface(board));
}

QString Words(CardId card)
{
    return GameBoard::CardWords(CardSprite{{}, 0, 0, CardRank(card) + 1, CardSuit(card) + 1});
}

QString CardList(std::initializer_list<CardId> cards)
{
    QStringList names;
    for (CardId card : cards)
        names.append(Words(card));
    return names.join(QStringLiteral(", "));
}

// The cards the hand's places hold, and the keys that take them.
QString HandWords(const GameRecord& r)
{
    QStringList names;
    int first = 0;
    int last = 0;
    for (int p = 0; p < 6; ++p) {
        if (r.playerHandSprites[p].suit1 == kSuitEmpty)
            continue;
        names.append(GameBoard::CardWords(r.playerHandSprites[p]));
        first = first == 0 ? p + 1 : first;
        last = p + 1;
    }
    if (names.isEmpty())
        return {};
    return QStringLiteral("Your hand, keys %1 to %2: %3.").arg(first).arg(last).arg(names.join(QStringLiteral(", ")));
}

} // namespace

QString GameBoard::CardWords(const CardSprite& sprite)
{
    static const char* const ranks[] = {"Ace", "Two", "Three", "Four", "Five", "Six", "Seven",
                                        "Eight", "Nine", "Ten", "Jack", "Queen", "King"};
    // Suits as the program numbers them.
    static const char* const suits[] = {"Spades", "Diamonds", "Hearts", "Clubs"};
    if (sprite.faceDown || sprite.suit1 < 1 || sprite.suit1 > 4 || sprite.rank1 < 1 || sprite.rank1 > 13)
        return {};
    return QLatin1String(ranks[sprite.rank1 - 1]) + QStringLiteral(" of ") + QLatin1String(suits[sprite.suit1 - 1]);
}

void GameBoard::Announce(const QString& text)
{
    if (!QAccessible::isActive())
        return;
    if (TableAccessible* table = Table(this))
        table->Queue(text);
}

void GameBoard::AccessibleTableChanged()
{
    if (!QAccessible::isActive())
        return;
    if (TableAccessible* table = Table(this))
        table->ScheduleFlush();
}

void GameBoard::FocusCardByKey(int position)
{
    if (!QAccessible::isActive() || position < 1 || position > 6)
        return;
    TableAccessible* table = Table(this);
    if (table == nullptr)
        return;
    // The card stays in its place when chosen or refused; laid, it is in the
    // row (also the last card, which the show then lists in the hand again).
    const int slot = position - 1;
    TableItem* target = table->Item(TablePart::YourHand, slot);
    for (int i = 0; i < 4 && record.playerHandSprites[slot].suit1 == kSuitEmpty; ++i) {
        const TableAccessible::Face laid = table->FaceAt(TablePart::YourLaid, i);
        if (laid.suit1 == CardSuit(record.deal[slot]) + 1 && laid.rank1 == CardRank(record.deal[slot]) + 1)
            target = table->Item(TablePart::YourLaid, i);
    }
    if (target->Shown())
        table->SetFocusTarget(target);
}

void GameBoard::AnnounceButton(QPushButton* button)
{
    if (!QAccessible::isActive())
        return;
    if (TableAccessible* table = Table(this))
        table->QueueButton(button);
}

void GameBoard::AnnounceTable(Turned what, int which)
{
    if (!QAccessible::isActive())
        return;
    const GameRecord& r = record;
    switch (what) {
    case Turned::Deal:
        Announce(HandWords(r));
        break;
    case Turned::Choice:
        if (which >= 1 && which <= 6)
            Announce(CardWords(r.playerHandSprites[which - 1])
                     + (r.selected[which - 1] ? QStringLiteral(" chosen for the crib") : QStringLiteral(" let go")));
        break;
    case Turned::Starter:
        // The hand is sorted again, and its keys are now 2 to 5.
        Announce(HandWords(r));
        if (r.starterSprite.suit1 != kSuitBack)
            Announce(QStringLiteral("Starter: ") + CardWords(r.starterSprite));
        break;
    case Turned::Laid: {
        // The card laid last is the rightmost of the side's row.
        const CardSprite* row = which == kSidePlayer ? r.playerPileSprites : r.opponentPileSprites;
        int last = 3;
        while (last > 0 && row[last].suit1 == kSuitEmpty)
            --last;
        Announce((which == kSidePlayer ? QStringLiteral("You lay ") : QStringLiteral("Opponent lays "))
                 + CardWords(row[last]) + QStringLiteral(", count ") + QString::number(r.runningCount));
        break;
    }
    case Turned::Hand:
        if (which == kSidePlayer)
            Announce(QStringLiteral("Your hand: ") + CardList({r.deal[1], r.deal[2], r.deal[3], r.deal[4]}));
        else
            Announce(QStringLiteral("Opponent's hand: ") + CardList({r.deal[7], r.deal[8], r.deal[9], r.deal[10]}));
        break;
    case Turned::Crib:
        Announce((r.playerCrib == 1 ? QStringLiteral("Your crib: ") : QStringLiteral("Opponent's crib: "))
                 + CardList({r.deal[0], r.deal[5], r.deal[6], r.deal[11]}));
        break;
    }
}

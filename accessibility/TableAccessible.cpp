#include "accessibility/TableAccessible.h"

#include "game/GameBoard.h"

#include <QMetaObject>

namespace {

bool IsList(TablePart part)
{
    return part == TablePart::YourHand || part == TablePart::YourLaid || part == TablePart::OpponentLaid
           || part == TablePart::OpponentHand || part == TablePart::Crib;
}

// Card places of each part: six in a hand, four in a row or the crib.
int SlotCount(TablePart part)
{
    switch (part) {
    case TablePart::YourHand:
    case TablePart::OpponentHand: return 6;
    case TablePart::YourLaid:
    case TablePart::OpponentLaid:
    case TablePart::Crib: return 4;
    default: return 0;
    }
}

// The show, from the end of the play until the next deal: the hands are
// counted from the cards the rows turned up.
bool InShow(int32_t phase)
{
    return phase == kPhasePlayOver || phase == kPhaseHandCounted || phase == kPhaseCribCounted;
}

const CardSprite* CribRow(const GameRecord& r)
{
    return r.playerCrib == 1 ? r.playerPileSprites : r.opponentPileSprites;
}

bool ShowsCard(const CardSprite& sprite, CardId card)
{
    return sprite.suit1 == CardSuit(card) + 1 && sprite.rank1 == CardRank(card) + 1 && !sprite.faceDown;
}

// Score Crib lays the crib face up in its owner's row: the row then shows
// exactly the crib's four cards, which no play ever lays.
bool CribFaceUp(const GameRecord& r)
{
    const CardSprite* row = CribRow(r);
    const CardId crib[4] = {r.deal[0], r.deal[5], r.deal[6], r.deal[11]};
    for (int i = 0; i < 4; ++i)
        if (!ShowsCard(row[i], crib[i]))
            return false;
    return true;
}

int CribCardsFaceDown(const GameRecord& r)
{
    if (CribFaceUp(r))
        return 0;
    switch (r.phase) {
    case kPhaseNoDeal: return 0;
    case kPhaseDiscard: return r.opponentDiscarded ? 2 : 0;
    default: return 4;
    }
}

TableAccessible::Face FaceOf(const CardSprite& sprite)
{
    if (sprite.faceDown || sprite.suit1 < 1 || sprite.suit1 > 4)
        return {};
    return {sprite.rank1, sprite.suit1};
}

TableAccessible::Face FaceOf(CardId card)
{
    return {CardRank(card) + 1, CardSuit(card) + 1};
}

QString CountedCards(int n, const char* what)
{
    return n == 1 ? QStringLiteral(": 1 card %1").arg(QLatin1String(what))
                  : QStringLiteral(": %1 cards %2").arg(n).arg(QLatin1String(what));
}

} // namespace

QAccessibleInterface* TableAccessibleFactory(const QString& className, QObject* object)
{
    if (className == QLatin1String("GameBoard") && object != nullptr && object->isWidgetType())
        if (auto* board = qobject_cast<GameBoard*>(object))
            return new TableAccessible(board);
    return nullptr;
}

TableAccessible::TableAccessible(GameBoard* board)
    : QAccessibleWidget(board, QAccessible::Pane)
{
}

void TableAccessible::Build() const
{
    if (built)
        return;
    built = true;
    auto* self = const_cast<TableAccessible*>(this);
    // Every item is handed to Qt's cache at once, so that it has one id for
    // the life of the window; this interface gives them back when it goes.
    for (int p = 0; p < kTablePartCount; ++p) {
        const auto part = static_cast<TablePart>(p);
        parts[p] = Keep(new TableItem(self, part, -1));
        for (int slot = 0; slot < SlotCount(part); ++slot)
            cards[p].push_back(Keep(new TableItem(self, part, slot)));
    }
    notice = Keep(new TableItem(self, TablePart::YourHand, -1, true));
    // What the table shows now is what a client first reads: no events for it.
    for (TableItem* part : parts)
        part->toldName = part->text(QAccessible::Name);
    for (const auto& places : cards)
        for (TableItem* card : places) {
            card->toldShown = card->Shown();
            card->toldName = card->toldShown ? card->text(QAccessible::Name) : QString();
            card->toldChecked = card->toldShown && card->state().checked;
        }
}

TableAccessible::~TableAccessible()
{
    for (QAccessible::Id id : ids)
        QAccessible::deleteAccessibleInterface(id);
}

TableItem* TableAccessible::Keep(TableItem* item) const
{
    ids.push_back(QAccessible::registerAccessibleInterface(item));
    return item;
}

GameBoard* TableAccessible::Board() const
{
    return static_cast<GameBoard*>(widget());
}

TableItem* TableAccessible::Item(TablePart part, int slot) const
{
    Build();
    const int p = static_cast<int>(part);
    if (slot < 0)
        return parts[p];
    return slot < static_cast<int>(cards[p].size()) ? cards[p][slot] : nullptr;
}

int TableAccessible::childCount() const
{
    return kTablePartCount + QAccessibleWidget::childCount() + 1;
}

QAccessibleInterface* TableAccessible::child(int index) const
{
    const int widgets = QAccessibleWidget::childCount();
    if (index < 0 || index > kTablePartCount + widgets)
        return nullptr;
    Build();
    if (index < kTablePartCount)
        return parts[index];
    if (index < kTablePartCount + widgets)
        return QAccessibleWidget::child(index - kTablePartCount);
    return notice;
}

int TableAccessible::indexOfChild(const QAccessibleInterface* child) const
{
    Build();
    for (int p = 0; p < kTablePartCount; ++p)
        if (child == parts[p])
            return p;
    if (child == notice)
        return kTablePartCount + QAccessibleWidget::childCount();
    const int index = QAccessibleWidget::indexOfChild(child);
    return index < 0 ? -1 : kTablePartCount + index;
}

QAccessibleInterface* TableAccessible::focusChild() const
{
    if (focusTarget != nullptr && focusTarget->Shown() && Board()->hasFocus())
        return focusTarget;
    return QAccessibleWidget::focusChild();
}

QString TableAccessible::text(QAccessible::Text t) const
{
    switch (t) {
    case QAccessible::Name: return QStringLiteral("Card table");
    case QAccessible::Description:
        return QStringLiteral("Keys 1 to 6 choose or lay the card in that place; Enter presses the button shown.");
    default: return QAccessibleWidget::text(t);
    }
}

TableAccessible::Face TableAccessible::FaceAt(TablePart part, int slot) const
{
    const GameRecord& r = Board()->record;
    const bool cribUp = CribFaceUp(r);
    switch (part) {
    case TablePart::YourHand:
        if (r.playerHandSprites[slot].suit1 != kSuitEmpty)
            return FaceOf(r.playerHandSprites[slot]);
        return InShow(r.phase) && slot >= 1 && slot <= 4 ? FaceOf(r.deal[slot]) : Face{};
    case TablePart::OpponentHand:
        // Face down until the show turns the computer's hand up.
        return InShow(r.phase) && slot >= 1 && slot <= 4 ? FaceOf(r.deal[6 + slot]) : Face{};
    case TablePart::YourLaid: return cribUp && r.playerCrib == 1 ? Face{} : FaceOf(r.playerPileSprites[slot]);
    case TablePart::OpponentLaid: return cribUp && r.playerCrib != 1 ? Face{} : FaceOf(r.opponentPileSprites[slot]);
    case TablePart::Crib: return cribUp ? FaceOf(CribRow(r)[slot]) : Face{};
    default: return {};
    }
}

QString TableAccessible::PartName(TablePart part) const
{
    const GameBoard& board = *Board();
    const GameRecord& r = board.record;
    switch (part) {
    case TablePart::YourHand: return QStringLiteral("Your hand");
    case TablePart::YourLaid: return QStringLiteral("Cards you laid");
    case TablePart::OpponentLaid: return QStringLiteral("Cards the opponent laid");
    case TablePart::Count:
        return r.countVisible ? QStringLiteral("Count: %1").arg(r.shownCount) : QStringLiteral("Count: none");
    case TablePart::Starter:
        if (r.starterSprite.suit1 == kSuitBack)
            return QStringLiteral("Starter: face down");
        return QStringLiteral("Starter: ") + (r.starterSprite.suit1 == kSuitEmpty ? QStringLiteral("none")
                                                                                 : GameBoard::CardWords(r.starterSprite));
    case TablePart::OpponentHand: {
        int faceDown = 0;
        for (const CardSprite& sprite : r.opponentHandSprites)
            faceDown += sprite.suit1 != kSuitEmpty ? 1 : 0;
        return QStringLiteral("Opponent's hand") + (faceDown > 0 ? CountedCards(faceDown, "face down") : QString());
    }
    case TablePart::Crib: {
        const int faceDown = CribCardsFaceDown(r);
        if (faceDown == 0 && !CribFaceUp(r))
            return QStringLiteral("Crib: none");
        return (r.playerCrib == 1 ? QStringLiteral("Your crib") : QStringLiteral("Opponent's crib"))
               + (faceDown > 0 ? CountedCards(faceDown, "face down") : QString());
    }
    case TablePart::Score: return board.BoardTip();
    }
    return {};
}

QRect TableAccessible::ScreenRect(TablePart part, int slot) const
{
    const GameBoard& board = *Board();
    const GameRecord& r = board.record;
    Rect area;
    if (slot >= 0) {
        switch (part) {
        case TablePart::YourHand: area = r.playerHandSprites[slot].rect; break;
        case TablePart::OpponentHand: area = r.opponentHandSprites[slot].rect; break;
        case TablePart::YourLaid: area = r.playerPileSprites[slot].rect; break;
        case TablePart::OpponentLaid: area = r.opponentPileSprites[slot].rect; break;
        case TablePart::Crib: area = CribRow(r)[slot].rect; break;
        default: break;
        }
    } else if (IsList(part)) {
        // A part covers all of its places, those without a card too.
        QRect all;
        for (int s = 0; s < SlotCount(part); ++s)
            all |= ScreenRect(part, s);
        return all;
    } else if (part == TablePart::Starter) {
        area = r.starterSprite.rect;
    } else if (part == TablePart::Count) {
        area = r.countRect;
    } else {
        area = Rect{0, 0, board.boardInfo.bmWidth, board.boardInfo.bmHeight};
    }
    const QRect scaled = board.ScaledRect(area);
    return QRect(board.mapToGlobal(scaled.topLeft()), scaled.size());
}

void TableAccessible::Queue(const QString& line)
{
    queued.append(line);
    ScheduleFlush();
}

void TableAccessible::QueueButton(QPushButton* button)
{
    buttons.append(button);
    ScheduleFlush();
}

void TableAccessible::SetFocusTarget(TableItem* item)
{
    focusTarget = item;
    focusPending = true;
    ScheduleFlush();
}

void TableAccessible::ScheduleFlush()
{
    if (flushQueued)
        return;
    flushQueued = true;
    // After the game's own work and after Qt's Focus event for the window, so
    // that a card's focus is the last a screen reader hears.
    GameBoard* board = Board();
    QMetaObject::invokeMethod(
        board,
        [board] {
            if (auto* table = dynamic_cast<TableAccessible*>(QAccessible::queryAccessibleInterface(board)))
                table->Flush();
        },
        Qt::QueuedConnection);
}

void TableAccessible::Flush()
{
    flushQueued = false;
    if (!isValid())
        return;
    Build();
    const auto raise = [](QAccessibleInterface* item, QAccessible::Event type) {
        QAccessibleEvent event(item, type);
        QAccessible::updateAccessibility(&event);
    };
    for (int p = 0; p < kTablePartCount; ++p) {
        TableItem* part = parts[p];
        const QString name = part->text(QAccessible::Name);
        if (name != part->toldName) {
            part->toldName = name;
            raise(part, QAccessible::NameChanged);
        }
        for (TableItem* card : cards[p]) {
            const bool shown = card->Shown();
            const QString cardName = shown ? card->text(QAccessible::Name) : QString();
            const bool checked = shown && card->state().checked;
            if (shown != card->toldShown) {
                raise(card, shown ? QAccessible::ObjectCreated : QAccessible::ObjectDestroyed);
            } else if (shown) {
                if (cardName != card->toldName)
                    raise(card, QAccessible::NameChanged);
                if (checked != card->toldChecked) {
                    QAccessible::State change;
                    change.checked = true;
                    QAccessibleStateChangeEvent event(card, change);
                    QAccessible::updateAccessibility(&event);
                }
            }
            card->toldShown = shown;
            card->toldName = cardName;
            card->toldChecked = checked;
        }
    }

    if (focusTarget != nullptr && !focusTarget->Shown())
        focusTarget = nullptr;
    if (focusPending && focusTarget != nullptr)
        raise(focusTarget, QAccessible::Focus);
    focusPending = false;

    // One announcement for the turn: lines said one after another, each
    // ending as a sentence so that the voice pauses between them; last the
    // button that appeared, which Enter presses next.
    for (const QPointer<QPushButton>& button : std::as_const(buttons))
        if (button != nullptr && !button->isHidden())
            queued.append(button->text() + QStringLiteral(" button"));
    buttons.clear();
    QStringList lines;
    for (const QString& line : std::as_const(queued)) {
        const QString trimmed = line.trimmed();
        if (trimmed.isEmpty())
            continue;
        const QChar last = trimmed.back();
        lines.append(last == u'.' || last == u'!' || last == u'?' ? trimmed : trimmed + u'.');
    }
    queued.clear();
    if (lines.isEmpty())
        return;
    notice->noticeText = lines.join(u' ');
    raise(notice, QAccessible::NameChanged);
    raise(notice, QAccessible::ObjectShow);
}

TableItem::TableItem(TableAccessible* owner, TablePart itsPart, int itsSlot, bool notification)
    : table(owner), part(itsPart), slot(itsSlot), isNotice(notification)
{
}

bool TableItem::isValid() const
{
    return table->isValid();
}

QWindow* TableItem::window() const
{
    return table->window();
}

bool TableItem::Shown() const
{
    return !isNotice && IsCard() && table->FaceAt(part, slot).suit1 != kSuitEmpty;
}

std::vector<TableItem*> TableItem::ShownCards() const
{
    std::vector<TableItem*> shown;
    if (isNotice || IsCard() || !IsList(part))
        return shown;
    for (TableItem* card : table->cards[static_cast<int>(part)])
        if (card->Shown())
            shown.push_back(card);
    return shown;
}

QAccessibleInterface* TableItem::parent() const
{
    if (isNotice || !IsCard())
        return table;
    return table->Item(part);
}

QAccessibleInterface* TableItem::child(int index) const
{
    const std::vector<TableItem*> shown = ShownCards();
    return index >= 0 && index < static_cast<int>(shown.size()) ? shown[index] : nullptr;
}

int TableItem::childCount() const
{
    return static_cast<int>(ShownCards().size());
}

int TableItem::indexOfChild(const QAccessibleInterface* child) const
{
    const std::vector<TableItem*> shown = ShownCards();
    for (size_t i = 0; i < shown.size(); ++i)
        if (shown[i] == child)
            return static_cast<int>(i);
    return -1;
}

QAccessibleInterface* TableItem::childAt(int x, int y) const
{
    for (TableItem* card : ShownCards())
        if (card->rect().contains(x, y))
            return card;
    return nullptr;
}

QString TableItem::text(QAccessible::Text t) const
{
    if (isNotice)
        return t == QAccessible::Name ? noticeText : QString();
    if (!IsCard())
        return t == QAccessible::Name ? table->PartName(part) : QString();
    const TableAccessible::Face face = table->FaceAt(part, slot);
    if (t == QAccessible::Name)
        return GameBoard::CardWords(CardSprite{{}, 0, 0, face.rank1, face.suit1});
    // The key that takes a card of the hand while it is held.
    const GameRecord& r = table->Board()->record;
    if (t == QAccessible::Description && part == TablePart::YourHand && r.playerHandSprites[slot].suit1 != kSuitEmpty)
        return QStringLiteral("Key %1").arg(slot + 1);
    return {};
}

QRect TableItem::rect() const
{
    if (isNotice)
        return table->rect();
    return table->ScreenRect(part, slot);
}

QAccessible::Role TableItem::role() const
{
    if (isNotice)
        return QAccessible::Notification;
    if (IsCard())
        return QAccessible::ListItem;
    return IsList(part) ? QAccessible::List : QAccessible::StaticText;
}

QAccessible::State TableItem::state() const
{
    QAccessible::State s;
    const QAccessible::State window = table->state();
    s.invisible = window.invisible;
    s.offscreen = window.offscreen;
    if (!IsCard() || isNotice)
        return s;
    const GameBoard& board = *table->Board();
    s.focusable = true;
    s.focused = table->focusChild() == this;
    // Chosen for the crib: a card of the hand while the two are chosen.
    const GameRecord& r = board.record;
    if (part == TablePart::YourHand && r.phase == kPhaseDiscard && r.playerHandSprites[slot].suit1 != kSuitEmpty) {
        s.checkable = true;
        s.checked = r.selected[slot] != 0;
    }
    return s;
}

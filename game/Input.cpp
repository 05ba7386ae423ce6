#include "game/GameBoard.h"

#include <QFocusEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPushButton>

void GameBoard::OnCommand(int id)
{
    switch (id) {
    case kCmdDeal: OnDeal(); break;
    case kCmdSendToCrib: OnSendToCrib(); break;
    case kCmdScorePlayerHand: ScorePlayerHand(); break;
    case kCmdScoreOpponentHand: ScoreOpponentHand(); break;
    case kCmdOk: OnOk(); break;
    case kCmdScoreCrib: ScoreCrib(); break;
    default: break;
    }
}

void GameBoard::mousePressEvent(QMouseEvent* event)
{
    ActOnPendingRelease();
    if (event->button() == Qt::LeftButton)
        OnLButtonDown(DevicePoint(event->position()));
    QWidget::mousePressEvent(event);
}

void GameBoard::OnLButtonDown(QPoint point)
{
    // Before the first paint there are no factors to divide by and no buttons.
    if (record.firstPaintPending)
        return;
    const int x = point.x() / record.scaleX;
    const int y = point.y() / record.scaleY;
    for (int p = 1; p <= 6; ++p)
        if (record.playerHandSprites[p - 1].rect.Contains(x, y))
            OnCardTap(p, record.playerHandSprites[p - 1]);
}

int GameBoard::HandPositionKey(int key)
{
    switch (key) {
    case Qt::Key_Up: return 1;
    case Qt::Key_Left: return 2;
    case Qt::Key_Right: return 3;
    case Qt::Key_Down: return 6;
    default: break;
    }
    // The digit keys pick hand positions directly.
    if (key >= Qt::Key_1 && key <= Qt::Key_6)
        return key - Qt::Key_1 + 1;
    return 0;
}

namespace {

// A window system may repeat a held key as a release and a press of the same
// time; a press this close after a release of its key is taken for a repeat.
constexpr quint64 kRepeatGap = 5;
// How long the release of Enter or Escape waits for such a press (ms).
constexpr int kRepeatWait = 40;

bool IsActionKey(int key)
{
    return key == Qt::Key_Return || key == Qt::Key_Enter || key == Qt::Key_Escape;
}

} // namespace

void GameBoard::keyPressEvent(QKeyEvent* event)
{
    const int key = event->key();
    if (HandPositionKey(key) == 0 && !IsActionKey(key)) {
        QWidget::keyPressEvent(event);
        return;
    }
    event->accept();
    if (event->isAutoRepeat() || keysDown.contains(key))
        return;
    // Events made without a time (0) cannot be told apart and always count.
    const quint64 time = event->timestamp();
    if (lastRelease.key == key && time != 0 && time >= lastRelease.time && time - lastRelease.time <= kRepeatGap) {
        // The key never went up: its release is undone.
        keysDown.insert(key, lastRelease.pressTime);
        pendingRelease.stop();
        lastRelease = {};
        return;
    }
    ActOnPendingRelease();
    keysDown.insert(key, time);
    OnKeyDown(key);
}

void GameBoard::keyReleaseEvent(QKeyEvent* event)
{
    const int key = event->key();
    // Only a press this window saw counts: not the one that closed a dialog.
    if (event->isAutoRepeat() || !keysDown.contains(key)) {
        QWidget::keyReleaseEvent(event);
        return;
    }
    event->accept();
    ActOnPendingRelease();
    lastRelease = {key, event->timestamp(), keysDown.take(key)};
    if (!IsActionKey(key))
        return;
    if (lastRelease.time == 0) {
        OnKeyUp(key);
    } else {
        pendingRelease.start(kRepeatWait, this);
    }
}

void GameBoard::timerEvent(QTimerEvent* event)
{
    if (event->timerId() == pendingRelease.timerId()) {
        ActOnPendingRelease();
    } else if (event->timerId() == pendingStatus.timerId()) {
        pendingStatus.stop();
        emit StatusChanged();
    } else {
        QWidget::timerEvent(event);
    }
}

void GameBoard::ActOnPendingRelease()
{
    if (!pendingRelease.isActive())
        return;
    pendingRelease.stop();
    OnKeyUp(lastRelease.key);
}

void GameBoard::focusOutEvent(QFocusEvent* event)
{
    // Keys held while the focus goes elsewhere are released there; a release
    // already seen still acts when its wait ends.
    keysDown.clear();
    QWidget::focusOutEvent(event);
}

void GameBoard::OnKeyDown(int key)
{
    if (record.firstPaintPending)
        return;
    if (const int p = HandPositionKey(key)) {
        OnCardTap(p, record.playerHandSprites[p - 1]);
        FocusCardByKey(p);
    }
}

void GameBoard::OnKeyUp(int key)
{
    if (key != Qt::Key_Return && key != Qt::Key_Enter && key != Qt::Key_Escape)
        return;
    // Enter and Escape press whichever action button is shown, the first in this order.
    for (int id : {kCmdDeal, kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk}) {
        if (IsButtonShown(id)) {
            OnCommand(id);
            return;
        }
    }
}

void GameBoard::OnCardTap(int position, CardSprite& sprite)
{
    GameRecord& r = record;
    if (r.gameOver)
        return;
    if (r.phase == kPhaseDiscard) {
        int& selected = r.selected[position - 1];
        // A third card cannot be chosen until one of the two is let go.
        if (SelectedCount() < 2 || selected) {
            selected = selected ? 0 : 1;
            sprite.highlighted = selected;
            Invalidate(sprite.rect);
            AnnounceTable(Turned::Choice, position);
            SetButtonShown(sendToCribButton, SelectedCount() == 2);
        }
    } else if (r.phase == kPhasePlay) {
        PlayerLaysCard(sprite);
    }
}

int GameBoard::SelectedCount() const
{
    int n = 0;
    for (int flag : record.selected)
        n += flag ? 1 : 0;
    return n;
}

QPushButton* GameBoard::ActionButton(int id) const
{
    switch (id) {
    case kCmdDeal: return dealButton;
    case kCmdSendToCrib: return sendToCribButton;
    case kCmdScorePlayerHand: return scorePlayerHandButton;
    case kCmdScoreOpponentHand: return scoreOpponentHandButton;
    case kCmdOk: return okButton;
    case kCmdScoreCrib: return scoreCribButton;
    default: return nullptr;
    }
}

bool GameBoard::IsButtonShown(int id) const
{
    // The button's own state, not isVisible(): the window may be off screen.
    const QPushButton* button = ActionButton(id);
    return button != nullptr && !button->isHidden();
}

void GameBoard::SetButtonShown(QPushButton* button, bool shown)
{
    if (button != nullptr) {
        if (shown && button->isHidden())
            AnnounceButton(button);
        button->setVisible(shown);
    }
    NoteStatusChange();
}

void GameBoard::ShowOk()
{
    SetButtonShown(okButton, true);
}

void GameBoard::ShowScoreOpponentHand()
{
    SetButtonShown(okButton, false);
    SetButtonShown(scorePlayerHandButton, false);
    SetButtonShown(scoreOpponentHandButton, true);
}

void GameBoard::ShowScorePlayerHand()
{
    SetButtonShown(okButton, false);
    SetButtonShown(scoreOpponentHandButton, false);
    SetButtonShown(scorePlayerHandButton, true);
}

void GameBoard::ShowScoreCrib()
{
    SetButtonShown(okButton, false);
    SetButtonShown(scoreOpponentHandButton, false);
    SetButtonShown(scorePlayerHandButton, false);
    SetButtonShown(scoreCribButton, true);
}

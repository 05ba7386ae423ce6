#pragma once

#include <QAccessibleWidget>
#include <QPointer>
#include <QPushButton>
#include <QStringList>

#include <array>
#include <vector>

class GameBoard;
class TableItem;

// The parts of the table a screen reader walks, in their order under the game
// window; the window's own buttons and log follow them, the notification last.
enum class TablePart : int {
    YourHand,
    YourLaid,
    Count,
    Starter,
    OpponentLaid,
    OpponentHand,
    Crib,
    Score,
};
constexpr int kTablePartCount = 8;

// The accessible view of the game window: the table's parts as children,
// answered from the record whenever asked, as the paint does. It is made only
// when an assistive technology asks for the window (the factory below).
class TableAccessible : public QAccessibleWidget {
public:
    explicit TableAccessible(GameBoard* board);
    ~TableAccessible() override;

    GameBoard* Board() const;

    int childCount() const override;
    QAccessibleInterface* child(int index) const override;
    int indexOfChild(const QAccessibleInterface* child) const override;
    QAccessibleInterface* focusChild() const override;
    QString text(QAccessible::Text t) const override;

    // The item of a part (slot -1) or of one card place in it.
    TableItem* Item(TablePart part, int slot = -1) const;
    // Whether the items exist: not before a client asks for them or the game
    // tells a listening client something.
    bool Built() const { return built; }

    // The card shown in a place of a part: suit1 kSuitEmpty when none.
    struct Face {
        int rank1 = 0;
        int suit1 = 0;
    };
    Face FaceAt(TablePart part, int slot) const;
    QString PartName(TablePart part) const;
    // A board rectangle on the screen.
    QRect ScreenRect(TablePart part, int slot) const;

    // Called by the game's hooks; all of it reaches the screen reader in Flush.
    void Queue(const QString& line);
    void QueueButton(QPushButton* button);
    void SetFocusTarget(TableItem* item);
    void ScheduleFlush();
    // Raises the events of what changed since the last flush, then the focus
    // a key gave, then the lines queued, as one announcement.
    void Flush();

private:
    // Makes the items and notes what the table shows, so that a client's first
    // look raises no events. Qt makes this interface for every window that
    // shows, listened to or not; the items wait for a client.
    void Build() const;
    TableItem* Keep(TableItem* item) const;

    mutable bool built = false;
    mutable std::vector<QAccessible::Id> ids;
    mutable std::array<TableItem*, kTablePartCount> parts{};
    mutable std::array<std::vector<TableItem*>, kTablePartCount> cards;
    mutable TableItem* notice = nullptr;
    TableItem* focusTarget = nullptr;
    bool focusPending = false;
    bool flushQueued = false;
    QStringList queued;
    QList<QPointer<QPushButton>> buttons;

    friend class TableItem;
};

// A part of the table, one card place of a part, or the notification through
// which announcements are said. It has no object of its own; what it shows is
// read from the record each time it is asked.
class TableItem : public QAccessibleInterface {
public:
    // slot -1: the part itself; part ignored for the notification.
    TableItem(TableAccessible* owner, TablePart itsPart, int itsSlot, bool notification = false);

    bool isValid() const override;
    QObject* object() const override { return nullptr; }
    QWindow* window() const override;
    QAccessibleInterface* parent() const override;
    QAccessibleInterface* child(int index) const override;
    int childCount() const override;
    int indexOfChild(const QAccessibleInterface* child) const override;
    QAccessibleInterface* childAt(int x, int y) const override;
    QString text(QAccessible::Text t) const override;
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override;
    QAccessible::Role role() const override;
    QAccessible::State state() const override;

    TablePart Part() const { return part; }
    int Slot() const { return slot; }
    bool IsCard() const { return slot >= 0; }
    // Whether a card place holds a card the tree lists.
    bool Shown() const;

    // What the screen reader was last told about this item.
    bool toldShown = false;
    bool toldChecked = false;
    QString toldName;
    QString noticeText;

private:
    std::vector<TableItem*> ShownCards() const;

    TableAccessible* table;
    TablePart part;
    int slot;
    bool isNotice;
};

// The factory installed by the application: the game window's interface.
QAccessibleInterface* TableAccessibleFactory(const QString& className, QObject* object);

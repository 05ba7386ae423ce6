#pragma once

#include "game/GameRecord.h"
#include "presentation/ImageHolder.h"
#include "scoring/ScoreReasons.h"

#include <QBasicTimer>
#include <QHash>
#include <QRect>
#include <QString>
#include <QWidget>

#include <functional>

class QListWidget;
class QPushButton;

// Command ids of the six action buttons.
enum ActionCommand : int {
    kCmdDeal = 1,
    kCmdSendToCrib = 3,
    kCmdScorePlayerHand = 4,
    kCmdScoreOpponentHand = 5,
    kCmdOk = 6,
    kCmdScoreCrib = 7,
};

// The game window. It holds the whole game record; every game operation is a
// member, defined in the folder of the subsystem it belongs to:
// game/ (deal, input, log, pegs), scoring/ (counting, show, pegging),
// play/ (the play and the computer), presentation/ (holes, layout, images,
// painting), settings/ (stored values, Options).
class GameBoard : public QWidget {
    Q_OBJECT

public:
    explicit GameBoard(QWidget* parent = nullptr);
    ~GameBoard() override;

    GameRecord record;

    // Where the deal draws its numbers: std::rand, seeded once at construction.
    // Tests put a scripted source here to stack the deck.
    std::function<int()> randomSource;

    // --- game/: dealing and the crib
    void OnDeal();
    void DealHand();
    void SortByRank(int first, int last);
    void OnSendToCrib();
    void NewGame();
    void SyncCardSprites();

    // --- game/: phases, action buttons and input
    void OnCommand(int id);
    void OnLButtonDown(QPoint point);
    void OnKeyDown(int key);
    void OnKeyUp(int key);
    void OnCardTap(int position, CardSprite& sprite);
    int SelectedCount() const;
    void ShowOk();
    void ShowScoreOpponentHand();
    void ShowScorePlayerHand();
    void ShowScoreCrib();
    // Whether an action button is shown; false before the buttons exist.
    bool IsButtonShown(int id) const;
    // The action button of a command id, or null before the first paint.
    QPushButton* ActionButton(int id) const;
    // Shows or hides one action button; nothing before the buttons exist.
    void SetButtonShown(QPushButton* button, bool shown);
    // The hand position (1..6) a key selects, or 0.
    static int HandPositionKey(int key);
    // Acts now on a release of Enter or Escape still waiting to prove it is
    // not a repeat; other input and commands come after it.
    void ActOnPendingRelease();

    // --- game/: message log
    void LogMessage(const QString& text);
    // The reasons of a score in a line of their own, when "Explain each score" is on.
    void LogReasons(const QList<ScoreItem>& reasons);
    QListWidget* MessageLog() const { return messageLog; }

    // --- game/: score track and pegs
    int PlayerScore() const { return record.playerFrontHole; }
    int OpponentScore() const { return record.opponentFrontHole; }
    void MovePlayerPegs(int points);
    void MoveOpponentPegs(int points);
    void SetPlayerBackHole(int hole);
    void SetPlayerFrontHole(int hole);
    void SetOpponentBackHole(int hole);
    void SetOpponentFrontHole(int hole);
    void UpdatePegRects(bool invalidate);
    void InvalidatePegRects();
    void RefreshCount();

    // --- scoring/
    int CountHand(const CardId cards[5]) const;
    // The reasons of the same count, under the same rule.
    QList<ScoreItem> HandReasons(const CardId cards[5]) const;
    void ScorePlayerHand();
    void ScoreOpponentHand();
    void ScoreCrib();
    // With "Explain each score" on, the reasons follow the announcement in a line of their own.
    void PegPoints(int side, int points, const QString& suffix, const QList<ScoreItem>& reasons = {});
    // Games a win adds to the tally: 1, 2 when the loser has 90 or less, 4 when 60 or less.
    static int32_t GamesForWin(int loserScore);

    // --- play/
    void StartPlay();
    void PlayerLaysCard(CardSprite& sprite);  // the play half of a card tap
    void PlayerPlaysCard(int rank1);
    void ComputerTurn();
    void ComputerPlaysCard(int rank1);
    bool PlayerCannotPlay() const;
    bool ComputerCannotPlay() const;
    // Starts a new count: the running count to 0, no cards in it, 0 shown.
    void ResetCount();
    void OnOk();
    void ChooseComputerDiscards();
    int ChooseComputerCard() const;  // hand position 1..4, or 0 for none
    static double DiscardValue(int rank1a, int rank1b);

    // --- presentation/
    void BuildHoleMap();
    void ResetTable();
    // A board rectangle in window coordinates, covering its device pixels.
    QRect ScaledRect(const Rect& r) const;
    // A window point in device pixels, which the factors divide.
    QPoint DevicePoint(QPointF point) const;
    // The message log's board rectangle.
    Rect LogRect() const;
    // The game window's size in device pixels for a scale factor; without the
    // band it ends at the log's border.
    QSize DeviceWindowSize(int scale, bool band = true) const;
    void Invalidate(const Rect& r);
    void LoadImages();
    void ReloadBoardBitmap();
    // The scale factors for a game window of this size, each at least 1.
    static int ScaleFactorX(int width);
    int ScaleFactorY(int height) const;

    BitmapInfo boardInfo;
    BitmapInfo cardInfo;
    BitmapInfo pegInfo;
    ImageHolder boardBitmap;
    ImageHolder suitFaceBitmaps[4];
    ImageHolder backBitmap;
    ImageHolder rankGlyphBitmap;
    ImageHolder playerPegBitmap;
    ImageHolder opponentPegBitmap;
    ImageHolder digitBitmap;

    // --- settings/
    void LoadSettings();
    void SaveSettings();
    void OnOptions();
    void ApplyBoardStyle(int style);
    // True while the store lacks values of this run that a save could not
    // write: loading then keeps them rather than going back to older ones.
    bool storeBehind = false;
    // The tally as this window last read it from the store or wrote it there;
    // a save adds what was won since to what the store then holds.
    int32_t storedFor = 0;
    int32_t storedAgainst = 0;

    // --- game/: views of the record in words
    // The board's tooltip: both scores and whose crib it is.
    QString BoardTip() const;
    // The status line: the tooltip and what the game waits for; at the game's
    // end the final score and what the tally gained.
    QString StatusLine() const;
    // After the first deal and before the game's end.
    bool GameInProgress() const;

signals:
    // Something the status line shows may have changed; sent once after a
    // burst of changes, when the event loop next runs.
    void StatusChanged();

public:

    // --- accessibility/: the table as a screen reader presents it. Each of
    // these returns at once while no assistive technology listens.
    // Says a line wherever the screen reader's focus is; the lines of one turn
    // of the event loop are said together, after the table's own events.
    void Announce(const QString& text);
    // What the table has just turned up, put into words and announced.
    enum class Turned { Deal, Choice, Starter, Laid, Hand, Crib };
    // which: the hand position (Choice) or the side (Laid, Hand).
    void AnnounceTable(Turned what, int which = 0);
    // A button that appears is what Enter presses next: said last, if it is
    // still shown at the end of the turn.
    void AnnounceButton(QPushButton* button);
    // The table's looks changed: its accessible tree follows once per turn of
    // the event loop, as the paint does.
    void AccessibleTableChanged();
    // The card of a hand position (1..6) that a key took gets the accessible focus.
    void FocusCardByKey(int position);
    // "Five of Hearts"; empty for a place that shows no face.
    static QString CardWords(const CardSprite& sprite);

protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void timerEvent(QTimerEvent* event) override;
    bool event(QEvent* event) override;

private:
    // Writes the four values, the tally merged with the store's, under its lock.
    bool WriteStore(class QSettings& settings);
    void PlaceCountRect();
    // Schedules StatusChanged once for everything changed until then.
    void NoteStatusChange();
    void MovePegs(int points, void (GameBoard::*setBack)(int), void (GameBoard::*setFront)(int),
                  const int32_t& frontHole);
    void FirstPaintSetup();
    void CreateActionButtons();
    void PaintCard(class QPainter& painter, const CardSprite& sprite);
    void PaintImage(class QPainter& painter, const QImage& image, QRect source, QPoint target);

    QPushButton* dealButton = nullptr;
    QPushButton* sendToCribButton = nullptr;
    QPushButton* scorePlayerHandButton = nullptr;
    QPushButton* scoreOpponentHandButton = nullptr;
    QPushButton* scoreCribButton = nullptr;
    QPushButton* okButton = nullptr;
    QListWidget* messageLog = nullptr;

    // Keys whose press this window saw, with the press's time.
    QHash<int, quint64> keysDown;
    struct KeyRelease {
        int key = 0;
        quint64 time = 0;
        quint64 pressTime = 0;
    };
    KeyRelease lastRelease;
    // Runs while the last release of Enter or Escape waits to act.
    QBasicTimer pendingRelease;
    QBasicTimer pendingStatus;
};

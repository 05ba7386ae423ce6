#include "settings/OptionsDialog.h"
#include "shell/AboutDialog.h"
#include "shell/MainFrame.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QApplication>
#include <QDialogButtonBox>
#include <QMenu>
#include <QMenuBar>
#include <QPointer>
#include <QPushButton>
#include <QTimer>

#include <algorithm>
#include <functional>
#include <memory>

namespace {

// A frame shown and active, as the user sees it, on a cleared store.
std::unique_ptr<CMainFrame> MakeFrame()
{
    ClearSettings();
    auto frame = std::make_unique<CMainFrame>();
    frame->show();
    if (!QTest::qWaitForWindowExposed(frame.get()))
        qWarning("frame not exposed");
    frame->activateWindow();
    if (!QTest::qWaitForWindowActive(frame.get()))
        qWarning("frame not active");
    frame->Board()->repaint();
    return frame;
}

QAction* ToolsAction(CMainFrame& frame, const QString& text)
{
    for (QAction* action : frame.ToolsMenu()->actions())
        if (action->text() == text)
            return action;
    return nullptr;
}

// Triggers a menu item; action works the modal dialog it opens. A dialog
// left open is rejected after a while so that a fault cannot hang the run.
template <class Dialog>
bool RunMenuDialog(QAction* item, std::function<void(Dialog&)> action)
{
    bool seen = false;
    QTimer::singleShot(0, item, [&seen, action] {
        auto* dialog = qobject_cast<Dialog*>(QApplication::activeModalWidget());
        if (!dialog)
            return;
        seen = true;
        QPointer<Dialog> guard(dialog);
        action(*dialog);
        QTimer::singleShot(2000, dialog, [guard] {
            if (guard)
                guard->reject();
        });
    });
    item->trigger();
    return seen;
}

// Plays a fresh game on to the phase with clicks and taps.
void ReachPhase(GameBoard& board, int phase)
{
    if (phase == kPhaseNoDeal)
        return;
    // Low cards and a king as starter: nobody comes near the end of a game.
    StackDeck(board, {Card(1, 1), Card(3, 2), Card(5, 3), Card(7, 4), Card(9, 1), Card(11, 2), Card(2, 3),
                      Card(4, 4), Card(6, 1), Card(8, 2), Card(10, 3), Card(12, 4), Card(13, 1)});
    ClickButton(board, kCmdDeal);
    if (phase == kPhaseGameOver) {
        // The user's points of a hand carry the game home.
        board.PegPoints(kSidePlayer, kGameHole, QStringLiteral(" for your hand"));
        return;
    }
    if (phase == kPhaseDiscard)
        return;
    TapHand(board, 1);
    TapHand(board, 6);
    ClickButton(board, kCmdSendToCrib);
    if (phase == kPhasePlay)
        return;

    for (int step = 0; step < 64 && board.record.phase == kPhasePlay; ++step) {
        if (board.IsButtonShown(kCmdOk)) {
            ClickButton(board, kCmdOk);
            continue;
        }
        int position = 0;
        for (int p = 2; p <= 5 && position == 0; ++p) {
            const CardSprite& card = board.record.playerHandSprites[p - 1];
            if (card.suit1 != kSuitEmpty && board.record.runningCount + Rank1Value(card.rank1) <= 31)
                position = p;
        }
        QVERIFY2(position != 0, "the play waits for a card the user cannot lay");
        TapHand(board, position);
    }
    QCOMPARE(board.record.phase, int(kPhasePlayOver));
    if (phase == kPhasePlayOver)
        return;

    ClickButton(board, board.IsButtonShown(kCmdScorePlayerHand) ? kCmdScorePlayerHand : kCmdScoreOpponentHand);
    QCOMPARE(board.record.phase, int(kPhaseHandCounted));
    if (phase == kPhaseHandCounted)
        return;
    ClickButton(board, board.IsButtonShown(kCmdScorePlayerHand) ? kCmdScorePlayerHand : kCmdScoreOpponentHand);
    ClickButton(board, kCmdScoreCrib);
    QCOMPARE(board.record.phase, int(kPhaseCribCounted));
}

bool TableIsEmpty(const GameRecord& r)
{
    auto empty = [](const CardSprite& s) { return s.suit1 == kSuitEmpty; };
    return std::all_of(std::begin(r.playerHandSprites), std::end(r.playerHandSprites), empty)
           && std::all_of(std::begin(r.opponentHandSprites), std::end(r.opponentHandSprites), empty)
           && std::all_of(std::begin(r.playerPileSprites), std::end(r.playerPileSprites), empty)
           && std::all_of(std::begin(r.opponentPileSprites), std::end(r.opponentPileSprites), empty)
           && empty(r.starterSprite);
}

// The program's own loop, run until something ends it; 7 after five seconds.
int RunProgramLoop()
{
    QTimer timeout;
    timeout.setSingleShot(true);
    QObject::connect(&timeout, &QTimer::timeout, [] { QCoreApplication::exit(7); });
    timeout.start(5000);
    return QCoreApplication::exec();
}

} // namespace

// The menu, the keys of the frame and where the keyboard goes after a dialog.
class MenuKeysTest : public QObject {
    Q_OBJECT

private slots:
    void menuItemsInOrder()
    {
        CMainFrame frame;
        const QList<QAction*> menus = frame.menuBar()->actions();
        QCOMPARE(menus.size(), 1);
        QCOMPARE(menus.first()->text(), QStringLiteral("Tools"));
        QStringList items;
        for (QAction* action : frame.ToolsMenu()->actions())
            items.append(action->text());
        QCOMPARE(items, (QStringList{QStringLiteral("About Vennick..."), QStringLiteral("Options..."),
                                     QStringLiteral("Exit")}));
    }

    void newGameFromEveryPhase_data()
    {
        QTest::addColumn<int>("phase");
        QTest::newRow("no deal") << int(kPhaseNoDeal);
        QTest::newRow("discarding") << int(kPhaseDiscard);
        QTest::newRow("the play") << int(kPhasePlay);
        QTest::newRow("play over") << int(kPhasePlayOver);
        QTest::newRow("a hand counted") << int(kPhaseHandCounted);
        QTest::newRow("crib counted") << int(kPhaseCribCounted);
        QTest::newRow("game over") << int(kPhaseGameOver);
    }

    void newGameFromEveryPhase()
    {
        QFETCH(int, phase);
        auto frame = MakeFrame();
        GameBoard& board = *frame->Board();
        ReachPhase(board, phase);
        if (QTest::currentTestFailed())
            return;
        QCOMPARE(board.record.phase, phase);

        QTest::keyClick(frame.get(), Qt::Key_N, Qt::ControlModifier);

        QCOMPARE(board.record.phase, int(kPhaseNoDeal));
        QCOMPARE(board.record.gameOver, 0);
        QCOMPARE(board.PlayerScore(), 0);
        QCOMPARE(board.OpponentScore(), 0);
        QCOMPARE(board.record.countVisible, 0);
        QVERIFY(TableIsEmpty(board.record));
        QCOMPARE(ShownButtons(board), QList<int>{kCmdDeal});
        const QStringList lines = LogLines(board);
        QCOMPARE(lines.size(), 3);
        // A game won counts in the tally the new game shows.
        QVERIFY(lines[0].endsWith(QStringLiteral(": ") + QString::number(board.record.gamesFor)));
        QCOMPARE(board.record.gamesFor > 0, phase == kPhaseGameOver);
        QCOMPARE(lines[2], QStringLiteral("Click Deal to start a new game."));
        // The first crib of the new game is the other side's.
        ClickButton(board, kCmdDeal);
        QCOMPARE(LogLines(board).last(), QStringLiteral("Your Crib."));
    }

    void otherAcceleratorsDoNothing_data()
    {
        QTest::addColumn<int>("key");
        QTest::newRow("Ctrl+O") << int(Qt::Key_O);
        QTest::newRow("Ctrl+S") << int(Qt::Key_S);
        QTest::newRow("Ctrl+Z") << int(Qt::Key_Z);
        QTest::newRow("Ctrl+X") << int(Qt::Key_X);
        QTest::newRow("Ctrl+C") << int(Qt::Key_C);
        QTest::newRow("Ctrl+V") << int(Qt::Key_V);
    }

    void otherAcceleratorsDoNothing()
    {
        QFETCH(int, key);
        auto frame = MakeFrame();
        GameBoard& board = *frame->Board();
        ReachPhase(board, kPhaseDiscard);
        TapHand(board, 2);
        const GameRecord before = board.record;
        const QStringList lines = LogLines(board);

        QTest::keyClick(frame.get(), static_cast<Qt::Key>(key), Qt::ControlModifier);
        QTest::keyClick(QApplication::focusWidget(), static_cast<Qt::Key>(key), Qt::ControlModifier);

        QVERIFY(!frame->isHidden());
        QVERIFY(!QApplication::activeModalWidget());
        QCOMPARE(board.record.phase, before.phase);
        QVERIFY(std::equal(std::begin(before.deal), std::end(before.deal), std::begin(board.record.deal)));
        QVERIFY(std::equal(std::begin(before.selected), std::end(before.selected), std::begin(board.record.selected)));
        QCOMPARE(LogLines(board), lines);
    }

    void ctrlQEndsTheProgram()
    {
        auto frame = MakeFrame();
        QTimer::singleShot(0, frame.get(), [&frame] { QTest::keyClick(frame.get(), Qt::Key_Q, Qt::ControlModifier); });
        QCOMPARE(RunProgramLoop(), 0);
    }

    void keyboardReturnsAfterDialogs_data()
    {
        QTest::addColumn<QString>("item");
        QTest::addColumn<bool>("confirm");
        QTest::newRow("About, OK") << QStringLiteral("About Vennick...") << true;
        QTest::newRow("About, Escape") << QStringLiteral("About Vennick...") << false;
        QTest::newRow("Options, OK") << QStringLiteral("Options...") << true;
        QTest::newRow("Options, Cancel") << QStringLiteral("Options...") << false;
    }

    void keyboardReturnsAfterDialogs()
    {
        QFETCH(QString, item);
        QFETCH(bool, confirm);
        auto frame = MakeFrame();
        GameBoard& board = *frame->Board();
        ReachPhase(board, kPhaseDiscard);
        QAction* action = ToolsAction(*frame, item);
        QVERIFY(action);

        bool seen = false;
        if (item.startsWith(QStringLiteral("About"))) {
            seen = RunMenuDialog<CAboutDlg>(action, [confirm](CAboutDlg& dialog) {
                if (confirm)
                    QTest::mouseClick(dialog.findChild<QPushButton*>(), Qt::LeftButton);
                else
                    QTest::keyClick(&dialog, Qt::Key_Escape);
            });
        } else {
            seen = RunMenuDialog<COptionsDlg>(action, [confirm](COptionsDlg& dialog) {
                const auto which = confirm ? QDialogButtonBox::Ok : QDialogButtonBox::Cancel;
                QTest::mouseClick(dialog.ButtonBox()->button(which), Qt::LeftButton);
            });
        }
        QVERIFY2(seen, "the menu item showed no dialog");
        QVERIFY(!QApplication::activeModalWidget());

        // The game window holds the frame's focus, so the next key reaches it
        // as soon as the frame is active again, which a window manager does
        // when a dialog closes; there is none offscreen, so it is done here.
        QCOMPARE(frame->focusWidget(), &board);
        if (QApplication::activeWindow() != frame.get()) {
            frame->activateWindow();
            QVERIFY(QTest::qWaitForWindowActive(frame.get()));
        }
        QCOMPARE(QApplication::focusWidget(), &board);
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_3);
        QCOMPARE(board.record.selected[2], 1);
    }
};

VENNICK_TEST(MenuKeysTest);
#include "MenuKeysTest.moc"

#include "settings/TempStore.h"
#include "shell/MainFrame.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QDialog>
#include <QDialogButtonBox>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>

#include <algorithm>
#include <memory>

namespace {

// A frame shown and active, as the user sees it, on a cleared store.
std::unique_ptr<CMainFrame> MakeFrame()
{
    ClearSettings();
    auto frame = std::make_unique<CMainFrame>();
    frame->show();
    frame->activateWindow();
    if (!QTest::qWaitForWindowActive(frame.get()))
        qWarning("frame not active");
    frame->Board()->repaint();
    return frame;
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
    if (phase == kPhaseGameOver)  // the user's hand carries the game home
        board.PegPoints(kSidePlayer, kGameHole, QStringLiteral(" for your hand"));
    if (phase == kPhaseDiscard || phase == kPhaseGameOver)
        return;
    TapHand(board, 1);
    TapHand(board, 6);
    ClickButton(board, kCmdSendToCrib);
    // The play: Ok after each announcement, else the first card that fits.
    for (int step = 0; step < 64 && phase != kPhasePlay && board.record.phase == kPhasePlay; ++step) {
        int position = board.IsButtonShown(kCmdOk) ? -1 : 0;
        for (int p = 2; p <= 5 && position == 0; ++p) {
            const CardSprite& card = board.record.playerHandSprites[p - 1];
            if (card.suit1 != kSuitEmpty && board.record.runningCount + Rank1Value(card.rank1) <= 31)
                position = p;
        }
        QVERIFY2(position != 0, "the play waits for a card the user cannot lay");
        if (position < 0)
            ClickButton(board, kCmdOk);
        else
            TapHand(board, position);
    }
    const auto scoreHand = [&board] {
        ClickButton(board, board.IsButtonShown(kCmdScorePlayerHand) ? kCmdScorePlayerHand : kCmdScoreOpponentHand);
    };
    if (phase == kPhaseHandCounted || phase == kPhaseCribCounted)
        scoreHand();
    if (phase == kPhaseCribCounted) {
        scoreHand();
        ClickButton(board, kCmdScoreCrib);
    }
}

bool TableIsEmpty(const GameRecord& r)
{
    const auto empty = [](const CardSprite& s) { return s.suit1 == kSuitEmpty; };
    const auto allEmpty = [&empty](const auto& sprites) { return std::all_of(std::begin(sprites), std::end(sprites), empty); };
    return allEmpty(r.playerHandSprites) && allEmpty(r.opponentHandSprites) && allEmpty(r.playerPileSprites)
           && allEmpty(r.opponentPileSprites) && empty(r.starterSprite);
}

} // namespace

// The menu, the keys of the frame and where the keyboard goes after a dialog.
class MenuKeysTest : public QObject {
    Q_OBJECT

private slots:
    void menuItemsInOrder()
    {
        CMainFrame frame;
        QCOMPARE(frame.menuBar()->actions().size(), 1);
        QStringList items;
        for (QAction* action : frame.ToolsMenu()->actions())
            items.append(action->text());
        QCOMPARE(items, (QStringList{"About Vennick...", "Options...", "Exit"}));
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
        QCOMPARE(board.record.phase, phase);

        QTest::keyClick(frame.get(), Qt::Key_N, Qt::ControlModifier);

        QCOMPARE(board.record.phase, int(kPhaseNoDeal));
        QCOMPARE(board.record.gameOver, 0);
        QCOMPARE(board.PlayerScore(), 0);
        QCOMPARE(board.OpponentScore(), 0);
        QCOMPARE(board.record.countVisible, 0);
        QVERIFY(TableIsEmpty(board.record));
        QCOMPARE(ShownButtons(board), QList<int>{kCmdDeal});
        // The game just won counts in the tally the new game shows.
        QCOMPARE(board.record.gamesFor > 0, phase == kPhaseGameOver);
        QVERIFY(LogLines(board).first().endsWith(QStringLiteral(": ") + QString::number(board.record.gamesFor)));
        // The first crib of the new game is the other side's.
        ClickButton(board, kCmdDeal);
        QCOMPARE(LogLines(board).last(), QStringLiteral("Your Crib."));
    }

    void ctrlQEndsTheProgram()
    {
        auto frame = MakeFrame();
        // The program's own loop; 7 should nothing end it within five seconds.
        QTimer::singleShot(0, frame.get(), [&frame] { QTest::keyClick(frame.get(), Qt::Key_Q, Qt::ControlModifier); });
        QTimer::singleShot(5000, frame.get(), [] { QCoreApplication::exit(7); });
        QCOMPARE(QCoreApplication::exec(), 0);
    }

    // After a dialog the keyboard reaches the game again, where other Ctrl
    // keys do nothing.
    void keysAfterADialog_data()
    {
        QTest::addColumn<int>("item");  // position in the Tools menu
        QTest::addColumn<bool>("confirm");
        QTest::newRow("About, OK") << 0 << true;
        QTest::newRow("About, Escape") << 0 << false;
        QTest::newRow("Options, OK") << 1 << true;
        QTest::newRow("Options, Cancel") << 1 << false;
    }

    void keysAfterADialog()
    {
        QFETCH(int, item);
        QFETCH(bool, confirm);
        auto frame = MakeFrame();
        GameBoard& board = *frame->Board();
        ReachPhase(board, kPhaseDiscard);
        TapHand(board, 2);
        const GameRecord before = board.record;
        const QStringList lines = LogLines(board);
        QAction* action = frame->ToolsMenu()->actions().at(item);
        QString shown;
        const bool seen = RunDialog<QDialog>([action] { action->trigger(); }, [&shown, confirm](QDialog& dialog) {
            shown = QString::fromLatin1(dialog.metaObject()->className());
            const auto* box = dialog.findChild<QDialogButtonBox*>();
            if (QPushButton* button = box->button(confirm ? QDialogButtonBox::Ok : QDialogButtonBox::Cancel))
                QTest::mouseClick(button, Qt::LeftButton);
            else  // the About box has no Cancel
                QTest::keyClick(&dialog, Qt::Key_Escape);
        });
        QVERIFY2(seen, "the menu item showed no dialog");
        QCOMPARE(shown, item == 0 ? "CAboutDlg" : "COptionsDlg");
        QVERIFY(!QApplication::activeModalWidget());

        // The game window holds the frame's focus, so the next key reaches it as
        // soon as the frame is active again, which a window manager does when a
        // dialog closes; there is none offscreen, so it is done here.
        QCOMPARE(frame->focusWidget(), &board);
        if (QApplication::activeWindow() != frame.get()) {
            frame->activateWindow();
            QVERIFY(QTest::qWaitForWindowActive(frame.get()));
        }
        QCOMPARE(QApplication::focusWidget(), &board);
        for (Qt::Key key : {Qt::Key_O, Qt::Key_S, Qt::Key_Z, Qt::Key_X, Qt::Key_C, Qt::Key_V})
            QTest::keyClick(&board, key, Qt::ControlModifier);
        QVERIFY(!frame->isHidden());
        QVERIFY(!QApplication::activeModalWidget());
        QCOMPARE(board.record.phase, before.phase);
        QVERIFY(std::equal(std::begin(before.deal), std::end(before.deal), std::begin(board.record.deal)));
        QCOMPARE(LogLines(board), lines);
        QTest::keyClick(&board, Qt::Key_3);
        QCOMPARE(board.SelectedCount(), 2);
        QCOMPARE(board.record.selected[2], 1);
    }
};

VENNICK_TEST(MenuKeysTest);
#include "MenuKeysTest.moc"

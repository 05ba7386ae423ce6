#include "settings/TempStore.h"
#include "shell/AboutDialog.h"
#include "shell/MainFrame.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QDialogButtonBox>
#include <QHelpEvent>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QToolTip>

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

QStringList Texts(const QList<QAction*>& actions)
{
    QStringList texts;
    for (const QAction* action : actions)
        texts.append(action->text() + action->shortcut().toString());
    return texts;
}

} // namespace

// The menu bar, the keys of the frame and the keys that close a dialog.
class MenuKeysTest : public QObject {
    Q_OBJECT

private slots:
    void menuBar()
    {
        auto frame = MakeFrame();
        QMenuBar* bar = frame->menuBar();
        QCOMPARE(Texts(bar->actions() + frame->ToolsMenu()->actions()),
                 (QStringList{"NewCtrl+N", "Tools", "About Vennick...", "Options...", "ExitCtrl+Q"}));
        const QPoint onNew = bar->actionGeometry(frame->NewAction()).center();
        QHelpEvent help(QEvent::ToolTip, onNew, bar->mapToGlobal(onNew));
        QCoreApplication::sendEvent(bar, &help);
        QVERIFY(QToolTip::isVisible() && QToolTip::text().contains(QStringLiteral("Ctrl+N")));
    }

    // New, by its key or on the menu bar, ends the game; a game won counts.
    void newGame_data()
    {
        QTest::addColumn<bool>("byKey");  // else on the menu bar, the game won
        QTest::newRow("Ctrl+N while discarding") << true;
        QTest::newRow("menu bar, game won") << false;
    }

    void newGame()
    {
        QFETCH(bool, byKey);
        auto frame = MakeFrame();
        GameBoard& board = *frame->Board();
        ClickButton(board, kCmdDeal);
        TapHand(board, 1);
        if (byKey) {
            QTest::keyClick(frame.get(), Qt::Key_N, Qt::ControlModifier);
        } else {
            board.PegPoints(kSidePlayer, kGameHole, QStringLiteral(" for your hand"));
            QTest::mouseClick(frame->menuBar(), Qt::LeftButton, {}, frame->menuBar()->actionGeometry(frame->NewAction()).center());
        }
        QCOMPARE(board.record.phase, int(kPhaseNoDeal));
        QCOMPARE(LogLines(board).first(), board.record.ownerName + (byKey ? ": 0" : ": 4"));  // far ahead: 4
    }

    void ctrlQEndsTheProgram()
    {
        auto frame = MakeFrame();
        // The program's own loop; 7 should nothing end it within five seconds.
        QTimer::singleShot(0, frame.get(), [&frame] { QTest::keyClick(frame.get(), Qt::Key_Q, Qt::ControlModifier); });
        QTimer::singleShot(5000, frame.get(), [] { QCoreApplication::exit(7); });
        QCOMPARE(QCoreApplication::exec(), 0);
    }

    // The key that closes a dialog, and a key held while one opens, never act
    // on the game; after it the keyboard reaches the game again.
    void keysAroundDialogs_data()
    {
        QTest::addColumn<int>("item");  // position in the Tools menu
        QTest::addColumn<int>("key");   // closes the dialog; 0: the mouse does, Enter being held
        for (int item : {0, 1})
            for (int key : {int(Qt::Key_Return), int(Qt::Key_Escape), 0})
                QTest::addRow("%s %x", item ? "Options" : "About", key) << item << key;
    }

    void keysAroundDialogs()
    {
        QFETCH(int, item);
        QFETCH(int, key);
        auto frame = MakeFrame();
        GameBoard& board = *frame->Board();
        ClickButton(board, kCmdDeal);
        TapHand(board, 1);
        TapHand(board, 2);  // "Send To Crib" is shown: a leaked key would press it
        const QStringList lines = LogLines(board);
        if (key == 0)
            QTest::keyPress(&board, Qt::Key_Return);
        QStringList texts;
        QVERIFY(RunDialog<QDialog>([&] { frame->ToolsMenu()->actions().at(item)->trigger(); }, [&](QDialog& dialog) {
            texts = {dialog.windowTitle()};
            for (const QLabel* label : dialog.findChildren<QLabel*>())
                texts.append(label->pixmap().isNull() ? label->text() : QString::number(label->pixmap().width()));
            if (key != 0)
                QTest::keyPress(&dialog, static_cast<Qt::Key>(key));
            else
                QTest::mouseClick(dialog.findChild<QDialogButtonBox*>()->buttons().first(), Qt::LeftButton);
        }));
        QTest::keyRelease(&board, key ? static_cast<Qt::Key>(key) : Qt::Key_Return);
        QTest::qWait(60);
        if (item == 0)
            QCOMPARE(texts, (QStringList{"About Vennick", "32", "Vennick"}));
        QCOMPARE(board.record.phase, int(kPhaseDiscard));
        QCOMPARE(LogLines(board), lines);
        frame->activateWindow();  // what a window manager does as a dialog closes
        QVERIFY(QTest::qWaitForWindowActive(frame.get()));
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_2);
        QCOMPARE(board.SelectedCount(), 1);
    }
};

VENNICK_TEST(MenuKeysTest);
#include "MenuKeysTest.moc"

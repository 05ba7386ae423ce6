#include "support/TestBoard.h"
#include "support/TestMain.h"

#include "shell/GameApp.h"
#include "shell/MainFrame.h"

#include <QListWidget>
#include <QScreen>

// The program's start-up, as main runs it: the icon, the frame, the first paint, the focus.
class StartupTest : public QObject {
    Q_OBJECT

private slots:
    void startsAsMainDoes()
    {
        auto* app = qobject_cast<CGameApp*>(QCoreApplication::instance());
        // The window icon in every size the build draws, for task bars and switchers.
        QCOMPARE(QApplication::windowIcon().availableSizes(), (QList<QSize>{{16, 16}, {32, 32}, {256, 256}}));
        QVERIFY(app && app->InitInstance());
        CMainFrame* frame = app->MainFrame();
        QVERIFY(frame && QTest::qWaitForWindowActive(frame));
        GameBoard* board = frame->Board();
        QTRY_COMPARE(board->record.firstPaintPending, 0);
        QCOMPARE(ShownButtons(*board), QList<int>{kCmdDeal});
        QCOMPARE(LogLines(*board).mid(2), QStringList{"Click Deal to start a new game."});  // the third of three
        QTRY_COMPARE(QApplication::focusWidget(), static_cast<QWidget*>(board));
        // The game window fills the frame at its chosen factor, the log inside it, the frame inside the screen.
        QCOMPARE(frame->windowTitle(), QStringLiteral("Vennick"));
        QCOMPARE(frame->centralWidget(), board);
        QCOMPARE(board->size(), frame->GameWindowSize(board->record.scaleY, 1.0));
        QCOMPARE(frame->minimumSize(), frame->maximumSize());
        QVERIFY(board->rect().contains(board->MessageLog()->geometry()));
        QVERIFY(frame->screen()->availableGeometry().contains(frame->frameGeometry()));
        frame->hide();  // out of the way of the suites that run after this one
    }
};

VENNICK_TEST(StartupTest);
#include "StartupTest.moc"

#include "shell/MainFrame.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QMenu>
#include <QMenuBar>
#include <QTimer>

// The frame: its scale, its single child, the focus and the New and Exit commands.
class FrameTest : public QObject {
    Q_OBJECT

private slots:
    void chooseScale_data()
    {
        QTest::addColumn<QSize>("available");
        QTest::addColumn<int>("scale");
        const QSize chrome(16, 70);
        QTest::newRow("1280 x 1024") << QSize(1280, 1024) << 3;
        QTest::newRow("1920 x 1080 is limited by height") << QSize(1920, 1080) << 3;
        QTest::newRow("2560 x 1400") << QSize(2560, 1400) << 4;
        QTest::newRow("exactly scale 2") << QSize(480, 588) + chrome << 2;
        QTest::newRow("one pixel short of scale 2") << QSize(480, 587) + chrome << 1;
        QTest::newRow("tiny screen still 1") << QSize(200, 150) << 1;
    }

    void chooseScale()
    {
        QFETCH(QSize, available);
        QFETCH(int, scale);
        QCOMPARE(CMainFrame::ChooseScale(available, QSize(16, 70)), scale);
    }

    void frameHoldsTheGameWindow()
    {
        ClearSettings();
        CMainFrame frame;
        frame.show();
        QVERIFY(QTest::qWaitForWindowExposed(&frame));
        QCOMPARE(frame.windowTitle(), QStringLiteral("Vennick"));
        QCOMPARE(frame.centralWidget(), frame.Board());
        QCOMPARE(frame.ToolsMenu()->title(), QStringLiteral("Tools"));

        // The game window's size gives whole factors that the first paint takes.
        frame.Board()->repaint();
        const int s = frame.Board()->record.scaleX;
        QVERIFY(s >= 1);
        QCOMPARE(frame.Board()->record.scaleY, s);
        QCOMPARE(frame.Board()->size(), CMainFrame::GameWindowSize(s));
        // Not resizable.
        QCOMPARE(frame.minimumSize(), frame.maximumSize());

        // The frame hands the keyboard focus to the game window.
        frame.activateWindow();
        frame.setFocus();
        QVERIFY(QTest::qWaitForWindowActive(&frame));
        QCOMPARE(QApplication::focusWidget(), frame.Board());

        // Ctrl+N reaches the game window from the frame.
        frame.Board()->OnDeal();
        QCOMPARE(frame.Board()->record.phase, int(kPhaseDiscard));
        QTest::keyClick(&frame, Qt::Key_N, Qt::ControlModifier);
        QCOMPARE(frame.Board()->record.phase, int(kPhaseNoDeal));
    }

    void exitEndsTheLoopWithZero()
    {
        ClearSettings();
        CMainFrame frame;
        QAction* exitAction = nullptr;
        for (QAction* action : frame.ToolsMenu()->actions())
            if (action->text() == QStringLiteral("Exit"))
                exitAction = action;
        QVERIFY(exitAction);
        // The application's own loop, as the game runs it.
        QTimer::singleShot(0, exitAction, &QAction::trigger);
        QTimer::singleShot(5000, [] { QCoreApplication::exit(7); });
        QCOMPARE(QCoreApplication::exec(), 0);
    }
};

VENNICK_TEST(FrameTest);
#include "FrameTest.moc"

#include "game/GameBoard.h"
#include "shell/MainFrame.h"
#include "support/TestMain.h"

// The frame's size: the largest whole factor in device pixels that fits the screen.
class FrameTest : public QObject {
    Q_OBJECT

private slots:
    void chooseScale_data()
    {
        QTest::addColumn<QSize>("available");
        QTest::addColumn<double>("ratio");
        QTest::addColumn<int>("scale");
        QTest::newRow("800 x 600") << QSize(800, 600) << 1.0 << 1;
        QTest::newRow("1920 x 1080 is limited by height") << QSize(1920, 1080) << 1.0 << 3;
        QTest::newRow("exactly scale 2") << QSize(496, 658) << 1.0 << 2;
        QTest::newRow("one pixel short of scale 2") << QSize(496, 657) << 1.0 << 1;
        QTest::newRow("1024 x 768 at 150%") << QSize(683, 512) << 1.5 << 2;
        QTest::newRow("1920 x 1080 at 125%") << QSize(1536, 864) << 1.25 << 3;
        QTest::newRow("tiny screen still 1") << QSize(200, 150) << 1.0 << 1;
    }

    // The game window asked for yields exactly the factor, and fits with the
    // chrome unless the factor is the least.
    void chooseScale()
    {
        QFETCH(QSize, available);
        QFETCH(double, ratio);
        QFETCH(int, scale);
        const QSize chrome(16, 70);
        CMainFrame frame;
        QCOMPARE(frame.ChooseScale(available, chrome, ratio), scale);
        const QSize window = frame.GameWindowSize(scale, ratio);
        const QSize device = (QSizeF(window) * ratio).toSize();
        QCOMPARE(QSize(GameBoard::ScaleFactorX(device.width()), GameBoard::ScaleFactorY(device.height())), QSize(scale, scale));
        QVERIFY(scale == 1 || available.expandedTo(window + chrome) == available);
    }
};

VENNICK_TEST(FrameTest);
#include "FrameTest.moc"

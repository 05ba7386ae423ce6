#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QKeyEvent>
#include <QListWidget>
#include <QMouseEvent>
#include <QPushButton>
#include <QScrollBar>

namespace {

void SendKey(GameBoard& board, QEvent::Type type, int key, bool autoRepeat)
{
    QKeyEvent event(type, key, Qt::NoModifier, QString(), autoRepeat);
    QCoreApplication::sendEvent(&board, &event);
}

QList<int> Selected(const GameBoard& board)
{
    QList<int> positions;
    for (int i = 0; i < 6; ++i) {
        if (board.record.selected[i])
            positions.append(i + 1);
        // A chosen card is drawn inverted, and only a chosen one.
        if (board.record.playerHandSprites[i].highlighted != board.record.selected[i])
            positions.append(-1);
    }
    return positions;
}

} // namespace

// Taps, keys and the action buttons in the discard.
class InputTest : public QObject {
    Q_OBJECT

private slots:
    void tapsSelectAtMostTwoCards()
    {
        auto board = MakeBoard(2);
        ClickButton(*board, kCmdDeal);
        TapHand(*board, 1);
        QCOMPARE(Selected(*board), QList<int>{1});
        QVERIFY(!board->IsButtonShown(kCmdSendToCrib));
        TapHand(*board, 3);
        QCOMPARE(Selected(*board), (QList<int>{1, 3}));
        QCOMPARE(ShownButtons(*board), QList<int>{kCmdSendToCrib});
        // A third card is refused.
        TapHand(*board, 5);
        QCOMPARE(Selected(*board), (QList<int>{1, 3}));
        // Tapping a chosen card lets it go and hides the button again.
        TapHand(*board, 3);
        QCOMPARE(Selected(*board), QList<int>{1});
        QVERIFY(ShownButtons(*board).isEmpty());
        TapHand(*board, 6);
        QCOMPARE(Selected(*board), (QList<int>{1, 6}));
        QCOMPARE(ShownButtons(*board), QList<int>{kCmdSendToCrib});
    }

    void tapsElsewhereChangeNothing()
    {
        auto board = MakeBoard(3);
        ClickButton(*board, kCmdDeal);
        const GameRecord before = board->record;
        const Rect& computerCard = board->record.opponentHandSprites[2].rect;
        TapBoard(*board, computerCard.left + 3, computerCard.top + 3);
        TapBoard(*board, 40, 100);                                   // the board
        TapBoard(*board, 95, 120);                                   // the pack
        const Rect& hand = board->record.playerHandSprites[0].rect;  // just above the first card
        TapBoard(*board, hand.left + 2, hand.top - 1);
        QCOMPARE(Selected(*board), QList<int>{});
        QVERIFY(std::equal(std::begin(before.deal), std::end(before.deal), std::begin(board->record.deal)));
    }

    void tapsUseTheScaleFactors()
    {
        // At scale 3 the window pixel divided by 3 must land in the card's board rectangle.
        auto board = MakeBoard(3);
        ClickButton(*board, kCmdDeal);
        const Rect& r = board->record.playerHandSprites[4].rect;
        QTest::mouseClick(board.get(), Qt::LeftButton, Qt::NoModifier, QPoint(r.right * 3 - 1, r.bottom * 3 - 1));
        QCOMPARE(Selected(*board), QList<int>{5});
        QTest::mouseClick(board.get(), Qt::LeftButton, Qt::NoModifier, QPoint(r.right * 3, r.top * 3));
        QCOMPARE(Selected(*board), QList<int>{5});  // right edge is outside
        // Only the left button taps.
        QTest::mouseClick(board.get(), Qt::RightButton, Qt::NoModifier, QPoint(r.left * 3 + 4, r.top * 3 + 4));
        QCOMPARE(Selected(*board), QList<int>{5});
    }

    void keysSelectHandPositions_data()
    {
        QTest::addColumn<int>("key");
        QTest::addColumn<int>("position");
        QTest::newRow("Up") << int(Qt::Key_Up) << 1;
        QTest::newRow("Left") << int(Qt::Key_Left) << 2;
        QTest::newRow("Right") << int(Qt::Key_Right) << 3;
        QTest::newRow("Down") << int(Qt::Key_Down) << 6;
        for (int d = 1; d <= 6; ++d)
            QTest::addRow("digit %d", d) << int(Qt::Key_1 + d - 1) << d;
    }

    void keysSelectHandPositions()
    {
        QFETCH(int, key);
        QFETCH(int, position);
        auto board = MakeBoard();
        ReleaseEnter(*board);
        PressKey(*board, key);
        QCOMPARE(Selected(*board), QList<int>{position});
        PressKey(*board, key);
        QCOMPARE(Selected(*board), QList<int>{});
    }

    void otherKeysDoNothing()
    {
        auto board = MakeBoard();
        ReleaseEnter(*board);
        for (int key : {Qt::Key_7, Qt::Key_0, Qt::Key_A, Qt::Key_Space, Qt::Key_Tab, Qt::Key_F1})
            PressKey(*board, key);
        QCOMPARE(Selected(*board), QList<int>{});
        QCOMPARE(board->record.phase, int(kPhaseDiscard));
    }

    void enterAndEscapeActOnReleaseOnce_data()
    {
        QTest::addColumn<int>("key");
        QTest::newRow("Return") << int(Qt::Key_Return);
        QTest::newRow("keypad Enter") << int(Qt::Key_Enter);
        QTest::newRow("Escape") << int(Qt::Key_Escape);
    }

    void enterAndEscapeActOnReleaseOnce()
    {
        QFETCH(int, key);
        auto board = MakeBoard();
        SendKey(*board, QEvent::KeyPress, key, false);
        QCOMPARE(board->record.phase, int(kPhaseNoDeal));
        // Held down: the repeats do nothing, not even their releases.
        for (int i = 0; i < 5; ++i) {
            SendKey(*board, QEvent::KeyRelease, key, true);
            SendKey(*board, QEvent::KeyPress, key, true);
        }
        QCOMPARE(board->record.phase, int(kPhaseNoDeal));
        QCOMPARE(LogLines(*board).size(), 3);
        SendKey(*board, QEvent::KeyRelease, key, false);
        QCOMPARE(board->record.phase, int(kPhaseDiscard));
        QCOMPARE(LogLines(*board).size(), 5);  // one deal only

        // With no button shown the key does nothing; with "Send To Crib" it sends.
        SendKey(*board, QEvent::KeyRelease, key, false);
        QCOMPARE(board->record.phase, int(kPhaseDiscard));
        PressKey(*board, Qt::Key_1);
        PressKey(*board, Qt::Key_2);
        SendKey(*board, QEvent::KeyRelease, key, false);
        QVERIFY(board->record.phase != kPhaseDiscard);
    }

    void heldCardKeyActsOnce()
    {
        auto board = MakeBoard();
        ReleaseEnter(*board);
        SendKey(*board, QEvent::KeyPress, Qt::Key_3, false);
        SendKey(*board, QEvent::KeyPress, Qt::Key_3, true);
        SendKey(*board, QEvent::KeyPress, Qt::Key_3, true);
        SendKey(*board, QEvent::KeyRelease, Qt::Key_3, false);
        QCOMPARE(Selected(*board), QList<int>{3});
    }

    void controlsNeverTakeTheFocus()
    {
        auto board = MakeBoard();
        for (int id : {kCmdDeal, kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk})
            QCOMPARE(board->ActionButton(id)->focusPolicy(), Qt::NoFocus);
        QCOMPARE(board->MessageLog()->focusPolicy(), Qt::NoFocus);
        board->activateWindow();
        board->setFocus();
        ClickButton(*board, kCmdDeal);
        QTest::mouseClick(board->MessageLog()->viewport(), Qt::LeftButton);
        QVERIFY(board->hasFocus());
    }

    void inputBeforeTheFirstPaintIsIgnored()
    {
        ClearSettings();
        GameBoard board;  // never shown: no factors, no buttons yet
        QCOMPARE(board.record.scaleX, 0);
        QMouseEvent press(QEvent::MouseButtonPress, QPointF(100, 170), QPointF(100, 170), Qt::LeftButton,
                          Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(&board, &press);
        SendKey(board, QEvent::KeyPress, Qt::Key_1, false);
        SendKey(board, QEvent::KeyRelease, Qt::Key_Return, false);
        board.NewGame();
        QCOMPARE(board.record.phase, int(kPhaseNoDeal));
        QVERIFY(board.ActionButton(kCmdDeal) == nullptr);
    }

    void tooSmallAWindowStillWorks()
    {
        ClearSettings();
        GameBoard board;
        board.setFixedSize(200, 150);
        board.show();
        QVERIFY(QTest::qWaitForWindowExposed(&board));
        board.repaint();
        QCOMPARE(board.record.scaleX, 1);
        QCOMPARE(board.record.scaleY, 1);
        ReleaseEnter(board);
        TapHand(board, 2);
        QCOMPARE(board.record.selected[1], 1);
    }
};

// The message log keeps every line in order and shows the newest.
class MessageLogTest : public QObject {
    Q_OBJECT

private slots:
    void keepsAllLinesAndShowsTheLast()
    {
        auto board = MakeBoard();
        for (int i = 0; i < 200; ++i)
            board->LogMessage(QStringLiteral("line %1").arg(i));
        board->LogMessage(QString());
        QCoreApplication::processEvents();
        const QStringList lines = LogLines(*board);
        QCOMPARE(lines.size(), 3 + 201);
        QCOMPARE(lines.at(3), QStringLiteral("line 0"));
        QCOMPARE(lines.at(202), QStringLiteral("line 199"));
        QCOMPARE(lines.last(), QString());
        QListWidget* log = board->MessageLog();
        QVERIFY(log->selectedItems().isEmpty());
        QCOMPARE(log->verticalScrollBar()->value(), log->verticalScrollBar()->maximum());
        QVERIFY(log->verticalScrollBar()->maximum() > 0);
        // A click on a line selects nothing.
        QTest::mouseClick(log->viewport(), Qt::LeftButton, Qt::NoModifier, QPoint(10, 5));
        QVERIFY(log->selectedItems().isEmpty());

        board->NewGame();
        QCOMPARE(LogLines(*board).size(), 3);
    }
};

VENNICK_TEST(InputTest);
VENNICK_TEST(MessageLogTest);
#include "InputTest.moc"

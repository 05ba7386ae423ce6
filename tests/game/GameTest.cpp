#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QKeyEvent>

namespace {

// A key event as the window system delivers it, with its time in ms.
void SendKey(GameBoard& board, QEvent::Type type, int key, quint64 time, bool autoRepeat = false)
{
    QKeyEvent event(type, key, Qt::NoModifier, QString(), autoRepeat);
    event.setTimestamp(time);
    QCoreApplication::sendEvent(&board, &event);
}

// The chosen positions; -1 where a card's inversion disagrees with its choice.
QList<int> Selected(const GameBoard& board)
{
    QList<int> positions;
    for (int i = 0; i < 6; ++i)
        if (board.record.selected[i] || board.record.playerHandSprites[i].highlighted != board.record.selected[i])
            positions.append(board.record.playerHandSprites[i].highlighted == board.record.selected[i] ? i + 1 : -1);
    return positions;
}

} // namespace

// The deal and the user's input: taps and keys.
class GameTest : public QObject {
    Q_OBJECT

private slots:
    // The deal and Send To Crib as the user sees them: the six dealt in rank
    // order (equal ranks as drawn), the two sent moved to the crib's places 1 and
    // 6, the four kept sorted again, every place showing its own card.
    void dealAndSend_data()
    {
        QTest::addColumn<QList<int>>("chosen");  // places tapped before Send To Crib
        QTest::addColumn<QString>("expected");   // the user's six in order | what places 1..6 and the starter show
        // Drawn 7H KH 2S 7S KC AC; the starter is the five of diamonds.
        QTest::newRow("dealt") << QList<int>{} << "AC 2S 7H 7S KH KC | AC 2S 7H 7S KH KC ##";
        QTest::newRow("2 and 4 sent") << QList<int>{2, 4} << "2S AC 7H KC KH 7S | -- AC 7H KC KH -- 5D";
        QTest::newRow("5 to place 1") << QList<int>{5, 6} << "KH AC 2S 7H 7S KC | -- AC 2S 7H 7S -- 5D";
        QTest::newRow("5 to place 6, its king shown") << QList<int>{1, 5} << "AC 2S 7H 7S KC KH | -- 2S 7H 7S KC -- 5D";
    }

    void dealAndSend()
    {
        QFETCH(QList<int>, chosen);
        QFETCH(QString, expected);
        auto board = MakeBoard();
        StackDeck(*board, {Card(7, 3), Card(13, 3), Card(2, 1), Card(7, 1), Card(13, 4), Card(1, 4), Card(3, 2),
                           Card(4, 2), Card(6, 2), Card(8, 2), Card(9, 2), Card(10, 2), Card(5, 2)});
        // Enter's release waits to act, yet deals before the taps that follow
        // it, and once only: acting again, it would send the two chosen.
        SendKey(*board, QEvent::KeyPress, Qt::Key_Return, 100);
        SendKey(*board, QEvent::KeyRelease, Qt::Key_Return, 200);
        for (int p : chosen)
            TapHand(*board, p);
        QTest::qWait(60);
        QCOMPARE(LogLines(*board).mid(3, 2), (QStringList{"Shuffling...", "Opponent's Crib."}));
        const Rect& third = board->record.playerHandSprites[2].rect;  // only the left button taps
        QTest::mouseClick(board.get(), Qt::RightButton, {}, QPoint(third.left + 5, third.top + 5));
        if (!chosen.isEmpty())
            ClickButton(*board, kCmdSendToCrib);
        const GameRecord& r = board->record;
        QStringList dealt;
        for (int i = 0; i < 6; ++i)
            dealt.append(CardName(r.deal[i]));
        QCOMPARE(dealt.join(' ') + " | " + ShownCards(r.playerHandSprites) + ' ' + ShownCards({&r.starterSprite, 1}),
                 expected);
    }

    // Each key picks its place; held down, it acts once, however its repeats
    // come: flagged, or as a plain release and press at the same moment. Enter
    // and Escape act on the release. Pressed again 20 ms after its release, a
    // key is a new press.
    void keys_data()
    {
        QTest::addColumn<int>("key");
        QTest::addColumn<bool>("flagged");
        QTest::addColumn<int>("position");  // the place it picks, 0 none; -1 it presses Deal
        const std::pair<int, int> rows[] = {{Qt::Key_Up, 1}, {Qt::Key_Left, 2}, {Qt::Key_Right, 3}, {Qt::Key_Down, 6},
                                            {Qt::Key_0, 0}, {Qt::Key_4, 4}, {Qt::Key_6, 6}, {Qt::Key_7, 0},
                                            {Qt::Key_Return, -1}, {Qt::Key_Escape, -1}, {Qt::Key_Enter, -1}};
        for (auto [key, position] : rows)
            for (bool flagged : {true, false})
                QTest::addRow("key %x, %s", key, flagged ? "flagged" : "plain") << key << flagged << position;
    }

    void keys()
    {
        QFETCH(int, key);
        QFETCH(bool, flagged);
        QFETCH(int, position);
        auto board = MakeBoard();
        if (position >= 0)
            PressKey(*board, Qt::Key_Return);
        SendKey(*board, QEvent::KeyPress, key, 1000);
        for (quint64 t = 1600; t < 3500; t += 33) {
            SendKey(*board, QEvent::KeyRelease, key, t, flagged);
            SendKey(*board, QEvent::KeyPress, key, flagged ? t : t + 5, flagged);  // at most 5 ms apart: a repeat
        }
        QTest::qWait(60);  // longer than a release waits
        QCOMPARE(Selected(*board), position > 0 ? QList<int>{position} : QList<int>{});
        QCOMPARE(board->record.phase, position >= 0 ? int(kPhaseDiscard) : int(kPhaseNoDeal));
        SendKey(*board, QEvent::KeyRelease, key, 3500);
        QTRY_COMPARE(board->record.phase, int(kPhaseDiscard));
        SendKey(*board, QEvent::KeyPress, key, 3520);
        SendKey(*board, QEvent::KeyRelease, key, 3600);
        QTest::qWait(60);
        QCOMPARE(Selected(*board), QList<int>{});
        QCOMPARE(LogLines(*board).size(), 5);  // one deal only
    }

    // Before the first paint, input does nothing.
    void inputBeforeFirstPaint()
    {
        GameBoard unpainted;  // never shown: no factors, no buttons yet
        QTest::mouseClick(&unpainted, Qt::LeftButton, Qt::NoModifier, QPoint(100, 170));
        PressKey(unpainted, Qt::Key_1);
        PressKey(unpainted, Qt::Key_Return);
        QCOMPARE(unpainted.record.phase, int(kPhaseNoDeal));
    }
};

VENNICK_TEST(GameTest);
#include "GameTest.moc"

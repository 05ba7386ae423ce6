#include "support/TestBoard.h"

#include <QListWidget>
#include <QPushButton>
#include <QSettings>
#include <QtTest>

#include <memory>
#include <vector>

void ClearSettings()
{
    QSettings settings(QStringLiteral("Quorvan"), QStringLiteral("Vennick"));
    settings.clear();
    settings.sync();
}

std::unique_ptr<GameBoard> MakeBoard(int scale, bool keepSettings)
{
    if (!keepSettings)
        ClearSettings();
    auto board = std::make_unique<GameBoard>();
    board->setFixedSize(240 * scale, 320 * scale - 52);
    board->show();
    if (!QTest::qWaitForWindowExposed(board.get()))
        qWarning("game window not exposed");
    // The first paint does the set-up; make sure it has happened.
    board->repaint();
    QCoreApplication::processEvents();
    return board;
}

void StackDeck(GameBoard& board, std::initializer_list<CardId> cards)
{
    auto queue = std::make_shared<std::vector<CardId>>(cards);
    auto next = std::make_shared<size_t>(0);
    board.randomSource = [queue, next]() {
        if (*next < queue->size())
            return static_cast<int>((*queue)[(*next)++]);
        return std::rand();
    };
}

void TapBoard(GameBoard& board, int x, int y)
{
    const int sx = board.record.scaleX > 0 ? board.record.scaleX : 1;
    const int sy = board.record.scaleY > 0 ? board.record.scaleY : 1;
    QTest::mouseClick(&board, Qt::LeftButton, Qt::NoModifier, QPoint(x * sx + sx / 2, y * sy + sy / 2));
}

void TapHand(GameBoard& board, int position)
{
    const Rect& r = board.record.playerHandSprites[position - 1].rect;
    TapBoard(board, (r.left + r.right) / 2, (r.top + r.bottom) / 2);
}

void ClickButton(GameBoard& board, int id)
{
    QPushButton* button = board.ActionButton(id);
    QVERIFY2(button != nullptr, "no such button");
    QVERIFY2(!button->isHidden(), "button is hidden");
    QTest::mouseClick(button, Qt::LeftButton);
}

void PressKey(GameBoard& board, int key)
{
    QTest::keyClick(&board, static_cast<Qt::Key>(key));
}

void ReleaseEnter(GameBoard& board)
{
    QTest::keyClick(&board, Qt::Key_Return);
}

QList<int> ShownButtons(const GameBoard& board)
{
    QList<int> ids;
    for (int id : {kCmdDeal, kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk})
        if (board.IsButtonShown(id))
            ids.append(id);
    return ids;
}

QStringList LogLines(const GameBoard& board)
{
    QStringList lines;
    if (QListWidget* log = board.MessageLog())
        for (int i = 0; i < log->count(); ++i)
            lines.append(log->item(i)->text());
    return lines;
}

CardId CardNamed(const QString& name)
{
    const auto rank1 = QStringLiteral("A23456789TJQK").indexOf(name.left(1)) + 1;
    const auto suit1 = QStringLiteral("SDHC").indexOf(name.mid(1)) + 1;
    if (name.size() != 2 || rank1 == 0 || suit1 == 0)
        qFatal("no such card: %s", qPrintable(name));
    return Card(static_cast<int>(rank1), static_cast<int>(suit1));
}

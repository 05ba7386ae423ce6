#include "support/TestBoard.h"

#include <QListWidget>
#include <QPushButton>
#include <QSettings>

#include <memory>
#include <vector>

void ClearSettings()
{
    QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).clear();  // written as it goes
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
    board->repaint();  // the first paint does the set-up; make sure it has happened
    QCoreApplication::processEvents();
    return board;
}

void StackDeck(GameBoard& board, std::initializer_list<CardId> cards)
{
    // Shared, so that copies of the source draw from one queue.
    auto queue = std::make_shared<std::vector<CardId>>(cards);
    board.randomSource = [queue, next = std::make_shared<size_t>(0)]() {
        return *next < queue->size() ? static_cast<int>((*queue)[(*next)++]) : std::rand();
    };
}

void TapBoard(GameBoard& board, int x, int y)
{
    const int sx = std::max(board.record.scaleX, 1), sy = std::max(board.record.scaleY, 1);
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
    QVERIFY2(button != nullptr && !button->isHidden(), "no such button shown");
    QTest::mouseClick(button, Qt::LeftButton);
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
    for (int i = 0; board.MessageLog() && i < board.MessageLog()->count(); ++i)
        lines.append(board.MessageLog()->item(i)->text());
    return lines;
}

namespace {
const QString kRanks = QStringLiteral("A23456789TJQK");
const QString kSuits = QStringLiteral("SDHC");
} // namespace

CardId CardNamed(const QString& name)
{
    const auto rank1 = kRanks.indexOf(name.left(1)) + 1;
    const auto suit1 = kSuits.indexOf(name.mid(1)) + 1;
    if (name.size() != 2 || rank1 == 0 || suit1 == 0)
        qFatal("no such card: %s", qPrintable(name));
    return Card(static_cast<int>(rank1), static_cast<int>(suit1));
}

QString CardName(CardId card) { return kRanks.mid(CardRank(card), 1) + kSuits.mid(CardSuit(card), 1); }

QString ShownCards(std::span<const CardSprite> places)
{
    QStringList names;
    for (const CardSprite& s : places)
        names.append(s.suit1 == kSuitEmpty ? "--" : s.suit1 == kSuitBack || s.faceDown ? "##"
                                                   : CardName(Card(s.rank1, s.suit1)));
    return names.join(' ');
}

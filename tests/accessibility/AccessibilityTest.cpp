#include "accessibility/TableAccessible.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QAccessible>
#include <QtGui/private/qguiapplication_p.h>
#include <qpa/qplatformaccessibility.h>
#include <qpa/qplatformintegration.h>

namespace {

// On the offscreen platform nothing listens; this is how a screen reader's
// arrival switches Qt's accessibility on.
void SetListening(bool on)
{
    QGuiApplicationPrivate::platformIntegration()->accessibility()->setActive(on);
}

// The events the table raised, as "kind name"; the owner's name (the
// account's) is written "Owner".
QStringList seen;
QString owner;

void Record(QAccessibleEvent* event)
{
    QAccessibleInterface* item = event->accessibleInterface();
    // Qt's own widgets raise theirs themselves; the table's items have no object.
    if (item == nullptr || (event->object() != nullptr && event->type() != QAccessible::Focus))
        return;
    QString name = item->text(QAccessible::Name).replace(owner, QStringLiteral("Owner"));
    // A card is named with its part, which the screen reader reads it in; an
    // emptied place by its part alone.
    if (item->role() == QAccessible::ListItem)
        name = item->parent()->text(QAccessible::Name) + (name.isEmpty() ? QString() : '/' + name);
    switch (event->type()) {
    case QAccessible::Focus: seen.append("focus " + name); break;
    case QAccessible::ObjectCreated: seen.append("created " + name); break;
    case QAccessible::ObjectDestroyed: seen.append("destroyed " + name); break;
    case QAccessible::StateChanged: seen.append((item->state().checked ? "checked " : "unchecked ") + name); break;
    case QAccessible::ObjectShow: seen.append("say " + name); break;
    case QAccessible::NameChanged:
        if (item->role() != QAccessible::Notification)
            seen.append("name " + name);
        break;
    default: break;
    }
}

// One deal: the user's 4C 5H 5D 6C JS KH, the computer's AS 2D 7S 8H 9C QD
// (it throws AS 2D to its crib), the starter 3H. The user sends 4C and KH
// and leads 5H 5D 6C JS by keys 2 to 5; the computer answers QD, 7S, 9C and
// takes a go and a last card with 8H.
std::unique_ptr<GameBoard> DealtBoard()
{
    auto board = MakeBoard();
    owner = board->record.ownerName;
    StackDeck(*board, {CardNamed("5H"), CardNamed("5D"), CardNamed("JS"), CardNamed("4C"), CardNamed("6C"),
                       CardNamed("KH"), CardNamed("AS"), CardNamed("2D"), CardNamed("7S"), CardNamed("8H"),
                       CardNamed("9C"), CardNamed("QD"), CardNamed("3H")});
    return board;
}

// Keys by name ("ret", "1".."6"), "tap2" a tap on place 2, "blur" the focus
// taken away, "focus" given back; each step one turn of the event loop, so
// that the table's events of that turn are raised.
void Play(GameBoard& board, const QString& steps, bool perTurn = true)
{
    for (const QString& step : steps.split(' ', Qt::SkipEmptyParts)) {
        if (step == "ret")
            PressKey(board, Qt::Key_Return);
        else if (step.startsWith("tap"))
            TapHand(board, step.mid(3).toInt());
        else if (step == "blur")
            board.clearFocus();
        else if (step == "focus")
            board.setFocus();
        else
            PressKey(board, Qt::Key_0 + step.toInt());
        if (perTurn)
            QCoreApplication::processEvents();
    }
    QCoreApplication::processEvents();
}

// The table's parts with their cards ("[x]" chosen, "[ ]" choosable), as a
// client walks them; a child whose way back to its parent is broken shows as "?".
QString Tree(GameBoard& board)
{
    QAccessibleInterface* table = QAccessible::queryAccessibleInterface(&board);
    QStringList parts;
    for (int i = 0; i < 8; ++i) {
        QAccessibleInterface* part = table->child(i);
        QStringList cards;
        for (int c = 0; c < part->childCount(); ++c) {
            QAccessibleInterface* card = part->child(c);
            const QAccessible::State s = card->state();
            const bool linked = card->parent() == part && part->indexOfChild(card) == c;
            cards.append(QString(linked ? "" : "?") + (s.checkable ? (s.checked ? "[x] " : "[ ] ") : "")
                         + card->text(QAccessible::Name));
        }
        const bool linked = part->parent() == table && table->indexOfChild(part) == i;
        parts.append(QString(linked ? "" : "?") + part->text(QAccessible::Name).replace(owner, "Owner")
                     + (cards.isEmpty() ? QString() : " = " + cards.join(", ")));
    }
    return parts.join(" | ");
}

} // namespace

// The table as a screen reader meets it: the tree in each phase of one deal,
// the events of choosing and laying, what is announced, and nothing at all
// while no assistive technology listens.
class AccessibilityTest : public QObject {
    Q_OBJECT

private slots:
    void initTestCase() { QAccessible::installUpdateHandler(Record); }
    void init()
    {
        SetListening(true);
        seen.clear();
    }

    // Without a client the table builds nothing (Qt itself makes the
    // window's interface as it shows), and the same game gives the same log
    // and the same picture with a listener as without.
    void nothingWithoutAListener()
    {
        const QString deal = "ret 1 6 ret 2 3 4 5 ret ret ret ret";
        QStringList logs;
        QList<QImage> pictures;
        for (bool listening : {false, true}) {
            SetListening(listening);
            auto board = DealtBoard();
            Play(*board, deal);
            const auto* table = dynamic_cast<TableAccessible*>(QAccessible::queryAccessibleInterface(board.get()));
            QVERIFY(table != nullptr);
            QCOMPARE(table->Built(), listening);
            logs.append(LogLines(*board).join('\n'));
            pictures.append(board->grab().toImage());
        }
        QCOMPARE(logs[1], logs[0]);
        QVERIFY(pictures[1] == pictures[0]);
    }

    // The window's interface, its parts' roles, Qt's own children with their
    // names, the notification last, and a card found by its place on screen.
    void structure()
    {
        auto board = DealtBoard();
        Play(*board, "ret");
        QAccessibleInterface* table = QAccessible::queryAccessibleInterface(board.get());
        QStringList roles;
        for (int i = 0; i < table->childCount(); ++i) {
            roles.append(QString::number(table->child(i)->role(), 16) + ' ' + table->child(i)->text(QAccessible::Name));
            QCOMPARE(table->indexOfChild(table->child(i)), i);  // a client's way back from each child
        }
        QCOMPARE(table->text(QAccessible::Name) + ' ' + QString::number(table->role(), 16), QString("Card table 10"));
        QCOMPARE(roles.mid(0, 3), (QStringList{"21 Your hand", "21 Cards you laid", "29 Count: none"}));
        QCOMPARE(roles.mid(8), (QStringList{"2b Deal", "2b Send To Crib", "2b Score Player's Hand",
                                            "2b Score Opponent's Hand", "2b Score Crib", "2b Ok", "21 Messages",
                                            "86 Shuffling... Opponent's Crib. Your hand, keys 1 to 6: Four of Clubs, "
                                            "Five of Hearts, Five of Diamonds, Six of Clubs, Jack of Spades, King of Hearts."}));
        QAccessibleInterface* hand = table->child(0);
        QCOMPARE(hand->child(2)->role(), QAccessible::ListItem);
        QCOMPARE(hand->child(2)->text(QAccessible::Description), QString("Key 3"));
        QCOMPARE(table->childAt(hand->child(2)->rect().center().x(), hand->child(2)->rect().center().y()), hand);
        QCOMPARE(hand->childAt(hand->child(2)->rect().center().x(), hand->child(2)->rect().center().y()), hand->child(2));
    }

    void treeThroughADeal_data()
    {
        QTest::addColumn<QString>("steps");
        QTest::addColumn<QString>("expected");
        const QString play = "ret 1 6 ret 2 3 4 5";
        QTest::newRow("before the deal") << ""
            << "Your hand | Cards you laid | Count: none | Starter: none | Cards the opponent laid | Opponent's hand "
               "| Crib: none | Owner 0 · Opponent 0 · Opponent's crib";
        QTest::newRow("dealt: six to choose from, the computer's two in the crib") << "ret"
            << "Your hand = [ ] Four of Clubs, [ ] Five of Hearts, [ ] Five of Diamonds, [ ] Six of Clubs, [ ] Jack of "
               "Spades, [ ] King of Hearts | Cards you laid | Count: none | Starter: face down | Cards the opponent laid "
               "| Opponent's hand: 4 cards face down | Opponent's crib: 2 cards face down | Owner 0 · Opponent 0 · Opponent's crib";
        QTest::newRow("sent: the starter turned, the count shown") << "ret 1 6 ret"
            << "Your hand = Five of Hearts, Five of Diamonds, Six of Clubs, Jack of Spades | Cards you laid | Count: 0 "
               "| Starter: Three of Hearts | Cards the opponent laid | Opponent's hand: 4 cards face down "
               "| Opponent's crib: 4 cards face down | Owner 0 · Opponent 0 · Opponent's crib";
        QTest::newRow("the play: cards leave the hands for the rows; a go starts the count again") << "ret 1 6 ret 2 3"
            << "Your hand = Six of Clubs, Jack of Spades | Cards you laid = Five of Hearts, Five of Diamonds | Count: 0 "
               "| Starter: Three of Hearts | Cards the opponent laid = Queen of Diamonds, Seven of Spades "
               "| Opponent's hand: 2 cards face down | Opponent's crib: 4 cards face down | Owner 0 · Opponent 3 · Opponent's crib";
        QTest::newRow("the show: both hands turned up") << play + " ret"
            << "Your hand = Five of Hearts, Five of Diamonds, Six of Clubs, Jack of Spades | Cards you laid = Five of "
               "Hearts, Five of Diamonds, Six of Clubs, Jack of Spades | Count: none | Starter: Three of Hearts | Cards the "
               "opponent laid = Queen of Diamonds, Seven of Spades, Nine of Clubs, Eight of Hearts | Opponent's hand = "
               "Queen of Diamonds, Seven of Spades, Eight of Hearts, Nine of Clubs | Opponent's crib: 4 cards face down "
               "| Owner 1 · Opponent 6 · Opponent's crib";
        QTest::newRow("the crib face up, out of the rows") << play + " ret ret ret ret"
            << "Your hand = Five of Hearts, Five of Diamonds, Six of Clubs, Jack of Spades | Cards you laid | Count: none "
               "| Starter: Three of Hearts | Cards the opponent laid | Opponent's hand = Queen of Diamonds, Seven of Spades, "
               "Eight of Hearts, Nine of Clubs | Opponent's crib = Four of Clubs, King of Hearts, Ace of Spades, Two of "
               "Diamonds | Owner 7 · Opponent 19 · Opponent's crib";
    }

    void treeThroughADeal()
    {
        QFETCH(QString, steps);
        QFETCH(QString, expected);
        auto board = DealtBoard();
        Play(*board, steps);
        QCOMPARE(Tree(*board), expected);
    }

    void events_data()
    {
        QTest::addColumn<QString>("before");
        QTest::addColumn<QString>("steps");
        QTest::addColumn<QStringList>("expected");
        QTest::newRow("chosen by key: the card's state, its focus, then said")
            << "ret" << "1"
            << QStringList{"checked Your hand/Four of Clubs", "focus Your hand/Four of Clubs",
                           "say Four of Clubs chosen for the crib."};
        QTest::newRow("let go by key") << "ret 1" << "1"
            << QStringList{"unchecked Your hand/Four of Clubs", "focus Your hand/Four of Clubs", "say Four of Clubs let go."};
        QTest::newRow("a third card refused: only the focus moves") << "ret 1 6" << "2"
            << QStringList{"focus Your hand/Five of Hearts"};
        QTest::newRow("chosen by a tap: no focus taken; the button that appears said last") << "ret 1" << "tap6"
            << QStringList{"checked Your hand/King of Hearts", "say King of Hearts chosen for the crib. Send To Crib button."};
        QTest::newRow("laid by key: moved to the row, the computer's reply, then the focus")
            << "ret 1 6 ret" << "2"
            << QStringList{"destroyed Your hand", "created Cards you laid/Five of Hearts", "name Count: 15",
                           "created Cards the opponent laid/Queen of Diamonds", "name Opponent's hand: 3 cards face down",
                           "name Owner 0 · Opponent 2 · Opponent's crib", "focus Cards you laid/Five of Hearts",
                           "say You lay Five of Hearts, count 5. Opponent lays Queen of Diamonds, count 15. Opponent pegs 2."};
        // The window's own focus comes as the turn's work is done; the card's
        // comes after it, or a screen reader would end on the window.
        QTest::newRow("the window's focus before the card's") << "ret blur" << "2 focus"
            << QStringList{"focus Card table", "checked Your hand/Five of Hearts", "focus Your hand/Five of Hearts",
                           "say Five of Hearts chosen for the crib."};
    }

    void events()
    {
        QFETCH(QString, before);
        QFETCH(QString, steps);
        QFETCH(QStringList, expected);
        auto board = DealtBoard();
        board->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(board.get()));
        Play(*board, before);
        seen.clear();
        Play(*board, steps, false);
        QCOMPARE(seen, expected);
    }

    // A card laid by key whose turn ends the play keeps the focus in its row,
    // though the show lists it in the hand again.
    void focusOnTheCardThatEndsThePlay()
    {
        auto board = DealtBoard();
        Play(*board, "ret 1 6 ret 2 5 4 ret 3");
        QCOMPARE(board->record.phase, int(kPhasePlayOver));
        QCOMPARE(seen.filter(QRegularExpression("^focus ")).last(), QString("focus Cards you laid/Five of Diamonds"));
    }

    // Every turn of one deal played by keys, as it is said: the start, the
    // deal, each card chosen, the starter, each card laid with the count, the
    // log's lines, the hands and the crib turned up, and the buttons.
    void announcementsOfADeal()
    {
        auto board = DealtBoard();
        Play(*board, "ret 1 6 ret 2 3 4 5 ret ret ret ret");
        QStringList said = seen.filter(QRegularExpression("^say "));
        QCOMPARE(said.join('\n').replace(owner, "Owner"), QStringList({
            "say Owner: 0. Opponent: 0. Click Deal to start a new game. Deal button.",
            "say Shuffling... Opponent's Crib. Your hand, keys 1 to 6: Four of Clubs, Five of Hearts, Five of Diamonds, "
            "Six of Clubs, Jack of Spades, King of Hearts.",
            "say Four of Clubs chosen for the crib.",
            "say King of Hearts chosen for the crib. Send To Crib button.",
            "say Your hand, keys 2 to 5: Five of Hearts, Five of Diamonds, Six of Clubs, Jack of Spades. Starter: Three of Hearts.",
            "say You lay Five of Hearts, count 5. Opponent lays Queen of Diamonds, count 15. Opponent pegs 2.",
            "say You lay Five of Diamonds, count 20. Opponent lays Seven of Spades, count 27. Opponent pegs 1 for a go.",
            "say You lay Six of Clubs, count 6. Opponent lays Nine of Clubs, count 15. Opponent pegs 2.",
            "say You lay Jack of Spades, count 25. You peg 1 for a go. Ok button.",
            "say Opponent lays Eight of Hearts, count 8. Opponent pegs 1 for a go. Score Player's Hand button.",
            "say Your hand: Five of Hearts, Five of Diamonds, Six of Clubs, Jack of Spades. You peg 6 for your hand. "
            "Score Opponent's Hand button.",
            "say Opponent's hand: Queen of Diamonds, Seven of Spades, Eight of Hearts, Nine of Clubs. Opponent pegs 5 for "
            "his hand. Score Crib button.",
            "say Opponent's crib: Four of Clubs, King of Hearts, Ace of Spades, Two of Diamonds. Opponent pegs 8 for the "
            "crib. Deal button.",
        }).join('\n'));
        // What the notification says is its name, there to be read again.
        QAccessibleInterface* table = QAccessible::queryAccessibleInterface(board.get());
        QCOMPARE("say " + table->child(table->childCount() - 1)->text(QAccessible::Name), seen.filter("say ").last());
    }
};

VENNICK_TEST(AccessibilityTest);
#include "AccessibilityTest.moc"

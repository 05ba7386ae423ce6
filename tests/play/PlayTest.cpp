#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QtTest>

// Deals played through the window: each row stacks the table, plays a script
// of taps, keys and button presses, and compares what the user then sees: the
// log since the deal, both pairs of pegs, the count and the button shown.
class PlayTest : public QObject {
    Q_OBJECT

private slots:
    void deal_data();
    void deal();
};

void PlayTest::deal_data()
{
    // The user's four kept (in rank order) and two thrown, the computer's
    // four kept (in its order) and two thrown, the starter.
    QTest::addColumn<QString>("cards");
    QTest::addColumn<bool>("userDeals");
    // A card: a tap on it; kXX: its digit key; ok: a click on the one button
    // shown; ret: Enter; all: every hand place tapped and keyed, then Enter;
    // you=N, opp=N: pegs moved on N holes.
    QTest::addColumn<QString>("script");
    // Log lines / pegs (back-front, the user's first) / count / button.
    QTest::addColumn<QString>("expected");

    const QString runsTo31 = "2S 8D TH QC AD 4D KS KD 6H 5S 9D KC 5H";  // the computer deals
    const QString lastCardGo = "AS AH 6D QH AD 3D 4S 2S 2C 4H 7D QD 9C";  // the user deals
    const QString repeatedGo = "AS 2S 7D KH 3H 4H QD JC TS 9H 5C 6C 8C";  // the computer deals
    const QString go = "Opponent says: 'Go' / ";
    const QString won = "You won. / Please click New to play again.";

    // The play.
    QTest::newRow("user's 31; no card while Ok shows; the computer leads after it; no double go")
        << "2S 4S 8S QS 9H TH 7D KD 7H 7C 3C 6C 5D" << false << "2S 4S 8S QS ok QS"
        << "You peg 2. / Opponent pegs 1 for a go. | 0-2 0-1 | 0 | 4";
    QTest::newRow("computer's 31 laid two cards at once; the user leads; user's go")
        << runsTo31 << false << "2S 8D TH QC" << "Opponent pegs 2. / You peg 1 for a go. | 0-1 0-2 | 0 | 4";
    QTest::newRow("go repeated until the user pegs it, by keyboard")
        << repeatedGo << false << "kKH k7D kAS k2S ret"
        << go + go + "You peg 1 for a go. / Opponent pegs 1 for a go. | 0-1 0-1 | 0 | 4";
    QTest::newRow("computer's last card takes its point unannounced")
        << "AS AD 2H 3C 9S TS 3D 7S 5H 7H KD QD 6C" << false << "AS AD 2H 3C" << "Opponent pegs 2. | 122-0 0-3 | 0 | 4";
    QTest::newRow("after the computer's go the user leads")
        << "AC 7C TD JD 2H 3H 8H JS QS TS 4D 5D 6C" << false << "AC 7C TD JD ok"
        << "Opponent pegs 1 for a go. / Opponent pegs 2. / You peg 1 for a go. / Opponent pegs 1 for a go. | 0-1 3-4 | 0 | 4";
    QTest::newRow("computer waits for Ok after scoring while the user is stuck")
        << "8S 9S TS KS AC 3C 5D 2D 2H 2C 6H 7H 4D" << false << "8S 9S ok TS KS"
        << "Opponent pegs 2. / Opponent pegs 6. / " + go + "You peg 1 for a go. | 0-1 2-9 | 0 | 4";
    QTest::newRow("a card past 31 is refused")
        << "4C 5C 7C TC AH 2H QD KD QH TH 3S 6S 8S" << false << "7C TC 5C 4C" << go + "You peg 2. | 0-2 122-0 | 0 | 6";
    QTest::newRow("user deals: the computer leads; the user's last card ends the play")
        << lastCardGo << true << "AS AH 6D QH" << "You peg 1 for a go. | 0-1 122-0 | 0 | 5";
    QTest::newRow("His Heels for the user; the computer leads after Ok")
        << "AS AH 6D QH AD 3D 4S 2S 2C 4H 7D QD JD" << true << "ok" << "You peg 2 for His Heels. | 0-2 122-0 | 4 | 0";
    QTest::newRow("His Heels for the computer; the user leads")
        << "2S 8D TH QC AD 4D KS KD 6H 5S 9D KC JH" << false << "2S" << "Opponent pegs 2 for His Heels. | 122-0 0-2 | 12 | 0";
    // The show: the non-dealer's hand, the dealer's, then the crib.
    QTest::newRow("show after the computer's deal")
        << runsTo31 << false << "2S 8D TH QC ok ok ok"
        << "Opponent pegs 2. / You peg 1 for a go. / You peg 6 for your hand. / Opponent pegs 12 for his hand. / "
           "Opponent pegs 6 for the crib. | 1-7 14-20 | 0 | 1";
    // Four of a suit with a starter of another: a flush in a hand, none in the crib.
    QTest::newRow("show after the user's deal, by keyboard")
        << lastCardGo << true << "AS AH 6D QH ret ret ret"
        << "You peg 1 for a go. / Opponent pegs 12 for his hand. / You peg 4 for your hand. / You peg 0 for the crib. "
           "| 1-5 0-12 | 0 | 1";
    // A win ends the deal where it stands: no button, and nothing moves.
    QTest::newRow("a go point wins on the last card")
        << lastCardGo << true << "you=120 AS AH 6D QH all" << "You peg 1 for a go. / " + won + " | 120-121 122-0 | 0 | 0";
    QTest::newRow("a go point wins with the computer's cards in hand")
        << repeatedGo << false << "you=120 KH 7D AS 2S all"
        << go + go + "You peg 1 for a go. / " + won + " | 120-121 122-0 | 0 | 0";
    QTest::newRow("user wins on the first count")
        << runsTo31 << false << "you=115 2S 8D TH QC ok all"
        << "Opponent pegs 2. / You peg 1 for a go. / You peg 6 for your hand. / " + won + " | 116-121 0-2 | 0 | 0";
    QTest::newRow("computer wins on the first count")
        << lastCardGo << true << "opp=110 AS AH 6D QH ok all"
        << "You peg 1 for a go. / Opponent pegs 12 for his hand. / You lost. / Please click New to play again. "
           "| 0-1 110-121 | 0 | 0";
}

void PlayTest::deal()
{
    QFETCH(QString, cards);
    QFETCH(bool, userDeals);
    QFETCH(QString, script);
    QFETCH(QString, expected);
    auto board = MakeBoard();
    GameBoard& b = *board;
    GameRecord& r = b.record;
    // The deal's own lines, "Shuffling..." and whose crib, are left out.
    const qsizetype mark = LogLines(b).size() + 2;

    // Deal, then put these cards in place of those drawn, overruling the
    // computer's own discard, and send the user's two to the crib.
    r.playerCrib = userDeals ? 0 : 1;  // every deal passes the crib over
    ClickButton(b, kCmdDeal);
    const QStringList names = cards.split(' ');
    const int places[13] = {1, 2, 3, 4, 0, 5, 7, 8, 9, 10, 6, 11, 12};
    for (int i = 0; i < 13; ++i)
        r.deal[places[i]] = CardNamed(names.value(i));
    for (int i = 0; i < 6; ++i)
        r.playerHandSprites[i].suit1 = CardSuit(r.deal[i]) + 1;
    for (int i = 1; i <= 4; ++i)
        r.opponentHandSprites[i].suit1 = CardSuit(r.deal[6 + i]) + 1;
    b.SyncCardSprites();
    TapHand(b, 1);
    TapHand(b, 6);
    ClickButton(b, kCmdSendToCrib);

    for (const QString& step : script.split(' ', Qt::SkipEmptyParts)) {
        const int n = step.mid(4).toInt();
        if (step == "ok" || step == "ret" || step == "all" || step.contains('=')) {
            for (int p = 1; step == "all" && p <= 6; ++p) {
                TapHand(b, p);
                PressKey(b, Qt::Key_0 + p);
            }
            step == "ok" ? ClickButton(b, ShownButtons(b).value(0)) : step.startsWith("you=") ? b.MovePlayerPegs(n)
                : step.startsWith("opp=") ? b.MoveOpponentPegs(n) : ReleaseEnter(b);
            continue;
        }
        const int place = static_cast<int>(std::find(r.deal + 1, r.deal + 5, CardNamed(step.right(2))) - r.deal) + 1;
        step.startsWith('k') ? PressKey(b, Qt::Key_0 + place) : TapHand(b, place);
    }
    const QString pegs = QStringLiteral("%1-%2 %3-%4").arg(r.playerBackHole).arg(r.playerFrontHole)
                             .arg(r.opponentBackHole).arg(r.opponentFrontHole);
    QCOMPARE(QStringList({LogLines(b).mid(mark).join(" / "), pegs, QString::number(r.runningCount),
                          QString::number(ShownButtons(b).value(0))}).join(" | "), expected);
}

VENNICK_TEST(PlayTest);
#include "PlayTest.moc"

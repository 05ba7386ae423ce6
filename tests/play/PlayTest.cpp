#include "play/PlayReasons.h"
#include "play/PlaySequence.h"
#include "play/ReferencePlay.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QtTest>

#include <cstdlib>

// The play and the show: deals played through the window, the computer's two
// decisions on hands laid out to show its rules, and the play scorer and its
// reasons against the plain reference.
class PlayTest : public QObject {
    Q_OBJECT

private slots:
    void deal_data();
    void deal();
    void discard_data()
    {
        QTest::addColumn<QString>("hand");
        QTest::addColumn<int>("playerCrib");
        QTest::addColumn<QString>("expected");  // the thrown pair at places 0 and 5

        // By the count alone the aces and the eight are the best throw; the
        // fives' worth to the crib turns that around when the crib is the
        // computer's. For the user's crib the two aces tie, and the first stays.
        QTest::newRow("pair of fives thrown to the computer's crib") << "AS AH 8S 5S 5D 4D" << 0 << "5S AH 8S AS 4D 5D";
        QTest::newRow("pair of fives kept from the user's crib") << "AS AH 8S 5S 5D 4D" << 1 << "AS AH 4D 5S 5D 8S";
        QTest::newRow("best split 1 and 3") << "JD 3H 5D 6D QS 5S" << 0 << "3H JD 5D 5S QS 6D";
        QTest::newRow("discards already outside") << "2D 2S 6H 7C 2C 8D" << 1 << "2D 2S 6H 7C 2C 8D";
        // Equal totals: the three in the earlier place goes.
        QTest::newRow("equal totals: the earlier split") << "TH 7D 3H 8D 6D 3S" << 1 << "TH 7D 3S 8D 6D 3H";
        // Both sevens thrown with the eight total the same exactly; summed
        // starter by starter in doubles, rounding puts the second seven ahead.
        QTest::newRow("rounding of the running sum decides") << "7H 7S TC 8C 3D 2C" << 0 << "7S 7H TC 2C 3D 8C";
    }

    void discard()
    {
        QFETCH(QString, hand);
        QFETCH(int, playerCrib);
        QFETCH(QString, expected);
        auto board = MakeBoard();
        GameRecord& r = board->record;
        for (int p = 0; p < 6; ++p)
            r.opponentHandSprites[p].suit1 = CardSuit(r.deal[6 + p] = CardNamed(hand.split(' ').value(p))) + 1;
        r.playerCrib = playerCrib;
        r.phase = kPhaseDiscard;
        board->ChooseComputerDiscards();
        board->ChooseComputerDiscards();  // once per deal: a second call changes nothing
        for (int p = 0; p < 6; ++p)
            QCOMPARE(r.deal[6 + p], CardNamed(expected.split(' ').value(p)));
    }

    void card_data()
    {
        QTest::addColumn<QList<int>>("hand");  // rank1 at places 1..4; negative: already laid
        QTest::addColumn<QList<int>>("laid");  // the ranks of the count so far
        QTest::addColumn<int>("expected");     // the place chosen, 0 for none

        QTest::newRow("no card fits") << QList<int>{5, 9, 13, 4} << QList<int>{10, 10, 8} << 0;
        QTest::newRow("lead: the four gives least away") << QList<int>{5, 13, 4, 2} << QList<int>{} << 3;
        // The two is judged against the replies the five leaves room for (a five
        // or a six), not those the two itself would allow (a two or a nine).
        QTest::newRow("replies those the chosen card leaves room for") << QList<int>{5, 2, -3, -4} << QList<int>{10, 13} << 2;
    }

    void card()
    {
        QFETCH(QList<int>, hand);
        QFETCH(QList<int>, laid);
        QFETCH(int, expected);
        auto board = MakeBoard();
        GameRecord& r = board->record;
        r.phase = kPhasePlay;
        for (int rank1 : laid) {
            SequenceAppend(r.playSequence, rank1);
            r.runningCount += Rank1Value(rank1);
        }
        for (int p = 1; p <= 4; ++p) {
            r.deal[6 + p] = Card(std::abs(hand[p - 1]), p);  // a suit per place: no card twice
            r.opponentHandSprites[p].suit1 = hand[p - 1] < 0 ? kSuitEmpty : p;
        }
        r.opponentHandSprites[0].suit1 = r.opponentHandSprites[5].suit1 = kSuitEmpty;
        QCOMPARE(board->ChooseComputerCard(), expected);
    }

    // Every sequence the play can produce of up to five cards always, all of
    // up to eight on request (VENNICK_EXHAUSTIVE=1), as that is slow under
    // the sanitizers.
    void scoreAgreesWithReference()
    {
        const bool everything = qEnvironmentVariableIntValue("VENNICK_EXHAUSTIVE") != 0;
        long long visited = 0;
        QString first;
        ForEveryLegalPlay(everything ? 8 : 5, [&](const PlaySequence& sequence) {
            ++visited;
            PlaySequence rebuilt;  // the same cards appended one by one
            for (int i = 0; i < SequenceLength(sequence); ++i)
                SequenceAppend(rebuilt, sequence.entries[i]);
            const int points = ReferenceScorePlay(sequence);
            if (first.isEmpty()
                && (ScorePlay(rebuilt) != points || rebuilt.entries[8] != -1 || ItemsTotal(ItemisePlay(sequence)) != points))
                for (int entry : sequence.entries)
                    first += QString::number(entry) + QLatin1Char(' ');
        });
        QVERIFY2(first.isEmpty(), qPrintable(first));
        QCOMPARE(visited, everything ? 12892167LL : 182587LL);
    }

    // The names and their order, which the totals above cannot see.
    void playReasons_data()
    {
        QTest::addColumn<QList<int>>("laid");  // rank1 of each card since the count began
        QTest::addColumn<QString>("expected");

        QTest::newRow("a run laid out of order, making fifteen") << QList<int>{4, 6, 5} << "fifteen 2, a run of three 5";
        QTest::newRow("thirty-one and a run") << QList<int>{13, 8, 6, 7} << "thirty-one 2, a run of three 5";
        QTest::newRow("three of a kind making fifteen") << QList<int>{5, 5, 5} << "fifteen 2, three of a kind 8";
        QTest::newRow("four of a kind after another card") << QList<int>{1, 2, 2, 2, 2} << "four of a kind 12";
        QTest::newRow("a run of seven") << QList<int>{7, 6, 5, 4, 3, 1, 2} << "a run of seven 7";
    }

    void playReasons()
    {
        QFETCH(QList<int>, laid);
        QFETCH(QString, expected);
        PlaySequence sequence;
        for (int rank1 : laid)
            SequenceAppend(sequence, rank1);
        QCOMPARE(ReasonsLine(ItemisePlay(sequence)), expected);
    }
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
    // Log lines / pegs (back-front, the user's first) / count / button / what
    // the status line says the game waits for.
    QTest::addColumn<QString>("expected");

    const QString runsTo31 = "2S 8D TH QC AD 4D KS KD 6H 5S 9D KC 5H";  // the computer deals
    const QString lastCardGo = "AS AH 6D QH AD 3D 4S 2S 2C 4H 7D QD 9C";  // the user deals
    const QString repeatedGo = "AS 2S 7D KH 3H 4H QD JC TS 9H 5C 6C 8C";  // the computer deals
    const QString go = "Opponent says: 'Go' / ", won = "You won. / Please click New to play again.";

    // The play.
    QTest::newRow("user's 31; no card while Ok shows; the computer leads after it; no double go")
        << "2S 4S 8S QS 9H TH 7D KD 7H 7C 3C 6C 5D" << false << "2S 4S 8S QS ok QS"
        << "You peg 2. / Opponent pegs 1 for a go. | 0-2 0-1 | none | 4 | Score your hand";
    QTest::newRow("computer's 31 laid two cards at once; the user leads; user's go")
        << runsTo31 << false << "2S 8D TH QC" << "Opponent pegs 2. / You peg 1 for a go. | 0-1 0-2 | none | 4 | Score your hand";
    QTest::newRow("go repeated until the user pegs it, by keyboard") << repeatedGo << false << "kKH k7D kAS k2S ret"
        << go + go + "You peg 1 for a go. / Opponent pegs 1 for a go. | 0-1 0-1 | none | 4 | Score your hand";
    QTest::newRow("computer's last card announces its go after its own points")
        << "AS AD 2H 3C 9S TS 3D 7S 5H 7H KD QD 6C" << false << "AS AD 2H 3C"
        << "Opponent pegs 2. / Opponent pegs 1 for a go. | 122-0 2-3 | none | 4 | Score your hand";
    QTest::newRow("after the computer's go the user leads") << "AC 7C TD JD 2H 3H 8H JS QS TS 4D 5D 6C" << false
        << "AC 7C TD JD ok"
        << "Opponent pegs 1 for a go. / Opponent pegs 2. / You peg 1 for a go. / Opponent pegs 1 for a go. | 0-1 3-4 | none | 4 | Score your hand";
    QTest::newRow("computer waits for Ok after scoring while the user is stuck")
        << "8S 9S TS KS AC 3C 5D 2D 2H 2C 6H 7H 4D" << false << "8S 9S ok TS KS"
        << "Opponent pegs 2. / Opponent pegs 6. / Opponent pegs 1 for a go. / " + go + "You peg 1 for a go. | 0-1 8-9 | none | 4 | Score your hand";
    QTest::newRow("a card past 31 is refused")
        << "4C 5C 7C TC AH 2H QD KD QH TH 3S 6S 8S" << false << "7C TC 5C 4C" << go + "You peg 2. | 0-2 122-0 | 0 | 6 | Press Ok";
    QTest::newRow("user deals: the computer leads; the user's last card ends the play")
        << lastCardGo << true << "AS AH 6D QH" << "You peg 1 for a go. | 0-1 122-0 | none | 5 | Score the computer's hand";
    QTest::newRow("His Heels for the user; the computer leads after Ok")
        << "AS AH 6D QH AD 3D 4S 2S 2C 4H 7D QD JD" << true << "ok" << "You peg 2 for His Heels. | 0-2 122-0 | 4 | 0 | Your turn";
    QTest::newRow("His Heels for the computer; the user leads")
        << "2S 8D TH QC AD 4D KS KD 6H 5S 9D KC JH" << false << "2S" << "Opponent pegs 2 for His Heels. | 122-0 0-2 | 12 | 0 | Your turn";
    // Explain each score: the reasons follow each count above 0, but not a go or His Heels.
    QTest::newRow("explained: the play") << "AC 7C TD JD 2H 3H 8H JS QS TS 4D 5D 6C" << false << "explain AC 7C TD JD ok"
        << "Opponent pegs 1 for a go. / Opponent pegs 2. / a pair 2 / You peg 1 for a go. / Opponent pegs 1 for a go. | 0-1 3-4 | none | 4 | Score your hand";
    QTest::newRow("explained: the show") << runsTo31 << false << "explain 2S 8D TH QC ok ok ok"
        << "Opponent pegs 2. / thirty-one 2 / You peg 1 for a go. / You peg 6 for your hand. / fifteen 2, fifteen 4, fifteen 6 / "
           "Opponent pegs 12 for his hand. / fifteen 2, fifteen 4, fifteen 6, fifteen 8, a pair 10, a pair 12 / "
           "Opponent pegs 6 for the crib. / fifteen 2, fifteen 4, fifteen 6 | 1-7 14-20 | none | 1 | Click Deal for the next hand";
    // The show: the non-dealer's hand, the dealer's, then the crib.
    QTest::newRow("show after the computer's deal") << runsTo31 << false << "2S 8D TH QC ok ok ok"
        << "Opponent pegs 2. / You peg 1 for a go. / You peg 6 for your hand. / Opponent pegs 12 for his hand. / "
           "Opponent pegs 6 for the crib. | 1-7 14-20 | none | 1 | Click Deal for the next hand";
    // Four of a suit with a starter of another: a flush in a hand, none in the crib.
    QTest::newRow("show after the user's deal, by keyboard") << lastCardGo << true << "AS AH 6D QH ret ret ret"
        << "You peg 1 for a go. / Opponent pegs 12 for his hand. / You peg 4 for your hand. / You peg 0 for the crib. "
           "| 1-5 0-12 | none | 1 | Click Deal for the next hand";
    // A win ends the deal where it stands: no button, and nothing moves.
    QTest::newRow("a go point wins on the last card")
        << lastCardGo << true << "you=120 AS AH 6D QH all" << "You peg 1 for a go. / " + won + " | 120-121 122-0 | 0 | 0 | You won 121 to 0: a double skunk, 4 games. Click New to play again.";
    QTest::newRow("a go point wins with the computer's cards in hand") << repeatedGo << false << "you=120 KH 7D AS 2S all"
        << go + go + "You peg 1 for a go. / " + won + " | 120-121 122-0 | 0 | 0 | You won 121 to 0: a double skunk, 4 games. Click New to play again.";
    QTest::newRow("user wins on the first count") << runsTo31 << false << "you=115 2S 8D TH QC ok all"
        << "Opponent pegs 2. / You peg 1 for a go. / You peg 6 for your hand. / " + won + " | 116-121 0-2 | none | 0 | You won 121 to 2: a double skunk, 4 games. Click New to play again.";
    QTest::newRow("computer wins on the first count") << lastCardGo << true << "opp=110 AS AH 6D QH ok all"
        << "You peg 1 for a go. / Opponent pegs 12 for his hand. / You lost. / Please click New to play again. "
           "| 0-1 110-121 | none | 0 | You lost 1 to 121: a double skunk, 4 games. Click New to play again.";
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
    const int places[13] = {1, 2, 3, 4, 0, 5, 7, 8, 9, 10, 6, 11, 12};
    for (int i = 0; i < 13; ++i)
        r.deal[places[i]] = CardNamed(cards.split(' ').value(i));
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
        if (step == "explain") {
            r.explainScores = 1;
            continue;
        }
        if (step == "ok" || step == "ret" || step == "all" || step.contains('=')) {
            for (int p = 1; step == "all" && p <= 6; ++p) {
                TapHand(b, p);
                PressKey(b, Qt::Key_0 + p);
            }
            step == "ok" ? ClickButton(b, ShownButtons(b).value(0)) : step.startsWith("you=") ? b.MovePlayerPegs(n)
                : step.startsWith("opp=") ? b.MoveOpponentPegs(n) : PressKey(b, Qt::Key_Return);
            continue;
        }
        const int place = static_cast<int>(std::find(r.deal + 1, r.deal + 5, CardNamed(step.right(2))) - r.deal) + 1;
        step.startsWith('k') ? PressKey(b, Qt::Key_0 + place) : TapHand(b, place);
    }
    const QString pegs = QStringLiteral("%1-%2 %3-%4").arg(r.playerBackHole).arg(r.playerFrontHole)
                             .arg(r.opponentBackHole).arg(r.opponentFrontHole);
    // The count as shown, which is always the real one; none in the show.
    const QString count = r.countVisible ? QString::number(r.shownCount) : QStringLiteral("none");
    QCOMPARE(r.countVisible ? r.shownCount : 0, r.runningCount);
    QCOMPARE(QStringList({LogLines(b).mid(mark).join(" / "), pegs, count, QString::number(ShownButtons(b).value(0)),
                          b.StatusLine().section(QStringLiteral(" \u00b7 "), -1)}).join(" | "), expected);
}

VENNICK_TEST(PlayTest);
#include "PlayTest.moc"

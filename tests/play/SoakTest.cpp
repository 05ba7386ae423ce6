#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QElapsedTimer>
#include <QSettings>
#include <QtTest>

#include <cstdint>
#include <memory>
#include <random>

namespace {

constexpr uint32_t kSeed = 20240611u;
constexpr int kDefaultGames = 300;
// A game takes a few hundred actions; far more means the game is stuck.
constexpr int kActionsPerGameLimit = 20000;

int StoredTally(const char* name)
{
    return QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).value(QLatin1String(name), -1).toInt();
}

// What must not change once a game is over, whatever the user does.
QString Table(const GameBoard& board)
{
    const GameRecord& r = board.record;
    QStringList parts{QString::number(r.runningCount), QString::number(r.gamesFor), QString::number(r.gamesAgainst)};
    for (int hole : {r.playerBackHole, r.playerFrontHole, r.opponentBackHole, r.opponentFrontHole})
        parts.append(QString::number(hole));
    for (CardId card : r.deal)
        parts.append(QString::number(card));
    const auto addRow = [&parts](const CardSprite* row, int places) {
        for (int i = 0; i < places; ++i)
            parts.append(QStringLiteral("%1/%2/%3").arg(row[i].rank1).arg(row[i].suit1).arg(row[i].highlighted));
    };
    addRow(r.playerHandSprites, 6);
    addRow(r.opponentHandSprites, 6);
    addRow(r.playerPileSprites, 4);
    addRow(r.opponentPileSprites, 4);
    return parts.join(' ') + " | " + LogLines(board).join(" / ") + QStringLiteral(" | %1").arg(ShownButtons(board).size());
}

// A scripted user: random legal moves with random nonsense mixed in, and the
// table checked after every action.
class ScriptedUser {
public:
    ScriptedUser(GameBoard& board, uint32_t seed) : b(board), rng(seed)
    {
        b.randomSource = [this]() { return static_cast<int>(rng() >> 1); };
        StartTracking();
    }

    // One action of the user. Returns false when it was New in mid-game.
    bool Act()
    {
        const uint32_t roll = Roll(10000);
        if (roll < 2) {
            b.NewGame();  // the New command, here in the middle of a game
            return false;
        }
        if (roll < 800)
            Nonsense();
        else
            LegalMove();
        return true;
    }

    // Nonsense only: the game is over and nothing may change.
    void Nonsense()
    {
        switch (Roll(4)) {
        case 0: TapBoard(b, static_cast<int>(Roll(240)), static_cast<int>(Roll(268))); break;
        case 1: TapHand(b, static_cast<int>(Roll(6)) + 1); break;
        case 2: {
            static const int keys[] = {Qt::Key_0, Qt::Key_1, Qt::Key_4, Qt::Key_6, Qt::Key_7, Qt::Key_9,
                                       Qt::Key_Up, Qt::Key_Down, Qt::Key_Left, Qt::Key_Right, Qt::Key_A,
                                       Qt::Key_N, Qt::Key_Space, Qt::Key_Tab, Qt::Key_F1, Qt::Key_Backspace};
            PressKey(b, keys[Roll(std::size(keys))]);
            break;
        }
        default: PressKey(b, Roll(2) ? Qt::Key_Escape : Qt::Key_Return); break;
        }
    }

    // The first broken rule, or an empty text.
    QString Check()
    {
        const GameRecord& r = b.record;
        const int player = b.PlayerScore();
        const int opponent = b.OpponentScore();
        const QList<int> shown = ShownButtons(b);

        if (r.phase != kPhaseNoDeal)
            dealt = true;
        if (r.phase == kPhaseDiscard && lastPhase != kPhaseDiscard)
            ++deals;
        lastPhase = r.phase;
        if (dealt) {
            for (int i = 0; i < 13; ++i) {
                if (r.deal[i] < 0 || r.deal[i] > 51)
                    return QStringLiteral("card out of range");
                for (int j = 0; j < i; ++j)
                    if (r.deal[i] == r.deal[j])
                        return QStringLiteral("a card dealt twice");
            }
        }
        if (player < 0 || player > kGameHole || opponent < 0 || opponent > kGameHole)
            return QStringLiteral("score out of range");
        if (player < lastPlayer || opponent < lastOpponent)
            return QStringLiteral("a score went down");
        lastPlayer = player;
        lastOpponent = opponent;
        const auto pegsInOrder = [](int back, int front) {
            return (back == kBackStartHole && front == kStartHole) || back < front;
        };
        if (!pegsInOrder(r.playerBackHole, r.playerFrontHole) || !pegsInOrder(r.opponentBackHole, r.opponentFrontHole))
            return QStringLiteral("back peg not behind the front peg");
        if (r.runningCount < 0 || r.runningCount > 31)
            return QStringLiteral("running count out of range");
        int sequenceTotal = 0;
        for (int i = 0; i < 9 && r.playSequence.entries[i] != -1; ++i)
            sequenceTotal += Rank1Value(r.playSequence.entries[i]);
        if (sequenceTotal != r.runningCount)
            return QStringLiteral("running count differs from the cards of the count");
        if (shown.size() > 1)
            return QStringLiteral("more than one action button shown");

        if (QString broken = CheckPhase(shown); !broken.isEmpty())
            return broken;
        return CheckGameEnd();
    }

    void StartTracking()
    {
        lastPlayer = 0;
        lastOpponent = 0;
        ended = false;
        tallyFor = b.record.gamesFor;
        tallyAgainst = b.record.gamesAgainst;
    }

    bool Ended() const { return ended; }
    int deals = 0;

private:
    uint32_t Roll(size_t n) { return static_cast<uint32_t>(rng() % n); }

    // A move the rules allow, by mouse or keyboard at random.
    void LegalMove()
    {
        const GameRecord& r = b.record;
        const QList<int> shown = ShownButtons(b);
        if (!shown.isEmpty()) {
            if (Roll(2))
                ClickButton(b, shown.first());
            else
                HoldKey(Roll(2) ? Qt::Key_Escape : Qt::Key_Return);
            return;
        }
        QList<int> choices;
        if (r.phase == kPhaseDiscard) {
            for (int p = 1; p <= 6; ++p)
                if (!r.selected[p - 1])
                    choices.append(p);
        } else if (r.phase == kPhasePlay) {
            for (int p = 2; p <= 5; ++p) {
                const CardSprite& card = r.playerHandSprites[p - 1];
                if (card.suit1 != kSuitEmpty && r.runningCount + Rank1Value(card.rank1) <= 31)
                    choices.append(p);
            }
        }
        if (choices.isEmpty()) {
            Nonsense();  // Check() reports a table that leaves no move
            return;
        }
        const int position = choices[Roll(choices.size())];
        if (Roll(2))
            TapHand(b, position);
        else
            HoldKey(Qt::Key_1 + position - 1);
    }

    // A key tapped, or held: its repeats flagged or as a plain release and
    // press at one time, as X11 may send them; then released.
    void HoldKey(int key)
    {
        const auto send = [this, key](QEvent::Type type, bool repeat) {
            QKeyEvent event(type, key, Qt::NoModifier, QString(), repeat);
            event.setTimestamp(keyClock);
            QCoreApplication::sendEvent(&b, &event);
        };
        keyClock += 1000;
        send(QEvent::KeyPress, false);
        for (uint32_t n = Roll(4); n > 0; --n) {
            keyClock += 33;
            const bool flagged = Roll(2) != 0;
            send(QEvent::KeyRelease, flagged);
            send(QEvent::KeyPress, flagged);
        }
        keyClock += 50;
        send(QEvent::KeyRelease, false);
        b.ActOnPendingRelease();  // as the next input would
    }
    quint64 keyClock = 0;

    QString CheckPhase(const QList<int>& shown)
    {
        const GameRecord& r = b.record;
        const auto only = [&shown](int id) { return shown == QList<int>{id}; };
        const auto cardsLaid = [&r]() {
            int inHand = 0;
            int opponentInHand = 0;
            for (int p = 0; p < 6; ++p) {
                inHand += r.playerHandSprites[p].suit1 != kSuitEmpty ? 1 : 0;
                opponentInHand += r.opponentHandSprites[p].suit1 != kSuitEmpty ? 1 : 0;
            }
            return inHand + r.playerPlayIndex - 1 == 4 && opponentInHand + r.opponentPlayIndex - 1 == 4;
        };
        if (r.gameOver) {
            if ((b.PlayerScore() == kGameHole) == (b.OpponentScore() == kGameHole))
                return QStringLiteral("game over without exactly one side at 121");
            if (!shown.isEmpty())
                return QStringLiteral("a button shown after the game");
            if (r.phase != kPhaseGameOver && r.phase != kPhaseHandCounted)
                return QStringLiteral("game over in a playing phase");
            return {};
        }
        if (b.PlayerScore() == kGameHole || b.OpponentScore() == kGameHole)
            return QStringLiteral("121 reached but the game goes on");
        switch (r.phase) {
        case kPhaseNoDeal:
            return only(kCmdDeal) ? QString() : QStringLiteral("no Deal before the first deal");
        case kPhaseDiscard:
            if (b.SelectedCount() > 2)
                return QStringLiteral("more than two cards chosen for the crib");
            if ((b.SelectedCount() == 2) != only(kCmdSendToCrib))
                return QStringLiteral("Send To Crib does not follow the choice");
            return shown.isEmpty() || only(kCmdSendToCrib) ? QString() : QStringLiteral("stray button while discarding");
        case kPhasePlay:
            if (!cardsLaid())
                return QStringLiteral("a card lost or doubled in the play");
            if (only(kCmdOk))
                return {};
            if (!shown.isEmpty())
                return QStringLiteral("stray button in the play");
            return b.PlayerCannotPlay() ? QStringLiteral("the play waits for a user who cannot play") : QString();
        case kPhasePlayOver:
            if (r.playerPlayIndex != 5 || r.opponentPlayIndex != 5)
                return QStringLiteral("play over with cards in hand");
            return only(r.playerCrib ? kCmdScoreOpponentHand : kCmdScorePlayerHand)
                ? QString() : QStringLiteral("the non-dealer does not count first");
        case kPhaseHandCounted:
            return only(kCmdScorePlayerHand) || only(kCmdScoreOpponentHand) || only(kCmdScoreCrib)
                ? QString() : QStringLiteral("no count button after a hand count");
        case kPhaseCribCounted:
            return only(kCmdDeal) ? QString() : QStringLiteral("no Deal after the crib");
        default:
            return QStringLiteral("unknown phase %1").arg(r.phase);
        }
    }

    QString CheckGameEnd()
    {
        const GameRecord& r = b.record;
        if (!r.gameOver) {
            if (ended)
                return QStringLiteral("the game came back to life");
            if (r.gamesFor != tallyFor || r.gamesAgainst != tallyAgainst)
                return QStringLiteral("the tally changed during a game");
            return {};
        }
        if (ended)
            return r.gamesFor == tallyFor && r.gamesAgainst == tallyAgainst ? QString()
                                                                            : QStringLiteral("the tally counted twice");
        ended = true;
        const bool userWon = b.PlayerScore() == kGameHole;
        const int loser = userWon ? b.OpponentScore() : b.PlayerScore();
        const int32_t games = loser <= 60 ? 4 : loser <= 90 ? 2 : 1;
        const int32_t expectFor = tallyFor + (userWon ? games : 0);
        const int32_t expectAgainst = tallyAgainst + (userWon ? 0 : games);
        tallyFor = r.gamesFor;
        tallyAgainst = r.gamesAgainst;
        if (r.gamesFor != expectFor || r.gamesAgainst != expectAgainst)
            return QStringLiteral("the tally did not grow by 1, 2 or 4 for the winner");
        if (StoredTally("For") != r.gamesFor || StoredTally("Against") != r.gamesAgainst)
            return QStringLiteral("the tally was not saved");
        const QStringList log = LogLines(b);
        const QString verdict = userWon ? QStringLiteral("You won.") : QStringLiteral("You lost.");
        if (log.size() < 2 || log[log.size() - 2] != verdict || log.last() != "Please click New to play again.")
            return QStringLiteral("the end of the game is not announced last");
        if (log.count(QStringLiteral("You won.")) + log.count(QStringLiteral("You lost.")) != 1)
            return QStringLiteral("the game ended more than once");
        return {};
    }

    GameBoard& b;
    std::mt19937 rng;
    bool dealt = false;
    int32_t lastPhase = kPhaseNoDeal;
    bool ended = false;
    int lastPlayer = 0;
    int lastOpponent = 0;
    int32_t tallyFor = 0;
    int32_t tallyAgainst = 0;
};

} // namespace

// Whole games against the computer, from the first deal to 121, by a user who
// also taps and presses keys at random. VENNICK_SOAK_GAMES raises the count.
class SoakTest : public QObject {
    Q_OBJECT

private slots:
    void wholeGames();
};

void SoakTest::wholeGames()
{
    const int asked = qEnvironmentVariableIntValue("VENNICK_SOAK_GAMES");
    const int games = asked > 0 ? asked : kDefaultGames;
    auto board = MakeBoard();
    ScriptedUser user(*board, kSeed);
    QElapsedTimer timer;
    timer.start();

    int finished = 0;
    int abandoned = 0;
    long long actions = 0;
    while (finished < games) {
        int gameActions = 0;
        bool abandonedNow = false;
        while (!user.Ended()) {
            QVERIFY2(++gameActions < kActionsPerGameLimit, qPrintable(QStringLiteral("game %1 never ends").arg(finished)));
            if (!user.Act()) {
                abandonedNow = true;
                break;
            }
            const QString broken = user.Check();
            QVERIFY2(broken.isEmpty(), qPrintable(QStringLiteral("game %1, action %2: %3")
                                                      .arg(finished).arg(gameActions).arg(broken)));
            if (gameActions % 64 == 0)
                QCoreApplication::processEvents();  // let the window paint now and then
        }
        actions += gameActions;
        if (abandonedNow) {
            ++abandoned;
        } else {
            // Once over, nothing the user taps or presses changes the table.
            const QString frozen = Table(*board);
            for (int i = 0; i < 6; ++i)
                user.Nonsense();
            QCOMPARE(Table(*board), frozen);
            ++finished;
            board->NewGame();
        }
        user.StartTracking();
        const QString broken = user.Check();
        QVERIFY2(broken.isEmpty(), qPrintable(QStringLiteral("after New: %1").arg(broken)));
        QCOMPARE(board->record.phase, int32_t(kPhaseNoDeal));
        QVERIFY(LogLines(*board).size() == 3);
    }
    qInfo("%d games played to the end (%d more abandoned with New), %d deals, %lld actions, %lld ms",
          finished, abandoned, user.deals, actions, static_cast<long long>(timer.elapsed()));
}

VENNICK_TEST(SoakTest);
#include "SoakTest.moc"

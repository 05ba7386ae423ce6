#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QScreen>
#include <QSettings>
#include <QtTest>

#include <memory>
#include <random>

namespace {

constexpr int kGamesPerRound = 500;
// A game takes a few hundred actions; far more means the game is stuck.
constexpr int kActionsPerGameLimit = 20000;

int StoredTally(const char* name)
{
    return QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).value(QLatin1String(name), -1).toInt();
}

bool FaceShows(const CardSprite& sprite, CardId card)
{
    return sprite.rank1 == CardRank(card) + 1 && sprite.suit1 == CardSuit(card) + 1;
}

// What must not change once a game is over, whatever the user does.
QString Table(const GameBoard& board)
{
    const GameRecord& r = board.record;
    QByteArray bytes(reinterpret_cast<const char*>(&r.deal), sizeof r.deal);
    bytes += QByteArray(reinterpret_cast<const char*>(&r.opponentHandSprites), 2 * sizeof r.opponentHandSprites
                        + 2 * sizeof r.opponentPileSprites);
    return QStringLiteral("%1 %2 %3 %4 %5 %6 %7 ").arg(r.runningCount).arg(r.gamesFor).arg(r.gamesAgainst)
        .arg(r.playerBackHole).arg(r.playerFrontHole).arg(r.opponentBackHole).arg(r.opponentFrontHole)
        + bytes.toHex() + LogLines(board).join(" / ") + QString::number(ShownButtons(board).size());
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
        static const int keys[] = {Qt::Key_0, Qt::Key_1, Qt::Key_4, Qt::Key_6, Qt::Key_7, Qt::Key_9, Qt::Key_Up,
                                   Qt::Key_Down, Qt::Key_Left, Qt::Key_Right, Qt::Key_A, Qt::Key_N, Qt::Key_Space,
                                   Qt::Key_Tab, Qt::Key_F1, Qt::Key_Backspace, Qt::Key_Escape, Qt::Key_Return};
        switch (Roll(3)) {
        case 0: TapBoard(b, static_cast<int>(Roll(240)), static_cast<int>(Roll(268))); break;
        case 1: TapHand(b, static_cast<int>(Roll(6)) + 1); break;
        default: PressKey(b, keys[Roll(std::size(keys))]); break;
        }
    }

    // The first broken rule, or an empty text.
    QString Check()
    {
        const GameRecord& r = b.record;
        const int player = b.PlayerScore();
        const int opponent = b.OpponentScore();
        deals += r.phase == kPhaseDiscard && lastPhase != kPhaseDiscard ? 1 : 0;
        lastPhase = r.phase;
        for (int i = 0; r.phase != kPhaseNoDeal && i < 13; ++i)
            if (r.deal[i] < 0 || r.deal[i] > 51 || std::count(r.deal, r.deal + i, r.deal[i]) != 0)
                return QStringLiteral("a card out of range or dealt twice");
        if (QString broken = CheckCards(); !broken.isEmpty())
            return broken;
        if (player < lastPlayer || opponent < lastOpponent || player > kGameHole || opponent > kGameHole)
            return QStringLiteral("a score went down or past 121");
        lastPlayer = player;
        lastOpponent = opponent;
        const auto pegsInOrder = [](int back, int front) {
            return (back == kBackStartHole && front == kStartHole) || back < front;
        };
        if (!pegsInOrder(r.playerBackHole, r.playerFrontHole) || !pegsInOrder(r.opponentBackHole, r.opponentFrontHole))
            return QStringLiteral("back peg not behind the front peg");
        int sequenceTotal = 0;
        for (int i = 0; i < 9 && r.playSequence.entries[i] != -1; ++i)
            sequenceTotal += Rank1Value(r.playSequence.entries[i]);
        if (sequenceTotal != r.runningCount || r.runningCount > 31)
            return QStringLiteral("running count differs from the cards of the count");
        if (QString broken = CheckPhase(ShownButtons(b)); !broken.isEmpty())
            return broken;
        return CheckGameEnd();
    }

    // Every card face shown is the card dealt to that place; a card laid is
    // one of its side's four and has left the hand; the crib, once counted,
    // lies in its owner's row.
    QString CheckCards() const
    {
        const GameRecord& r = b.record;
        const bool cribShown = r.phase == kPhaseCribCounted;
        for (int side = 0; side < 2; ++side) {
            const CardSprite* hand = side ? r.opponentHandSprites : r.playerHandSprites;
            const CardSprite* pile = side ? r.opponentPileSprites : r.playerPileSprites;
            const CardId* cards = r.deal + 6 * side;
            for (int p = 0; p < 6; ++p)
                if (hand[p].suit1 != kSuitEmpty && !FaceShows(hand[p], cards[p]))
                    return QStringLiteral("hand place %1 of side %2 shows another card").arg(p).arg(side);
            const CardId cribCards[4] = {r.deal[0], r.deal[5], r.deal[6], r.deal[11]};
            for (int i = 0; i < 4; ++i) {
                bool laid = false;
                for (int p = 1; p <= 4; ++p)
                    laid = laid || (FaceShows(pile[i], cards[p]) && hand[p].suit1 == kSuitEmpty);
                // A game won by the crib ends with the crib on show.
                const bool crib = FaceShows(pile[i], cribCards[i]) && r.phase >= kPhaseCribCounted;
                if (pile[i].suit1 != kSuitEmpty && !(crib || (laid && !cribShown)))
                    return QStringLiteral("pile place %1 of side %2 shows a card not laid").arg(i).arg(side);
            }
        }
        if (r.starterSprite.suit1 != kSuitBack && r.starterSprite.suit1 != kSuitEmpty
            && !FaceShows(r.starterSprite, r.deal[12]))
            return QStringLiteral("the starter shows another card");
        return {};
    }

    void StartTracking()
    {
        lastPlayer = lastOpponent = 0;
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
                PressKey(b, Roll(2) ? Qt::Key_Escape : Qt::Key_Return);
            return;
        }
        QList<int> choices;
        for (int p = 1; p <= 6; ++p) {
            const CardSprite& card = r.playerHandSprites[p - 1];
            if ((r.phase == kPhaseDiscard && !r.selected[p - 1])
                || (r.phase == kPhasePlay && p >= 2 && p <= 5 && card.suit1 != kSuitEmpty
                    && r.runningCount + Rank1Value(card.rank1) <= 31))
                choices.append(p);
        }
        if (choices.isEmpty()) {
            Nonsense();  // Check() reports a table that leaves no move
            return;
        }
        const int position = choices[Roll(choices.size())];
        if (Roll(2))
            TapHand(b, position);
        else
            PressKey(b, Qt::Key_1 + position - 1);
    }

    QString CheckPhase(const QList<int>& shown)
    {
        const GameRecord& r = b.record;
        const auto only = [&shown](int id) { return shown == QList<int>{id}; };
        int inHands = 0;
        for (int p = 0; p < 6; ++p)
            inHands += (r.playerHandSprites[p].suit1 != kSuitEmpty) + (r.opponentHandSprites[p].suit1 != kSuitEmpty);
        if (shown.size() > 1)
            return QStringLiteral("more than one action button shown");
        if (r.gameOver) {
            if ((b.PlayerScore() == kGameHole) == (b.OpponentScore() == kGameHole))
                return QStringLiteral("game over without exactly one side at 121");
            return shown.isEmpty() && (r.phase == kPhaseGameOver || r.phase == kPhaseHandCounted)
                ? QString() : QStringLiteral("a button or a playing phase after the game");
        }
        if (b.PlayerScore() == kGameHole || b.OpponentScore() == kGameHole)
            return QStringLiteral("121 reached but the game goes on");
        switch (r.phase) {
        case kPhaseNoDeal:
            return only(kCmdDeal) ? QString() : QStringLiteral("no Deal before the first deal");
        case kPhaseDiscard:
            return b.SelectedCount() <= 2 && (b.SelectedCount() == 2) == only(kCmdSendToCrib)
                    && (shown.isEmpty() || only(kCmdSendToCrib))
                ? QString() : QStringLiteral("Send To Crib does not follow the choice");
        case kPhasePlay:
            if (inHands + r.playerPlayIndex + r.opponentPlayIndex != 10)
                return QStringLiteral("a card lost or doubled in the play");
            if (!shown.isEmpty() && !only(kCmdOk))
                return QStringLiteral("stray button in the play");
            return shown.isEmpty() && b.PlayerCannotPlay() ? QStringLiteral("the play waits for a user who cannot play")
                                                           : QString();
        case kPhasePlayOver:
            return r.playerPlayIndex == 5 && r.opponentPlayIndex == 5
                    && only(r.playerCrib ? kCmdScoreOpponentHand : kCmdScorePlayerHand)
                ? QString() : QStringLiteral("the non-dealer does not count first, after all cards");
        case kPhaseHandCounted:
            return only(r.playerCrib ? kCmdScorePlayerHand : kCmdScoreOpponentHand) || only(kCmdScoreCrib)
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
        const bool tallySame = r.gamesFor == tallyFor && r.gamesAgainst == tallyAgainst;
        if (!r.gameOver || ended)
            return ended != (r.gameOver != 0) ? QStringLiteral("the game came back to life")
                : tallySame ? QString() : QStringLiteral("the tally changed during a game or twice");
        ended = true;
        const bool userWon = b.PlayerScore() == kGameHole;
        const int loser = userWon ? b.OpponentScore() : b.PlayerScore();
        const int32_t games = loser <= 60 ? 4 : loser <= 90 ? 2 : 1;
        if (r.gamesFor != tallyFor + (userWon ? games : 0) || r.gamesAgainst != tallyAgainst + (userWon ? 0 : games))
            return QStringLiteral("the tally did not grow by 1, 2 or 4 for the winner");
        tallyFor = r.gamesFor;
        tallyAgainst = r.gamesAgainst;
        if (StoredTally("For") != r.gamesFor || StoredTally("Against") != r.gamesAgainst)
            return QStringLiteral("the tally was not saved");
        const QStringList log = LogLines(b);
        const QString verdict = userWon ? QStringLiteral("You won.") : QStringLiteral("You lost.");
        if (log.size() < 2 || log[log.size() - 2] != verdict || log.last() != "Please click New to play again."
            || log.count(QStringLiteral("You won.")) + log.count(QStringLiteral("You lost.")) != 1)
            return QStringLiteral("the end of the game is not announced once and last");
        return {};
    }

    GameBoard& b;
    std::mt19937 rng;
    int32_t lastPhase = kPhaseNoDeal;
    bool ended = false;
    int lastPlayer = 0;
    int lastOpponent = 0;
    int32_t tallyFor = 0;
    int32_t tallyAgainst = 0;
};

} // namespace

// Whole games against the computer, from the first deal to 121, by a user who
// also taps and presses keys at random. VENNICK_SOAK_GAMES raises the count;
// the games are played in rounds, one data row each, so that Qt Test's limit
// per test function applies to a round, not to the whole run.
class SoakTest : public QObject {
    Q_OBJECT

private slots:
    void initTestCase();
    void wholeGames_data();
    void wholeGames();

private:
    std::unique_ptr<GameBoard> board;
    std::unique_ptr<ScriptedUser> user;
};

void SoakTest::initTestCase()
{
    board = MakeBoard();
    user = std::make_unique<ScriptedUser>(*board, 20240611u);
}

void SoakTest::wholeGames_data()
{
    QTest::addColumn<int>("games");
    const int asked = qEnvironmentVariableIntValue("VENNICK_SOAK_GAMES");
    for (int left = asked > 0 ? asked : 300, round = 1; left > 0; left -= kGamesPerRound, ++round)
        QTest::addRow("round %d", round) << std::min(left, kGamesPerRound);
}

void SoakTest::wholeGames()
{
    QFETCH(int, games);
    int finished = 0;
    long long actions = 0;
    while (finished < games) {
        int gameActions = 0;
        bool abandoned = false;
        while (!user->Ended()) {
            QVERIFY2(++gameActions < kActionsPerGameLimit, "a game never ends");
            if ((abandoned = !user->Act()))
                break;
            const QString broken = user->Check();
            QVERIFY2(broken.isEmpty(), qPrintable(QStringLiteral("game %1, action %2: %3")
                                                      .arg(finished).arg(gameActions).arg(broken)));
            // Now and then, what the window has painted bit by bit is what a
            // fresh paint of the record shows.
            if (gameActions % 97 == 0) {
                QCoreApplication::processEvents();
                QVERIFY2(board->screen()->grabWindow(board->winId()).toImage() == board->grab().toImage(),
                         "the window as painted differs from a fresh paint of it");
            }
        }
        actions += gameActions;
        if (!abandoned) {
            // Once over, nothing the user taps or presses changes the table.
            const QString frozen = Table(*board);
            for (int i = 0; i < 6; ++i)
                user->Nonsense();
            QCOMPARE(Table(*board), frozen);
            ++finished;
            board->NewGame();
        }
        user->StartTracking();
        QCOMPARE(user->Check(), QString());
        QCOMPARE(board->record.phase, int32_t(kPhaseNoDeal));
        QCOMPARE(LogLines(*board).size(), 3);
    }
    qInfo("%d games, %d deals so far, %lld actions", finished, user->deals, actions);
}

VENNICK_TEST(SoakTest);
#include "SoakTest.moc"

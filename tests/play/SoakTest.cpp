#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QListWidget>
#include <QScreen>
#include <QScrollBar>
#include <QtTest>

#include <condition_variable>
#include <mutex>
#include <random>
#include <stop_token>
#include <thread>
#include <utility>

namespace {

using namespace std::chrono_literals;

constexpr int kGamesPerRound = 500;
// A game takes a few hundred actions and well under a second, even under the
// sanitizers: far more of either is a game stuck.
constexpr int kActionsPerGameLimit = 20000;
constexpr auto kGameTimeLimit = 60s;

int SoakGames()
{
    const int asked = qEnvironmentVariableIntValue("VENNICK_SOAK_GAMES");
    return asked > 0 ? asked : 300;
}

// Qt 6.4's limit per test function is not one per data row: its watchdog can
// keep the deadline of an earlier row, so the rounds may share one limit. The
// whole soak is allowed a second a game; the game clock below stops a stuck game.
const bool soakTimeAllowed = AllowFunctionTime(SoakGames() * std::chrono::milliseconds(1s));

// Ends the run when one game has taken longer than kGameTimeLimit, also a game
// stuck inside one action, which never comes back to count its actions.
class GameClock {
public:
    void Start(QString game)
    {
        const std::scoped_lock lock(mutex);
        deadline = Clock::now() + kGameTimeLimit;
        name = std::move(game);
        wake.notify_all();
    }

private:
    using Clock = std::chrono::steady_clock;

    void Watch(std::stop_token stop)
    {
        std::unique_lock lock(mutex);
        while (!stop.stop_requested()) {
            if (Clock::now() >= deadline)
                qFatal("%s has run for more than %lld s: stuck", qPrintable(name),
                       static_cast<long long>(kGameTimeLimit.count()));
            // Until this deadline passes or another takes its place.
            wake.wait_until(lock, stop, deadline, [this, until = deadline] { return deadline != until; });
        }
    }

    std::mutex mutex;
    std::condition_variable_any wake;
    Clock::time_point deadline = Clock::time_point::max();
    QString name;
    std::jthread watcher{[this](std::stop_token stop) { Watch(stop); }};  // last: the rest exists first
};

bool Shows(const CardSprite& sprite, CardId card)
{
    return sprite.rank1 == CardRank(card) + 1 && sprite.suit1 == CardSuit(card) + 1;
}

} // namespace

// Whole games against the computer, from the first deal to 121, by a scripted
// user who makes random legal moves with random nonsense mixed in, and the
// table checked after every action. VENNICK_SOAK_GAMES raises the count; the
// games are played in rounds of 500, one data row each.
class SoakTest : public QObject {
    Q_OBJECT

private slots:
    void initTestCase()
    {
        b.randomSource = [this]() { return static_cast<int>(rng() >> 1); };
        connect(b.MessageLog()->model(), &QAbstractItemModel::rowsInserted, this,
                [this](const QModelIndex&, int first, int last) {
                    for (int i = first; i <= last; ++i)
                        SeePlay(b.MessageLog()->item(i)->text());
                });
    }
    void wholeGames_data()
    {
        QTest::addColumn<int>("games");
        for (int left = SoakGames(), round = 1; left > 0; left -= kGamesPerRound, ++round)
            QTest::addRow("round %d", round) << std::min(left, kGamesPerRound);
    }
    void wholeGames();

private:
    uint32_t Roll(size_t n) { return static_cast<uint32_t>(rng() % n); }

    // One action of the user. Returns false when it was New in mid-game.
    bool Act()
    {
        const uint32_t roll = Roll(10000);
        roll < 2 ? b.NewGame() : roll < 800 ? Nonsense() : LegalMove();
        return roll >= 2;
    }

    // Taps and keys, mostly of no use at the time.
    void Nonsense()
    {
        static const int keys[] = {Qt::Key_0, Qt::Key_1, Qt::Key_4, Qt::Key_7, Qt::Key_Up, Qt::Key_Down, Qt::Key_Left,
                                   Qt::Key_Right, Qt::Key_N, Qt::Key_Space, Qt::Key_Tab, Qt::Key_Escape, Qt::Key_Return};
        const uint32_t kind = Roll(3);
        kind == 0   ? TapBoard(b, int(Roll(240)), int(Roll(268)))
            : kind == 1 ? TapHand(b, int(Roll(6)) + 1) : PressKey(b, keys[Roll(std::size(keys))]);
    }

    // A move the rules allow, by mouse or keyboard at random.
    void LegalMove()
    {
        if (const QList<int> shown = ShownButtons(b); !shown.isEmpty())
            return Roll(2) ? ClickButton(b, shown.first()) : PressKey(b, Roll(2) ? Qt::Key_Escape : Qt::Key_Return);
        QList<int> choices;
        for (int p = 1; p <= 6; ++p)
            if (const CardSprite& card = r.playerHandSprites[p - 1]; r.phase == kPhaseDiscard ? !r.selected[p - 1]
                : r.phase == kPhasePlay && p >= 2 && p <= 5 && card.suit1 != kSuitEmpty
                    && r.runningCount + Rank1Value(card.rank1) <= 31)
                choices.append(p);
        if (choices.isEmpty())
            return Nonsense();  // Check() reports a table that leaves no move
        const int position = choices[Roll(choices.size())];
        Roll(2) ? TapHand(b, position) : PressKey(b, Qt::Key_0 + position);
    }

    // The first broken rule, or an empty text.
    QString Check()
    {
        for (int i = 0; r.phase != kPhaseNoDeal && i < 13; ++i)
            if (r.deal[i] < 0 || r.deal[i] > 51 || std::count(r.deal, r.deal + i, r.deal[i]) != 0)
                return "a card out of range or dealt twice";
        const int you = b.PlayerScore(), opponent = b.OpponentScore();
        if (you < lastYou || opponent < lastOpponent || you > kGameHole || opponent > kGameHole)
            return "a score went down or past 121";
        std::tie(lastYou, lastOpponent) = std::pair(you, opponent);
        // Every hole a peg moves is announced: the points the log has said add
        // up to the score (which stops at 121).
        const QStringList lines = LogLines(b);
        for (; logSeen < lines.size(); ++logSeen)
            for (auto [prefix, said] : {std::pair(QStringLiteral("You peg "), &saidYou), std::pair(QStringLiteral("Opponent pegs "), &saidOpponent)})
                if (lines[logSeen].startsWith(prefix))
                    *said += lines[logSeen].mid(prefix.size()).section(QLatin1Char(' '), 0, 0).section(QLatin1Char('.'), 0, 0).toInt();
        if (std::min(saidYou, kGameHole) != you || std::min(saidOpponent, kGameHole) != opponent)
            return QStringLiteral("the log announced %1 and %2 points, the pegs show %3 and %4").arg(saidYou).arg(saidOpponent).arg(you).arg(opponent);
        int total = 0;
        for (int i = 0; i < 9 && r.playSequence.entries[i] != -1; ++i)
            total += Rank1Value(r.playSequence.entries[i]);
        if (total != r.runningCount || total > 31)
            return "running count differs from the cards of the count";
        const bool show = r.phase == kPhasePlayOver || r.phase == kPhaseHandCounted || r.phase == kPhaseCribCounted;
        if ((r.countVisible && r.shownCount != r.runningCount) || (show && r.countVisible) || (r.phase == kPhasePlay && !r.countVisible))
            return "the count shown is not the real one";
        if (ShownButtons(b).size() > 1)
            return "two buttons shown at once";
        for (const QString& broken : {CheckTurns(), CheckCards()})
            if (!broken.isEmpty())
                return broken;
        return CheckGameEnd();
    }

    // Whether a side holds a card (hand places 1 to 4) that fits the count.
    bool CanLay(int side) const
    {
        const CardSprite* hand = side == kSidePlayer ? r.playerHandSprites : r.opponentHandSprites;
        const CardId* cards = r.deal + (side == kSidePlayer ? 0 : 6);
        for (int p = 1; p <= 4; ++p)
            if (hand[p].suit1 != kSuitEmpty && r.runningCount + CardValue(cards[p]) <= 31)
                return true;
        return false;
    }

    // What the play showed when last seen (at a log line or at rest).
    struct PlaySeen {
        int32_t phase = kPhaseNoDeal;
        int laid = 0;  // cards in both piles
        int32_t count = 0;
        bool cardFits = false;  // a card of either hand fits the count
    };

    // At each log line and at rest: the computer says "Go" only when no card
    // of its hand fits, and a count below 31 starts again only when no card
    // of either hand fits it (a go), whenever the change is announced.
    void SeePlay(const QString& line)
    {
        PlaySeen now{r.phase, 0, r.runningCount, CanLay(kSidePlayer) || CanLay(kSideOpponent)};
        for (int i = 0; i < 4; ++i)
            now.laid += (r.playerPileSprites[i].suit1 != kSuitEmpty) + (r.opponentPileSprites[i].suit1 != kSuitEmpty);
        if (turnBroken.isEmpty() && line == QStringLiteral("Opponent says: 'Go'") && CanLay(kSideOpponent))
            turnBroken = QStringLiteral("the computer said Go at %1 with a card that fits").arg(r.runningCount);
        if (turnBroken.isEmpty() && seen.phase == kPhasePlay && seen.count > 0 && seen.count < 31 && seen.cardFits
            && now.count == 0 && now.laid == seen.laid)
            turnBroken = QStringLiteral("the count started again after %1 with a card that fits").arg(seen.count);
        seen = now;
    }

    // The turns of the play at rest: the user, when to lay a card, has one
    // that fits; the computer, when it laid none on the user's card, has none;
    // the play ends with both hands laid.
    QString CheckTurns()
    {
        SeePlay(QString());
        if (!turnBroken.isEmpty() || r.gameOver)
            return std::exchange(turnBroken, QString());
        if (r.phase == kPhasePlay && ShownButtons(b).isEmpty()) {
            if (!CanLay(kSidePlayer))
                return "the user is to lay a card, but none fits";
            if (r.lastToPlay == kSidePlayer && r.playSequence.entries[0] != -1 && CanLay(kSideOpponent))
                return QStringLiteral("the computer let the turn pass at %1 with a card that fits").arg(r.runningCount);
        }
        const bool playOver = r.phase == kPhasePlayOver || r.phase == kPhaseHandCounted || r.phase == kPhaseCribCounted;
        for (int p = 1; playOver && p <= 4; ++p)
            if (r.playerHandSprites[p].suit1 != kSuitEmpty || r.opponentHandSprites[p].suit1 != kSuitEmpty)
                return "the play ended with a card still in a hand";
        return {};
    }

    // Every card face shown is the card dealt to that place; a card laid is
    // one of its side's four and has left the hand; the crib, once counted,
    // lies in its owner's row.
    QString CheckCards() const
    {
        const CardId crib[4] = {r.deal[0], r.deal[5], r.deal[6], r.deal[11]};
        for (int side = 0; side < 2; ++side) {
            const CardSprite* hand = side ? r.opponentHandSprites : r.playerHandSprites;
            const CardSprite* pile = side ? r.opponentPileSprites : r.playerPileSprites;
            const CardId* cards = r.deal + 6 * side;
            for (int p = 0; p < 6; ++p)
                if (hand[p].suit1 != kSuitEmpty && !Shows(hand[p], cards[p]))
                    return QStringLiteral("hand place %1 of side %2 shows another card").arg(p).arg(side);
            for (int i = 0; i < 4; ++i) {
                bool laid = false;
                for (int p = 1; p <= 4; ++p)
                    laid = laid || (Shows(pile[i], cards[p]) && hand[p].suit1 == kSuitEmpty);
                const bool inCrib = Shows(pile[i], crib[i]) && r.phase >= kPhaseCribCounted;
                if (pile[i].suit1 != kSuitEmpty && !inCrib && !(laid && r.phase != kPhaseCribCounted))
                    return QStringLiteral("pile place %1 of side %2 shows a card not laid").arg(i).arg(side);
            }
        }
        const bool faceUp = r.starterSprite.suit1 != kSuitBack && r.starterSprite.suit1 != kSuitEmpty;
        return faceUp && !Shows(r.starterSprite, r.deal[12]) ? "the starter shows another card" : "";
    }

    // Once per game, as it ends: the tally grows for the winner by the
    // loser's distance; the log shows its last line.
    QString CheckGameEnd()
    {
        if (!r.gameOver || ended)
            return ended != (r.gameOver != 0) ? "the game came back to life"
                : r.gamesFor == tallyFor && r.gamesAgainst == tallyAgainst ? "" : "the tally changed during a game or twice";
        ended = true;
        const bool userWon = b.PlayerScore() == kGameHole;
        const int loser = userWon ? b.OpponentScore() : b.PlayerScore();
        const int32_t games = loser <= 60 ? 4 : loser <= 90 ? 2 : 1;
        if (r.gamesFor != tallyFor + (userWon ? games : 0) || r.gamesAgainst != tallyAgainst + (userWon ? 0 : games))
            return "the tally did not grow by 1, 2 or 4 for the winner";
        QCoreApplication::processEvents();
        const QScrollBar* bar = b.MessageLog()->verticalScrollBar();
        return bar->value() == bar->maximum() && bar->maximum() > 0 ? "" : "the log does not show its last line";
    }

    std::mt19937 rng{20240611u};
    std::unique_ptr<GameBoard> board = MakeBoard();
    GameBoard& b = *board;
    const GameRecord& r = b.record;
    // Of the game under way: whether it has ended, the scores last seen, the
    // tally at its start.
    bool ended = false;
    int lastYou = 0, lastOpponent = 0;
    // The log lines read so far and the points they announced.
    qsizetype logSeen = 0;
    int saidYou = 0, saidOpponent = 0;
    int32_t tallyFor = 0, tallyAgainst = 0;
    // The play when last seen, and the first rule of its turns broken.
    PlaySeen seen;
    QString turnBroken;
    GameClock clock;
};

void SoakTest::wholeGames()
{
    QFETCH(int, games);
    for (int finished = 0, actions = 0; finished < games; actions = 0) {
        clock.Start(QStringLiteral("%1, game %2").arg(QString::fromLatin1(QTest::currentDataTag())).arg(finished));
        bool abandoned = false;
        while (!ended && !abandoned) {
            QVERIFY2(++actions < kActionsPerGameLimit, "a game never ends");
            abandoned = !Act();
            const QString broken = abandoned ? QString() : Check();
            QVERIFY2(broken.isEmpty(), qPrintable(QStringLiteral("game %1, action %2: %3")
                                                      .arg(finished).arg(actions).arg(broken)));
            // Now and then: what the window has painted bit by bit is what a
            // fresh paint of the record shows.
            if (actions % 97 == 0) {
                // Once the event loop has run dry, as between a player's
                // inputs: a button just shown is painted two passes after it
                // (its update and then its paint are posted in turn), while
                // a sprite never invalidated stays wrong however long it runs.
                QCoreApplication::processEvents(QEventLoop::AllEvents, 1000);
                QVERIFY2(b.screen()->grabWindow(b.winId()).toImage() == b.grab().toImage(),
                         qPrintable(QStringLiteral("game %1, action %2: the window as painted differs from a fresh "
                                                   "paint of it").arg(finished).arg(actions)));
            }
        }
        if (!abandoned) {
            ++finished;
            b.NewGame();
        }
        std::tie(ended, lastYou, lastOpponent, tallyFor, tallyAgainst) = std::tuple(false, 0, 0, r.gamesFor, r.gamesAgainst);
        std::tie(logSeen, saidYou, saidOpponent) = std::tuple(0, 0, 0);
        QCOMPARE(Check(), QString());
        QCOMPARE(LogLines(b).size(), 3);
    }
}

VENNICK_TEST(SoakTest);
#include "SoakTest.moc"

#include "bench/GameBench.h"
#include "bench/Timing.h"

#include "game/GameBoard.h"
#include "play/PlaySequence.h"

#include <QApplication>
#include <QDir>
#include <QSettings>
#include <QTemporaryDir>

#include <algorithm>
#include <cstdio>
#include <numeric>
#include <random>
#include <vector>

namespace {

constexpr int kBatches = 201;
constexpr uint32_t kSeed = 20261206u;

std::vector<CardId> ShuffledDeck(std::mt19937& random)
{
    std::vector<CardId> deck(52);
    std::iota(deck.begin(), deck.end(), 0);
    std::shuffle(deck.begin(), deck.end(), random);
    return deck;
}

// The computer's discard for random six-card hands, crib either side.
double MicrosecondsPerDiscard(GameBoard& board, std::mt19937& random)
{
    constexpr int kDealsPerBatch = 100;
    std::vector<double> batches;
    for (int batch = 0; batch < kBatches; ++batch) {
        std::vector<std::vector<CardId>> decks;
        for (int i = 0; i < kDealsPerBatch; ++i)
            decks.push_back(ShuffledDeck(random));
        GameRecord& r = board.record;
        const double start = ThreadSeconds();
        for (const std::vector<CardId>& deck : decks) {
            std::copy(deck.begin(), deck.begin() + 13, r.deal);
            r.phase = kPhaseDiscard;
            r.opponentDiscarded = 0;
            r.playerCrib = deck[13] % 2;
            board.ChooseComputerDiscards();
        }
        batches.push_back((ThreadSeconds() - start) * 1e6 / kDealsPerBatch);
    }
    return Median(batches);
}

// A moment of the play as the computer's choice reads it.
struct PlayPosition {
    PlaySequence sequence;
    int32_t runningCount = 0;
    CardId hand[4] = {};
    int32_t inHand[4] = {};
};

// The computer's card choice in random positions of the play: a count made
// of random cards, then two to four cards of its own still in hand.
double MicrosecondsPerChoice(GameBoard& board, std::mt19937& random)
{
    constexpr int kCallsPerBatch = 1000;
    std::vector<double> batches;
    long long chosen = 0;
    for (int batch = 0; batch < kBatches; ++batch) {
        std::vector<PlayPosition> positions(kCallsPerBatch);
        for (PlayPosition& position : positions) {
            const std::vector<CardId> deck = ShuffledDeck(random);
            const int laid = static_cast<int>(random() % 6);
            for (int i = 0; i < laid && position.runningCount + CardValue(deck[4 + i]) <= 31; ++i) {
                SequenceAppend(position.sequence, CardRank(deck[4 + i]) + 1);
                position.runningCount += CardValue(deck[4 + i]);
            }
            for (int p = 0; p < 4; ++p) {
                position.hand[p] = deck[p];
                position.inHand[p] = (p < 2 || random() % 2) ? CardSuit(deck[p]) + 1 : 0;
            }
        }
        GameRecord& r = board.record;
        const double start = ThreadSeconds();
        for (const PlayPosition& position : positions) {
            r.playSequence = position.sequence;
            r.runningCount = position.runningCount;
            for (int p = 1; p <= 4; ++p) {
                r.deal[6 + p] = position.hand[p - 1];
                r.opponentHandSprites[p].suit1 = position.inHand[p - 1];
            }
            chosen += board.ChooseComputerCard();
        }
        batches.push_back((ThreadSeconds() - start) * 1e6 / kCallsPerBatch);
    }
    std::printf("(positions chosen in all %lld)\n", chosen);
    return Median(batches);
}

// A user who always takes the next step: the shown button, two random cards
// for the crib, the first card that fits. Returns the number of games ended.
int PlayGames(GameBoard& board, std::mt19937& random, int games)
{
    int ended = 0;
    while (ended < games) {
        QCoreApplication::processEvents();  // what the widgets post between two actions
        GameRecord& r = board.record;
        if (r.gameOver) {
            ++ended;
            board.NewGame();
            continue;
        }
        bool pressed = false;
        for (int id : {kCmdDeal, kCmdSendToCrib, kCmdScorePlayerHand, kCmdScoreOpponentHand, kCmdScoreCrib, kCmdOk}) {
            if (board.IsButtonShown(id)) {
                board.OnCommand(id);
                pressed = true;
                break;
            }
        }
        if (pressed)
            continue;
        if (r.phase == kPhaseDiscard) {
            const int first = static_cast<int>(random() % 6) + 1;
            const int second = (first + static_cast<int>(random() % 5)) % 6 + 1;
            board.OnCardTap(first, r.playerHandSprites[first - 1]);
            board.OnCardTap(second, r.playerHandSprites[second - 1]);
        } else if (r.phase == kPhasePlay) {
            for (int p = 2; p <= 5; ++p) {
                const CardSprite& sprite = r.playerHandSprites[p - 1];
                if (sprite.suit1 != kSuitEmpty && r.runningCount + CardValue(r.deal[p - 1]) <= 31) {
                    board.OnCardTap(p, r.playerHandSprites[p - 1]);
                    break;
                }
            }
        } else {
            std::printf("the scripted user is stuck in phase %d\n", r.phase);
            return ended;
        }
    }
    return ended;
}

} // namespace

void RunGameBench(int argc, char** argv)
{
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    // The tally is saved at every game's end and New; keep it off the user's
    // settings, and in memory where the system has a memory file system.
    const QString base = QDir(QStringLiteral("/dev/shm")).exists() ? QStringLiteral("/dev/shm") : QDir::tempPath();
    QTemporaryDir store(base + QStringLiteral("/vennick-bench-XXXXXX"));
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, store.path());
    qputenv("XDG_CONFIG_HOME", store.path().toUtf8());
    QApplication app(argc, argv);

    std::mt19937 random(kSeed);
    {
        GameBoard board;  // never shown: the decisions alone
        std::printf("\nComputer's discard: %.2f us per deal (median of %d batches of 100 random deals)\n",
                    MicrosecondsPerDiscard(board, random), kBatches);
        std::printf("Computer's card choice: %.3f us per call (median of %d batches of 1000 random positions)\n",
                    MicrosecondsPerChoice(board, random), kBatches);
    }

    GameBoard board;
    board.setFixedSize(240, 268);
    board.show();
    QCoreApplication::processEvents();
    board.repaint();  // the first paint makes the buttons and the log
    board.hide();     // then the game alone is timed, not the painting
    board.randomSource = [&random] { return static_cast<int>(random() >> 1); };
    constexpr int kGames = 2000;
    const double start = ThreadSeconds();
    const int games = PlayGames(board, random, kGames);
    const double seconds = ThreadSeconds() - start;
    std::printf("Whole games: %d games in %.2f s of processor time, %.0f games per second "
                "(tally %d won, %d lost)\n",
                games, seconds, games / seconds, board.record.gamesFor, board.record.gamesAgainst);
}

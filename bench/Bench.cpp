// Figures for the hand counter and the play scorer: every hand of four with a
// starter counted under both rules (score table, totals, means, agreement of
// the counter and of the reasons with the plain reference counter, time per
// count and per itemised hand), then the time per play score over a fixed set
// of random plays and the agreement of the play scorer and its reasons with
// the reference over every play the game can make; then the computer's
// decisions and whole games (bench/GameBench.cpp). Times are printed, never
// judged; the exit status is 1 only if a counter or its reasons disagree with
// the reference.
// Needs no display. From the source folder:
//   cmake -S . -B build/release -G Ninja -DCMAKE_BUILD_TYPE=Release
//   cmake --build build/release --target vennick_bench
//   build/release/bench/vennick_bench

#include "bench/GameBench.h"
#include "bench/Timing.h"
#include "play/PlayReasons.h"
#include "play/PlaySequence.h"
#include "scoring/HandCount.h"
#include "scoring/ScoreReasons.h"
#include "tests/play/ReferencePlay.h"
#include "tests/scoring/ReferenceCount.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <random>
#include <vector>

namespace {

constexpr int kRepetitions = 7;
constexpr int kMaxScore = 29;
constexpr long long kHands = 12994800;
constexpr int kPlays = 1000000;
// The reasons are timed on every 97th hand, as the tests sample them.
constexpr long long kItemiseEvery = 97;

struct RuleFigures {
    std::array<long long, kMaxScore + 2> hands{};  // the last slot: anything above 29
    long long totalPoints = 0;
    long long disagreements = 0;
    long long reasonDisagreements = 0;
    double nanosecondsPerCount = 0;
    double nanosecondsPerItemise = 0;
    long long checksum = 0;
    long long reasonCharacters = 0;
};

RuleFigures CountEveryHand(bool cribRule)
{
    RuleFigures figures;
    ForEveryHand([&](const CardId* cards) {
        const int points = CountHandCards(cards, cribRule);
        ++figures.hands[static_cast<size_t>(std::clamp(points, 0, kMaxScore + 1))];
        figures.totalPoints += points;
        const int reference = ReferenceCountHand(cards, cribRule);
        if (points != reference)
            ++figures.disagreements;
        if (ItemsTotal(ItemiseHand(cards, cribRule)) != reference)
            ++figures.reasonDisagreements;
    });

    std::vector<double> times;
    for (int repetition = 0; repetition < kRepetitions; ++repetition) {
        long long sum = 0;
        const double start = ThreadSeconds();
        ForEveryHand([&](const CardId* cards) { sum += CountHandCards(cards, cribRule); });
        times.push_back((ThreadSeconds() - start) * 1e9 / static_cast<double>(kHands));
        figures.checksum = sum;
    }
    figures.nanosecondsPerCount = Median(times);

    // A reasons line as the log writes it: the reasons and their text.
    std::vector<std::array<CardId, 5>> sample;
    long long hands = 0;
    ForEveryHand([&](const CardId* cards) {
        if (hands++ % kItemiseEvery == 0)
            sample.push_back({cards[0], cards[1], cards[2], cards[3], cards[4]});
    });
    times.clear();
    for (int repetition = 0; repetition < kRepetitions; ++repetition) {
        long long characters = 0;
        const double start = ThreadSeconds();
        for (const auto& cards : sample)
            characters += ReasonsLine(ItemiseHand(cards.data(), cribRule)).size();
        times.push_back((ThreadSeconds() - start) * 1e9 / static_cast<double>(sample.size()));
        figures.reasonCharacters = characters;
    }
    figures.nanosecondsPerItemise = Median(times);
    return figures;
}

// Plays as the table makes them: cards from a shuffled deck laid in turn,
// skipping any that would pass 31, until the drawn number of cards (1 to 8)
// is down.
std::vector<PlaySequence> RandomPlays()
{
    std::mt19937 random(20240611);
    std::uniform_int_distribution<int> cardsWanted(1, 8);
    std::array<int, 52> deck{};
    for (int i = 0; i < 52; ++i)
        deck[static_cast<size_t>(i)] = i % 13 + 1;
    std::vector<PlaySequence> plays(kPlays);
    for (PlaySequence& play : plays) {
        std::shuffle(deck.begin(), deck.end(), random);
        const int wanted = cardsWanted(random);
        int total = 0;
        int laid = 0;
        for (int rank1 : deck) {
            if (laid == wanted)
                break;
            if (total + Rank1Value(rank1) > 31)
                continue;
            SequenceAppend(play, rank1);
            total += Rank1Value(rank1);
            ++laid;
        }
    }
    return plays;
}

} // namespace

int main(int argc, char** argv)
{
#ifndef NDEBUG
    std::printf("Warning: not an optimised build; the times below mean little.\n\n");
#endif
    std::printf("Hand counter: all %lld hands of four cards with a starter\n\n", kHands);
    const RuleFigures hand = CountEveryHand(false);
    const RuleFigures crib = CountEveryHand(true);

    std::printf("%5s %12s %12s\n", "score", "hand rule", "crib rule");
    for (int score = 0; score <= kMaxScore; ++score)
        std::printf("%5d %12lld %12lld\n", score, hand.hands[static_cast<size_t>(score)],
                    crib.hands[static_cast<size_t>(score)]);
    std::printf("%5s %12lld %12lld\n", ">29", hand.hands[kMaxScore + 1], crib.hands[kMaxScore + 1]);
    std::printf("%5s %12lld %12lld\n", "total", hand.totalPoints, crib.totalPoints);
    std::printf("%5s %12.6f %12.6f\n", "mean", static_cast<double>(hand.totalPoints) / kHands,
                static_cast<double>(crib.totalPoints) / kHands);
    std::printf("\nDisagreements with the reference counter: hand rule %lld, crib rule %lld\n",
                hand.disagreements, crib.disagreements);
    std::printf("Reasons whose points differ from it: hand rule %lld, crib rule %lld\n", hand.reasonDisagreements,
                crib.reasonDisagreements);
    std::printf("Time per count (median of %d passes over every hand): hand rule %.2f ns, crib rule %.2f ns\n",
                kRepetitions, hand.nanosecondsPerCount, crib.nanosecondsPerCount);
    std::printf("Time per reasons line, ItemiseHand and ReasonsLine (median of %d passes over every %lldth hand): "
                "hand rule %.0f ns, crib rule %.0f ns\n",
                kRepetitions, kItemiseEvery, hand.nanosecondsPerItemise, crib.nanosecondsPerItemise);
    std::printf("(checksums %lld %lld; characters of reasons %lld %lld)\n", hand.checksum, crib.checksum,
                hand.reasonCharacters, crib.reasonCharacters);

    std::printf("\nPlay scorer: %d random legal plays of 1 to 8 cards\n", kPlays);
    const std::vector<PlaySequence> plays = RandomPlays();
    long long randomDisagreements = 0;
    long long randomReasonDisagreements = 0;
    for (const PlaySequence& play : plays) {
        const int reference = ReferenceScorePlay(play);
        randomDisagreements += ScorePlay(play) != reference ? 1 : 0;
        randomReasonDisagreements += ItemsTotal(ItemisePlay(play)) != reference ? 1 : 0;
    }
    std::vector<double> times;
    long long sum = 0;
    for (int repetition = 0; repetition < kRepetitions; ++repetition) {
        sum = 0;
        const double start = ThreadSeconds();
        for (const PlaySequence& play : plays)
            sum += ScorePlay(play);
        times.push_back((ThreadSeconds() - start) * 1e9 / kPlays);
    }
    std::printf("Time per ScorePlay call (median of %d passes): %.2f ns (points in all %lld)\n", kRepetitions,
                Median(times), sum);

    long long visited = 0;
    long long everyDisagreements = 0;
    long long everyReasonDisagreements = 0;
    ForEveryLegalPlay(8, [&](const PlaySequence& sequence) {
        ++visited;
        const int reference = ReferenceScorePlay(sequence);
        everyDisagreements += ScorePlay(sequence) != reference ? 1 : 0;
        everyReasonDisagreements += ItemsTotal(ItemisePlay(sequence)) != reference ? 1 : 0;
    });
    std::printf("Disagreements with the reference scorer: %lld of the random plays, %lld of all %lld legal plays\n",
                randomDisagreements, everyDisagreements, visited);
    std::printf("Reasons whose points differ from it: %lld of the random plays, %lld of all legal plays\n",
                randomReasonDisagreements, everyReasonDisagreements);

    RunGameBench(argc, argv);

    const bool agreed = hand.disagreements == 0 && crib.disagreements == 0 && randomDisagreements == 0
        && everyDisagreements == 0 && hand.reasonDisagreements == 0 && crib.reasonDisagreements == 0
        && randomReasonDisagreements == 0 && everyReasonDisagreements == 0;
    return agreed ? 0 : 1;
}

#include "play/PlaySequence.h"

#include <bit>
#include <cstdint>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

namespace {

constexpr int kEnd = -1;
constexpr int kMaxCards = 8;
constexpr int kEntries = 9;

// Any record, whatever its entries hold: one walk back from the last card.
// - Pairs: cards of the last card's rank immediately before it; the k-th adds
//   2k (2 for a pair, 6 for three, 12 for four).
// - Runs: the last L cards form a run exactly when they are all different and
//   their highest and lowest differ by L - 1, whatever the order laid. The
//   longest such L of 3 or more counts. Once the window holds a repeated rank
//   or a rank more than 8 away from the last card, no longer window can be a
//   run (at most nine cards fit), so the search stops there.
// - Fifteen and thirty-one: on the sequence's own total.
int ScoreAnySequence(const PlaySequence& sequence, int length)
{
    if (length == 0)
        return 0;
    const int64_t last = sequence.entries[length - 1];

    int points = 0;
    int64_t total = Rank1Value(sequence.entries[length - 1]);
    int matches = 0;
    bool matching = true;

    // Ranks seen so far as bits offset from the last card's rank (bit 8 is
    // the last card itself), with the lowest and highest offset seen.
    uint32_t seen = 1u << 8;
    int64_t lowest = 0;
    int64_t highest = 0;
    bool runPossible = true;
    int run = 0;

    for (int i = length - 2; i >= 0; --i) {
        const int64_t rank1 = sequence.entries[i];
        total += Rank1Value(sequence.entries[i]);

        if (matching && rank1 == last)
            points += 2 * ++matches;
        else
            matching = false;

        if (runPossible) {
            const int64_t offset = rank1 - last;
            const uint32_t bit = (offset >= -8 && offset <= 8) ? 1u << (offset + 8) : 0u;
            if (bit == 0 || (seen & bit) != 0) {
                runPossible = false;
            } else {
                seen |= bit;
                lowest = offset < lowest ? offset : lowest;
                highest = offset > highest ? offset : highest;
                const int cards = length - i;
                if (cards >= 3 && highest - lowest == cards - 1)
                    run = cards;
            }
        }
    }

    points += run;
    if (total == 15 || total == 31)
        points += 2;
    return points;
}

#if defined(__SSE2__)
// Sequences as the play makes them, 1 to 8 ranks of 1..13, scored with all
// eight places side by side and no branch on the cards: the scorer sits in
// the computer's inner loop, where the walk above loses most of its time to
// mispredicted loop exits. Lane i of every vector is place i; a bit mask
// from _mm_movemask_epi8 has two bits per place.
int ScorePlaySequence(const PlaySequence& sequence, int length, __m128i ranks)
{
    const __m128i place = _mm_setr_epi16(0, 1, 2, 3, 4, 5, 6, 7);
    const __m128i inside = _mm_cmpgt_epi16(_mm_set1_epi16(static_cast<int16_t>(length)), place);
    const auto lastRank = static_cast<int16_t>(sequence.entries[length - 1]);
    const __m128i last = _mm_set1_epi16(lastRank);

    // Fifteen and thirty-one.
    __m128i values = _mm_and_si128(_mm_min_epi16(ranks, _mm_set1_epi16(10)), inside);
    values = _mm_madd_epi16(values, _mm_set1_epi16(1));
    values = _mm_add_epi32(values, _mm_shuffle_epi32(values, 0x4E));
    values = _mm_add_epi32(values, _mm_shuffle_epi32(values, 0xB1));
    const int total = _mm_cvtsi128_si32(values);
    int points = (total == 15 || total == 31) ? 2 : 0;

    // Pairs: the places before the last card that differ from it; the cards
    // above the highest of them match.
    const uint32_t before = (1u << (2 * (length - 1))) - 1;
    const auto equal = static_cast<uint32_t>(_mm_movemask_epi8(_mm_cmpeq_epi16(ranks, last)));
    const uint32_t differ = ~equal & before;
    const int matches = length - 1 - (std::bit_width((differ << 1) | 1u) - 1) / 2;
    points += matches * (matches + 1);

    // Runs. With each rank taken less the last card's, and 0 past the end
    // (the last card's own value, so it changes no window's extremes), the
    // highest and lowest of places i..7 are those of the window starting at
    // place i, which holds length - i cards.
    const __m128i offset = _mm_and_si128(_mm_sub_epi16(ranks, last), inside);
    __m128i highest = _mm_max_epi16(offset, _mm_srli_si128(offset, 2));
    __m128i lowest = _mm_min_epi16(offset, _mm_srli_si128(offset, 2));
    highest = _mm_max_epi16(highest, _mm_srli_si128(highest, 4));
    lowest = _mm_min_epi16(lowest, _mm_srli_si128(lowest, 4));
    highest = _mm_max_epi16(highest, _mm_srli_si128(highest, 8));
    lowest = _mm_min_epi16(lowest, _mm_srli_si128(lowest, 8));
    const __m128i spread = _mm_sub_epi16(_mm_set1_epi16(static_cast<int16_t>(length - 1)), place);
    const auto fits = static_cast<uint32_t>(_mm_movemask_epi8(_mm_cmpeq_epi16(_mm_sub_epi16(highest, lowest), spread)));

    // A window must not repeat a rank: find the places whose rank comes again
    // later. Past the end stand distinct negative fillers, which match
    // nothing, nor do the zeros the shifts bring in.
    const __m128i filler = _mm_setr_epi16(-2, -3, -4, -5, -6, -7, -8, -9);
    const __m128i held = _mm_or_si128(_mm_and_si128(ranks, inside), _mm_andnot_si128(inside, filler));
    __m128i again = _mm_cmpeq_epi16(held, _mm_srli_si128(held, 2));
    again = _mm_or_si128(again, _mm_cmpeq_epi16(held, _mm_srli_si128(held, 4)));
    again = _mm_or_si128(again, _mm_cmpeq_epi16(held, _mm_srli_si128(held, 6)));
    again = _mm_or_si128(again, _mm_cmpeq_epi16(held, _mm_srli_si128(held, 8)));
    again = _mm_or_si128(again, _mm_cmpeq_epi16(held, _mm_srli_si128(held, 10)));
    again = _mm_or_si128(again, _mm_cmpeq_epi16(held, _mm_srli_si128(held, 12)));
    again = _mm_or_si128(again, _mm_cmpeq_epi16(held, _mm_srli_si128(held, 14)));
    const auto repeats = static_cast<uint32_t>(_mm_movemask_epi8(again));
    const uint32_t afterRepeats = ~((1u << (std::bit_width((repeats << 1) | 1u) - 1)) - 1);

    // Windows of three cards or more start at places 0..length-3; the
    // longest run starts at the lowest place that qualifies.
    const auto threeOrMore = static_cast<uint32_t>(((1ull << (2 * length)) - 1) >> 4);
    const uint32_t runs = fits & afterRepeats & threeOrMore;
    const int run = (length - std::countr_zero(runs | 0x10000u) / 2) & -static_cast<int>(runs != 0);
    return points + run;
}
#endif

} // namespace

int SequenceLength(const PlaySequence& sequence)
{
    for (int i = 0; i < kEntries; ++i)
        if (sequence.entries[i] == kEnd)
            return i;
    return kEntries;
}

void SequenceAppend(PlaySequence& sequence, int rank1)
{
    for (int i = 0; i < kMaxCards; ++i) {
        if (sequence.entries[i] == kEnd) {
            sequence.entries[i] = rank1;
            sequence.entries[i + 1] = kEnd;
            return;
        }
    }
}

void SequenceCopy(const PlaySequence& source, PlaySequence& target)
{
    target = source;
}

int ScorePlay(const PlaySequence& sequence)
{
#if defined(__SSE2__)
    // The first eight entries as 16-bit lanes; the narrowing saturates, so
    // -1 stays -1 and nothing else becomes a rank 1..13. The length, and
    // whether every card laid is such a rank, are found without a branch;
    // anything else, or nine entries without an end marker, takes the walk.
    const __m128i ranks = _mm_packs_epi32(_mm_loadu_si128(reinterpret_cast<const __m128i*>(sequence.entries)),
                                          _mm_loadu_si128(reinterpret_cast<const __m128i*>(sequence.entries + 4)));
    const auto ends = static_cast<uint32_t>(_mm_movemask_epi8(_mm_cmpeq_epi16(ranks, _mm_set1_epi16(kEnd))))
        | static_cast<uint32_t>(sequence.entries[8] == kEnd) << 16 | 1u << 18;
    const int length = std::countr_zero(ends) / 2;
    const __m128i isRank = _mm_and_si128(_mm_cmpgt_epi16(ranks, _mm_setzero_si128()),
                                         _mm_cmplt_epi16(ranks, _mm_set1_epi16(14)));
    const auto rankBits = static_cast<uint32_t>(_mm_movemask_epi8(isRank));
    const uint32_t laid = (1u << (2 * length)) - 1;
    if (length == 0 || length > kMaxCards || (rankBits & laid) != laid)
        return ScoreAnySequence(sequence, length);
    return ScorePlaySequence(sequence, length, ranks);
#else
    return ScoreAnySequence(sequence, SequenceLength(sequence));
#endif
}

#include "play/PlayReasons.h"

#include "play/PlaySequence.h"

#include <algorithm>

QList<ScoreItem> ItemisePlay(const PlaySequence& sequence)
{
    QList<ScoreItem> items;
    const int length = SequenceLength(sequence);
    if (length == 0)
        return items;
    const int32_t* const ranks = sequence.entries;
    const int32_t last = ranks[length - 1];

    int total = 0;
    for (int i = 0; i < length; ++i)
        total += Rank1Value(ranks[i]);
    if (total == 15)
        items.append({QStringLiteral("fifteen"), 2});
    else if (total == 31)
        items.append({QStringLiteral("thirty-one"), 2});

    // The cards of the last card's rank laid straight before it.
    int equal = 1;
    while (equal < length && ranks[length - 1 - equal] == last)
        ++equal;
    if (equal == 2)
        items.append({QStringLiteral("a pair"), 2});
    else if (equal == 3)
        items.append({QStringLiteral("three of a kind"), 6});
    else if (equal == 4)
        items.append({QStringLiteral("four of a kind"), 12});

    // The longest run among the last cards: all different, and the highest
    // and lowest as far apart as their number allows.
    for (int cards = length; cards >= 3; --cards) {
        const int first = length - cards;
        int32_t lowest = last;
        int32_t highest = last;
        bool different = true;
        for (int i = first; i < length; ++i) {
            lowest = std::min(lowest, ranks[i]);
            highest = std::max(highest, ranks[i]);
            for (int j = first; j < i; ++j)
                different = different && ranks[j] != ranks[i];
        }
        if (different && highest - lowest == cards - 1) {
            items.append({RunName(cards), cards});
            break;
        }
    }
    return items;
}

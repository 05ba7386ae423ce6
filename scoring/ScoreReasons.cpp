#include "scoring/ScoreReasons.h"

#include <QStringList>

namespace {

constexpr int kJackRank = 10;

} // namespace

QString RunName(int cards)
{
    static const char* const kNumbers[] = {"three", "four", "five", "six", "seven", "eight"};
    if (cards < 3 || cards > 8)
        return QStringLiteral("a run of %1").arg(cards);
    return QStringLiteral("a run of ") + QLatin1String(kNumbers[cards - 3]);
}

QList<ScoreItem> ItemiseHand(const CardId cards[5], bool cribRule)
{
    QList<ScoreItem> items;

    // Fifteens: every combination of two or more of the five cards.
    for (int subset = 3; subset < 32; ++subset) {
        int sum = 0;
        int members = 0;
        for (int i = 0; i < 5; ++i)
            if (subset & (1 << i)) {
                sum += CardValue(cards[i]);
                ++members;
            }
        if (members >= 2 && sum == 15)
            items.append({QStringLiteral("fifteen"), 2});
    }

    int count[13] = {};
    for (int i = 0; i < 5; ++i)
        ++count[CardRank(cards[i])];

    // Equal ranks, one reason per rank: every two of its cards make a pair.
    for (int rank = 0; rank < 13; ++rank) {
        if (count[rank] == 2)
            items.append({QStringLiteral("a pair"), 2});
        else if (count[rank] == 3)
            items.append({QStringLiteral("three of a kind"), 6});
        else if (count[rank] == 4)
            items.append({QStringLiteral("four of a kind"), 12});
    }

    // Runs: the longest stretch of ranks present, ace low (five cards hold at
    // most one of three or more). Each way of taking one card of every rank
    // in it is a run of its own.
    for (int low = 0; low < 13;) {
        int high = low;
        int ways = 1;
        while (high < 13 && count[high] > 0)
            ways *= count[high++];
        if (high - low >= 3)
            for (int way = 0; way < ways; ++way)
                items.append({RunName(high - low), high - low});
        low = high + 1;
    }

    // The flush: the four cards of one suit, or all five.
    const int suit = CardSuit(cards[0]);
    bool fourOfSuit = true;
    for (int i = 1; i < 4; ++i)
        fourOfSuit = fourOfSuit && CardSuit(cards[i]) == suit;
    if (fourOfSuit && CardSuit(cards[4]) == suit)
        items.append({QStringLiteral("a flush of five"), 5});
    else if (fourOfSuit && !cribRule)
        items.append({QStringLiteral("a flush of four"), 4});

    // His nobs: the jack of the starter's suit among the four cards.
    for (int i = 0; i < 4; ++i)
        if (CardRank(cards[i]) == kJackRank && CardSuit(cards[i]) == CardSuit(cards[4]))
            items.append({QStringLiteral("his nobs"), 1});

    return items;
}

int ItemsTotal(const QList<ScoreItem>& items)
{
    int total = 0;
    for (const ScoreItem& item : items)
        total += item.points;
    return total;
}

QString ReasonsLine(const QList<ScoreItem>& items)
{
    QStringList parts;
    int total = 0;
    for (const ScoreItem& item : items) {
        total += item.points;
        parts.append(item.name + QLatin1Char(' ') + QString::number(total));
    }
    return parts.join(QStringLiteral(", "));
}

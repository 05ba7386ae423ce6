#pragma once

#include "game/GameRecord.h"

#include <QList>
#include <QString>

// One reason for points: "fifteen", 2.
struct ScoreItem {
    QString name;
    int points = 0;
};

// The reasons of four cards (positions 0 to 3) with the starter (position 4),
// in this order: each fifteen, each group of equal ranks, each run (a double
// run lists each of its runs), the flush, his nobs. Under the crib rule a
// flush needs all five cards of one suit, as CountHandCards has it; the points
// of the reasons always add up to that count. Plain code: about half a
// microsecond, once for each hand or crib shown.
QList<ScoreItem> ItemiseHand(const CardId cards[5], bool cribRule);

// The points of all the reasons together.
int ItemsTotal(const QList<ScoreItem>& items);

// Each reason with the running total, "fifteen 2, fifteen 4, a pair 6"; the
// last total is the points. Empty for no reasons.
QString ReasonsLine(const QList<ScoreItem>& items);

// "a run of three" .. "a run of eight", by the number of cards in the run.
QString RunName(int cards);

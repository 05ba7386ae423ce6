#include "presentation/HoleMap.h"

namespace {

struct ArcHole {
    HolePoint player;
    HolePoint opponent;
};

// The arcs across the top (holes 36..45) and the bottom (81..85), before the
// player's track is shifted one pixel left.
constexpr ArcHole kTopArc[10] = {
    {{13, 29}, {21, 29}}, {{14, 20}, {22, 23}}, {{20, 14}, {27, 19}}, {{28, 10}, {33, 17}},
    {{37, 8}, {39, 16}},  {{47, 8}, {45, 16}},  {{56, 10}, {51, 17}}, {{64, 14}, {57, 19}},
    {{70, 20}, {62, 23}}, {{71, 29}, {63, 29}},
};
constexpr ArcHole kBottomArc[5] = {
    {{71, 185}, {63, 185}}, {{65, 197}, {61, 190}}, {{55, 200}, {55, 191}},
    {{44, 197}, {49, 190}}, {{38, 185}, {46, 185}},
};

// A straight column of 35 holes. y is kept in half pixels: holes are 4 pixels
// apart, with one and a half more after every fifth hole.
void Column(HolePoint player[], HolePoint opponent[], int first, int last, int playerX, int opponentX,
            int v, int direction)
{
    for (int n = first; n <= last; ++n) {
        player[n] = {playerX, v / 2};
        opponent[n] = {opponentX, v / 2};
        v += direction * (n % 5 == 0 ? 11 : 8);
    }
}

} // namespace

void BuildHoleTables(HolePoint playerHoles[kHoleCount], HolePoint opponentHoles[kHoleCount])
{
    playerHoles[kStartHole] = {13, 190};
    opponentHoles[kStartHole] = {21, 190};
    playerHoles[kBackStartHole] = {13, 195};
    opponentHoles[kBackStartHole] = {21, 195};

    Column(playerHoles, opponentHoles, 1, 35, 13, 21, 359, -1);
    for (int i = 0; i < 10; ++i) {
        playerHoles[36 + i] = kTopArc[i].player;
        opponentHoles[36 + i] = kTopArc[i].opponent;
    }
    Column(playerHoles, opponentHoles, 46, 80, 71, 63, 69, +1);
    for (int i = 0; i < 5; ++i) {
        playerHoles[81 + i] = kBottomArc[i].player;
        opponentHoles[81 + i] = kBottomArc[i].opponent;
    }
    Column(playerHoles, opponentHoles, 86, 120, 38, 46, 359, -1);
    playerHoles[kGameHole] = {42, 26};
    opponentHoles[kGameHole] = {42, 26};

    // The player's outer track sits one pixel further left, except on the
    // right-hand column and the corners that join it.
    for (int n = 0; n < kHoleCount; ++n)
        if (n < 45 || n > 81)
            playerHoles[n].x -= 1;
}

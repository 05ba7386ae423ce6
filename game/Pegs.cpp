#include "game/GameBoard.h"

#include <algorithm>

namespace {

// A peg moves only while no peg stands in the game hole; it never passes it.
void SetHole(int32_t& peg, int hole, const GameRecord& r)
{
    for (const int32_t* other : {&r.playerBackHole, &r.playerFrontHole, &r.opponentBackHole, &r.opponentFrontHole})
        if (other != &peg && *other == kGameHole)
            return;
    peg = std::min(hole, kGameHole);
}

} // namespace

void GameBoard::SetPlayerBackHole(int hole) { SetHole(record.playerBackHole, hole, record); }
void GameBoard::SetPlayerFrontHole(int hole) { SetHole(record.playerFrontHole, hole, record); }
void GameBoard::SetOpponentBackHole(int hole) { SetHole(record.opponentBackHole, hole, record); }
void GameBoard::SetOpponentFrontHole(int hole) { SetHole(record.opponentFrontHole, hole, record); }

void GameBoard::MovePlayerPegs(int points)
{
    MovePegs(points, &GameBoard::SetPlayerBackHole, &GameBoard::SetPlayerFrontHole, record.playerFrontHole);
}

void GameBoard::MoveOpponentPegs(int points)
{
    MovePegs(points, &GameBoard::SetOpponentBackHole, &GameBoard::SetOpponentFrontHole, record.opponentFrontHole);
}

void GameBoard::MovePegs(int points, void (GameBoard::*setBack)(int), void (GameBoard::*setFront)(int),
                         const int32_t& frontHole)
{
    if (points <= 0)
        return;
    InvalidatePegRects();
    // Leapfrog: the back peg jumps to the front peg, which moves on.
    (this->*setBack)(frontHole);
    (this->*setFront)(frontHole + points);
    UpdatePegRects(true);
}

void GameBoard::InvalidatePegRects()
{
    Invalidate(record.playerBackPegRect);
    Invalidate(record.playerFrontPegRect);
    Invalidate(record.opponentBackPegRect);
    Invalidate(record.opponentFrontPegRect);
}

void GameBoard::UpdatePegRects(bool invalidate)
{
    const int w = pegInfo.bmWidth;
    const int h = pegInfo.bmHeight;
    // The peg image is centred on its hole; the half width serves both ways.
    auto pegRect = [w, h](HolePoint hole) {
        const int left = hole.x - w / 2;
        const int top = hole.y - w / 2;
        return Rect{left, top, left + w, top + h};
    };
    GameRecord& r = record;
    r.playerBackPegRect = pegRect(r.playerHoles[r.playerBackHole]);
    r.playerFrontPegRect = pegRect(r.playerHoles[r.playerFrontHole]);
    r.opponentBackPegRect = pegRect(r.opponentHoles[r.opponentBackHole]);
    r.opponentFrontPegRect = pegRect(r.opponentHoles[r.opponentFrontHole]);
    if (invalidate)
        InvalidatePegRects();
}

void GameBoard::RefreshCount()
{
    record.shownCount = record.runningCount;
    Invalidate(record.countRect);
}

#include "game/GameBoard.h"

#include <cstdlib>
#include <ctime>

GameBoard::GameBoard(QWidget* parent)
    : QWidget(parent)
{
    // The game window keeps the keyboard; it paints every pixel itself.
    setFocusPolicy(Qt::StrongFocus);
    setAttribute(Qt::WA_OpaquePaintEvent);

    record.firstPaintPending = 1;
    std::srand(static_cast<unsigned>(std::time(nullptr)));
    randomSource = [] { return std::rand(); };
    record.savedPlayerCrib = 1;
    LoadImages();
    ResetTable();
    PlaceCountRect();
}

GameBoard::~GameBoard() = default;

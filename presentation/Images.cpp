#include "game/GameBoard.h"

void GameBoard::LoadImages()
{
    boardBitmap.Load(kBitmapBoardNormal);
    boardInfo = boardBitmap.Info();
    suitFaceBitmaps[0].Load(kBitmapFaceSpades);
    cardInfo = suitFaceBitmaps[0].Info();
    suitFaceBitmaps[1].Load(kBitmapFaceDiamonds);
    suitFaceBitmaps[2].Load(kBitmapFaceHearts);
    suitFaceBitmaps[3].Load(kBitmapFaceClubs);
    backBitmap.Load(kBitmapBack);
    playerPegBitmap.Load(kBitmapPlayerPeg);
    opponentPegBitmap.Load(kBitmapOpponentPeg);
    pegInfo = opponentPegBitmap.Info();
    rankGlyphBitmap.Load(kBitmapRankGlyphs);
    digitBitmap.Load(kBitmapDigits);
}

void GameBoard::ReloadBoardBitmap()
{
    boardBitmap.Reset();
    switch (record.boardStyle) {
    case 1: boardBitmap.Load(kBitmapBoardNormal); break;
    case 2: boardBitmap.Load(kBitmapBoardWooden); break;
    default: boardBitmap.Load(kBitmapBoardEmbossed); break;
    }
    boardInfo = boardBitmap.Info();
    Invalidate(Rect{0, 0, boardInfo.bmWidth, boardInfo.bmHeight});
}

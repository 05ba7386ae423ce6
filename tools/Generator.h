#pragma once

#include "ArtFile.h"
#include "Canvas.h"

// Card faces for suit1 1..4 (spades, diamonds, hearts, clubs), the back, the
// rank glyph strip, the pegs and the count digits, from the sprites of cards.txt.
Canvas MakeFace(const ArtFile& art, int suit1);
Canvas MakeBack(const ArtFile& art);
Canvas MakeRankGlyphs(const ArtFile& art);
Canvas MakeDigits(const ArtFile& art);

// The three looks of the pegging board.
enum class BoardLook { Normal, Wooden, Embossed };
Canvas MakeBoard(BoardLook look, Colour table);

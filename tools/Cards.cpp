#include "Generator.h"

#include <string>

namespace {

constexpr int kCardWidth = 23;
constexpr int kCardHeight = 41;
constexpr int kGlyphWidth = 8;
constexpr int kGlyphHeight = 10;
constexpr int kDigitSize = 8;

const char* const kSuitNames[4] = {"spades", "diamonds", "hearts", "clubs"};

// A blank card: the edge with its corner pixels left to the table, so the
// card looks rounded on the green.
Canvas BlankCard(const ArtFile& art, Colour inside)
{
    const Colour edge = art.Named("edge");
    const Colour table = art.Named("table");
    Canvas card(kCardWidth, kCardHeight, inside);
    for (int x = 0; x < kCardWidth; ++x) {
        card.Set(x, 0, edge);
        card.Set(x, kCardHeight - 1, edge);
    }
    for (int y = 0; y < kCardHeight; ++y) {
        card.Set(0, y, edge);
        card.Set(kCardWidth - 1, y, edge);
    }
    for (int x : {0, kCardWidth - 1})
        for (int y : {0, kCardHeight - 1})
            card.Set(x, y, table);
    return card;
}

} // namespace

Canvas MakeFace(const ArtFile& art, int suit1)
{
    const std::string suit = kSuitNames[suit1 - 1];
    const Canvas& small = art.Sprite(suit + "-small", 9, 9);
    const Canvas& large = art.Sprite(suit + "-large", 13, 13);
    Canvas face = BlankCard(art, art.Named("card"));

    // The upright rank glyph lands at x 2..10, y 3..13 and the turned one at
    // x 13..21, y 28..38: the pips keep clear of both. The small pip stands
    // beside each glyph, level with its ink; the whole face reads the same
    // when the card is turned.
    face.Paste(small, 12, 3);
    face.Paste(small.Turned(), kCardWidth - 12 - small.Width(), kCardHeight - 3 - small.Height());
    face.Paste(large, (kCardWidth - large.Width()) / 2, (kCardHeight - large.Height()) / 2);
    return face;
}

Canvas MakeBack(const ArtFile& art)
{
    const Colour white = art.Named("white");
    Canvas back = BlankCard(art, white);
    const Canvas& tile = art.Sprite("back-tile");
    for (int y = 2; y < kCardHeight - 2; ++y)
        for (int x = 2; x < kCardWidth - 2; ++x)
            back.Set(x, y, tile.At(x % tile.Width(), y % tile.Height()));
    // A white frame inside the pattern marks it plainly as the back.
    for (int x = 5; x < kCardWidth - 5; ++x) {
        back.Set(x, 5, white);
        back.Set(x, kCardHeight - 6, white);
    }
    for (int y = 5; y < kCardHeight - 5; ++y) {
        back.Set(5, y, white);
        back.Set(kCardWidth - 6, y, white);
    }
    return back;
}

Canvas MakeRankGlyphs(const ArtFile& art)
{
    static const char* const kRankNames[13] = {"A", "2", "3", "4", "5", "6", "7",
                                               "8", "9", "10", "J", "Q", "K"};
    const Colour black = art.Named("black");
    const Colour red = art.Named("red");
    Canvas strip(14 * kGlyphWidth, 4 * kGlyphHeight, art.Named("card"));
    for (int rank1 = 1; rank1 <= 13; ++rank1) {
        Canvas glyph = art.Sprite(std::string("rank-") + kRankNames[rank1 - 1], kGlyphWidth, kGlyphHeight);
        Canvas redGlyph = glyph;
        redGlyph.Replace(black, red);
        // The ace closes the upright rows so that the turned rows mirror them.
        const int column = rank1 == 1 ? 13 : rank1 - 1;
        const int turnedColumn = 13 - column;
        strip.Paste(glyph, column * kGlyphWidth, 0);
        strip.Paste(redGlyph, column * kGlyphWidth, kGlyphHeight);
        strip.Paste(redGlyph.Turned(), turnedColumn * kGlyphWidth, 2 * kGlyphHeight);
        strip.Paste(glyph.Turned(), turnedColumn * kGlyphWidth, 3 * kGlyphHeight);
    }
    return strip;
}

Canvas MakeDigits(const ArtFile& art)
{
    const Colour table = art.Named("table");
    const Colour ink = art.Named("digit");
    const Colour shadow = art.Named("digit-shadow");
    Canvas strip(10 * kDigitSize, kDigitSize, table);
    for (int d = 0; d < 10; ++d) {
        const Canvas& digit = art.Sprite("digit-" + std::to_string(d), 5, 7);
        // Centred in the cell, leaving room for a shadow that lifts the
        // digit off the table.
        const int left = d * kDigitSize + (kDigitSize - 1 - digit.Width()) / 2;
        for (int y = 0; y < digit.Height(); ++y)
            for (int x = 0; x < digit.Width(); ++x)
                if (digit.At(x, y) == ink)
                    strip.Set(left + x + 1, y + 1, shadow);
        for (int y = 0; y < digit.Height(); ++y)
            for (int x = 0; x < digit.Width(); ++x)
                if (digit.At(x, y) == ink)
                    strip.Set(left + x, y, ink);
    }
    return strip;
}

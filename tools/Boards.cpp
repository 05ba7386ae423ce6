#include "Generator.h"

#include "presentation/HoleMap.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace {

constexpr int kBoardWidth = 86;
constexpr int kBoardHeight = 211;
constexpr int kCornerRadius = 6;
constexpr double kLaneRadius = 3.2;

// Which pixels belong to a shape.
class Mask {
public:
    Mask() : bits(static_cast<size_t>(kBoardWidth * kBoardHeight), 0) {}
    bool operator()(int x, int y) const
    {
        return x >= 0 && y >= 0 && x < kBoardWidth && y < kBoardHeight && bits[Index(x, y)] != 0;
    }
    void Set(int x, int y)
    {
        if (x >= 0 && y >= 0 && x < kBoardWidth && y < kBoardHeight)
            bits[Index(x, y)] = 1;
    }
    // Inside, with a 4-neighbour outside.
    bool Edge(int x, int y) const
    {
        return (*this)(x, y) && (!(*this)(x - 1, y) || !(*this)(x + 1, y) || !(*this)(x, y - 1) || !(*this)(x, y + 1));
    }

private:
    static size_t Index(int x, int y) { return static_cast<size_t>(y * kBoardWidth + x); }
    std::vector<uint8_t> bits;
};

// The board: a rectangle with rounded corners; the table shows around it.
Mask BoardShape()
{
    Mask mask;
    for (int y = 0; y < kBoardHeight; ++y)
        for (int x = 0; x < kBoardWidth; ++x) {
            const double cx = std::clamp(x + 0.5, double{kCornerRadius}, double{kBoardWidth - kCornerRadius});
            const double cy = std::clamp(y + 0.5, double{kCornerRadius}, double{kBoardHeight - kCornerRadius});
            if (std::hypot(x + 0.5 - cx, y + 0.5 - cy) <= kCornerRadius)
                mask.Set(x, y);
        }
    return mask;
}

double DistanceToSegment(double px, double py, HolePoint a, HolePoint b)
{
    const double dx = b.x - a.x;
    const double dy = b.y - a.y;
    const double length2 = dx * dx + dy * dy;
    double t = length2 > 0 ? ((px - a.x) * dx + (py - a.y) * dy) / length2 : 0.0;
    t = std::clamp(t, 0.0, 1.0);
    return std::hypot(px - (a.x + t * dx), py - (a.y + t * dy));
}

// The groove a track's holes sit in: from the back start hole through the
// start hole and holes 1..120 up to the game hole.
Mask Lane(const HolePoint holes[kHoleCount])
{
    std::vector<HolePoint> path{holes[kBackStartHole]};
    for (int n = kStartHole; n <= kGameHole; ++n)
        path.push_back(holes[n]);
    Mask mask;
    for (int y = 0; y < kBoardHeight; ++y)
        for (int x = 0; x < kBoardWidth; ++x)
            for (size_t i = 0; i + 1 < path.size(); ++i)
                if (DistanceToSegment(x, y, path[i], path[i + 1]) <= kLaneRadius) {
                    mask.Set(x, y);
                    break;
                }
    return mask;
}

struct HoleColours {
    Colour core;
    Colour topLeft;      // rim pixel up-left of the centre
    Colour bottomRight;  // rim pixel down-right
    Colour otherRim;     // the other two diagonal pixels
};

// A hole is a plus of core pixels around its centre with its diagonal pixels
// as a rim, so it looks round and stays inside the 5 x 5 peg drawn over it.
void DrawHole(Canvas& board, HolePoint centre, const HoleColours& colours)
{
    const int x = centre.x;
    const int y = centre.y;
    board.Set(x - 1, y - 1, colours.topLeft);
    board.Set(x + 1, y + 1, colours.bottomRight);
    board.Set(x + 1, y - 1, colours.otherRim);
    board.Set(x - 1, y + 1, colours.otherRim);
}

void DrawHoleCore(Canvas& board, HolePoint centre, Colour core)
{
    board.Set(centre.x, centre.y, core);
    board.Set(centre.x - 1, centre.y, core);
    board.Set(centre.x + 1, centre.y, core);
    board.Set(centre.x, centre.y - 1, core);
    board.Set(centre.x, centre.y + 1, core);
}

// Rims first, cores after, so that the two centres of the game hole (one
// pixel apart) merge into one wider hole.
void DrawAllHoles(Canvas& board, const HolePoint player[kHoleCount], const HolePoint opponent[kHoleCount],
                  const HoleColours& colours)
{
    for (int n = 0; n < kHoleCount; ++n) {
        DrawHole(board, player[n], colours);
        DrawHole(board, opponent[n], colours);
    }
    for (int n = 0; n < kHoleCount; ++n) {
        DrawHoleCore(board, player[n], colours.core);
        DrawHoleCore(board, opponent[n], colours.core);
    }
}

// A ring round the shared game hole, so the goal is easy to find.
void DrawGameRing(Canvas& board, HolePoint a, HolePoint b, Colour ring)
{
    const double cx = (a.x + b.x) / 2.0;
    const double cy = (a.y + b.y) / 2.0;
    for (int y = a.y - 4; y <= a.y + 4; ++y)
        for (int x = a.x - 4; x <= b.x + 4; ++x) {
            const double d = std::hypot((x - cx) / 1.1, y - cy);
            if (d >= 2.6 && d < 3.6)
                board.Set(x, y, ring);
        }
}

struct Layout {
    HolePoint player[kHoleCount];
    HolePoint opponent[kHoleCount];
    Mask shape;
    Mask playerLane;
    Mask opponentLane;

    Layout()
    {
        BuildHoleTables(player, opponent);
        shape = BoardShape();
        playerLane = Lane(player);
        opponentLane = Lane(opponent);
    }
    bool InLane(int x, int y) const { return playerLane(x, y) || opponentLane(x, y); }
};

// A light maple board; each side's groove is tinted in the colour of its pegs.
Canvas NormalBoard(const Layout& layout, Colour table)
{
    const Colour surface = Rgb(238, 222, 178);
    const Colour rim = Rgb(120, 84, 40);
    const Colour playerLane = Rgb(206, 218, 236);
    const Colour opponentLane = Rgb(240, 206, 196);
    const Colour laneEdge = Rgb(186, 164, 120);
    const Colour core = Rgb(52, 36, 20);
    const Colour holeRim = Rgb(112, 88, 60);

    Canvas board(kBoardWidth, kBoardHeight, table);
    for (int y = 0; y < kBoardHeight; ++y)
        for (int x = 0; x < kBoardWidth; ++x) {
            if (!layout.shape(x, y))
                continue;
            Colour c = surface;
            if (layout.playerLane(x, y))
                c = layout.playerLane.Edge(x, y) && !layout.opponentLane(x, y) ? laneEdge : playerLane;
            else if (layout.opponentLane(x, y))
                c = layout.opponentLane.Edge(x, y) ? laneEdge : opponentLane;
            if (layout.shape.Edge(x, y))
                c = rim;
            board.Set(x, y, c);
        }
    DrawGameRing(board, layout.player[kGameHole], layout.opponent[kGameHole], rim);
    DrawAllHoles(board, layout.player, layout.opponent, {core, holeRim, holeRim, holeRim});
    return board;
}

// A small hash of a position, for grain that looks irregular but is the same
// in every build.
double Noise(int x, int y)
{
    uint32_t h = static_cast<uint32_t>(x) * 374761393u + static_cast<uint32_t>(y) * 668265263u;
    h = (h ^ (h >> 13)) * 1274126177u;
    h ^= h >> 16;
    return (h & 0xFFFF) / 65535.0;
}

// Walnut: grain running the length of the board, the grooves cut darker.
Canvas WoodenBoard(const Layout& layout, Colour table)
{
    constexpr int kShades = 24;
    const Colour light = Rgb(214, 156, 96);
    const Colour dark = Rgb(150, 92, 46);
    auto woodShade = [&](int x, int y) {
        // Long fibres: the stripes wander slowly across the width as they
        // run down the board, with a little unevenness along each fibre.
        const double wave = (x + 2.2 * std::sin(y * 0.023 + x * 0.05) + 0.9 * std::sin(y * 0.067 + x * 0.11)) / 3.6;
        const double stripe = wave - std::floor(wave);
        double s = std::exp(-stripe * 5.0) * 0.75 + 0.25 * Noise(x, y / 9);
        s = std::clamp(s, 0.0, 1.0);
        return static_cast<int>(std::lround(s * (kShades - 1)));
    };
    auto shadeColour = [&](int level, double darken) {
        const Colour c = Mix(light, dark, static_cast<double>(level) / (kShades - 1));
        return Mix(c, Rgb(40, 20, 8), darken);
    };

    Canvas board(kBoardWidth, kBoardHeight, table);
    for (int y = 0; y < kBoardHeight; ++y)
        for (int x = 0; x < kBoardWidth; ++x) {
            if (!layout.shape(x, y))
                continue;
            const int level = woodShade(x, y);
            double darken = 0.0;
            if (layout.InLane(x, y))
                darken = layout.playerLane.Edge(x, y) || layout.opponentLane.Edge(x, y) ? 0.45 : 0.25;
            Colour c = shadeColour(level, darken);
            // A rounded edge: lit along the top and left, dark along the bottom and right.
            const bool outer = layout.shape.Edge(x, y);
            const bool inner = !outer && (layout.shape.Edge(x - 1, y) || layout.shape.Edge(x, y - 1) ||
                                          layout.shape.Edge(x + 1, y) || layout.shape.Edge(x, y + 1));
            if (outer)
                c = Rgb(70, 38, 16);
            else if (inner)
                c = (x < kBoardWidth / 2 && y < kBoardHeight / 2) || x <= 2 || y <= 2 ? Mix(c, Rgb(255, 230, 190), 0.35)
                                                                                      : Mix(c, Rgb(40, 20, 8), 0.35);
            board.Set(x, y, c);
        }
    DrawGameRing(board, layout.player[kGameHole], layout.opponent[kGameHole], Rgb(240, 200, 90));
    DrawAllHoles(board, layout.player, layout.opponent,
                 {Rgb(28, 14, 6), Rgb(60, 32, 14), Rgb(120, 74, 36), Rgb(90, 52, 24)});
    return board;
}

// Slate with raised grooves and sunken holes, lit from the top left.
Canvas EmbossedBoard(const Layout& layout, Colour table)
{
    const Colour base = Rgb(150, 160, 176);
    const Colour raised = Rgb(182, 192, 206);
    const Colour light = Rgb(236, 242, 250);
    const Colour shadow = Rgb(84, 92, 108);

    Canvas board(kBoardWidth, kBoardHeight, table);
    for (int y = 0; y < kBoardHeight; ++y)
        for (int x = 0; x < kBoardWidth; ++x) {
            if (!layout.shape(x, y))
                continue;
            Colour c = base;
            if (layout.InLane(x, y)) {
                c = raised;
                if (!layout.InLane(x - 1, y) || !layout.InLane(x, y - 1))
                    c = light;
                else if (!layout.InLane(x + 1, y) || !layout.InLane(x, y + 1))
                    c = shadow;
            }
            // Two pixels of bevel round the whole board.
            for (int d = 1; d <= 2; ++d) {
                if (!layout.shape(x - d, y) || !layout.shape(x, y - d))
                    c = d == 1 ? light : Mix(light, base, 0.5);
                else if (!layout.shape(x + d, y) || !layout.shape(x, y + d))
                    c = d == 1 ? shadow : Mix(shadow, base, 0.5);
                else
                    continue;
                break;
            }
            board.Set(x, y, c);
        }
    DrawGameRing(board, layout.player[kGameHole], layout.opponent[kGameHole], Rgb(250, 214, 80));
    DrawAllHoles(board, layout.player, layout.opponent, {Rgb(24, 28, 38), shadow, light, Rgb(120, 128, 144)});
    return board;
}

} // namespace

Canvas MakeBoard(BoardLook look, Colour table)
{
    static const Layout layout;
    switch (look) {
    case BoardLook::Normal:
        return NormalBoard(layout, table);
    case BoardLook::Wooden:
        return WoodenBoard(layout, table);
    case BoardLook::Embossed:
        break;
    }
    return EmbossedBoard(layout, table);
}

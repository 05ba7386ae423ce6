#include "support/TestMain.h"

#include "presentation/HoleMap.h"
#include "presentation/ImageHolder.h"

#include <QFile>
#include <QImage>
#include <QtTest>

#include <algorithm>
#include <cmath>
#include <map>
#include <set>
#include <utility>
#include <vector>

namespace {

uint32_t ReadLe(const QByteArray& bytes, qsizetype offset, int size)
{
    uint32_t value = 0;
    for (int i = size - 1; i >= 0; --i)
        value = (value << 8) | static_cast<uint8_t>(bytes[offset + i]);
    return value;
}

QImage LoadBitmap(int id)
{
    return QImage(BitmapResourcePath(id)).convertToFormat(QImage::Format_RGB32);
}

int Luminance(QRgb c)
{
    return (299 * qRed(c) + 587 * qGreen(c) + 114 * qBlue(c)) / 1000;
}

double Distance(QRgb a, QRgb b)
{
    return std::hypot(qRed(a) - qRed(b), qGreen(a) - qGreen(b), qBlue(a) - qBlue(b));
}

bool IsRed(QRgb c)
{
    return qRed(c) >= 150 && qGreen(c) <= 90 && qBlue(c) <= 90;
}

bool IsBlack(QRgb c)
{
    return std::max({qRed(c), qGreen(c), qBlue(c)}) <= 80;
}

QRgb MostCommonColour(const QImage& image)
{
    std::map<QRgb, int> counts;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            ++counts[image.pixel(x, y)];
    return std::max_element(counts.begin(), counts.end(),
                            [](const auto& a, const auto& b) { return a.second < b.second; })->first;
}

// One cell of the rank glyph strip.
QImage GlyphCell(const QImage& strip, int column, int row)
{
    return strip.copy(8 * column, 10 * row, 8, 10);
}

QImage Turned(const QImage& image)
{
    return image.transformed(QTransform().rotate(180));
}

struct HoleTables {
    HolePoint player[kHoleCount];
    HolePoint opponent[kHoleCount];
    HoleTables() { BuildHoleTables(player, opponent); }
};

} // namespace

class ImagesTest : public QObject {
    Q_OBJECT

private slots:
    void bitmapFiles_data();
    void bitmapFiles();
    void holeAtEveryCentre_data();
    void holeAtEveryCentre();
    void pegsStandOut_data();
    void pegsStandOut();
    void turnedGlyphs_data();
    void turnedGlyphs();
    void glyphsDistinctAndUnusedCellsBlank();
    void faces_data();
    void faces();
    void digitsOnTheTable();
    void icons_data();
    void icons();
};

void ImagesTest::bitmapFiles_data()
{
    QTest::addColumn<int>("id");
    QTest::addColumn<int>("width");
    QTest::addColumn<int>("height");
    QTest::addColumn<int>("bitsPerPixel");
    QTest::newRow("board Normal") << 166 << 86 << 211 << 4;
    QTest::newRow("board Wooden") << 200 << 86 << 211 << 8;
    QTest::newRow("board Embossed") << 135 << 86 << 211 << 8;
    QTest::newRow("face spades") << 130 << 23 << 41 << 4;
    QTest::newRow("face diamonds") << 133 << 23 << 41 << 4;
    QTest::newRow("face hearts") << 134 << 23 << 41 << 4;
    QTest::newRow("face clubs") << 132 << 23 << 41 << 4;
    QTest::newRow("card back") << 164 << 23 << 41 << 4;
    QTest::newRow("rank glyphs") << 161 << 112 << 40 << 4;
    QTest::newRow("player's peg") << 162 << 5 << 5 << 4;
    QTest::newRow("opponent's peg") << 163 << 5 << 5 << 4;
    QTest::newRow("digits") << 165 << 80 << 8 << 4;
}

void ImagesTest::bitmapFiles()
{
    QFETCH(int, id);
    QFETCH(int, width);
    QFETCH(int, height);
    QFETCH(int, bitsPerPixel);

    QFile file(BitmapResourcePath(id));
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QByteArray bytes = file.readAll();
    QVERIFY(bytes.size() >= 54);

    const uint32_t colours = 1u << bitsPerPixel;
    const uint32_t stride = (static_cast<uint32_t>(width * bitsPerPixel) + 31) / 32 * 4;
    const uint32_t offset = 14 + 40 + 4 * colours;
    QCOMPARE(bytes.left(2), QByteArray("BM"));
    QCOMPARE(ReadLe(bytes, 2, 4), static_cast<uint32_t>(bytes.size()));
    QCOMPARE(ReadLe(bytes, 10, 4), offset);
    QCOMPARE(ReadLe(bytes, 14, 4), 40u);                                // BITMAPINFOHEADER
    QCOMPARE(ReadLe(bytes, 18, 4), static_cast<uint32_t>(width));
    QCOMPARE(static_cast<int32_t>(ReadLe(bytes, 22, 4)), height);      // positive: bottom-up
    QCOMPARE(ReadLe(bytes, 26, 2), 1u);                                 // planes
    QCOMPARE(ReadLe(bytes, 28, 2), static_cast<uint32_t>(bitsPerPixel));
    QCOMPARE(ReadLe(bytes, 30, 4), 0u);                                 // BI_RGB
    const uint32_t used = ReadLe(bytes, 46, 4);
    QVERIFY2(used == 0 || used == colours, "the colour table has the full size of the depth");
    QCOMPARE(static_cast<uint32_t>(bytes.size()), offset + stride * static_cast<uint32_t>(height));

    const QImage image = QImage::fromData(bytes, "BMP");
    QVERIFY(!image.isNull());
    QCOMPARE(image.size(), QSize(width, height));
    QCOMPARE(LoadBitmap(id).size(), QSize(width, height));
}

void ImagesTest::holeAtEveryCentre_data()
{
    QTest::addColumn<int>("id");
    QTest::newRow("Normal") << static_cast<int>(kBitmapBoardNormal);
    QTest::newRow("Wooden") << static_cast<int>(kBitmapBoardWooden);
    QTest::newRow("Embossed") << static_cast<int>(kBitmapBoardEmbossed);
}

// Every centre of both tracks is clearly darker than the board surface round
// it. The surface is the median brightness of an 11 x 11 window less the
// 3 x 3 neighbourhoods of all hole centres, so grain and grooves count as
// surface and neighbouring holes do not.
void ImagesTest::holeAtEveryCentre()
{
    QFETCH(int, id);
    const QImage board = LoadBitmap(id);
    QCOMPARE(board.size(), QSize(86, 211));
    const HoleTables holes;

    std::set<std::pair<int, int>> nearHole;
    for (const HolePoint* track : {holes.player, holes.opponent})
        for (int n = 0; n < kHoleCount; ++n)
            for (int dy = -1; dy <= 1; ++dy)
                for (int dx = -1; dx <= 1; ++dx)
                    nearHole.insert({track[n].x + dx, track[n].y + dy});

    for (const HolePoint* track : {holes.player, holes.opponent})
        for (int n = 0; n < kHoleCount; ++n) {
            const HolePoint c = track[n];
            std::vector<int> surface;
            for (int y = c.y - 5; y <= c.y + 5; ++y)
                for (int x = c.x - 5; x <= c.x + 5; ++x)
                    if (board.valid(x, y) && !nearHole.count({x, y}))
                        surface.push_back(Luminance(board.pixel(x, y)));
            QVERIFY(surface.size() > 40);
            std::nth_element(surface.begin(), surface.begin() + surface.size() / 2, surface.end());
            const int median = surface[surface.size() / 2];
            const int centre = Luminance(board.pixel(c.x, c.y));
            if (centre > median - 60)
                QFAIL(qPrintable(QStringLiteral("%1 track, hole %2 at (%3, %4): centre %5, surface %6")
                                     .arg(track == holes.player ? "player's" : "opponent's")
                                     .arg(n).arg(c.x).arg(c.y).arg(centre).arg(median)));
        }
}

void ImagesTest::pegsStandOut_data()
{
    holeAtEveryCentre_data();
}

// Drawn over any hole of its track, most pixels of each peg differ plainly
// from the board it covers; and the two pegs differ plainly from each other.
void ImagesTest::pegsStandOut()
{
    QFETCH(int, id);
    const QImage board = LoadBitmap(id);
    const QImage playerPeg = LoadBitmap(kBitmapPlayerPeg);
    const QImage opponentPeg = LoadBitmap(kBitmapOpponentPeg);
    const HoleTables holes;

    int pegsDiffer = 0;
    for (int y = 0; y < 5; ++y)
        for (int x = 0; x < 5; ++x)
            if (Distance(playerPeg.pixel(x, y), opponentPeg.pixel(x, y)) > 100)
                ++pegsDiffer;
    QVERIFY2(pegsDiffer >= 20, "the two pegs are told apart at a glance");

    for (const auto& [track, peg] : {std::pair{holes.player, &playerPeg}, std::pair{holes.opponent, &opponentPeg}})
        for (int n = 0; n < kHoleCount; ++n) {
            // The ring of board pixels just outside the peg: what it is seen against.
            const HolePoint c = track[n];
            int standOut = 0;
            for (int y = 0; y < 5; ++y)
                for (int x = 0; x < 5; ++x) {
                    const int bx = std::clamp(c.x - 2 + (x == 0 ? -1 : x == 4 ? 5 : x), 0, 85);
                    const int by = std::clamp(c.y - 2 + (y == 0 ? -1 : y == 4 ? 5 : y), 0, 210);
                    if (Distance(peg->pixel(x, y), board.pixel(bx, by)) > 80)
                        ++standOut;
                }
            if (standOut < 16)
                QFAIL(qPrintable(QStringLiteral("peg at hole %1 (%2, %3): only %4 of 25 pixels stand out")
                                     .arg(n).arg(c.x).arg(c.y).arg(standOut)));
        }
}

void ImagesTest::turnedGlyphs_data()
{
    QTest::addColumn<int>("uprightColumn");
    QTest::addColumn<int>("turnedColumn");
    // Columns of the painting rule: upright rank1 - 1 (the ace 13), turned
    // 14 - rank1 (the ace 0).
    QTest::newRow("ace") << 13 << 0;
    QTest::newRow("two") << 1 << 12;
    QTest::newRow("six") << 5 << 8;
    QTest::newRow("nine") << 8 << 5;
    QTest::newRow("ten") << 9 << 4;
    QTest::newRow("jack") << 10 << 3;
    QTest::newRow("queen") << 11 << 2;
    QTest::newRow("king") << 12 << 1;
}

// A turned cell is its upright cell rotated by 180 degrees, row 2 the red
// row 1 and row 3 the black row 0; the ink is the colour of the row.
void ImagesTest::turnedGlyphs()
{
    QFETCH(int, uprightColumn);
    QFETCH(int, turnedColumn);
    const QImage strip = LoadBitmap(kBitmapRankGlyphs);
    const QRgb background = MostCommonColour(strip);

    for (const auto& [uprightRow, turnedRow] : {std::pair{0, 3}, std::pair{1, 2}}) {
        const QImage upright = GlyphCell(strip, uprightColumn, uprightRow);
        QCOMPARE(GlyphCell(strip, turnedColumn, turnedRow), Turned(upright));
        int ink = 0;
        for (int y = 0; y < upright.height(); ++y)
            for (int x = 0; x < upright.width(); ++x) {
                const QRgb c = upright.pixel(x, y);
                if (c == background)
                    continue;
                ++ink;
                QVERIFY2(uprightRow == 0 ? IsBlack(c) : IsRed(c), "glyph ink is black in row 0, red in row 1");
            }
        QVERIFY2(ink >= 12, "the cell holds a glyph");
    }
}

void ImagesTest::glyphsDistinctAndUnusedCellsBlank()
{
    const QImage strip = LoadBitmap(kBitmapRankGlyphs);
    const QRgb background = MostCommonColour(strip);
    const QImage blank = GlyphCell(strip, 0, 0);
    for (int y = 0; y < blank.height(); ++y)
        for (int x = 0; x < blank.width(); ++x)
            QCOMPARE(blank.pixel(x, y), background);
    QCOMPARE(GlyphCell(strip, 0, 1), blank);
    QCOMPARE(GlyphCell(strip, 13, 2), blank);
    QCOMPARE(GlyphCell(strip, 13, 3), blank);

    for (int a = 1; a <= 13; ++a)
        for (int b = a + 1; b <= 13; ++b)
            QVERIFY2(GlyphCell(strip, a, 0) != GlyphCell(strip, b, 0),
                     qPrintable(QStringLiteral("columns %1 and %2 hold the same glyph").arg(a).arg(b)));

    // The cells blend into the card: their background is the face's.
    QCOMPARE(background, MostCommonColour(LoadBitmap(kBitmapFaceSpades)));
}

void ImagesTest::faces_data()
{
    QTest::addColumn<int>("id");
    QTest::addColumn<bool>("red");
    QTest::newRow("spades") << static_cast<int>(kBitmapFaceSpades) << false;
    QTest::newRow("diamonds") << static_cast<int>(kBitmapFaceDiamonds) << true;
    QTest::newRow("hearts") << static_cast<int>(kBitmapFaceHearts) << true;
    QTest::newRow("clubs") << static_cast<int>(kBitmapFaceClubs) << false;
}

// The corners where the rank glyphs are copied are plain background, and
// every pip pixel inside the edge is in the suit's colour.
void ImagesTest::faces()
{
    QFETCH(int, id);
    QFETCH(bool, red);
    const QImage face = LoadBitmap(id);
    const QRgb background = MostCommonColour(face);
    QVERIFY2(Luminance(background) >= 200, "a light card");

    const QRect glyphAreas[] = {QRect(2, 3, 8, 10), QRect(13, 28, 8, 10)};
    for (const QRect& area : glyphAreas)
        for (int y = area.top(); y <= area.bottom(); ++y)
            for (int x = area.left(); x <= area.right(); ++x)
                if (face.pixel(x, y) != background)
                    QFAIL(qPrintable(QStringLiteral("(%1, %2) is not background").arg(x).arg(y)));

    int pips = 0;
    for (int y = 1; y < face.height() - 1; ++y)
        for (int x = 1; x < face.width() - 1; ++x) {
            const QRgb c = face.pixel(x, y);
            if (c == background)
                continue;
            ++pips;
            if (red ? !IsRed(c) : !IsBlack(c))
                QFAIL(qPrintable(QStringLiteral("pip pixel (%1, %2) is not %3").arg(x).arg(y).arg(red ? "red" : "black")));
        }
    QVERIFY2(pips >= 60, "the face shows its pips");

    const QImage back = LoadBitmap(kBitmapBack);
    int differ = 0;
    for (int y = 0; y < face.height(); ++y)
        for (int x = 0; x < face.width(); ++x)
            differ += face.pixel(x, y) != back.pixel(x, y) ? 1 : 0;
    QVERIFY2(differ > face.width() * face.height() / 2, "the back does not look like a face");
}

// The digits sit on the table's green, which is their cells' background, in
// a light ink that reads on it; no two look alike.
void ImagesTest::digitsOnTheTable()
{
    const QImage strip = LoadBitmap(kBitmapDigits);
    const QRgb table = qRgb(0, 128, 0);
    std::vector<QImage> cells;
    for (int d = 0; d < 10; ++d) {
        const QImage cell = strip.copy(8 * d, 0, 8, 8);
        int light = 0;
        for (int y = 0; y < 8; ++y)
            for (int x = 0; x < 8; ++x)
                light += Luminance(cell.pixel(x, y)) >= 180 ? 1 : 0;
        QVERIFY2(light >= 10, qPrintable(QStringLiteral("digit %1 has too little light ink").arg(d)));
        // The outer columns stay green, so two digits side by side keep apart.
        for (int y = 0; y < 8; ++y) {
            QCOMPARE(cell.pixel(0, y), table);
            QCOMPARE(cell.pixel(7, y), table);
        }
        for (const QImage& earlier : cells)
            QVERIFY(earlier != cell);
        cells.push_back(cell);
    }
}

void ImagesTest::icons_data()
{
    QTest::addColumn<int>("size");
    for (int size : {16, 32, 48, 64, 128, 256})
        QTest::newRow(qPrintable(QString::number(size))) << size;
}

void ImagesTest::icons()
{
    QFETCH(int, size);
    const QImage icon(QStringLiteral(":/icons/vennick-%1.png").arg(size));
    QVERIFY(!icon.isNull());
    QCOMPARE(icon.size(), QSize(size, size));
    std::set<QRgb> colours;
    const QImage argb = icon.convertToFormat(QImage::Format_ARGB32);
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x)
            if (qAlpha(argb.pixel(x, y)) != 0)
                colours.insert(argb.pixel(x, y));
    QVERIFY2(colours.size() >= 4 && colours.size() <= 16, "sixteen-colour art");
}

VENNICK_TEST(ImagesTest);

#include "ImagesTest.moc"

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

QImage LoadBitmap(int id) { return QImage(BitmapResourcePath(id)).convertToFormat(QImage::Format_RGB32); }
int Luminance(QRgb c) { return (299 * qRed(c) + 587 * qGreen(c) + 114 * qBlue(c)) / 1000; }
double Distance(QRgb a, QRgb b) { return std::hypot(qRed(a) - qRed(b), qGreen(a) - qGreen(b), qBlue(a) - qBlue(b)); }
bool IsRed(QRgb c) { return qRed(c) >= 150 && qGreen(c) <= 90 && qBlue(c) <= 90; }
bool IsBlack(QRgb c) { return std::max({qRed(c), qGreen(c), qBlue(c)}) <= 80; }
// One cell of the rank glyph strip.
QImage GlyphCell(const QImage& strip, int column, int row) { return strip.copy(8 * column, 10 * row, 8, 10); }

QRgb MostCommonColour(const QImage& image)
{
    std::map<QRgb, int> counts;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            ++counts[image.pixel(x, y)];
    return std::max_element(counts.begin(), counts.end(), [](const auto& a, const auto& b) { return a.second < b.second; })
        ->first;
}

} // namespace

// The generated bitmaps and icons: file format, and what the painting relies on.
class ImagesTest : public QObject {
    Q_OBJECT

private slots:
    void bitmapFiles_data()
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

    void bitmapFiles()
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
        QCOMPARE(ReadLe(bytes, 14, 4), 40u);  // BITMAPINFOHEADER
        QCOMPARE(ReadLe(bytes, 18, 4), static_cast<uint32_t>(width));
        QCOMPARE(static_cast<int32_t>(ReadLe(bytes, 22, 4)), height);  // positive: bottom-up
        QCOMPARE(ReadLe(bytes, 26, 2), 1u);                            // planes
        QCOMPARE(ReadLe(bytes, 28, 2), static_cast<uint32_t>(bitsPerPixel));
        QCOMPARE(ReadLe(bytes, 30, 4), 0u);  // BI_RGB
        const uint32_t used = ReadLe(bytes, 46, 4);
        QVERIFY2(used == 0 || used == colours, "the colour table has the full size of the depth");
        QCOMPARE(static_cast<uint32_t>(bytes.size()), offset + stride * static_cast<uint32_t>(height));
        QCOMPARE(QImage::fromData(bytes, "BMP").size(), QSize(width, height));
    }

    void holesAndPegs_data()
    {
        QTest::addColumn<int>("id");
        QTest::newRow("Normal") << int(kBitmapBoardNormal);
        QTest::newRow("Wooden") << int(kBitmapBoardWooden);
        QTest::newRow("Embossed") << int(kBitmapBoardEmbossed);
    }

    // Every centre of both tracks is clearly darker than the surface round it:
    // the median brightness of an 11 x 11 window less the 3 x 3 neighbourhoods
    // of all centres, so grain and grooves count as surface and other holes do
    // not. Over any hole of its track, most pixels of each peg differ plainly
    // from the ring of board just outside it; the two pegs differ plainly too.
    void holesAndPegs()
    {
        QFETCH(int, id);
        const QImage board = LoadBitmap(id);
        const QImage pegs[2] = {LoadBitmap(kBitmapPlayerPeg), LoadBitmap(kBitmapOpponentPeg)};
        int pegsDiffer = 0;
        for (int y = 0; y < 5; ++y)
            for (int x = 0; x < 5; ++x)
                pegsDiffer += Distance(pegs[0].pixel(x, y), pegs[1].pixel(x, y)) > 100 ? 1 : 0;
        QVERIFY2(pegsDiffer >= 20, "the two pegs are told apart at a glance");

        HolePoint tracks[2][kHoleCount];
        BuildHoleTables(tracks[0], tracks[1]);
        std::set<std::pair<int, int>> nearHole;
        for (const auto& track : tracks)
            for (const HolePoint& c : track)
                for (int dy = -1; dy <= 1; ++dy)
                    for (int dx = -1; dx <= 1; ++dx)
                        nearHole.insert({c.x + dx, c.y + dy});

        for (int side = 0; side < 2; ++side)
            for (int n = 0; n < kHoleCount; ++n) {
                const HolePoint c = tracks[side][n];
                std::vector<int> surface;
                for (int y = c.y - 5; y <= c.y + 5; ++y)
                    for (int x = c.x - 5; x <= c.x + 5; ++x)
                        if (board.valid(x, y) && !nearHole.count({x, y}))
                            surface.push_back(Luminance(board.pixel(x, y)));
                QVERIFY(surface.size() > 40);
                std::nth_element(surface.begin(), surface.begin() + surface.size() / 2, surface.end());
                const int median = surface[surface.size() / 2];
                const int centre = Luminance(board.pixel(c.x, c.y));
                int standOut = 0;
                for (int y = 0; y < 5; ++y)
                    for (int x = 0; x < 5; ++x) {
                        const int bx = std::clamp(c.x - 2 + (x == 0 ? -1 : x == 4 ? 5 : x), 0, 85);
                        const int by = std::clamp(c.y - 2 + (y == 0 ? -1 : y == 4 ? 5 : y), 0, 210);
                        standOut += Distance(pegs[side].pixel(x, y), board.pixel(bx, by)) > 80 ? 1 : 0;
                    }
                if (centre > median - 60 || standOut < 16)
                    QFAIL(qPrintable(QStringLiteral("side %1, hole %2 at (%3, %4): centre %5, surface %6, peg pixels standing out %7")
                                         .arg(side).arg(n).arg(c.x).arg(c.y).arg(centre).arg(median).arg(standOut)));
            }
    }

    // Painted upright from column rank1 - 1 (the ace 13) of rows 0 (black) and 1
    // (red), turned from column 14 - rank1 (the ace 0) of rows 3 and 2: each
    // turned cell is its upright cell rotated by 180 degrees. The cells left
    // over are blank, on the face's own background.
    void rankGlyphs()
    {
        const QImage strip = LoadBitmap(kBitmapRankGlyphs);
        const QRgb background = MostCommonColour(strip);
        QCOMPARE(background, MostCommonColour(LoadBitmap(kBitmapFaceSpades)));
        QImage plain(8, 10, QImage::Format_RGB32);
        plain.fill(background);
        for (const auto& [column, row] : {std::pair{0, 0}, {0, 1}, {13, 2}, {13, 3}})
            QCOMPARE(GlyphCell(strip, column, row), plain);

        for (int rank1 = 1; rank1 <= 13; ++rank1) {
            const int upright = rank1 == 1 ? 13 : rank1 - 1;
            const int turned = rank1 == 1 ? 0 : 14 - rank1;
            for (const auto& [uprightRow, turnedRow] : {std::pair{0, 3}, {1, 2}}) {
                const QImage cell = GlyphCell(strip, upright, uprightRow);
                QCOMPARE(GlyphCell(strip, turned, turnedRow), cell.transformed(QTransform().rotate(180)));
                int ink = 0;
                for (int y = 0; y < cell.height(); ++y)
                    for (int x = 0; x < cell.width(); ++x)
                        if (const QRgb c = cell.pixel(x, y); c != background) {
                            ++ink;
                            QVERIFY2(uprightRow == 0 ? IsBlack(c) : IsRed(c), "ink is black in row 0, red in row 1");
                        }
                QVERIFY2(ink >= 12, qPrintable(QStringLiteral("rank %1 has no glyph").arg(rank1)));
            }
            for (int other = 1; other < upright; ++other)
                QVERIFY2(GlyphCell(strip, other, 0) != GlyphCell(strip, upright, 0),
                         qPrintable(QStringLiteral("columns %1 and %2 hold the same glyph").arg(other).arg(upright)));
        }
    }

    void faces_data()
    {
        QTest::addColumn<int>("id");
        QTest::addColumn<bool>("red");
        QTest::newRow("spades") << int(kBitmapFaceSpades) << false;
        QTest::newRow("diamonds") << int(kBitmapFaceDiamonds) << true;
        QTest::newRow("hearts") << int(kBitmapFaceHearts) << true;
        QTest::newRow("clubs") << int(kBitmapFaceClubs) << false;
    }

    // A light card whose glyph corners are plain background, every pip pixel
    // inside the edge in the suit's colour, and unlike the back.
    void faces()
    {
        QFETCH(int, id);
        QFETCH(bool, red);
        const QImage face = LoadBitmap(id);
        const QImage back = LoadBitmap(kBitmapBack);
        const QRgb background = MostCommonColour(face);
        QVERIFY(Luminance(background) >= 200);
        const QRect corners[] = {QRect(2, 3, 8, 10), QRect(13, 28, 8, 10)};  // where the glyphs go
        int pips = 0;
        int differ = 0;
        for (int y = 0; y < face.height(); ++y)
            for (int x = 0; x < face.width(); ++x) {
                const QRgb c = face.pixel(x, y);
                differ += c != back.pixel(x, y) ? 1 : 0;
                if (c == background || x == 0 || y == 0 || x == face.width() - 1 || y == face.height() - 1)
                    continue;
                if (corners[0].contains(x, y) || corners[1].contains(x, y) || (red ? !IsRed(c) : !IsBlack(c)))
                    QFAIL(qPrintable(QStringLiteral("(%1, %2) is neither background nor pip").arg(x).arg(y)));
                ++pips;
            }
        QVERIFY2(pips >= 60, "the face shows its pips");
        QVERIFY2(differ > face.width() * face.height() / 2, "the back does not look like a face");
    }

    // Light digits on the table's green, the cells' outer columns left green so
    // that neighbours keep apart; no two alike.
    void digitsOnTheTable()
    {
        const QImage strip = LoadBitmap(kBitmapDigits);
        std::vector<QImage> cells;
        for (int d = 0; d < 10; ++d) {
            const QImage cell = strip.copy(8 * d, 0, 8, 8);
            int light = 0;
            for (int y = 0; y < 8; ++y) {
                for (int x = 0; x < 8; ++x)
                    light += Luminance(cell.pixel(x, y)) >= 180 ? 1 : 0;
                QCOMPARE(cell.pixel(0, y), qRgb(0, 128, 0));
                QCOMPARE(cell.pixel(7, y), qRgb(0, 128, 0));
            }
            QVERIFY2(light >= 10, qPrintable(QStringLiteral("digit %1 has too little light ink").arg(d)));
            QVERIFY(std::find(cells.begin(), cells.end(), cell) == cells.end());
            cells.push_back(cell);
        }
    }

    void icons_data()
    {
        QTest::addColumn<int>("size");
        for (int size : {16, 32, 48, 64, 128, 256})
            QTest::addRow("%d", size) << size;
    }

    void icons()
    {
        QFETCH(int, size);
        const QImage icon = QImage(QStringLiteral(":/icons/vennick-%1.png").arg(size)).convertToFormat(QImage::Format_ARGB32);
        QCOMPARE(icon.size(), QSize(size, size));
        std::set<QRgb> colours;
        for (int y = 0; y < size; ++y)
            for (int x = 0; x < size; ++x)
                if (qAlpha(icon.pixel(x, y)) != 0)
                    colours.insert(icon.pixel(x, y));
        QVERIFY2(colours.size() >= 4 && colours.size() <= 16, "sixteen-colour art");
    }
};

VENNICK_TEST(ImagesTest);
#include "ImagesTest.moc"

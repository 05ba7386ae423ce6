#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QPixmap>

namespace {

constexpr int kScale = 2;
const QRgb kGreen = qRgb(0, 128, 0);

QImage Shot(GameBoard& board)
{
    return board.grab().toImage().convertToFormat(QImage::Format_RGB32);
}

// Whether the window shows `source` (a rectangle of a bitmap) at board point
// `at`, every source pixel enlarged to a kScale x kScale block.
bool Shows(const QImage& shot, QPoint at, const QImage& image, QRect source)
{
    for (int y = 0; y < source.height(); ++y)
        for (int x = 0; x < source.width(); ++x) {
            const QRgb want = image.pixel(source.x() + x, source.y() + y);
            for (int dy = 0; dy < kScale; ++dy)
                for (int dx = 0; dx < kScale; ++dx)
                    if (shot.pixel((at.x() + x) * kScale + dx, (at.y() + y) * kScale + dy) != want)
                        return false;
        }
    return true;
}

bool IsGreen(const QImage& shot, Rect r)
{
    for (int y = r.top * kScale; y < r.bottom * kScale; ++y)
        for (int x = r.left * kScale; x < r.right * kScale; ++x)
            if (shot.pixel(x, y) != kGreen)
                return false;
    return true;
}

QPoint TopLeft(const Rect& r) { return {r.left, r.top}; }

} // namespace

// What the window shows, read back pixel by pixel.
class PaintingTest : public QObject {
    Q_OBJECT

private slots:
    void emptyPlacesShowTheTable()
    {
        auto board = MakeBoard(kScale);
        const QImage shot = Shot(*board);
        for (const CardSprite& s : board->record.playerHandSprites)
            QVERIFY(IsGreen(shot, s.rect));
        QVERIFY(IsGreen(shot, board->record.starterSprite.rect));
        QVERIFY(IsGreen(shot, board->record.countRect));
        // The table around the board is green too, below the cards and right of them.
        QVERIFY(IsGreen(shot, Rect{86, 41, 88, 211}));
        QVERIFY(IsGreen(shot, Rect{236, 0, 240, 195}));
    }

    void cardsFacesBacksAndHighlight()
    {
        auto board = MakeBoard(kScale);
        // The user holds the ace of spades (first) and the ten of diamonds (last).
        StackDeck(*board, {Card(1, 1), Card(3, 4), Card(4, 3), Card(6, 2), Card(8, 1), Card(10, 2),
                           Card(2, 2), Card(5, 3), Card(7, 4), Card(9, 1), Card(11, 3), Card(12, 4), Card(13, 1)});
        ClickButton(*board, kCmdDeal);
        QImage shot = Shot(*board);
        const GameRecord& r = board->record;

        // The computer's cards still in hand are backs, whatever they are.
        for (int i = 1; i <= 4; ++i)
            QVERIFY(Shows(shot, TopLeft(r.opponentHandSprites[i].rect), board->backBitmap.Image(), QRect(0, 0, 23, 41)));
        // The pack lies face down.
        QVERIFY(Shows(shot, TopLeft(r.starterSprite.rect), board->backBitmap.Image(), QRect(0, 0, 23, 41)));

        // Ace of spades: upright glyph from (104, 0), turned from (0, 30).
        const QPoint ace = TopLeft(r.playerHandSprites[0].rect);
        const QImage& spades = board->suitFaceBitmaps[0].Image();
        const QImage& glyphs = board->rankGlyphBitmap.Image();
        QVERIFY(Shows(shot, ace, spades, QRect(0, 0, 23, 3)));    // above the glyphs
        QVERIFY(Shows(shot, ace + QPoint(2, 3), glyphs, QRect(104, 0, 8, 10)));
        QVERIFY(Shows(shot, ace + QPoint(13, 28), glyphs, QRect(0, 30, 8, 10)));
        QVERIFY(Shows(shot, ace + QPoint(0, 14), spades, QRect(0, 14, 23, 14)));  // the middle

        // Ten of diamonds: (72, 10) and (32, 20).
        const QPoint ten = TopLeft(r.playerHandSprites[5].rect);
        QVERIFY(Shows(shot, ten + QPoint(2, 3), glyphs, QRect(72, 10, 8, 10)));
        QVERIFY(Shows(shot, ten + QPoint(13, 28), glyphs, QRect(32, 20, 8, 10)));
        QVERIFY(Shows(shot, ten + QPoint(0, 14), board->suitFaceBitmaps[1].Image(), QRect(0, 14, 23, 14)));

        // A chosen card is drawn inverted: face and both glyphs.
        TapHand(*board, 1);
        shot = Shot(*board);
        QVERIFY(Shows(shot, ace + QPoint(0, 14), board->suitFaceBitmaps[0].Inverted(), QRect(0, 14, 23, 14)));
        QVERIFY(Shows(shot, ace + QPoint(2, 3), board->rankGlyphBitmap.Inverted(), QRect(104, 0, 8, 10)));
        QVERIFY(Shows(shot, ace + QPoint(13, 28), board->rankGlyphBitmap.Inverted(), QRect(0, 30, 8, 10)));
        QVERIFY(!Shows(shot, ace + QPoint(0, 14), spades, QRect(0, 14, 23, 14)));
        // The inverted copy really is the inverse.
        QCOMPARE(board->suitFaceBitmaps[0].Inverted().pixel(11, 20) & 0xffffff,
                 ~spades.pixel(11, 20) & 0xffffff);

        // A highlighted back is inverted as well.
        board->record.starterSprite.highlighted = 1;
        board->repaint();
        shot = Shot(*board);
        QVERIFY(Shows(shot, TopLeft(r.starterSprite.rect), board->backBitmap.Inverted(), QRect(0, 0, 23, 41)));
    }

    void runningCount_data()
    {
        QTest::addColumn<int>("count");
        QTest::addColumn<QList<int>>("digits");   // digit, board x of the cell
        QTest::newRow("one digit") << 7 << QList<int>{7, 95};
        QTest::newRow("zero") << 0 << QList<int>{0, 95};
        QTest::newRow("fifteen") << 15 << QList<int>{1, 91, 5, 99};
        QTest::newRow("thirty-one") << 31 << QList<int>{3, 91, 1, 99};
    }

    void runningCount()
    {
        QFETCH(int, count);
        QFETCH(QList<int>, digits);
        auto board = MakeBoard(kScale);
        board->record.shownCount = count;
        board->record.countVisible = 1;
        board->repaint();
        const QImage shot = Shot(*board);
        for (int i = 0; i < digits.size(); i += 2)
            QVERIFY(Shows(shot, {digits[i + 1], 87}, board->digitBitmap.Image(), QRect(8 * digits[i], 0, 8, 8)));
        if (digits.size() == 2) {  // one digit leaves the sides of the square clear
            QVERIFY(IsGreen(shot, Rect{91, 87, 95, 95}));
            QVERIFY(IsGreen(shot, Rect{103, 87, 107, 95}));
        }

        board->record.countVisible = 0;
        board->repaint();
        QVERIFY(IsGreen(Shot(*board), board->record.countRect));
    }

    void pegsOnTheBoard()
    {
        auto board = MakeBoard(kScale);
        board->MovePlayerPegs(12);
        board->MoveOpponentPegs(40);
        board->repaint();
        const QImage shot = Shot(*board);
        const GameRecord& r = board->record;
        const QRect peg(0, 0, 5, 5);
        QVERIFY(Shows(shot, TopLeft(r.playerFrontPegRect), board->playerPegBitmap.Image(), peg));
        QVERIFY(Shows(shot, TopLeft(r.playerBackPegRect), board->playerPegBitmap.Image(), peg));
        QVERIFY(Shows(shot, TopLeft(r.opponentFrontPegRect), board->opponentPegBitmap.Image(), peg));
        QVERIFY(Shows(shot, TopLeft(r.opponentBackPegRect), board->opponentPegBitmap.Image(), peg));
    }

    void boardFollowsTheStyle()
    {
        auto board = MakeBoard(kScale);
        for (int style : {1, 2, 3, 0, 4}) {
            board->record.boardStyle = style;
            board->ReloadBoardBitmap();
            board->repaint();
            const int id = style == 1 ? kBitmapBoardNormal : style == 2 ? kBitmapBoardWooden : kBitmapBoardEmbossed;
            const QImage expected = QImage(BitmapResourcePath(id)).convertToFormat(QImage::Format_RGB32);
            // Away from the pegs: the top half of the board.
            QVERIFY2(Shows(Shot(*board), {0, 0}, expected, QRect(0, 0, 86, 100)), qPrintable(QString::number(style)));
        }
    }
};

VENNICK_TEST(PaintingTest);
#include "PaintingTest.moc"

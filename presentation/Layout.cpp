#include "game/GameBoard.h"
#include "presentation/HoleMap.h"

#include <QFont>
#include <QListWidget>
#include <QPushButton>
#include <QtMath>

#include <algorithm>

namespace {

// The logical space every factor multiplies: 240 x 268, the window being 52
// pixels shorter than the 320 it is measured against.
constexpr int kLogicalWidth = 240;
constexpr int kLogicalHeight = 320;
constexpr int kHeightAllowance = 52;

} // namespace

void GameBoard::BuildHoleMap()
{
    BuildHoleTables(record.playerHoles, record.opponentHoles);
    record.playerBackHole = kBackStartHole;
    record.playerFrontHole = kStartHole;
    record.opponentBackHole = kBackStartHole;
    record.opponentFrontHole = kStartHole;
}

void GameBoard::ResetTable()
{
    GameRecord& r = record;
    const int bw = boardInfo.bmWidth;
    const int bh = boardInfo.bmHeight;
    const int w = cardInfo.bmWidth;
    const int h = cardInfo.bmHeight;
    // Six card columns of pitch w + 2, starting two pixels right of the board.
    auto columnLeft = [bw, w](int k) { return bw + 2 + k * (w + 2); };

    for (int i = 0; i < 6; ++i) {
        r.opponentHandSprites[i] = CardSprite{{columnLeft(i), 0, columnLeft(i) + w, h}, 1, 0, r.opponentHandSprites[i].rank1, 0};
        r.playerHandSprites[i] = CardSprite{{columnLeft(i), bh - h - 18, columnLeft(i) + w, bh - 18}, 0, 0, r.playerHandSprites[i].rank1, 0};
    }
    for (int i = 0; i < 4; ++i) {
        const int left = columnLeft(i + 1);
        r.opponentPileSprites[i] = CardSprite{{left, h + 4, left + w, 2 * (h + 2)}, 0, 0, r.opponentPileSprites[i].rank1, 0};
        r.playerPileSprites[i] = CardSprite{{left, bh - 2 * (h + 11), left + w, bh - h - 22}, 0, 0, r.playerPileSprites[i].rank1, 0};
    }
    r.starterSprite = CardSprite{{bw + 2, bh / 2, bw + 2 + w, bh / 2 + h}, 0, 0, r.starterSprite.rank1, 0};

    r.gameOver = 0;
    r.phase = kPhaseNoDeal;
    r.playerCrib = 1;
    r.countVisible = 0;
    BuildHoleMap();
    UpdatePegRects(false);
}

void GameBoard::PlaceCountRect()
{
    // A 16 x 16 square centred over the starter, two pixels above it.
    const Rect& s = record.starterSprite.rect;
    const int mid = s.left + (s.right - s.left) / 2;
    record.countRect = Rect{mid - 8, s.top - 18, mid + 8, s.top - 2};
}

int GameBoard::ScaleFactorX(int width)
{
    return std::max(1, width / kLogicalWidth);
}

int GameBoard::ScaleFactorY(int height) const
{
    // A window without the band under the log, which ends at the log's
    // border, keeps the factor the log fits at.
    return std::max({1, (height + kHeightAllowance) / kLogicalHeight, height / LogRect().bottom});
}

QSize GameBoard::DeviceWindowSize(int scale, bool band) const
{
    // Tall enough for the whole log, which at scale 1 ends a pixel below 268.
    const int logBottom = LogRect().bottom * scale;
    return QSize(kLogicalWidth * scale, band ? std::max(kLogicalHeight * scale - kHeightAllowance, logBottom) : logBottom);
}

Rect GameBoard::LogRect() const
{
    const int bh = boardInfo.bmHeight;
    return Rect{3, bh + 2, record.opponentHandSprites[5].rect.right, bh + 58};
}

QRect GameBoard::ScaledRect(const Rect& r) const
{
    // The factors count device pixels; a window pixel is `ratio` of them, so
    // fractional edges round outwards and the rectangle covers every device pixel.
    const qreal ratio = devicePixelRatioF();
    const int sx = record.scaleX;
    const int sy = record.scaleY;
    const QPoint topLeft(qFloor(r.left * sx / ratio), qFloor(r.top * sy / ratio));
    const QPoint end(qCeil(r.right * sx / ratio), qCeil(r.bottom * sy / ratio));
    return QRect(topLeft, QSize(end.x() - topLeft.x(), end.y() - topLeft.y()));
}

QPoint GameBoard::DevicePoint(QPointF point) const
{
    const qreal ratio = devicePixelRatioF();
    return QPoint(qFloor(point.x() * ratio), qFloor(point.y() * ratio));
}

void GameBoard::Invalidate(const Rect& r)
{
    AccessibleTableChanged();
    // Before the first paint nothing is on screen, and that paint draws everything.
    if (record.firstPaintPending)
        return;
    update(ScaledRect(r));
    // Whatever is drawn anew may change what the status line says.
    NoteStatusChange();
}

void GameBoard::CreateActionButtons()
{
    const int bh = boardInfo.bmHeight;
    // The centre of the card area: the right edge of the third card of the top row.
    const int cx = record.opponentHandSprites[2].rect.right + 1;
    // Ten board pixels of text, counted in device pixels like the images.
    QFont font = this->font();
    font.setPixelSize(std::max(1, qRound(10 * record.scaleY / devicePixelRatioF())));

    struct ButtonPlace {
        QPushButton** button;
        int id;
        const char* caption;
        int halfWidth;
    };
    const ButtonPlace places[] = {
        {&dealButton, kCmdDeal, "Deal", 25},
        {&sendToCribButton, kCmdSendToCrib, "Send To Crib", 50},
        {&scorePlayerHandButton, kCmdScorePlayerHand, "Score Player's Hand", 70},
        {&scoreOpponentHandButton, kCmdScoreOpponentHand, "Score Opponent's Hand", 75},
        {&scoreCribButton, kCmdScoreCrib, "Score Crib", 40},
        {&okButton, kCmdOk, "Ok", 25},
    };
    for (const ButtonPlace& place : places) {
        auto* button = new QPushButton(QString::fromLatin1(place.caption), this);
        button->setFocusPolicy(Qt::NoFocus);
        button->setFont(font);
        button->setGeometry(ScaledRect(Rect{cx - place.halfWidth, bh - 16, cx + place.halfWidth, bh}));
        button->hide();
        const int id = place.id;
        connect(button, &QPushButton::clicked, this, [this, id] { OnCommand(id); });
        *place.button = button;
    }
    SetButtonShown(dealButton, true);

    messageLog = new QListWidget(this);
    messageLog->setObjectName(QStringLiteral("MessageLog"));
    messageLog->setAccessibleName(QStringLiteral("Messages"));
    messageLog->setFocusPolicy(Qt::NoFocus);
    messageLog->setSelectionMode(QAbstractItemView::NoSelection);
    // A line longer than the list is wide (a long reasons line, a path) wraps
    // rather than being cut off.
    messageLog->setWordWrap(true);
    messageLog->setVerticalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    messageLog->setFont(font);
    messageLog->setGeometry(ScaledRect(LogRect()));
    messageLog->show();
}

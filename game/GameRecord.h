#pragma once

#include <QString>
#include <cstdint>

// A card: 0..51. Rank 0 ace .. 9 ten, 10 jack, 11 queen, 12 king; suit 0..3.
using CardId = int32_t;

constexpr int CardRank(CardId card) { return card % 13; }
constexpr int CardSuit(CardId card) { return card / 13; }
// Value for the running count and for fifteens: ace 1 .. ten 10, court cards 10.
constexpr int CardValue(CardId card) { return CardRank(card) < 10 ? CardRank(card) + 1 : 10; }
// The same value for a card held by rank1 (1 ace .. 13 king).
constexpr int Rank1Value(int rank1) { return rank1 < 10 ? rank1 : 10; }

// Steps of a deal. Everything below kPhaseCountStart is the discard and the play;
// the show phases (15, 9, 10) lie above it, and pegging relies on that order.
enum Phase : int32_t {
    kPhaseNoDeal = 0,
    kPhaseDiscard = 1,
    kPhasePlay = 2,
    kPhaseHandCounted = 9,
    kPhaseCribCounted = 10,
    kPhasePlayOver = 15,
    kPhaseGameOver = 20,
};
constexpr int32_t kPhaseCountStart = 9;

// Side codes wherever an operation takes a side.
enum Side : int32_t { kSidePlayer = 1, kSideOpponent = 2 };

// Hole numbers on a track.
constexpr int32_t kStartHole = 0;
constexpr int32_t kGameHole = 121;
constexpr int32_t kBackStartHole = 122;
constexpr int kHoleCount = 123;

// A rectangle in board coordinates; right and bottom are exclusive.
struct Rect {
    int32_t left = 0;
    int32_t top = 0;
    int32_t right = 0;
    int32_t bottom = 0;

    bool Contains(int32_t x, int32_t y) const { return x >= left && x < right && y >= top && y < bottom; }
    bool operator==(const Rect&) const = default;
};

struct HolePoint {
    int32_t x = 0;
    int32_t y = 0;
    bool operator==(const HolePoint&) const = default;
};

// suit1 values of a card place besides 1..4.
constexpr int32_t kSuitEmpty = 0;
constexpr int32_t kSuitBack = 5;

// One place on the table where a card may be drawn.
struct CardSprite {
    Rect rect;
    int32_t faceDown = 0;
    int32_t highlighted = 0;
    int32_t rank1 = 0;  // rank + 1 of the card shown
    int32_t suit1 = 0;  // suit + 1; kSuitBack a back; kSuitEmpty nothing
};

// The ranks (rank1) laid since the running count was last reset, ended by -1.
// At most eight cards; the ninth entry only ever holds the end marker.
struct PlaySequence {
    int32_t entries[9] = {-1, -1, -1, -1, -1, -1, -1, -1, -1};
};

// All state of the game in progress.
struct GameRecord {
    CardId deal[13] = {};
    int32_t phase = kPhaseNoDeal;
    int32_t playerCrib = 0;
    int32_t savedPlayerCrib = 0;
    int32_t selected[6] = {};
    int32_t opponentDiscarded = 0;
    int32_t runningCount = 0;
    int32_t playerPlayIndex = 0;
    int32_t opponentPlayIndex = 0;
    PlaySequence playSequence;
    int32_t lastToPlay = 0;

    int32_t playerBackHole = 0;
    int32_t playerFrontHole = 0;
    int32_t opponentBackHole = 0;
    int32_t opponentFrontHole = 0;
    Rect playerBackPegRect;
    Rect playerFrontPegRect;
    Rect opponentBackPegRect;
    Rect opponentFrontPegRect;

    int32_t gameOver = 0;
    int32_t gamesFor = 0;
    int32_t gamesAgainst = 0;
    QString ownerName;

    Rect countRect;
    int32_t shownCount = 0;
    int32_t countVisible = 0;
    int32_t boardStyle = 0;
    // 1: every score in the log is followed by a line of its reasons.
    int32_t explainScores = 0;
    int32_t scaleX = 0;
    int32_t scaleY = 0;
    int32_t firstPaintPending = 0;

    CardSprite opponentHandSprites[6];
    CardSprite playerHandSprites[6];
    CardSprite opponentPileSprites[4];
    CardSprite playerPileSprites[4];
    CardSprite starterSprite;

    // Hole centres of both tracks, indexed by hole number.
    HolePoint playerHoles[kHoleCount];
    HolePoint opponentHoles[kHoleCount];
};

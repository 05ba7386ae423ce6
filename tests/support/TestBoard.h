#pragma once

#include "game/GameBoard.h"

#include <QStringList>
#include <QtTest>
#include <initializer_list>
#include <memory>
#include <span>

// A game window as the frame makes it: 240 s x (320 s - 52) pixels, shown and
// painted once, so its factors, buttons and log exist. The stored settings are
// removed first unless keepSettings is set, so each board starts as a first run.
std::unique_ptr<GameBoard> MakeBoard(int scale = 1, bool keepSettings = false);

// Removes the stored settings of the test run.
void ClearSettings();

// Makes the next deal draw exactly these cards (13 ids: the user's six, the
// computer's six, the starter); the user's six are then sorted by the deal.
void StackDeck(GameBoard& board, std::initializer_list<CardId> cards);

// Real input, at window pixels scaled from board coordinates.
void TapBoard(GameBoard& board, int x, int y);
void TapHand(GameBoard& board, int position);   // 1..6, the middle of that card
void ClickButton(GameBoard& board, int id);     // a mouse click on a visible button
inline void PressKey(GameBoard& board, int key) { QTest::keyClick(&board, static_cast<Qt::Key>(key)); }

// The ids of the action buttons that are shown.
QList<int> ShownButtons(const GameBoard& board);
QStringList LogLines(const GameBoard& board);

// A card by name, rank then suit: "5H", "TC" (T ten; suits S D H C as the
// program numbers them), and back.
CardId CardNamed(const QString& name);
QString CardName(CardId card);
// What the places show: a card's name, "##" a back, "--" nothing.
QString ShownCards(std::span<const CardSprite> places);

// Builds a CardId from rank1 (1 ace .. 13 king) and suit1 (1..4).
constexpr CardId Card(int rank1, int suit1) { return (suit1 - 1) * 13 + (rank1 - 1); }

#pragma once

#include "game/GameBoard.h"

#include <QMainWindow>
#include <QSize>

class QAction;
class QMenu;

// The frame window: New and the "Tools" menu on its menu bar, the Exit key, and the game
// window as its only central child, which always holds the keyboard focus.
class CMainFrame : public QMainWindow {
    Q_OBJECT

public:
    explicit CMainFrame(QWidget* parent = nullptr);

    GameBoard* Board() { return &board; }
    QMenu* ToolsMenu() const { return toolsMenu; }
    QAction* NewAction() const { return newAction; }

    // The largest whole scale factor in device pixels (at least 1) at which the
    // game window plus the frame's own chrome fits the available area. Sizes
    // are in window pixels, each `ratio` device pixels wide.
    int ChooseScale(QSize available, QSize chrome, qreal ratio) const;
    // The game window's size in window pixels that yields a scale factor.
    QSize GameWindowSize(int scale, qreal ratio) const;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void OnNew();
    void OnAbout();
    void OnOptionsCommand();
    void OnExit();

    GameBoard board;
    QMenu* toolsMenu = nullptr;
    QAction* newAction = nullptr;
};

#pragma once

#include "game/GameBoard.h"

#include <QMainWindow>
#include <QSize>

class CHowToPlayWnd;
class QAction;
class QLabel;
class QMenu;

// The frame window: New, the "Tools" and "Help" menus on its menu bar, the Exit
// key, the game window as its only central child, which always holds the
// keyboard focus, and a status bar with the state of the game in words.
class CMainFrame : public QMainWindow {
    Q_OBJECT

public:
    explicit CMainFrame(QWidget* parent = nullptr);

    GameBoard* Board() { return &board; }
    QMenu* ToolsMenu() const { return toolsMenu; }
    QAction* NewAction() const { return newAction; }
    QMenu* HelpMenu() const { return helpMenu; }
    QLabel* StatusLabel() const { return statusLabel; }
    // The rules window, once opened.
    CHowToPlayWnd* HowToPlay() const { return howToPlay; }

    // The largest whole scale factor in device pixels (at least 1) at which the
    // game window plus the frame's own chrome fits the available area, and
    // whether the window keeps the band under the log: it goes only where it
    // alone keeps that factor from fitting. Sizes are in window pixels, each
    // `ratio` device pixels wide.
    struct Scale {
        int factor = 1;
        bool band = true;
        bool operator==(const Scale&) const = default;
    };
    Scale ChooseScale(QSize available, QSize chrome, qreal ratio) const;
    // The game window's size in window pixels that yields a scale factor.
    QSize GameWindowSize(int scale, qreal ratio, bool band = true) const;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void OnNew();
    void OnHowToPlay();
    void OnAbout();
    void OnOptionsCommand();
    void OnExit();

    GameBoard board;
    QMenu* toolsMenu = nullptr;
    QMenu* helpMenu = nullptr;
    QAction* newAction = nullptr;
    QLabel* statusLabel = nullptr;
    CHowToPlayWnd* howToPlay = nullptr;
};

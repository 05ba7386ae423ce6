#pragma once

#include <QDialog>

class QTextBrowser;

// The rules of the game as Vennick plays them, the mouse and the keys: a
// window of its own beside the game, which goes on while it is open.
class CHowToPlayWnd : public QDialog {
    Q_OBJECT

public:
    explicit CHowToPlayWnd(QWidget* parent = nullptr);

    QTextBrowser* Browser() const { return browser; }

private:
    QTextBrowser* browser = nullptr;
};

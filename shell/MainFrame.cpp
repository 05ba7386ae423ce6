#include "shell/MainFrame.h"

#include "shell/AboutDialog.h"
#include "shell/HowToPlay.h"

#include <QAction>
#include <QCoreApplication>
#include <QHelpEvent>
#include <QLabel>
#include <QLayout>
#include <QMenuBar>
#include <QMessageBox>
#include <QPushButton>
#include <QScreen>
#include <QStatusBar>
#include <QStyle>
#include <QToolTip>
#include <QtMath>

namespace {

// Title bar and borders that a window manager adds; not known before the
// window is shown, so a typical allowance is kept free.
constexpr int kDecorationWidth = 16;
constexpr int kDecorationHeight = 48;

} // namespace

CMainFrame::CMainFrame(QWidget* parent)
    : QMainWindow(parent)
{
    setWindowTitle(QStringLiteral("Vennick"));
    setCentralWidget(&board);
    setFocusProxy(&board);

    // New sits on the menu bar itself, left of "Tools", as a command of its own.
    // Every entry has its Alt key.
    newAction = menuBar()->addAction(QStringLiteral("&New"));
    newAction->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_N));
    newAction->setToolTip(QStringLiteral("New game (Ctrl+N)"));
    connect(newAction, &QAction::triggered, this, &CMainFrame::OnNew);
    // The shortcut works while the menu bar is hidden or inactive as well.
    addAction(newAction);

    toolsMenu = menuBar()->addMenu(QStringLiteral("&Tools"));
    QAction* about = toolsMenu->addAction(QStringLiteral("&About Vennick..."));
    connect(about, &QAction::triggered, this, &CMainFrame::OnAbout);
    QAction* options = toolsMenu->addAction(QStringLiteral("&Options..."));
    connect(options, &QAction::triggered, this, &CMainFrame::OnOptionsCommand);
    QAction* exitAction = toolsMenu->addAction(QStringLiteral("E&xit"));
    exitAction->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_Q));
    connect(exitAction, &QAction::triggered, this, &CMainFrame::OnExit);

    helpMenu = menuBar()->addMenu(QStringLiteral("&Help"));
    QAction* rules = helpMenu->addAction(QStringLiteral("&How to Play"));
    rules->setShortcut(QKeySequence(Qt::Key_F1));
    connect(rules, &QAction::triggered, this, &CMainFrame::OnHowToPlay);
    addAction(rules);
    menuBar()->installEventFilter(this);

    // F10 opens the first menu, as on other desktops.
    auto* menuKey = new QAction(this);
    menuKey->setShortcut(QKeySequence(Qt::Key_F10));
    connect(menuKey, &QAction::triggered, this, [this] { menuBar()->setActiveAction(toolsMenu->menuAction()); });
    addAction(menuKey);

    statusLabel = new QLabel(this);
    statusLabel->setObjectName(QStringLiteral("status"));
    statusLabel->setTextFormat(Qt::PlainText);
    statusBar()->addWidget(statusLabel, 1);
    statusBar()->setSizeGripEnabled(false);
    connect(&board, &GameBoard::StatusChanged, this, [this] { statusLabel->setText(board.StatusLine()); });
    statusLabel->setText(board.StatusLine());

    const QScreen* screen = this->screen();
    const QSize available = screen ? screen->availableGeometry().size() : QSize(240, 320);
    const qreal ratio = screen ? screen->devicePixelRatio() : 1.0;
    const QSize chrome(kDecorationWidth,
                       menuBar()->sizeHint().height() + statusBar()->sizeHint().height() + kDecorationHeight);
    const Scale scale = ChooseScale(available, chrome, ratio);
    board.setFixedSize(GameWindowSize(scale.factor, ratio, scale.band));
    // The factors are fixed at the first paint, so the frame keeps its size.
    layout()->setSizeConstraint(QLayout::SetFixedSize);
}

CMainFrame::Scale CMainFrame::ChooseScale(QSize available, QSize chrome, qreal ratio) const
{
    const auto fits = [&](int factor, bool band) {
        const QSize window = GameWindowSize(factor, ratio, band) + chrome;
        return window.width() <= available.width() && window.height() <= available.height();
    };
    Scale scale;
    while (fits(scale.factor + 1, true))
        ++scale.factor;
    if (fits(scale.factor + 1, false))
        scale = {scale.factor + 1, false};
    return scale;
}

QSize CMainFrame::GameWindowSize(int scale, qreal ratio, bool band) const
{
    // Rounded up, so the device size is at least the one the factor needs.
    const QSize device = board.DeviceWindowSize(scale, band);
    return QSize(qCeil(device.width() / ratio), qCeil(device.height() / ratio));
}

void CMainFrame::OnNew()
{
    // A release of Enter that came just before acts before the new game.
    board.ActOnPendingRelease();
    if (board.GameInProgress()) {
        // A game under way is not thrown away, nor its loss dodged, by one slip.
        QMessageBox ask(QMessageBox::Question, QStringLiteral("New Game"), QStringLiteral("Abandon this game?"),
                        QMessageBox::NoButton, this);
        ask.addButton(QStringLiteral("&Abandon"), QMessageBox::DestructiveRole);
        QPushButton* cancel = ask.addButton(QMessageBox::Cancel);
        ask.setDefaultButton(cancel);
        ask.setEscapeButton(cancel);
        ask.exec();
        activateWindow();
        board.setFocus();
        if (ask.clickedButton() == cancel)
            return;
    }
    board.NewGame();
}

void CMainFrame::OnHowToPlay()
{
    board.ActOnPendingRelease();
    if (howToPlay == nullptr)
        howToPlay = new CHowToPlayWnd(this);
    howToPlay->show();
    howToPlay->raise();
    howToPlay->activateWindow();
}

bool CMainFrame::eventFilter(QObject* watched, QEvent* event)
{
    // The tooltip of a command on the menu bar itself, such as New.
    if (watched == menuBar() && event->type() == QEvent::ToolTip) {
        const auto* help = static_cast<QHelpEvent*>(event);
        const QAction* action = menuBar()->actionAt(help->pos());
        if (action != nullptr && action->menu() == nullptr) {
            QToolTip::showText(help->globalPos(), action->toolTip(), menuBar(), menuBar()->actionGeometry(const_cast<QAction*>(action)));
            return true;
        }
    }
    return QMainWindow::eventFilter(watched, event);
}

void CMainFrame::OnAbout()
{
    board.ActOnPendingRelease();
    CAboutDlg dialog(this);
    dialog.exec();
    activateWindow();
    board.setFocus();
}

void CMainFrame::OnOptionsCommand()
{
    board.ActOnPendingRelease();
    board.OnOptions();
    activateWindow();
    board.setFocus();
}

void CMainFrame::OnExit()
{
    QCoreApplication::exit(0);
}

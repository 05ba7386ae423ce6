#include "shell/MainFrame.h"

#include "shell/AboutDialog.h"

#include <QAction>
#include <QCoreApplication>
#include <QLayout>
#include <QMenuBar>
#include <QScreen>
#include <QStyle>
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

    toolsMenu = menuBar()->addMenu(QStringLiteral("Tools"));
    QAction* about = toolsMenu->addAction(QStringLiteral("About Vennick..."));
    connect(about, &QAction::triggered, this, &CMainFrame::OnAbout);
    QAction* options = toolsMenu->addAction(QStringLiteral("Options..."));
    connect(options, &QAction::triggered, this, &CMainFrame::OnOptionsCommand);
    QAction* exitAction = toolsMenu->addAction(QStringLiteral("Exit"));
    exitAction->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_Q));
    connect(exitAction, &QAction::triggered, this, &CMainFrame::OnExit);

    // New has no menu item; its key works in every phase.
    auto* newGame = new QAction(QStringLiteral("New"), this);
    newGame->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_N));
    connect(newGame, &QAction::triggered, &board, &GameBoard::NewGame);
    addAction(newGame);

    const QScreen* screen = this->screen();
    const QSize available = screen ? screen->availableGeometry().size() : QSize(240, 320);
    const qreal ratio = screen ? screen->devicePixelRatio() : 1.0;
    const QSize chrome(kDecorationWidth, menuBar()->sizeHint().height() + kDecorationHeight);
    board.setFixedSize(GameWindowSize(ChooseScale(available, chrome, ratio), ratio));
    // The factors are fixed at the first paint, so the frame keeps its size.
    layout()->setSizeConstraint(QLayout::SetFixedSize);
}

int CMainFrame::ChooseScale(QSize available, QSize chrome, qreal ratio) const
{
    int scale = 1;
    while (true) {
        const QSize next = GameWindowSize(scale + 1, ratio) + chrome;
        if (next.width() > available.width() || next.height() > available.height())
            return scale;
        ++scale;
    }
}

QSize CMainFrame::GameWindowSize(int scale, qreal ratio) const
{
    // Rounded up, so the device size is at least the one the factor needs.
    const QSize device = board.DeviceWindowSize(scale);
    return QSize(qCeil(device.width() / ratio), qCeil(device.height() / ratio));
}

void CMainFrame::OnAbout()
{
    CAboutDlg dialog(this);
    dialog.exec();
    activateWindow();
    board.setFocus();
}

void CMainFrame::OnOptionsCommand()
{
    board.OnOptions();
    activateWindow();
    board.setFocus();
}

void CMainFrame::OnExit()
{
    QCoreApplication::exit(0);
}

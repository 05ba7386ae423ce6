#include "shell/MainFrame.h"

#include "shell/AboutDialog.h"

#include <QAction>
#include <QCoreApplication>
#include <QHelpEvent>
#include <QLayout>
#include <QMenuBar>
#include <QScreen>
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
    newAction = menuBar()->addAction(QStringLiteral("New"));
    newAction->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_N));
    newAction->setToolTip(QStringLiteral("New game (Ctrl+N)"));
    connect(newAction, &QAction::triggered, this, &CMainFrame::OnNew);
    // The shortcut works while the menu bar is hidden or inactive as well.
    addAction(newAction);

    toolsMenu = menuBar()->addMenu(QStringLiteral("Tools"));
    QAction* about = toolsMenu->addAction(QStringLiteral("About Vennick..."));
    connect(about, &QAction::triggered, this, &CMainFrame::OnAbout);
    QAction* options = toolsMenu->addAction(QStringLiteral("Options..."));
    connect(options, &QAction::triggered, this, &CMainFrame::OnOptionsCommand);
    QAction* exitAction = toolsMenu->addAction(QStringLiteral("Exit"));
    exitAction->setShortcut(QKeySequence(Qt::CTRL | Qt::Key_Q));
    connect(exitAction, &QAction::triggered, this, &CMainFrame::OnExit);
    menuBar()->installEventFilter(this);

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

void CMainFrame::OnNew()
{
    // A release of Enter that came just before acts before the new game.
    board.ActOnPendingRelease();
    board.NewGame();
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

#include "shell/GameApp.h"

#include "accessibility/TableAccessible.h"
#include "shell/MainFrame.h"

#include <QAccessible>
#include <QIcon>

CGameApp::CGameApp(int& argc, char** argv)
    : QApplication(argc, argv)
{
    setApplicationName(QStringLiteral("Vennick"));
    setOrganizationName(QStringLiteral("Quorvan"));
    // The project's version, from the build (CMake's project()).
    setApplicationVersion(QStringLiteral(VENNICK_VERSION));
    QIcon icon;
    for (int size : {16, 32, 256})
        icon.addFile(QStringLiteral(":/icons/vennick-%1.png").arg(size), QSize(size, size));
    setWindowIcon(icon);
    // Costs nothing until a screen reader asks for the game window.
    QAccessible::installFactory(TableAccessibleFactory);
}

CGameApp::~CGameApp() = default;

bool CGameApp::InitInstance()
{
    mainFrame = std::make_unique<CMainFrame>();
    mainFrame->show();
    mainFrame->Board()->setFocus();
    return true;
}

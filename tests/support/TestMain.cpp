#include "support/TestMain.h"

#include "shell/GameApp.h"

#include <QSettings>
#include <QTemporaryDir>

#include <vector>

// Constant-initialised, so it exists before any test file registers.
constinit static std::vector<std::function<int(int, char**)>> registry;

bool RegisterTestClass(std::function<int(int, char**)> run)
{
    registry.push_back(std::move(run));
    return true;
}

int main(int argc, char** argv)
{
    // Settings never touch the user's own: the whole run uses a fresh folder.
    QTemporaryDir configHome;
    qputenv("XDG_CONFIG_HOME", configHome.path().toUtf8());
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, configHome.path());

    // The program's own application object, so its start-up can be tested too.
    CGameApp app(argc, argv);
    // Qt Test's crash handler can hang a process that runs several test
    // classes; without it a crash ends the run at once, reported by CTest
    // (and by the sanitizers' own handler in their build).
    std::vector<char*> args(argv, argv + argc);
    char noCrashHandler[] = "-nocrashhandler";
    args.push_back(noCrashHandler);
    int failed = 0;
    for (const auto& run : registry)
        failed += run(static_cast<int>(args.size()), args.data()) != 0;
    return failed == 0 ? 0 : 1;
}

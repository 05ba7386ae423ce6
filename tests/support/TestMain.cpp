#include "support/TestMain.h"

#include "shell/GameApp.h"

#include <QSettings>
#include <QTemporaryDir>

#include <algorithm>
#include <climits>
#include <vector>

// Constant-initialised, so they exist before any test file registers.
constinit static std::vector<std::pair<const QMetaObject*, std::function<int(int, char**)>>> registry;
constinit static std::chrono::milliseconds functionTimeAllowed{0};

bool RegisterTestClass(const QMetaObject& meta, std::function<int(int, char**)> run)
{
    registry.emplace_back(&meta, std::move(run));
    return true;
}

// Whether a class runs: it has a function named on the command line
// ("function" or "function:tag"), or none is named.
static bool Runs(const QMetaObject& meta, const std::vector<char*>& args)
{
    bool named = false;
    for (size_t i = 1; i < args.size(); ++i) {
        if (args[i][0] == '-')
            continue;
        named = true;  // also an option's value, which matches no function
        if (meta.indexOfSlot(QByteArray(args[i]).split(':').first() + "()") >= 0)
            return true;
    }
    return !named;
}

bool AllowFunctionTime(std::chrono::milliseconds limit)
{
    functionTimeAllowed = std::max(functionTimeAllowed, limit);
    return true;
}

int main(int argc, char** argv)
{
    // Qt Test reads its limit once, at the first test function of the run.
    constexpr std::chrono::milliseconds kQtTestLimit = std::chrono::minutes(5);
    if (functionTimeAllowed > kQtTestLimit && !qEnvironmentVariableIsSet("QTEST_FUNCTION_TIMEOUT"))
        qputenv("QTEST_FUNCTION_TIMEOUT", QByteArray::number(std::min<qint64>(functionTimeAllowed.count(), INT_MAX)));

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
    // When no class has a function named, all run, and Qt Test says so.
    const bool anyRuns = std::any_of(registry.begin(), registry.end(), [&args](const auto& c) { return Runs(*c.first, args); });
    int failed = 0;
    for (const auto& [meta, run] : registry)
        if (!anyRuns || Runs(*meta, args))
            failed += run(static_cast<int>(args.size()), args.data()) != 0;
    return failed == 0 ? 0 : 1;
}

#include "support/TestMain.h"

#include "shell/GameApp.h"

#include <QSettings>
#include <QTemporaryDir>

#include <algorithm>
#include <climits>
#include <vector>

// Constant-initialised, so they exist before any test file registers.
struct TestClass {
    const QMetaObject* meta;
    std::function<int(int, char**)> run;
};
constinit static std::vector<TestClass> registry;
constinit static std::chrono::milliseconds functionTimeAllowed{0};

bool RegisterTestClass(const QMetaObject& meta, std::function<int(int, char**)> run)
{
    registry.push_back({&meta, std::move(run)});
    return true;
}

namespace {

// The test functions named on the command line ("function" or "function:data
// tag"); an option's value taken for a name matches no function.
QList<QByteArray> NamedFunctions(const std::vector<char*>& args)
{
    QList<QByteArray> names;
    for (size_t i = 1; i < args.size(); ++i)
        if (args[i][0] != '-')
            names.append(QByteArray(args[i]).split(':').first() + "()");
    return names;
}

bool HasAny(const QMetaObject& meta, const QList<QByteArray>& functions)
{
    return std::any_of(functions.begin(), functions.end(),
                       [&meta](const QByteArray& f) { return meta.indexOfSlot(f.constData()) >= 0; });
}

} // namespace

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
    // Only the classes that have a function named; when none has, all run,
    // and Qt Test says what was not found.
    const QList<QByteArray> named = NamedFunctions(args);
    const bool anyKnown = std::any_of(registry.begin(), registry.end(),
                                      [&named](const TestClass& c) { return HasAny(*c.meta, named); });
    int failed = 0;
    for (const TestClass& c : registry)
        if (!anyKnown || HasAny(*c.meta, named))
            failed += c.run(static_cast<int>(args.size()), args.data()) != 0;
    return failed == 0 ? 0 : 1;
}

#include "shell/GameApp.h"

#include <QCommandLineParser>
#include <QFileInfo>

#include <cstdio>

namespace {

// The exit status for a command line the program does not understand.
constexpr int kUsageError = 2;

void DescribeOptions(QCommandLineParser& parser)
{
    parser.setApplicationDescription(QStringLiteral("Cribbage against the computer."));
    parser.addHelpOption();
    parser.addVersionOption();
}

// Whether the command line asks for the help or the version and nothing else
// the parser does not know, looked at before Qt takes its own options out.
bool AsksOnlyForText(int argc, char** argv)
{
    QStringList arguments;
    for (int i = 0; i < argc; ++i)
        arguments.append(QString::fromLocal8Bit(argv[i]));
    QCommandLineParser parser;
    DescribeOptions(parser);
    return parser.parse(arguments)
           && (parser.isSet(QStringLiteral("help")) || parser.isSet(QStringLiteral("help-all"))
               || parser.isSet(QStringLiteral("version")));
}

} // namespace

int main(int argc, char** argv)
{
    // The help and the version are text for the terminal: no display is needed
    // for them, so they work over ssh and in scripts as well.
    if (AsksOnlyForText(argc, argv))
        qputenv("QT_QPA_PLATFORM", "minimal");
    CGameApp app(argc, argv);

    // Qt's own options (-platform, -style, ...) are gone from the arguments by now.
    QCommandLineParser parser;
    DescribeOptions(parser);
    const QStringList arguments = QCoreApplication::arguments();
    const QString program = QFileInfo(arguments.value(0, QStringLiteral("vennick"))).fileName();
    QString error;
    if (!parser.parse(arguments))
        error = parser.errorText();
    else if (!parser.positionalArguments().isEmpty())
        error = QStringLiteral("Unexpected argument '%1'.").arg(parser.positionalArguments().constFirst());
    if (!error.isEmpty()) {
        std::fprintf(stderr, "%s: %s\nTry '%s --help' for more information.\n", qPrintable(program),
                     qPrintable(error), qPrintable(program));
        return kUsageError;
    }
    // Prints the help or the version and ends the program when asked.
    parser.process(arguments);

    if (!app.InitInstance())
        return 1;
    return CGameApp::exec();
}

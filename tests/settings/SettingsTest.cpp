#include "settings/Settings.h"
#include "settings/TempStore.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QApplication>

#include <optional>
#include <random>
#include <sys/stat.h>

namespace {

QStringList TallyLines(const QString& owner, qint64 won, qint64 lost)
{
    return {owner + QStringLiteral(": ") + QString::number(won), QStringLiteral("Opponent: ") + QString::number(lost),
            QStringLiteral("Click Deal to start a new game.")};
}

// The crib line of the next deal: by the Deal button when it is shown,
// else straight away, as the end of a deal's show would offer it.
QString DealAndTellCrib(GameBoard& board)
{
    if (board.IsButtonShown(kCmdDeal))
        ClickButton(board, kCmdDeal);
    else
        board.OnDeal();
    const QStringList lines = LogLines(board);
    return lines.isEmpty() ? QString() : lines.last();
}

// Deals, chooses two cards and sends them: the game is in the play.
void PlayIntoThePlay(GameBoard& board)
{
    ClickButton(board, kCmdDeal);
    QCOMPARE(board.record.phase, int(kPhaseDiscard));
    TapHand(board, 1);
    TapHand(board, 2);
    ClickButton(board, kCmdSendToCrib);
    QCOMPARE(board.record.phase, int(kPhasePlay));
}

enum BadFile { Garbage, Truncated, Huge, Folder, ParentIsFile, Pipe, ReadOnlyFolder, Unreadable };

} // namespace

// The stored values: the first run, reading them back, damaged values and files.
class SettingsTest : public QObject {
    Q_OBJECT

private slots:
    void ownerName_data()
    {
        QTest::addColumn<QByteArray>("gecos");
        QTest::addColumn<QString>("name");
        QTest::newRow("full name only") << QByteArray("Ada Byron") << QStringLiteral("Ada Byron");
        QTest::newRow("name with office and phones") << QByteArray("Ada Byron,Room 12,555-1234,")
                                                     << QStringLiteral("Ada Byron");
        QTest::newRow("spaces around") << QByteArray("  Ada Byron \t,x") << QStringLiteral("Ada Byron");
        QTest::newRow("UTF-8") << QByteArray("Zo\xc3\xab Ng") << QStringLiteral("Zo\u00eb Ng");
        QTest::newRow("empty") << QByteArray() << QStringLiteral("You");
        QTest::newRow("only commas") << QByteArray(",,,") << QStringLiteral("You");
        QTest::newRow("blank before the comma") << QByteArray("   ,Room 12") << QStringLiteral("You");
    }

    void ownerName()
    {
        QFETCH(QByteArray, gecos);
        QFETCH(QString, name);
        QCOMPARE(OwnerNameFromGecos(gecos), name);
        QVERIFY(!SystemOwnerName().isEmpty());
    }

    void firstRun_data()
    {
        QTest::addColumn<bool>("emptyFile");
        QTest::newRow("no store") << false;
        QTest::newRow("an empty store") << true;
    }

    void firstRun()
    {
        QFETCH(bool, emptyFile);
        TempStore store;
        if (emptyFile)
            store.Write(QByteArray());
        auto board = MakeBoard(1, true);

        QCOMPARE(store.Value(QStringLiteral("For")).toInt(), 0);
        QCOMPARE(store.Value(QStringLiteral("Against")).toInt(), 0);
        QCOMPARE(store.Value(QStringLiteral("Crib")).toInt(), 1);
        QCOMPARE(store.Value(QStringLiteral("Board")).toInt(), 1);
        QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), 0, 0));
        QCOMPARE(board->record.boardStyle, 1);
        QVERIFY(ShowsBoard(*board, kBitmapBoardNormal));
        QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Opponent's Crib."));
    }

    void storedValues_data()
    {
        QTest::addColumn<int>("style");
        QTest::addColumn<int>("bitmap");
        QTest::newRow("Normal") << 1 << int(kBitmapBoardNormal);
        QTest::newRow("Wooden") << 2 << int(kBitmapBoardWooden);
        QTest::newRow("Embossed") << 3 << int(kBitmapBoardEmbossed);
        QTest::newRow("0 shows Embossed") << 0 << int(kBitmapBoardEmbossed);
        QTest::newRow("4 shows Embossed") << 4 << int(kBitmapBoardEmbossed);
        QTest::newRow("-1 shows Embossed") << -1 << int(kBitmapBoardEmbossed);
    }

    void storedValues()
    {
        QFETCH(int, style);
        QFETCH(int, bitmap);
        TempStore store;
        store.Write(QStringLiteral("[General]\nFor=5\nAgainst=7\nCrib=1\nBoard=%1\n").arg(style).toUtf8());
        const QByteArray before = store.Content();
        auto board = MakeBoard(1, true);

        QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), 5, 7));
        QCOMPARE(board->record.boardStyle, style);
        QVERIFY(ShowsBoard(*board, bitmap));
        if (bitmap != kBitmapBoardNormal)
            QVERIFY(!ShowsBoard(*board, kBitmapBoardNormal));
        // Loading an existing store never writes it.
        QCOMPARE(store.Content(), before);
    }

    void newGameAlternatesAcrossRuns()
    {
        TempStore store;
        {
            auto board = MakeBoard(1, true);
            QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Opponent's Crib."));
            QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Your Crib."));
            // As after games won and lost in this run.
            board->record.gamesFor = 3;
            board->record.gamesAgainst = 2;
            board->NewGame();
            QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), 3, 2));
            QCOMPARE(store.Value(QStringLiteral("Crib")).toInt(), 0);
            QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Your Crib."));
        }
        // The next run goes on from the game the last one started.
        {
            auto board = MakeBoard(1, true);
            QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), 3, 2));
            QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Your Crib."));
            board->NewGame();
            QCOMPARE(store.Value(QStringLiteral("Crib")).toInt(), 1);
            QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Opponent's Crib."));
            board->NewGame();
            QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Your Crib."));
        }
    }

    void unusableStoreStillAlternates()
    {
        TempStore store;
        QVERIFY(QDir().mkpath(store.FileName()));
        auto board = MakeBoard(1, true);
        QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Opponent's Crib."));
        board->NewGame();
        QCOMPARE(LogLines(*board), TallyLines(QStringLiteral("You"), 0, 0));
        QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Your Crib."));
        board->NewGame();
        QCOMPARE(DealAndTellCrib(*board), QStringLiteral("Opponent's Crib."));
        QVERIFY(QFileInfo(store.FileName()).isDir());
    }

    void badValues_data()
    {
        QTest::addColumn<QByteArray>("content");
        QTest::addColumn<int>("gamesFor");
        QTest::addColumn<int>("gamesAgainst");
        QTest::addColumn<int>("crib");
        QTest::addColumn<int>("style");
        QTest::newRow("only For") << QByteArray("[General]\nFor=3\n") << 3 << 0 << 1 << 1;
        QTest::newRow("empty values") << QByteArray("[General]\nFor=\nAgainst=\nCrib=\nBoard=\n") << 0 << 0 << 1 << 1;
        QTest::newRow("not numbers") << QByteArray("[General]\nFor=five\nAgainst=7x\nCrib=yes\nBoard=2.5\n")
                                     << 0 << 0 << 1 << 1;
        QTest::newRow("a list") << QByteArray("[General]\nFor=4, 5\nBoard=2\n") << 0 << 0 << 1 << 2;
        QTest::newRow("largest 32-bit values") << QByteArray("[General]\nFor=2147483647\nAgainst=2147483647\n")
                                               << 2147483647 << 2147483647 << 1 << 1;
        // Cut to 32 bits these would read as 0, -1 and 2 (Wooden).
        QTest::newRow("beyond 32 bits")
            << QByteArray("[General]\nFor=4294967296\nAgainst=2147483648\nCrib=4294967296\nBoard=4294967298\n")
            << 0 << 0 << 1 << 1;
        QTest::newRow("below 32 bits") << QByteArray("[General]\nFor=-2147483649\n") << 0 << 0 << 1 << 1;
        QTest::newRow("twenty digits") << QByteArray("[General]\nFor=99999999999999999999\n") << 0 << 0 << 1 << 1;
        QTest::newRow("crib 0") << QByteArray("[General]\nCrib=0\n") << 0 << 0 << 0 << 1;
        QTest::newRow("crib 2 counts as 1") << QByteArray("[General]\nCrib=2\n") << 0 << 0 << 1 << 1;
        QTest::newRow("crib -1 counts as 1") << QByteArray("[General]\nCrib=-1\n") << 0 << 0 << 1 << 1;
    }

    void badValues()
    {
        QFETCH(QByteArray, content);
        QFETCH(int, gamesFor);
        QFETCH(int, gamesAgainst);
        QFETCH(int, crib);
        QFETCH(int, style);
        TempStore store;
        store.Write(content);
        auto board = MakeBoard(1, true);

        QCOMPARE(board->record.gamesFor, gamesFor);
        QCOMPARE(board->record.gamesAgainst, gamesAgainst);
        QCOMPARE(board->record.savedPlayerCrib, crib);
        QCOMPARE(board->record.playerCrib, crib);
        QCOMPARE(board->record.boardStyle, style);
        QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), gamesFor, gamesAgainst));
        QCOMPARE(store.Content(), content);

        // The crib alternates from whatever was stored.
        const QString first = crib == 1 ? QStringLiteral("Opponent's Crib.") : QStringLiteral("Your Crib.");
        const QString second = crib == 1 ? QStringLiteral("Your Crib.") : QStringLiteral("Opponent's Crib.");
        QCOMPARE(DealAndTellCrib(*board), first);
        QCOMPARE(DealAndTellCrib(*board), second);
        QCOMPARE(DealAndTellCrib(*board), first);
    }

    void badFiles_data()
    {
        QTest::addColumn<int>("kind");
        QTest::addColumn<bool>("readable");   // its values are read
        QTest::addColumn<bool>("writable");   // a save replaces it
        QTest::newRow("garbage bytes") << int(Garbage) << true << true;
        QTest::newRow("truncated") << int(Truncated) << true << true;
        QTest::newRow("huge") << int(Huge) << false << false;
        QTest::newRow("a folder") << int(Folder) << false << false;
        QTest::newRow("its folder is a file") << int(ParentIsFile) << false << false;
        QTest::newRow("a named pipe") << int(Pipe) << false << false;
        QTest::newRow("read-only folder") << int(ReadOnlyFolder) << true << false;
        QTest::newRow("unreadable file") << int(Unreadable) << false << false;
    }

    void badFiles()
    {
        QFETCH(int, kind);
        QFETCH(bool, readable);
        QFETCH(bool, writable);
        TempStore store;
        const QByteArray values("[General]\nAgainst=7\nBoard=2\nCrib=0\nFor=5\n");
        int expectFor = readable ? 5 : 0;
        int expectAgainst = readable ? 7 : 0;
        switch (kind) {
        case Garbage: {
            QByteArray bytes(4096, '\0');
            std::mt19937 random(7);
            for (char& c : bytes)
                c = static_cast<char>(random() % 256);
            store.Write(bytes);
            expectFor = 0;
            expectAgainst = 0;
            break;
        }
        case Truncated:
            store.Write(values.left(values.indexOf("Crib") + 2));
            expectFor = 0;
            break;
        case Huge:
            store.Write(values + QByteArray(8 * 1024 * 1024, 'x'));
            break;
        case Folder:
            QVERIFY(QDir().mkpath(store.FileName()));
            break;
        case ParentIsFile:
            QVERIFY(QDir().mkpath(QFileInfo(store.Folder()).absolutePath()));
            {
                QFile file(store.Folder());
                QVERIFY(file.open(QIODevice::WriteOnly));
            }
            break;
        case Pipe:
            QVERIFY(QDir().mkpath(store.Folder()));
            QCOMPARE(mkfifo(QFile::encodeName(store.FileName()).constData(), 0644), 0);
            break;
        case ReadOnlyFolder:
            store.Write(values);
            QVERIFY(QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::ExeOwner | QFile::ReadOther
                                                              | QFile::ExeOther));
            break;
        case Unreadable:
            store.Write(values);
            QVERIFY(QFile::setPermissions(store.FileName(), QFile::WriteOwner));
            break;
        }
        const QFileInfo before(store.FileName());
        const QByteArray contentBefore = before.isFile() ? store.Content() : QByteArray();

        {
            std::optional<Unprivileged> unprivileged;
            if (kind == ReadOnlyFolder || kind == Unreadable)
                unprivileged.emplace();
            auto board = MakeBoard(1, true);
            const QString owner = readable ? SystemOwnerName() : QStringLiteral("You");
            QCOMPARE(LogLines(*board), TallyLines(owner, expectFor, expectAgainst));
            PlayIntoThePlay(*board);

            // A game won: the tally grows and is saved where that is possible.
            board->record.gamesFor += 1;
            board->SaveSettings();
            QCOMPARE(board->record.gamesFor, expectFor + 1);
            QVERIFY(!QApplication::activeModalWidget());

            // New game keeps this run's tally, whether or not the store took it.
            board->NewGame();
            QCOMPARE(LogLines(*board), TallyLines(owner, expectFor + 1, expectAgainst));
            board->record.savedPlayerCrib = 1;  // as before New, for the file's check below
            board->SaveSettings();
        }
        if (kind == ReadOnlyFolder)
            QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);

        const QFileInfo after(store.FileName());
        if (writable) {
            // Rewritten clean, with every value that could be read.
            const QByteArray expected = QStringLiteral("[General]\nAgainst=%1\nBoard=%2\nCrib=%3\nFor=%4\n")
                                            .arg(expectAgainst)
                                            .arg(kind == Truncated ? 2 : 1)
                                            .arg(1)
                                            .arg(expectFor + 1)
                                            .toUtf8();
            QCOMPARE(store.Content(), expected);
        } else {
            QCOMPARE(after.exists(), before.exists());
            QCOMPARE(after.isDir(), before.isDir());
            QCOMPARE(after.size(), before.size());
            if (!contentBefore.isEmpty())
                QCOMPARE(store.Content(), contentBefore);
        }
    }
};

VENNICK_TEST(SettingsTest);
#include "SettingsTest.moc"

#include "settings/Settings.h"
#include "settings/TempStore.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QElapsedTimer>
#include <QSysInfo>

#include <optional>
#include <random>
#include <sys/stat.h>

namespace {

QStringList TallyLines(const QString& owner, qint64 won, qint64 lost)
{
    return {owner + QStringLiteral(": ") + QString::number(won), QStringLiteral("Opponent: ") + QString::number(lost),
            QStringLiteral("Click Deal to start a new game.")};
}

// Deals and returns the crib line.
QString DealAndTellCrib(GameBoard& board)
{
    board.OnDeal();
    return LogLines(board).last();
}

QString OtherCrib(const QString& line)
{
    return line == QStringLiteral("Your Crib.") ? QStringLiteral("Opponent's Crib.") : QStringLiteral("Your Crib.");
}

enum BadFile { Garbage, Truncated, Huge, Folder, ParentIsFile, Pipe, ReadOnlyFolder, Unreadable };

} // namespace

// The stored values: the first run, reading them back, damaged values and files.
class SettingsTest : public QObject {
    Q_OBJECT

private slots:
    void ownerName()
    {
        QCOMPARE(OwnerNameFromGecos("  Ada Byron \t,Room 12,555-1234,"), QStringLiteral("Ada Byron"));
        QCOMPARE(OwnerNameFromGecos("Zo\xc3\xab Ng"), QStringLiteral("Zo\u00eb Ng"));
        QCOMPARE(OwnerNameFromGecos(",Room 12"), QStringLiteral("You"));
        QVERIFY(!SystemOwnerName().isEmpty());
    }

    // A store that is missing or empty is created with the defaults; any other
    // is read, taking only whole 32-bit numbers, and never rewritten by a load.
    void load_data()
    {
        QTest::addColumn<QByteArray>("content");  // null: no store
        QTest::addColumn<int>("gamesFor");
        QTest::addColumn<int>("gamesAgainst");
        QTest::addColumn<int>("crib");
        QTest::addColumn<int>("style");
        QTest::newRow("no store") << QByteArray() << 0 << 0 << 1 << 1;
        QTest::newRow("an empty store") << QByteArray("") << 0 << 0 << 1 << 1;
        QTest::newRow("For 5, Against 7, Wooden") << QByteArray("[General]\nFor=5\nAgainst=7\nCrib=1\nBoard=2\n")
                                                  << 5 << 7 << 1 << 2;
        QTest::newRow("Board 4 shows Embossed") << QByteArray("[General]\nBoard=4\n") << 0 << 0 << 1 << 4;
        QTest::newRow("not numbers") << QByteArray("[General]\nFor=five\nAgainst=7x\nCrib=yes\nBoard=2.5\n")
                                     << 0 << 0 << 1 << 1;
        // The largest 32-bit value, then values that cut to 32 bits would read as -1, 0 and 2 (Wooden).
        QTest::newRow("32 bits and beyond")
            << QByteArray("[General]\nFor=2147483647\nAgainst=2147483648\nCrib=4294967296\nBoard=4294967298\n")
            << 2147483647 << 0 << 1 << 1;
        QTest::newRow("Crib 0") << QByteArray("[General]\nCrib=0\n") << 0 << 0 << 0 << 1;
        QTest::newRow("Crib 2 counts as 1") << QByteArray("[General]\nCrib=2\n") << 0 << 0 << 1 << 1;
    }

    void load()
    {
        QFETCH(QByteArray, content);
        QFETCH(int, gamesFor);
        QFETCH(int, gamesAgainst);
        QFETCH(int, crib);
        QFETCH(int, style);
        TempStore store;
        if (!content.isNull())
            store.Write(content);
        auto board = MakeBoard(1, true);

        QCOMPARE(board->record.boardStyle, style);
        QCOMPARE(board->record.savedPlayerCrib, crib);  // read as 0 or 1 only
        QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), gamesFor, gamesAgainst));
        QVERIFY(HoldsBoard(*board, style));
        QCOMPARE(store.Content(), content.isEmpty() ? QByteArray("[General]\nAgainst=0\nBoard=1\nCrib=1\nFor=0\n") : content);

        // The crib alternates from the stored value; after 1 the opponent's comes first.
        QCOMPARE(DealAndTellCrib(*board), crib == 1 ? QStringLiteral("Opponent's Crib.") : QStringLiteral("Your Crib."));
    }

    // Two windows on one store lose no game, and a lock left by a copy that
    // died does not hold the save up.
    void twoCopiesAddUp()
    {
        TempStore store;
        auto first = MakeBoard(1, true);
        auto second = MakeBoard(1, true);
        first->record.gamesFor = 2;  // as if won in this window, not yet saved
        for (GameBoard* board : {first.get(), second.get()}) {
            ClickButton(*board, kCmdDeal);
            board->PegPoints(kSideOpponent, kGameHole, QStringLiteral(" for his hand"));
            QFile lock(store.FileName() + QStringLiteral(".save.lock"));
            QVERIFY(lock.open(QIODevice::WriteOnly));
            lock.write("999999999\nvennick\n" + QSysInfo::machineHostName().toUtf8() + "\n");
        }
        QElapsedTimer timer;
        timer.start();
        second->NewGame();
        QVERIFY(timer.elapsed() < 1000);
        // Each loss, from far behind, counts 4.
        QCOMPARE(LogLines(*second), TallyLines(SystemOwnerName(), 2, 8));
        QCOMPARE(store.Content(), QByteArray("[General]\nAgainst=8\nBoard=1\nCrib=0\nFor=2\n"));
        first->NewGame();  // the first window catches up when it reads again
        QCOMPARE(LogLines(*first), TallyLines(SystemOwnerName(), 2, 8));
    }

    // A store the program cannot use never stops the game: the tally and the
    // crib go on in memory, and what is there is left alone unless it can be
    // rewritten clean.
    void badFiles_data()
    {
        QTest::addColumn<int>("kind");
        QTest::addColumn<bool>("readable");  // its values are read
        QTest::addColumn<bool>("writable");  // a save replaces it
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
        const int expectFor = readable && kind != Garbage && kind != Truncated ? 5 : 0;
        const int expectAgainst = readable && kind != Garbage ? 7 : 0;
        if (kind == Garbage) {
            std::mt19937 random(7);
            QByteArray bytes;
            while (bytes.size() < 4096)
                bytes.append(static_cast<char>(random() % 256));
            store.Write(bytes);
        } else if (kind == Truncated) {
            store.Write(values.left(values.indexOf("Crib") + 2));
        } else if (kind == Huge) {
            store.Write(values + QByteArray(8 << 20, 'x'));
        } else if (kind == Folder) {
            QVERIFY(QDir().mkpath(store.FileName()));
        } else if (kind == Pipe) {
            QVERIFY(QDir().mkpath(store.Folder()));
            QCOMPARE(mkfifo(QFile::encodeName(store.FileName()).constData(), 0644), 0);
        } else if (kind == ParentIsFile) {
            QVERIFY(QDir().mkpath(QFileInfo(store.Folder()).absolutePath()));
            QFile file(store.Folder());
            QVERIFY(file.open(QIODevice::WriteOnly));
        } else {
            store.Write(values);
            QVERIFY(kind == ReadOnlyFolder
                        ? QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::ExeOwner | QFile::ReadOther | QFile::ExeOther)
                        : QFile::setPermissions(store.FileName(), QFile::WriteOwner));
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
            const QString firstCrib = DealAndTellCrib(*board);

            // A game won: the tally grows, is saved where possible, and survives New game.
            board->record.gamesFor += 1;
            board->SaveSettings();
            QVERIFY(!QApplication::activeModalWidget());
            board->NewGame();
            QCOMPARE(LogLines(*board), TallyLines(owner, expectFor + 1, expectAgainst));
            QCOMPARE(DealAndTellCrib(*board), OtherCrib(firstCrib));
        }
        if (kind == ReadOnlyFolder)
            QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);

        const QFileInfo after(store.FileName());
        if (writable) {
            // Rewritten clean, with every value that could be read; the crib turned with New game.
            QCOMPARE(store.Content(), QStringLiteral("[General]\nAgainst=%1\nBoard=%2\nCrib=0\nFor=%3\n")
                                          .arg(expectAgainst).arg(kind == Truncated ? 2 : 1).arg(expectFor + 1).toUtf8());
        } else {
            QCOMPARE(after.exists(), before.exists());
            QCOMPARE(after.isDir(), before.isDir());
            QCOMPARE(after.size(), before.size());
            if (!contentBefore.isEmpty())  // a pipe is not read: that would block
                QCOMPARE(store.Content(), contentBefore);
        }
    }
};

VENNICK_TEST(SettingsTest);
#include "SettingsTest.moc"

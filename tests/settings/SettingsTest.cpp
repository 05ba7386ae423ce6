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
    }

    // A store that is missing or empty is created with the defaults; any other
    // is read, taking only whole 32-bit numbers, and never rewritten by a load.
    void load_data()
    {
        QTest::addColumn<QByteArray>("content");  // null: no store
        QTest::addColumn<QList<int>>("values");   // For, Against, Crib, Board
        QTest::newRow("no store") << QByteArray() << QList<int>{0, 0, 1, 1};
        QTest::newRow("an empty store") << QByteArray("") << QList<int>{0, 0, 1, 1};
        QTest::newRow("Wooden, Crib 0") << QByteArray("[General]\nFor=5\nAgainst=7\nCrib=0\nBoard=2\n") << QList<int>{5, 7, 0, 2};
        QTest::newRow("Board 4 is Embossed, Crib 2 is 1") << QByteArray("[General]\nBoard=4\nCrib=2\n") << QList<int>{0, 0, 1, 4};
        QTest::newRow("not numbers") << QByteArray("[General]\nFor=five\nAgainst=7x\nCrib=yes\nBoard=2.5\n") << QList<int>{0, 0, 1, 1};
        // The largest 32-bit value, then values that cut to 32 bits would read as -1, 0 and 2 (Wooden).
        QTest::newRow("32 bits and beyond")
            << QByteArray("[General]\nFor=2147483647\nAgainst=2147483648\nCrib=4294967296\nBoard=4294967298\n")
            << QList<int>{2147483647, 0, 1, 1};
    }

    void load()
    {
        QFETCH(QByteArray, content);
        QFETCH(QList<int>, values);
        TempStore store;
        if (!content.isNull())
            store.Write(content);
        auto board = MakeBoard(1, true);
        QCOMPARE((QList<int>{board->record.savedPlayerCrib, board->record.boardStyle}), values.mid(2));
        QCOMPARE(LogLines(*board), TallyLines(SystemOwnerName(), values[0], values[1]));
        QVERIFY(HoldsBoard(*board, values[3]));
        QCOMPARE(store.Content(), content.isEmpty() ? QByteArray("[General]\nAgainst=0\nBoard=1\nCrib=1\nFor=0\n") : content);
        // The first crib follows the stored one: after 1 the opponent's.
        board->OnDeal();
        QCOMPARE(LogLines(*board).last(), values[2] ? QStringLiteral("Opponent's Crib.") : QStringLiteral("Your Crib."));
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

    // A store the program cannot use never stops the game: the tally goes on
    // in memory, and what is there is left alone unless it can be rewritten clean.
    void badFiles_data()
    {
        QTest::addColumn<int>("kind");
        QTest::addColumn<int>("gamesFor");      // as read; -1: the store is not read
        QTest::addColumn<int>("gamesAgainst");
        QTest::addColumn<bool>("writable");     // a save replaces it
        QTest::newRow("garbage bytes") << int(Garbage) << 0 << 0 << true;
        QTest::newRow("truncated") << int(Truncated) << 0 << 7 << true;
        QTest::newRow("huge") << int(Huge) << -1 << 0 << false;
        QTest::newRow("a folder") << int(Folder) << -1 << 0 << false;
        QTest::newRow("its folder is a file") << int(ParentIsFile) << -1 << 0 << false;
        QTest::newRow("a named pipe") << int(Pipe) << -1 << 0 << false;
        QTest::newRow("read-only folder") << int(ReadOnlyFolder) << 5 << 7 << false;
        QTest::newRow("unreadable file") << int(Unreadable) << -1 << 0 << false;
    }

    void badFiles()
    {
        QFETCH(int, kind);
        QFETCH(int, gamesFor);
        QFETCH(int, gamesAgainst);
        QFETCH(bool, writable);
        TempStore store;
        const QByteArray values("[General]\nAgainst=7\nBoard=2\nCrib=0\nFor=5\n");
        std::mt19937 random(7);
        QByteArray garbage;
        while (garbage.size() < 4096)
            garbage.append(static_cast<char>(random() % 256));
        if (kind == Folder)
            QVERIFY(QDir().mkpath(store.FileName()));
        else if (kind == ParentIsFile)
            QVERIFY(QFile(store.Folder()).open(QIODevice::WriteOnly));
        else if (kind == Pipe)
            QVERIFY(QDir().mkpath(store.Folder()) && mkfifo(QFile::encodeName(store.FileName()).constData(), 0644) == 0);
        else
            store.Write(kind == Garbage ? garbage : kind == Truncated ? values.left(values.indexOf("Crib") + 2)
                                      : kind == Huge ? values + QByteArray(8 << 20, 'x') : values);
        if (kind == ReadOnlyFolder || kind == Unreadable)
            QVERIFY(kind == ReadOnlyFolder
                        ? QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::ExeOwner | QFile::ReadOther | QFile::ExeOther)
                        : QFile::setPermissions(store.FileName(), QFile::WriteOwner));
        const QFileInfo before(store.FileName());
        const QByteArray contentBefore = before.isFile() ? store.Content() : QByteArray();
        const int readFor = std::max(gamesFor, 0);
        {
            std::optional<Unprivileged> unprivileged;
            if (kind == ReadOnlyFolder || kind == Unreadable)
                unprivileged.emplace();
            auto board = MakeBoard(1, true);
            const QString owner = gamesFor >= 0 ? SystemOwnerName() : QStringLiteral("You");
            QCOMPARE(LogLines(*board), TallyLines(owner, readFor, gamesAgainst));
            board->OnDeal();
            const QString firstCrib = LogLines(*board).last();
            // A game won: the tally grows, is saved where possible, and survives New game.
            board->record.gamesFor += 1;
            board->SaveSettings();
            QVERIFY(!QApplication::activeModalWidget());
            board->NewGame();
            QCOMPARE(LogLines(*board), TallyLines(owner, readFor + 1, gamesAgainst));
            board->OnDeal();  // the crib still turns
            QVERIFY(LogLines(*board).last() != firstCrib && LogLines(*board).last().endsWith(QStringLiteral("Crib.")));
        }
        if (kind == ReadOnlyFolder)
            QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        const QFileInfo after(store.FileName());
        if (writable) {
            // Rewritten clean, with every value that could be read; the crib turned with New game.
            QCOMPARE(store.Content(), QStringLiteral("[General]\nAgainst=%1\nBoard=%2\nCrib=0\nFor=%3\n")
                                          .arg(gamesAgainst).arg(kind == Truncated ? 2 : 1).arg(readFor + 1).toUtf8());
        } else {
            QCOMPARE((QList<qint64>{after.exists(), after.isDir(), after.size()}),
                     (QList<qint64>{before.exists(), before.isDir(), before.size()}));
            if (!contentBefore.isEmpty())  // a pipe is not read: that would block
                QCOMPARE(store.Content(), contentBefore);
        }
    }
};

VENNICK_TEST(SettingsTest);
#include "SettingsTest.moc"

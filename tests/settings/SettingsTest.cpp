#include "settings/Settings.h"
#include "settings/TempStore.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QDeadlineTimer>
#include <QSysInfo>

#include <pwd.h>
#include <random>
#include <sys/stat.h>

namespace {

QStringList TallyLines(const QString& owner, qint64 won, qint64 lost)
{
    return {owner + QStringLiteral(": ") + QString::number(won), QStringLiteral("Opponent: ") + QString::number(lost),
            QStringLiteral("Click Deal to start a new game.")};
}

enum StoreKind { Plain, Pipe, ReadOnlyFolder, Unreadable };

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
        // The account's own name, looked up here the simple way.
        const passwd* account = getpwuid(getuid());
        QCOMPARE(SystemOwnerName(), OwnerNameFromGecos(account && account->pw_gecos ? account->pw_gecos : ""));
    }

    // A store that is missing is created with the defaults; any other
    // is read, taking only whole 32-bit numbers, and never rewritten by a load.
    // A store the program cannot use never stops the game: the tally goes on
    // in memory, and what is there is left alone unless it can be rewritten clean.
    void stores_data()
    {
        QTest::addColumn<int>("kind");
        QTest::addColumn<QByteArray>("content");  // of a Plain store; null: none
        // As read: For (-1: the store is not read), Against, Crib, Board, Explain.
        QTest::addColumn<QList<int>>("values");
        QTest::addColumn<bool>("writable");       // a save rewrites it
        const QByteArray five("[General]\nAgainst=7\nBoard=2\nCrib=0\nFor=5\n");
        QByteArray garbage;
        for (std::mt19937 random(7); garbage.size() < 4096;)
            garbage.append(static_cast<char>(random() % 256));
        QTest::newRow("no store") << int(Plain) << QByteArray() << QList<int>{0, 0, 1, 1, 0} << true;
        QTest::newRow("Wooden, Crib 0") << int(Plain) << five << QList<int>{5, 7, 0, 2, 0} << true;
        QTest::newRow("Board 4 is Embossed, Crib 2 is 1") << int(Plain) << QByteArray("[General]\nBoard=4\nCrib=2\n")
                                                         << QList<int>{0, 0, 1, 4, 0} << true;
        // Negative counts were never written: they count as missing, as an Explain that is not 0 or 1.
        QTest::newRow("negative tallies, Explain 2") << int(Plain) << QByteArray("[General]\nFor=-5\nAgainst=-1\nExplain=2\n")
                                                    << QList<int>{0, 0, 1, 1, 0} << true;
        QTest::newRow("Explain 1") << int(Plain) << QByteArray("[General]\nExplain=1\nFor=3\n") << QList<int>{3, 0, 1, 1, 1} << true;
        QTest::newRow("not numbers") << int(Plain) << QByteArray("[General]\nFor=five\nAgainst=7x\nCrib=yes\nBoard=2.5\n")
                                     << QList<int>{0, 0, 1, 1, 0} << true;
        // The largest 32-bit value, then values that cut to 32 bits would read as -1, 0 and 2 (Wooden).
        QTest::newRow("32 bits and beyond")
            << int(Plain) << QByteArray("[General]\nFor=2147483647\nAgainst=2147483648\nCrib=4294967296\nBoard=4294967298\n")
            << QList<int>{2147483647, 0, 1, 1, 0} << true;
        QTest::newRow("garbage bytes") << int(Plain) << garbage << QList<int>{0, 0, 1, 1, 0} << true;
        QTest::newRow("truncated") << int(Plain) << five.left(five.indexOf("Crib") + 2) << QList<int>{0, 7, 1, 2, 0} << true;
        QTest::newRow("huge") << int(Plain) << five + QByteArray(8 << 20, 'x') << QList<int>{-1, 0, 1, 1, 0} << false;
        QTest::newRow("a named pipe, not a file") << int(Pipe) << QByteArray() << QList<int>{-1, 0, 1, 1, 0} << false;
        QTest::newRow("read-only folder") << int(ReadOnlyFolder) << five << QList<int>{5, 7, 0, 2, 0} << false;
        QTest::newRow("unreadable file") << int(Unreadable) << five << QList<int>{-1, 0, 1, 1, 0} << false;
    }

    void stores()
    {
        QFETCH(int, kind);
        QFETCH(QByteArray, content);
        QFETCH(QList<int>, values);
        QFETCH(bool, writable);
        TempStore store;
        if (kind == Pipe)
            QVERIFY(QDir().mkpath(store.Folder()) && mkfifo(QFile::encodeName(store.FileName()).constData(), 0644) == 0);
        else if (!content.isNull())
            store.Write(content);
        if (kind == ReadOnlyFolder || kind == Unreadable)
            QVERIFY(kind == ReadOnlyFolder
                        ? QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::ExeOwner | QFile::ReadOther | QFile::ExeOther)
                        : QFile::setPermissions(store.FileName(), QFile::WriteOwner));
        const QFileInfo before(store.FileName());
        const int32_t gamesFor = std::max(values[0], 0), won = gamesFor < INT32_MAX ? gamesFor + 4 : gamesFor;
        const QString owner = values[0] >= 0 ? SystemOwnerName() : QStringLiteral("You");
        {
            const Unprivileged unprivileged(kind == ReadOnlyFolder || kind == Unreadable);
            auto board = MakeBoard(1, true);
            QCOMPARE(LogLines(*board), TallyLines(owner, gamesFor, values[1]));
            QCOMPARE(board->record.boardStyle, values[3]);
            QCOMPARE(board->record.explainScores, values[4]);
            QVERIFY(HoldsBoard(*board, values[3]));
            if (kind == Plain)
                QCOMPARE(store.Content(), content.isEmpty() ? QByteArray("[General]\nAgainst=0\nBoard=1\nCrib=1\nExplain=0\nFor=0\n") : content);
            // The first crib follows the stored one: after 1 the opponent's.
            board->OnDeal();
            QCOMPARE(LogLines(*board).last(), values[2] ? QStringLiteral("Opponent's Crib.") : QStringLiteral("Your Crib."));
            // Meanwhile another copy lost a game, saved it and died holding the lock:
            // neither copy's game is lost, and the save is not held up.
            const int against = values[1] + (writable ? 1 : 0);
            if (writable) {
                store.Write(QStringLiteral("[General]\nAgainst=%1\n").arg(against).toUtf8());
                store.Write("999999999\nvennick\n" + QSysInfo::machineHostName().toUtf8() + "\n", QStringLiteral(".save.lock"));
            }
            // A game won from far ahead counts 4; the tally is saved where possible and survives New game.
            const QDeadlineTimer second(1000);
            board->PegPoints(kSidePlayer, kGameHole, QStringLiteral(" for your hand"));
            QVERIFY(!second.hasExpired() && !QApplication::activeModalWidget());
            // A save that fails is said once, with the store's path; the tally stays in hand.
            const QString unsaved = QStringLiteral("Could not save the tally to %1: it is kept while Vennick runs.").arg(store.FileName());
            QCOMPARE(LogLines(*board).last(), writable ? QStringLiteral("Please click New to play again.") : unsaved);
            board->SaveSettings();
            QCOMPARE(LogLines(*board).count(unsaved), writable ? 0 : 1);
            board->NewGame();
            QCOMPARE(LogLines(*board), TallyLines(owner, won, against));
            board->OnDeal();  // the crib still turns
            QCOMPARE(LogLines(*board).last(), values[2] ? QStringLiteral("Your Crib.") : QStringLiteral("Opponent's Crib."));
        }
        if (kind == ReadOnlyFolder)
            QFile::setPermissions(store.Folder(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        const QFileInfo after(store.FileName());
        if (writable) {  // rewritten clean, with every value that could be read or merged; the crib turned with New game
            QCOMPARE(store.Content(), QStringLiteral("[General]\nAgainst=%1\nBoard=%2\nCrib=%3\nExplain=%4\nFor=%5\n")
                                          .arg(values[1] + 1).arg(values[3]).arg(values[2] ? 0 : 1).arg(values[4]).arg(won).toUtf8());
        } else {
            QCOMPARE((QList<qint64>{after.exists(), after.isDir(), after.size()}),
                     (QList<qint64>{before.exists(), before.isDir(), before.size()}));
            if (kind != Pipe)  // a pipe is not read: that would block
                QCOMPARE(store.Content(), content);
        }
    }
};

VENNICK_TEST(SettingsTest);
#include "SettingsTest.moc"

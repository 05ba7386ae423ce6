#include "settings/Settings.h"

#include "game/GameBoard.h"

#include <QDir>
#include <QFileInfo>
#include <QLockFile>
#include <QSettings>
#include <QVariant>

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <limits>
#include <optional>
#include <vector>

#if defined(Q_OS_UNIX)
#include <pwd.h>
#include <unistd.h>
#endif

namespace {

const QString kOrganisation = QStringLiteral("Quorvan");
const QString kApplication = QStringLiteral("Vennick");

// The store holds four small numbers; anything much larger is not ours, and
// reading it whole would stall the start or exhaust memory.
constexpr qint64 kLargestStore = 64 * 1024;

enum class StoreState {
    Present,   // readable, holding values
    Missing,   // not there yet (or empty): to be created
    Unusable,  // there, but neither readable nor replaceable by us
};

// The store's file, found without reading it: a settings object under another
// application name tells the folder, so the size can be checked first.
QString StoreFileName()
{
    const QSettings probe(QSettings::NativeFormat, QSettings::UserScope, kOrganisation,
                          kApplication + QStringLiteral("-probe"));
    const QFileInfo probeFile(probe.fileName());
    return probeFile.absolutePath() + QLatin1Char('/') + kApplication + QLatin1Char('.') + probeFile.suffix();
}

// Opens the store into settings when it is there and sane; says what was found.
StoreState OpenStore(std::optional<QSettings>& settings)
{
    const QFileInfo file(StoreFileName());
    if (file.exists() || file.isSymLink()) {
        // A folder, a device or a pipe would block or fail the read; a huge file
        // is left alone as well, so nothing in it is overwritten.
        if (!file.isFile() || !file.isReadable() || file.size() > kLargestStore)
            return StoreState::Unusable;
    }
    settings.emplace(QSettings::NativeFormat, QSettings::UserScope, kOrganisation, kApplication);
    // Only the user's own store counts, not organisation or system-wide files.
    settings->setFallbacksEnabled(false);
    const QStringList keys = settings->allKeys();
    if (settings->status() == QSettings::AccessError)
        return StoreState::Unusable;
    return keys.isEmpty() ? StoreState::Missing : StoreState::Present;
}

// Reads a value into field when it is a whole number that fits 32 bits;
// anything else counts as missing and leaves the field as it was.
bool ReadInt32(const QSettings& settings, const QString& name, int32_t& field)
{
    const QVariant value = settings.value(name);
    if (!value.isValid())
        return false;
    bool ok = false;
    const qlonglong number = value.toString().toLongLong(&ok, 10);
    if (!ok || number < std::numeric_limits<int32_t>::min() || number > std::numeric_limits<int32_t>::max())
        return false;
    field = static_cast<int32_t>(number);
    return true;
}

// A tally counter: a whole number of games, never negative (the program never
// wrote one); anything else counts as missing.
bool ReadCount(const QSettings& settings, const QString& name, int32_t& field)
{
    int32_t count = 0;
    if (!ReadInt32(settings, name, count) || count < 0)
        return false;
    field = count;
    return true;
}

// Adds what this window won since it last read or wrote the store to the
// tally the store holds now, so that two copies on one store lose no game.
int32_t MergedCount(const QSettings& settings, const QString& name, int32_t inHand, int32_t stored)
{
    int32_t now = stored;
    ReadCount(settings, name, now);
    const qint64 merged = qint64(now) + (qint64(inHand) - qint64(stored));
    return static_cast<int32_t>(std::clamp<qint64>(merged, std::numeric_limits<int32_t>::min(),
                                                   std::numeric_limits<int32_t>::max()));
}

} // namespace

QString OwnerNameFromGecos(const QByteArray& gecos)
{
    const qsizetype comma = gecos.indexOf(',');
    const QString name = QString::fromLocal8Bit(comma < 0 ? gecos : gecos.left(comma)).trimmed();
    return name.isEmpty() ? kDefaultOwnerName : name;
}

QString SystemOwnerName()
{
#if defined(Q_OS_UNIX)
    const long suggested = sysconf(_SC_GETPW_R_SIZE_MAX);
    std::vector<char> buffer(suggested > 0 ? static_cast<size_t>(suggested) : 1024);
    passwd entry{};
    passwd* found = nullptr;
    int error = 0;
    while ((error = getpwuid_r(getuid(), &entry, buffer.data(), buffer.size(), &found)) == ERANGE
           && buffer.size() < 1024 * 1024)
        buffer.resize(buffer.size() * 2);
    if (error == 0 && found != nullptr && found->pw_gecos != nullptr)
        return OwnerNameFromGecos(QByteArray(found->pw_gecos));
#endif
    return kDefaultOwnerName;
}

// Replaces the store's content with the four values, the tally merged with
// what the store holds, as one step under a lock beside it. A damaged file is
// rewritten clean; a store that cannot be written is left as it is.
bool GameBoard::WriteStore(QSettings& settings)
{
    GameRecord& r = record;
    // Not the ".lock" that QSettings takes for each sync inside this step.
    QLockFile lock(settings.fileName() + QStringLiteral(".save.lock"));
    // Another copy holds the lock for a moment only; one that died leaves a
    // lock taken over at once (its process is gone) or after a second.
    lock.setStaleLockTime(1000);
    // Without the lock (an unwritable folder, say) the save still goes ahead.
    const bool locked = lock.tryLock(1500);
    settings.sync();
    r.gamesFor = MergedCount(settings, QStringLiteral("For"), r.gamesFor, storedFor);
    r.gamesAgainst = MergedCount(settings, QStringLiteral("Against"), r.gamesAgainst, storedAgainst);
    settings.clear();
    settings.setValue(QStringLiteral("For"), r.gamesFor);
    settings.setValue(QStringLiteral("Against"), r.gamesAgainst);
    settings.setValue(QStringLiteral("Crib"), r.savedPlayerCrib);
    settings.setValue(QStringLiteral("Board"), r.boardStyle);
    settings.setValue(QStringLiteral("Explain"), r.explainScores);
    settings.sync();
    if (locked)
        lock.unlock();
    if (settings.status() == QSettings::AccessError)
        return false;
    storedFor = r.gamesFor;
    storedAgainst = r.gamesAgainst;
    return true;
}

void GameBoard::LoadSettings()
{
    GameRecord& r = record;
    if (!storeBehind) {
        r.ownerName = kDefaultOwnerName;
        r.gamesFor = 0;
        r.gamesAgainst = 0;
        r.boardStyle = 1;
        r.explainScores = 0;
    }

    std::optional<QSettings> settings;
    StoreState state = OpenStore(settings);
    // A new store starts from the values in hand; one that missed a save is
    // brought up to date before it is read back, and where it still cannot be
    // written, the values in hand stay.
    if (state == StoreState::Missing || (state == StoreState::Present && storeBehind)) {
        if (WriteStore(*settings)) {
            storeBehind = false;
            state = StoreState::Present;
        } else if (state == StoreState::Missing) {
            state = StoreState::Unusable;
        }
    }

    if (state == StoreState::Present) {
        if (!storeBehind) {
            ReadCount(*settings, QStringLiteral("For"), r.gamesFor);
            ReadCount(*settings, QStringLiteral("Against"), r.gamesAgainst);
            int32_t crib = 0;
            // The crib alternates by inverting 0 and 1; a damaged value would
            // stop it, so anything but 0 means the user's.
            if (ReadInt32(*settings, QStringLiteral("Crib"), crib))
                r.savedPlayerCrib = crib != 0 ? 1 : 0;
            ReadInt32(*settings, QStringLiteral("Board"), r.boardStyle);
            int32_t explain = 0;
            if (ReadInt32(*settings, QStringLiteral("Explain"), explain) && (explain == 0 || explain == 1))
                r.explainScores = explain;
            storedFor = r.gamesFor;
            storedAgainst = r.gamesAgainst;
        }
        r.ownerName = SystemOwnerName();
    }
    // Also without a store, so the first crib still alternates from game to game.
    r.playerCrib = r.savedPlayerCrib;

    LogMessage(r.ownerName + QStringLiteral(": ") + QString::number(r.gamesFor));
    LogMessage(QStringLiteral("Opponent: ") + QString::number(r.gamesAgainst));
    LogMessage(QStringLiteral("Click Deal to start a new game."));
}

void GameBoard::SaveSettings()
{
    std::optional<QSettings> settings;
    // A store that is missing is created by the next load, not here; until
    // then, as when it cannot be written, it is behind this run.
    const bool wasBehind = storeBehind;
    storeBehind = !(OpenStore(settings) == StoreState::Present && WriteStore(*settings));
    // Said once as the store falls behind, not at every save that follows.
    if (storeBehind && !wasBehind)
        LogMessage(QStringLiteral("Could not save the tally to %1: it is kept while Vennick runs.")
                       .arg(QDir::toNativeSeparators(StoreFileName())));
}

#pragma once

#include "presentation/ImageHolder.h"
#include "support/TestBoard.h"

#include <QDir>
#include <QFile>
#include <QSettings>
#include <QTemporaryDir>
#include <QtTest>

#include <unistd.h>

// The settings store of a test: a fresh folder for the user scope while it
// lives, so no two cases share a file (or the settings cache's copy of it).
class TempStore {
public:
    TempStore()
    {
        // Readable by everyone, so a case may also run without privileges.
        QFile::setPermissions(dir.path(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner
                                              | QFile::ReadOther | QFile::ExeOther | QFile::ReadGroup | QFile::ExeGroup);
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.path());
    }
    ~TempStore()
    {
        // Back to the folder the test run uses for everything else.
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, qEnvironmentVariable("XDG_CONFIG_HOME"));
    }
    TempStore(const TempStore&) = delete;
    TempStore& operator=(const TempStore&) = delete;

    QString Folder() const { return dir.path() + QStringLiteral("/Quorvan"); }
    QString FileName() const { return Folder() + QStringLiteral("/Vennick.conf"); }

    void Write(const QByteArray& content) const
    {
        QDir().mkpath(Folder());
        QFile file(FileName());
        QVERIFY(file.open(QIODevice::WriteOnly | QIODevice::Truncate));
        QCOMPARE(file.write(content), content.size());
    }

    QByteArray Content() const
    {
        QFile file(FileName());
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }

    // A stored value as the program reads it; an invalid variant when absent.
    QVariant Value(const QString& name) const
    {
        QSettings settings(QStringLiteral("Quorvan"), QStringLiteral("Vennick"));
        return settings.value(name);
    }

private:
    QTemporaryDir dir;
};

// While it lives, file permissions bind even when the tests run as root
// (root would otherwise write into any read-only folder).
class Unprivileged {
public:
    Unprivileged()
    {
        if (geteuid() == 0)
            active = setegid(65534) == 0 && seteuid(65534) == 0;
    }
    ~Unprivileged()
    {
        if (active && seteuid(0) == 0)
            (void)setegid(0);
    }
    Unprivileged(const Unprivileged&) = delete;
    Unprivileged& operator=(const Unprivileged&) = delete;

private:
    bool active = false;
};

// Whether the board's area of the game window shows this board bitmap,
// pixel for pixel, apart from the pegs standing on it.
inline bool ShowsBoard(GameBoard& board, int bitmapId)
{
    const QImage shot = board.grab().toImage().convertToFormat(QImage::Format_RGB32);
    const QImage expected = QImage(BitmapResourcePath(bitmapId)).convertToFormat(QImage::Format_RGB32);
    if (expected.isNull())
        return false;
    const GameRecord& r = board.record;
    const int sx = r.scaleX;
    const int sy = r.scaleY;
    for (int y = 0; y < expected.height(); ++y)
        for (int x = 0; x < expected.width(); ++x) {
            bool underPeg = false;
            for (const Rect& peg : {r.playerBackPegRect, r.playerFrontPegRect, r.opponentBackPegRect, r.opponentFrontPegRect})
                underPeg = underPeg || peg.Contains(x, y);
            if (!underPeg && shot.pixel(x * sx, y * sy) != expected.pixel(x, y))
                return false;
        }
    return true;
}

#pragma once

#include "presentation/ImageHolder.h"
#include "support/TestBoard.h"

#include <QDir>
#include <QFile>
#include <QSettings>
#include <QTemporaryDir>
#include <QtTest>

#include <unistd.h>

// Helpers of the tests that read and write the stored settings.

// The settings store of a test: a fresh user-scope folder while it lives, so no
// two cases share a file (or the settings cache's copy of it).
class TempStore {
public:
    TempStore()
    {
        // Readable by everyone, so a case may also run without privileges.
        QFile::setPermissions(dir.path(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner | QFile::ReadOther
                                              | QFile::ExeOther | QFile::ReadGroup | QFile::ExeGroup);
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.path());
    }
    ~TempStore() { QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, qEnvironmentVariable("XDG_CONFIG_HOME")); }

    QString Folder() const { return dir.path() + QStringLiteral("/Quorvan"); }
    QString FileName() const { return Folder() + QStringLiteral("/Vennick.conf"); }
    void Write(const QByteArray& content, const QString& suffix = QString()) const
    {
        QFile file(FileName() + suffix);
        QVERIFY(QDir().mkpath(Folder()) && file.open(QIODevice::WriteOnly) && file.write(content) == content.size());
    }
    QByteArray Content() const
    {
        QFile file(FileName());
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }

private:
    QTemporaryDir dir;
};

// While it lives, when asked, file permissions bind even when the tests run as root.
class Unprivileged {
public:
    explicit Unprivileged(bool asked) { active = asked && geteuid() == 0 && setegid(65534) == 0 && seteuid(65534) == 0; }
    ~Unprivileged() { (void)(active && seteuid(0) == 0 && setegid(0) == 0); }

private:
    bool active = false;
};

// Whether the game window holds the board image of a style (any but 1 and 2 is Embossed).
inline bool HoldsBoard(const GameBoard& board, int style)
{
    const int id = style == 1 ? kBitmapBoardNormal : style == 2 ? kBitmapBoardWooden : kBitmapBoardEmbossed;
    const QImage expected = QImage(BitmapResourcePath(id)).convertToFormat(QImage::Format_RGB32);
    return !expected.isNull() && board.boardBitmap.Image().convertToFormat(QImage::Format_RGB32) == expected;
}

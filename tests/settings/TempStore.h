#pragma once

#include "presentation/ImageHolder.h"
#include "support/TestBoard.h"

#include <QApplication>
#include <QDir>
#include <QFile>
#include <QPointer>
#include <QSettings>
#include <QTemporaryDir>
#include <QTimer>
#include <QtTest>

#include <functional>
#include <unistd.h>

// Helpers of the settings tests; the shell's tests work their dialogs with RunDialog too.

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
    ~TempStore()
    {
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

    // A stored value as the program reads it; invalid when absent.
    QVariant Value(const QString& name) const { return QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).value(name); }

private:
    QTemporaryDir dir;
};

// While it lives, file permissions bind even when the tests run as root.
class Unprivileged {
public:
    Unprivileged() { active = geteuid() == 0 && setegid(65534) == 0 && seteuid(65534) == 0; }
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

inline int StyleBitmap(int style)
{
    return style == 1 ? kBitmapBoardNormal : style == 2 ? kBitmapBoardWooden : kBitmapBoardEmbossed;
}

// Whether the game window shows this board bitmap pixel for pixel, apart from the pegs on it.
inline bool ShowsBoard(GameBoard& board, int bitmapId)
{
    const QImage shot = board.grab().toImage().convertToFormat(QImage::Format_RGB32);
    const QImage expected = QImage(BitmapResourcePath(bitmapId)).convertToFormat(QImage::Format_RGB32);
    const GameRecord& r = board.record;
    for (int y = 0; y < expected.height(); ++y)
        for (int x = 0; x < expected.width(); ++x) {
            bool underPeg = false;
            for (const Rect& peg : {r.playerBackPegRect, r.playerFrontPegRect, r.opponentBackPegRect, r.opponentFrontPegRect})
                underPeg = underPeg || peg.Contains(x, y);
            if (!underPeg && shot.pixel(x * r.scaleX, y * r.scaleY) != expected.pixel(x, y))
                return false;
        }
    return !expected.isNull();
}

// Triggers a command while action works the modal dialog it opens; says whether
// one was seen. A dialog left open is rejected so that a fault cannot hang the run.
template <class Dialog>
bool RunDialog(const std::function<void()>& trigger, std::function<void(Dialog&)> action)
{
    bool seen = false;
    QTimer::singleShot(0, qApp, [&seen, action] {
        auto* dialog = qobject_cast<Dialog*>(QApplication::activeModalWidget());
        if (!dialog)
            return;
        seen = true;
        QPointer<Dialog> guard(dialog);
        action(*dialog);
        QTimer::singleShot(2000, dialog, [guard] {
            if (guard)
                guard->reject();
        });
    });
    trigger();
    return seen;
}

#include "settings/OptionsDialog.h"
#include "settings/TempStore.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QApplication>
#include <QDialogButtonBox>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>
#include <QTimer>

#include <algorithm>
#include <functional>

namespace {

QList<int> CheckedButtons(const COptionsDlg& dialog)
{
    QList<int> ids;
    for (int id : {kStyleButtonNormal, kStyleButtonWooden, kStyleButtonEmbossed})
        if (dialog.StyleButton(id)->isChecked())
            ids.append(id);
    return ids;
}

// Runs the Options command while action works the dialog it opens; the
// dialog is rejected after a while should the action leave it open.
void RunOptions(GameBoard& board, std::function<void(COptionsDlg&)> action)
{
    bool seen = false;
    QTimer::singleShot(0, &board, [&seen, action] {
        auto* dialog = qobject_cast<COptionsDlg*>(QApplication::activeModalWidget());
        if (!dialog)
            return;
        seen = true;
        QPointer<COptionsDlg> guard(dialog);
        action(*dialog);
        QTimer::singleShot(2000, dialog, [guard] {
            if (guard)
                guard->reject();
        });
    });
    board.OnOptions();
    QVERIFY2(seen, "no Options dialog was shown");
}

} // namespace

// The Options dialog and the board style it sets.
class OptionsTest : public QObject {
    Q_OBJECT

private slots:
    void opensWithTheCurrentStyle_data()
    {
        QTest::addColumn<int>("style");
        QTest::addColumn<QList<int>>("checked");
        QTest::newRow("Normal") << 1 << QList<int>{kStyleButtonNormal};
        QTest::newRow("Wooden") << 2 << QList<int>{kStyleButtonWooden};
        QTest::newRow("Embossed") << 3 << QList<int>{kStyleButtonEmbossed};
        QTest::newRow("0: none") << 0 << QList<int>{};
        QTest::newRow("4: none") << 4 << QList<int>{};
        QTest::newRow("-1: none") << -1 << QList<int>{};
    }

    void opensWithTheCurrentStyle()
    {
        QFETCH(int, style);
        QFETCH(QList<int>, checked);
        COptionsDlg dialog;
        QCOMPARE(dialog.windowTitle(), QStringLiteral("Options"));
        QCOMPARE(dialog.StyleButton(kStyleButtonNormal)->text(), QStringLiteral("Normal"));
        QCOMPARE(dialog.StyleButton(kStyleButtonWooden)->text(), QStringLiteral("Wooden"));
        QCOMPARE(dialog.StyleButton(kStyleButtonEmbossed)->text(), QStringLiteral("Embossed"));
        // Set twice: a style shown before does not stay selected.
        dialog.SetSelectedStyle(2);
        dialog.SetSelectedStyle(style);
        QCOMPARE(CheckedButtons(dialog), checked);
        QCOMPARE(dialog.selectedStyle, style);
    }

    void choosing_data()
    {
        QTest::addColumn<int>("click");    // the style button clicked, or 0
        QTest::addColumn<QString>("end");  // how the dialog is closed
        QTest::addColumn<int>("style");
        QTest::addColumn<int>("bitmap");
        QTest::newRow("Embossed, OK") << int(kStyleButtonEmbossed) << "ok" << 3 << int(kBitmapBoardEmbossed);
        QTest::newRow("Normal, OK") << int(kStyleButtonNormal) << "ok" << 1 << int(kBitmapBoardNormal);
        QTest::newRow("OK alone saves the same style") << 0 << "ok" << 2 << int(kBitmapBoardWooden);
        QTest::newRow("Embossed, Cancel") << int(kStyleButtonEmbossed) << "cancel" << 2 << int(kBitmapBoardWooden);
        QTest::newRow("Embossed, Escape") << int(kStyleButtonEmbossed) << "escape" << 2 << int(kBitmapBoardWooden);
        QTest::newRow("Embossed, close box") << int(kStyleButtonEmbossed) << "close" << 2 << int(kBitmapBoardWooden);
    }

    void choosing()
    {
        QFETCH(int, click);
        QFETCH(QString, end);
        QFETCH(int, style);
        QFETCH(int, bitmap);
        TempStore store;
        store.Write("[General]\nFor=4\nAgainst=6\nCrib=1\nBoard=2\n");
        auto board = MakeBoard(1, true);
        QCOMPARE(board->record.boardStyle, 2);
        ClickButton(*board, kCmdDeal);
        TapHand(*board, 3);
        const GameRecord before = board->record;
        const QStringList logBefore = LogLines(*board);
        // The store changed behind the game's back tells whether it is saved.
        {
            QSettings settings(QStringLiteral("Quorvan"), QStringLiteral("Vennick"));
            settings.setValue(QStringLiteral("Board"), 9);
        }

        QList<int> checkedOnOpen;
        QList<int> checkedAfterClick;
        RunOptions(*board, [&](COptionsDlg& dialog) {
            checkedOnOpen = CheckedButtons(dialog);
            if (click != 0) {
                QTest::mouseClick(dialog.StyleButton(click), Qt::LeftButton);
                checkedAfterClick = CheckedButtons(dialog);
            }
            if (end == QLatin1String("ok"))
                QTest::mouseClick(dialog.ButtonBox()->button(QDialogButtonBox::Ok), Qt::LeftButton);
            else if (end == QLatin1String("cancel"))
                QTest::mouseClick(dialog.ButtonBox()->button(QDialogButtonBox::Cancel), Qt::LeftButton);
            else if (end == QLatin1String("escape"))
                QTest::keyClick(&dialog, Qt::Key_Escape);
            else
                dialog.close();
        });
        QCOMPARE(checkedOnOpen, QList<int>{kStyleButtonWooden});
        if (click != 0)
            QCOMPARE(checkedAfterClick, QList<int>{click});

        QCOMPARE(board->record.boardStyle, style);
        QCOMPARE(store.Value(QStringLiteral("Board")).toInt(), end == QLatin1String("ok") ? style : 9);
        QVERIFY(ShowsBoard(*board, bitmap));
        // The game goes on untouched.
        QCOMPARE(board->record.phase, before.phase);
        QVERIFY(std::equal(std::begin(before.deal), std::end(before.deal), std::begin(board->record.deal)));
        QVERIFY(std::equal(std::begin(before.selected), std::end(before.selected), std::begin(board->record.selected)));
        QCOMPARE(board->record.playerHandSprites[2].highlighted, before.playerHandSprites[2].highlighted);
        QCOMPARE(board->PlayerScore(), before.playerFrontHole);
        QCOMPARE(board->OpponentScore(), before.opponentFrontHole);
        QCOMPARE(board->record.gamesFor, 4);
        QCOMPARE(LogLines(*board), logBefore);
        QCOMPARE(ShownButtons(*board), QList<int>{});
        // Choosing another card still works: the keyboard and mouse reach the game.
        TapHand(*board, 4);
        QCOMPARE(board->SelectedCount(), 2);
    }

    void styleOutsideTheRange()
    {
        TempStore store;
        store.Write("[General]\nBoard=7\n");
        auto board = MakeBoard(1, true);
        QVERIFY(ShowsBoard(*board, kBitmapBoardEmbossed));
        QList<int> checkedOnOpen{-1};
        RunOptions(*board, [&](COptionsDlg& dialog) {
            checkedOnOpen = CheckedButtons(dialog);
            QTest::mouseClick(dialog.ButtonBox()->button(QDialogButtonBox::Ok), Qt::LeftButton);
        });
        QCOMPARE(checkedOnOpen, QList<int>{});
        // Confirmed untouched, the damaged value is kept as it was.
        QCOMPARE(board->record.boardStyle, 7);
        QCOMPARE(store.Value(QStringLiteral("Board")).toInt(), 7);
    }
};

VENNICK_TEST(OptionsTest);
#include "OptionsTest.moc"

#include "settings/OptionsDialog.h"
#include "settings/TempStore.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QDialogButtonBox>
#include <QPushButton>
#include <QRadioButton>

#include <algorithm>

namespace {

QList<int> CheckedButtons(const COptionsDlg& dialog)
{
    QList<int> ids;
    for (int id : {kStyleButtonNormal, kStyleButtonWooden, kStyleButtonEmbossed})
        if (dialog.StyleButton(id)->isChecked())
            ids.append(id);
    return ids;
}

} // namespace

// The Options dialog, worked by real clicks during a game, and the board style it sets.
class OptionsTest : public QObject {
    Q_OBJECT

private slots:
    void choosing_data()
    {
        QTest::addColumn<int>("stored");   // the style in the store
        QTest::addColumn<int>("click");    // the style button clicked, or 0
        QTest::addColumn<QString>("end");  // how the dialog is closed
        QTest::addColumn<int>("style");    // the style afterwards
        QTest::newRow("Wooden; Embossed, OK") << 2 << int(kStyleButtonEmbossed) << "ok" << 3;
        QTest::newRow("Wooden; Normal, OK") << 2 << int(kStyleButtonNormal) << "ok" << 1;
        QTest::newRow("Embossed; Wooden, OK") << 3 << int(kStyleButtonWooden) << "ok" << 2;
        QTest::newRow("Wooden; OK alone saves it") << 2 << 0 << "ok" << 2;
        QTest::newRow("Wooden; Embossed, Cancel") << 2 << int(kStyleButtonEmbossed) << "cancel" << 2;
        QTest::newRow("Wooden; Embossed, Escape") << 2 << int(kStyleButtonEmbossed) << "escape" << 2;
        QTest::newRow("Wooden; Embossed, close box") << 2 << int(kStyleButtonEmbossed) << "close" << 2;
        // A damaged style selects no button; confirmed untouched, it is kept.
        QTest::newRow("7; OK alone keeps it") << 7 << 0 << "ok" << 7;
        QTest::newRow("0; Normal, OK") << 0 << int(kStyleButtonNormal) << "ok" << 1;
        QTest::newRow("-1; Cancel") << -1 << 0 << "cancel" << -1;
    }

    void choosing()
    {
        QFETCH(int, stored);
        QFETCH(int, click);
        QFETCH(QString, end);
        QFETCH(int, style);
        TempStore store;
        store.Write(QStringLiteral("[General]\nFor=4\nAgainst=6\nCrib=1\nBoard=%1\n").arg(stored).toUtf8());
        auto board = MakeBoard(1, true);
        ClickButton(*board, kCmdDeal);
        TapHand(*board, 3);
        const GameRecord before = board->record;
        const QStringList logBefore = LogLines(*board);
        // Changed behind the game's back, the store tells whether it is saved.
        QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).setValue(QStringLiteral("Board"), 9);

        QStringList labels;
        QList<int> checkedOnOpen{-1};
        QList<int> checkedAfterClick;
        const bool seen = RunDialog<COptionsDlg>([&] { board->OnOptions(); }, [&](COptionsDlg& dialog) {
            labels = {dialog.windowTitle()};
            for (int id : {kStyleButtonNormal, kStyleButtonWooden, kStyleButtonEmbossed})
                labels.append(dialog.StyleButton(id)->text());
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
        QVERIFY2(seen, "no Options dialog was shown");
        QCOMPARE(labels, (QStringList{"Options", "Normal", "Wooden", "Embossed"}));
        QCOMPARE(checkedOnOpen, stored >= 1 && stored <= 3 ? QList<int>{kStyleButtonNormal + stored - 1} : QList<int>{});
        if (click != 0)
            QCOMPARE(checkedAfterClick, QList<int>{click});

        QCOMPARE(board->record.boardStyle, style);
        QCOMPARE(store.Value(QStringLiteral("Board")).toInt(), end == QLatin1String("ok") ? style : 9);
        QVERIFY(ShowsBoard(*board, StyleBitmap(style)));
        // The game goes on untouched, the mouse still reaching it.
        QCOMPARE(board->record.phase, before.phase);
        QVERIFY(std::equal(std::begin(before.deal), std::end(before.deal), std::begin(board->record.deal)));
        QVERIFY(std::equal(std::begin(before.selected), std::end(before.selected), std::begin(board->record.selected)));
        QCOMPARE(LogLines(*board), logBefore);
        TapHand(*board, 4);
        QCOMPARE(board->SelectedCount(), 2);
    }
};

VENNICK_TEST(OptionsTest);
#include "OptionsTest.moc"

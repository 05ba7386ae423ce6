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
        QTest::addColumn<QString>("keys"); // N clicks style N; d, u: arrow down, up
        QTest::addColumn<QString>("end");  // how the dialog is closed
        QTest::addColumn<int>("style");    // the style afterwards
        QTest::newRow("Wooden; Embossed, OK") << 2 << "3" << "ok" << 3;
        QTest::newRow("Embossed; Normal, Wooden, OK") << 3 << "12" << "ok" << 2;
        QTest::newRow("Wooden; OK alone saves it") << 2 << "" << "ok" << 2;
        QTest::newRow("Wooden; Embossed, Cancel") << 2 << "3" << "cancel" << 2;
        QTest::newRow("Wooden; Embossed, Escape") << 2 << "3" << "escape" << 2;
        QTest::newRow("Wooden; Embossed, close box") << 2 << "3" << "close" << 2;
        QTest::newRow("Wooden; down, Enter") << 2 << "d" << "enter" << 3;
        QTest::newRow("Embossed; up, up, Enter") << 3 << "uu" << "enter" << 1;
        QTest::newRow("Normal; Enter") << 1 << "" << "enter" << 1;
        // A damaged style selects no button; confirmed untouched, it is kept.
        QTest::newRow("7; Enter keeps it") << 7 << "" << "enter" << 7;
        QTest::newRow("0; Normal, OK") << 0 << "1" << "ok" << 1;
        QTest::newRow("-1; Cancel") << -1 << "" << "cancel" << -1;
    }

    void choosing()
    {
        QFETCH(int, stored);
        QFETCH(QString, keys);
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
        QList<int> checkedAfterKeys;
        bool focusOnStored = false;
        const bool seen = RunDialog<COptionsDlg>([&] { board->OnOptions(); }, [&](COptionsDlg& dialog) {
            labels = {dialog.windowTitle()};
            for (int id : {kStyleButtonNormal, kStyleButtonWooden, kStyleButtonEmbossed})
                labels.append(dialog.StyleButton(id)->text());
            checkedOnOpen = CheckedButtons(dialog);
            focusOnStored = dialog.focusWidget() && dialog.focusWidget() == dialog.StyleButton(kStyleButtonNormal + stored - 1);
            for (QChar k : keys) {
                if (k.isDigit())
                    QTest::mouseClick(dialog.StyleButton(kStyleButtonNormal + k.digitValue() - 1), Qt::LeftButton);
                else
                    QTest::keyClick(dialog.focusWidget(), k == u'd' ? Qt::Key_Down : Qt::Key_Up);
            }
            checkedAfterKeys = CheckedButtons(dialog);
            if (end == QLatin1String("ok"))
                QTest::mouseClick(dialog.ButtonBox()->button(QDialogButtonBox::Ok), Qt::LeftButton);
            else if (end == QLatin1String("cancel"))
                QTest::mouseClick(dialog.ButtonBox()->button(QDialogButtonBox::Cancel), Qt::LeftButton);
            else if (end != QLatin1String("close"))
                QTest::keyClick(dialog.focusWidget() ? dialog.focusWidget() : &dialog, end == QLatin1String("enter") ? Qt::Key_Return : Qt::Key_Escape);
            else
                dialog.close();
        });
        QVERIFY2(seen, "no Options dialog was shown");
        QCOMPARE(labels, (QStringList{"Options", "Normal", "Wooden", "Embossed"}));
        const bool known = stored >= 1 && stored <= 3;
        QCOMPARE(checkedOnOpen, known ? QList<int>{kStyleButtonNormal + stored - 1} : QList<int>{});
        QCOMPARE(focusOnStored, known);  // the keyboard starts on the style shown
        const bool confirmed = end == QLatin1String("ok") || end == QLatin1String("enter");
        if (!keys.isEmpty() && confirmed)
            QCOMPARE(checkedAfterKeys, QList<int>{kStyleButtonNormal + style - 1});

        QCOMPARE(board->record.boardStyle, style);
        QCOMPARE(store.Value(QStringLiteral("Board")).toInt(), confirmed ? style : 9);
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

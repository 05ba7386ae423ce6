#include "settings/OptionsDialog.h"
#include "settings/TempStore.h"
#include "support/TestMain.h"

#include <QDialogButtonBox>
#include <QPushButton>
#include <QRadioButton>

// The Options dialog, worked by clicks and keys during a game, and the board style it sets.
class OptionsTest : public QObject {
    Q_OBJECT

private slots:
    void choosing_data()
    {
        QTest::addColumn<int>("stored");    // the style in the store
        QTest::addColumn<QString>("keys");  // a digit clicks that style; d, u: arrow down, up
        QTest::addColumn<int>("end");       // what closes the dialog: OK, Cancel, Enter or Escape
        QTest::addColumn<int>("style");     // the style afterwards
        QTest::newRow("Wooden; Embossed, OK") << 2 << "3" << int(QDialogButtonBox::Ok) << 3;
        QTest::newRow("Embossed; Normal, Wooden, OK") << 3 << "12" << int(QDialogButtonBox::Ok) << 2;
        QTest::newRow("Wooden; Embossed, Cancel") << 2 << "3" << int(QDialogButtonBox::Cancel) << 2;
        QTest::newRow("Wooden; Embossed, Escape") << 2 << "3" << int(Qt::Key_Escape) << 2;
        QTest::newRow("Wooden; down, Enter") << 2 << "d" << int(Qt::Key_Return) << 3;
        QTest::newRow("Embossed; up, up, Enter") << 3 << "uu" << int(Qt::Key_Return) << 1;
        QTest::newRow("Embossed; down round to Normal, Enter") << 3 << "d" << int(Qt::Key_Return) << 1;
        QTest::newRow("Wooden; Enter alone saves it") << 2 << "" << int(Qt::Key_Return) << 2;
        // A damaged style selects no button; confirmed untouched, it is kept.
        QTest::newRow("7; Enter keeps it") << 7 << "" << int(Qt::Key_Return) << 7;
        QTest::newRow("0; Normal, OK") << 0 << "1" << int(QDialogButtonBox::Ok) << 1;
    }

    void choosing()
    {
        QFETCH(int, stored);
        QFETCH(QString, keys);
        QFETCH(int, end);
        QFETCH(int, style);
        TempStore store;
        store.Write(QStringLiteral("[General]\nBoard=%1\n").arg(stored).toUtf8());
        auto board = MakeBoard(1, true);
        ClickButton(*board, kCmdDeal);
        TapHand(*board, 3);
        const QStringList logBefore = LogLines(*board);
        // Changed behind the game's back, the store tells whether it is saved.
        QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).setValue(QStringLiteral("Board"), 9);

        QStringList shown;  // the title, the labels, then per step the style selected and the one with the focus
        QVERIFY(RunDialog<COptionsDlg>([&] { board->OnOptions(); }, [&](COptionsDlg& dialog) {
            shown.append(dialog.windowTitle());
            for (int s = 1; s <= 3; ++s)
                shown.append(dialog.StyleButton(kStyleButtonNormal + s - 1)->text());
            for (const QChar k : QStringLiteral("-") + keys) {
                if (k.isDigit())
                    QTest::mouseClick(dialog.StyleButton(kStyleButtonNormal + k.digitValue() - 1), Qt::LeftButton);
                else if (k != u'-')
                    QTest::keyClick(dialog.focusWidget(), k == u'd' ? Qt::Key_Down : Qt::Key_Up);
                QString state = QStringLiteral("-");
                for (int s = 1; s <= 3; ++s) {
                    const QRadioButton* button = dialog.StyleButton(kStyleButtonNormal + s - 1);
                    state += (button->isChecked() ? QString::number(s) : QString()) + (dialog.focusWidget() == button ? "f" : "");
                }
                shown.append(state);
            }
            if (end == QDialogButtonBox::Ok || end == QDialogButtonBox::Cancel)
                dialog.ButtonBox()->button(QDialogButtonBox::StandardButton(end))->click();
            else
                QTest::keyClick(dialog.focusWidget() ? dialog.focusWidget() : &dialog, Qt::Key(end));
        }));
        // Opened on the stored style, selected and with the focus; after keys or a click, the style reached.
        QCOMPARE(shown.mid(0, 5), (QStringList{"Options", "Normal", "Wooden", "Embossed",
                                               stored >= 1 && stored <= 3 ? QStringLiteral("-%1f").arg(stored) : "-"}));
        const bool confirmed = end == QDialogButtonBox::Ok || end == Qt::Key_Return;
        if (!keys.isEmpty())
            QCOMPARE(shown.last().left(2), QStringLiteral("-%1").arg(confirmed ? style : keys.back().digitValue()));

        QCOMPARE(board->record.boardStyle, style);
        QCOMPARE(QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).value(QStringLiteral("Board")).toInt(),
                 confirmed ? style : 9);
        QVERIFY(HoldsBoard(*board, style));
        // The game goes on untouched, the mouse still reaching it.
        QCOMPARE(LogLines(*board), logBefore);
        TapHand(*board, 4);
        QCOMPARE(board->SelectedCount(), 2);
    }
};

VENNICK_TEST(OptionsTest);
#include "OptionsTest.moc"

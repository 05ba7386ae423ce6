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
        QTest::addColumn<QString>("end");   // how the dialog is closed: OK, Cancel, Enter, Escape, close box
        QTest::addColumn<int>("style");     // the style afterwards
        QTest::newRow("Wooden; Embossed, OK") << 2 << "3" << "o" << 3;
        QTest::newRow("Embossed; Normal, Wooden, OK") << 3 << "12" << "o" << 2;
        QTest::newRow("Wooden; Embossed, Cancel") << 2 << "3" << "c" << 2;
        QTest::newRow("Wooden; Embossed, Escape") << 2 << "3" << "x" << 2;
        QTest::newRow("Wooden; Embossed, close box") << 2 << "3" << "b" << 2;
        QTest::newRow("Wooden; down, Enter") << 2 << "d" << "e" << 3;
        QTest::newRow("Embossed; up, up, Enter") << 3 << "uu" << "e" << 1;
        QTest::newRow("Embossed; down round to Normal, Enter") << 3 << "d" << "e" << 1;
        QTest::newRow("Wooden; Enter alone saves it") << 2 << "" << "e" << 2;
        // A damaged style selects no button; confirmed untouched, it is kept.
        QTest::newRow("7; Enter keeps it") << 7 << "" << "e" << 7;
        QTest::newRow("0; Normal, OK") << 0 << "1" << "o" << 1;
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
        const QStringList logBefore = LogLines(*board);
        // Changed behind the game's back, the store tells whether it is saved.
        QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).setValue(QStringLiteral("Board"), 9);

        QStringList shown;  // the title, the labels, then per step the style selected and the one with the focus
        const bool seen = RunDialog<COptionsDlg>([&] { board->OnOptions(); }, [&](COptionsDlg& dialog) {
            const auto state = [&] {
                QString checked = QStringLiteral("-");
                for (int s = 1; s <= 3; ++s) {
                    QRadioButton* button = dialog.StyleButton(kStyleButtonNormal + s - 1);
                    checked += button->isChecked() ? QString::number(s) : QString();
                    checked += dialog.focusWidget() == button ? QStringLiteral("f") : QString();
                }
                shown.append(checked);
            };
            shown.append(dialog.windowTitle());
            for (int id : {kStyleButtonNormal, kStyleButtonWooden, kStyleButtonEmbossed})
                shown.append(dialog.StyleButton(id)->text());
            state();
            for (QChar k : keys) {
                if (k.isDigit())
                    QTest::mouseClick(dialog.StyleButton(kStyleButtonNormal + k.digitValue() - 1), Qt::LeftButton);
                else
                    QTest::keyClick(dialog.focusWidget(), k == u'd' ? Qt::Key_Down : Qt::Key_Up);
                state();
            }
            QWidget* keyTarget = dialog.focusWidget() ? dialog.focusWidget() : &dialog;
            if (end == u"o" || end == u"c")
                dialog.ButtonBox()->button(end == u"o" ? QDialogButtonBox::Ok : QDialogButtonBox::Cancel)->click();
            else if (end == u"b")
                dialog.close();
            else
                QTest::keyClick(keyTarget, end == u"e" ? Qt::Key_Return : Qt::Key_Escape);
        });
        QVERIFY(seen);
        QCOMPARE(shown.mid(0, 4), (QStringList{"Options", "Normal", "Wooden", "Embossed"}));
        // Opened on the stored style, selected and with the focus; after keys or a click, the style reached.
        QCOMPARE(shown.at(4), stored >= 1 && stored <= 3 ? QStringLiteral("-%1f").arg(stored) : QStringLiteral("-"));
        const bool confirmed = end == u"o" || end == u"e";
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

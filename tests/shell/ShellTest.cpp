#include "settings/OptionsDialog.h"
#include "settings/TempStore.h"
#include "shell/GameApp.h"
#include "shell/HowToPlay.h"
#include "shell/MainFrame.h"
#include "support/TestBoard.h"
#include "support/TestMain.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QHelpEvent>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QPushButton>
#include <QRadioButton>
#include <QScreen>
#include <QTextBrowser>
#include <QTimer>
#include <QToolTip>

#include <memory>

// The program as main starts it, the frame's size, its menu bar and keys, and
// the dialogs it opens.
class ShellTest : public QObject {
    Q_OBJECT

private slots:
    // The program as main starts it: the icon, the frame, the first paint,
    // the focus; then its menu bar, New by key and on the bar, and Ctrl+Q.
    void startsAsMainDoes()
    {
        ClearSettings();
        auto* app = qobject_cast<CGameApp*>(QCoreApplication::instance());
        // The window icon in every size the build draws, for task bars and switchers.
        QCOMPARE(QApplication::windowIcon().availableSizes(), (QList<QSize>{{16, 16}, {32, 32}, {256, 256}}));
        QVERIFY(app && app->InitInstance());
        CMainFrame* frame = app->MainFrame();
        QVERIFY(frame && QTest::qWaitForWindowActive(frame));
        GameBoard& board = *frame->Board();
        QTRY_COMPARE(board.record.firstPaintPending, 0);
        QCOMPARE(ShownButtons(board), QList<int>{kCmdDeal});
        QCOMPARE(LogLines(board).mid(2), QStringList{"Click Deal to start a new game."});  // the third of three
        QTRY_COMPARE(QApplication::focusWidget(), static_cast<QWidget*>(&board));
        // The game window fills the frame at its chosen factor, the frame inside the screen.
        QCOMPARE(frame->windowTitle(), QStringLiteral("Vennick"));
        QCOMPARE(board.size(), frame->GameWindowSize(board.record.scaleY, 1.0, board.height() > board.LogRect().bottom * board.record.scaleY));
        QCOMPARE(frame->minimumSize(), frame->maximumSize());
        const QRect available = frame->screen()->availableGeometry();
        QVERIFY(available.contains(frame->frameGeometry()));
        // Also with a window manager's title bar and borders (up to 48 pixels) the frame fits.
        QVERIFY(board.record.scaleY == 1 || frame->frameGeometry().height() + 48 <= available.height());

        QMenuBar* bar = frame->menuBar();
        QStringList texts;
        for (const QAction* action : bar->actions() + frame->ToolsMenu()->actions() + frame->HelpMenu()->actions())
            texts.append(action->text() + action->shortcut().toString());
        QCOMPARE(texts, (QStringList{"&NewCtrl+N", "&Tools", "&Help", "&About Vennick...", "&Options...", "E&xitCtrl+Q",
                                     "&How to PlayF1"}));
        // Tooltips: New's shortcut; over the board (and only there) both scores and whose crib it is.
        const auto tipAt = [](QWidget* widget, QPoint at) {
            QHelpEvent help(QEvent::ToolTip, at, widget->mapToGlobal(at));
            QCoreApplication::sendEvent(widget, &help);
            return QToolTip::isVisible() ? QToolTip::text() : QString();
        };
        const QPoint corner(board.boardInfo.bmWidth * board.record.scaleX - 1, board.boardInfo.bmHeight * board.record.scaleY - 1);
        const QString tip = board.record.ownerName + QStringLiteral(" %1 \u00b7 Opponent 0 \u00b7 %2 crib");
        QCOMPARE(tipAt(&board, corner + QPoint(1, 1)), QString());
        QCOMPARE(tipAt(&board, corner), tip.arg(0).arg("Opponent's"));
        const QPoint onNew = bar->actionGeometry(frame->NewAction()).center();
        QVERIFY(tipAt(bar, onNew).contains(QStringLiteral("Ctrl+N")));
        // The status bar: both scores, whose crib and what the game waits for.
        const auto status = [frame] {
            QCoreApplication::processEvents();
            return frame->StatusLabel()->text();
        };
        QCOMPARE(status(), tip.arg(0).arg("Opponent's") + QStringLiteral(" \u00b7 Click Deal to start"));
        // New asks during a game: Enter (Cancel is the default) and Escape keep
        // it, Abandon ends it. After the game's end it asks nothing, and a game
        // won from far ahead counts 4.
        for (bool byKey : {true, false}) {
            ClickButton(board, kCmdDeal);
            TapHand(board, 1);
            if (byKey) {
                QCOMPARE(status(), tip.arg(0).arg("Opponent's") + QStringLiteral(" \u00b7 Choose one more card for the crib"));
                for (int answer : {int(Qt::Key_Return), int(Qt::Key_Escape), 0}) {
                    QVERIFY(QTest::qWaitForWindowActive(frame));  // as the question closed
                    QString asked;
                    QTimer::singleShot(0, frame, [&asked, answer] {
                        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
                        QTimer::singleShot(2000, box, &QDialog::reject);  // left open, it cannot hang the run
                        asked = box->text();
                        for (QAbstractButton* button : box->buttons())
                            if (answer == 0 && box->buttonRole(button) == QMessageBox::DestructiveRole)
                                button->click();
                        if (answer != 0)
                            QTest::keyPress(box, Qt::Key(answer));  // the box is gone before a release
                    });
                    QTest::keyClick(frame, Qt::Key_N, Qt::ControlModifier);
                    QCOMPARE(asked, QStringLiteral("Abandon this game?"));
                    QCOMPARE(board.record.phase, answer != 0 ? int(kPhaseDiscard) : int(kPhaseNoDeal));
                }
            } else {
                board.PegPoints(kSidePlayer, kGameHole, QStringLiteral(" for your hand"));
                QCOMPARE(tipAt(&board, {0, 0}), tip.arg(kGameHole).arg("Your"));  // the crib turned with New
                QCOMPARE(status(), QStringLiteral("You won 121 to 0: a double skunk, 4 games. Click New to play again."));
                QTest::mouseClick(bar, Qt::LeftButton, {}, onNew);
            }
            QCOMPARE(board.record.phase, int(kPhaseNoDeal));
            QCOMPARE(LogLines(board).first(), board.record.ownerName + (byKey ? ": 0" : ": 4"));
        }
        // F1 opens the rules beside the game, which goes on meanwhile.
        QTest::keyClick(frame, Qt::Key_F1);
        QVERIFY(frame->HowToPlay() && !frame->HowToPlay()->isHidden() && !QApplication::activeModalWidget());
        QVERIFY(frame->HowToPlay()->Browser()->toPlainText().contains(QStringLiteral("His Heels")));
        QTest::mouseClick(frame->HowToPlay()->findChild<QDialogButtonBox*>()->button(QDialogButtonBox::Close), Qt::LeftButton);
        QVERIFY(frame->HowToPlay()->isHidden());
        // Ctrl+Q ends the program's own loop; 7 should nothing end it within five seconds.
        QTimer::singleShot(0, frame, [frame] { QTest::keyClick(frame, Qt::Key_Q, Qt::ControlModifier); });
        QTimer::singleShot(5000, frame, [] { QCoreApplication::exit(7); });
        QCOMPARE(QCoreApplication::exec(), 0);
        frame->hide();  // out of the way of the tests that follow
    }

    // The frame's size: the largest whole factor in device pixels that fits
    // the screen, also at 150% and 125%, without the band under the log only
    // where the band alone keeps that factor out. The game window asked for
    // yields exactly the factor, and fits with the chrome unless the factor is the least.
    void chooseScale()
    {
        const QSize chrome(16, 70);
        CMainFrame frame;
        using Scale = CMainFrame::Scale;
        for (const auto& [available, ratio, scale] :
             {std::tuple(QSize(1920, 1080), 1.0, Scale{3, true}), std::tuple(QSize(496, 658), 1.0, Scale{2, true}),
              std::tuple(QSize(496, 657), 1.0, Scale{2, false}), std::tuple(QSize(496, 607), 1.0, Scale{1, true}),
              std::tuple(QSize(1024, 877), 1.0, Scale{3, false}), std::tuple(QSize(683, 512), 1.5, Scale{2, true}),
              std::tuple(QSize(1536, 864), 1.25, Scale{3, true})}) {
            QCOMPARE(frame.ChooseScale(available, chrome, ratio), scale);
            const QSize window = frame.GameWindowSize(scale.factor, ratio, scale.band);
            const QSize device = (QSizeF(window) * ratio).toSize();
            QCOMPARE(QSize(GameBoard::ScaleFactorX(device.width()), frame.Board()->ScaleFactorY(device.height())),
                     QSize(scale.factor, scale.factor));
            QVERIFY(scale.factor == 1 || available.expandedTo(window + chrome) == available);
        }
    }

    // The dialogs of the Tools menu during a game. The key that closes one,
    // and a key held while one opens, never act on the game; Options opens on
    // the stored style, its arrow keys wrap round the three, and only OK or
    // Enter sets and saves the style.
    void dialogs_data()
    {
        QTest::addColumn<int>("item");       // in the Tools menu: About 0, Options 1
        QTest::addColumn<int>("stored");     // the style in the store
        // A digit clicks that style; d, u: arrow down, up; e: Alt+E, which turns "Explain each score" over.
        QTest::addColumn<QString>("steps");
        QTest::addColumn<int>("end");        // Enter, Escape, or a click on OK with Enter held
        // The title and labels; the style selected and "f" on the focus, as
        // opened and after each step; the style afterwards, and whether saved.
        QTest::addColumn<QString>("expected");
        const int ok = QDialogButtonBox::Ok, enter = Qt::Key_Return, escape = Qt::Key_Escape;
        // The version is the one the build gives --version.
        const QString about = "About Vennick: 32 Vennick Version " VENNICK_VERSION " Free software under the MIT licence. > 2";
        const QString options = "Options: Normal Wooden Embossed ";
        QTest::newRow("About, Enter") << 0 << 2 << "" << enter << about;
        QTest::newRow("Wooden; Embossed, explained, OK") << 1 << 2 << "3e" << ok << options + "2f 3f 3 > 3 explained saved";
        QTest::newRow("Wooden; Embossed, explained, Escape") << 1 << 2 << "3e" << escape << options + "2f 3f 3 > 2";
        QTest::newRow("Embossed; down round to Normal, up round back, Enter") << 1 << 3 << "du" << enter << options + "3f 1f 3f > 3 saved";
        // A damaged style selects no button; confirmed untouched, it is kept.
        QTest::newRow("7; Enter keeps it") << 1 << 7 << "" << enter << options + " > 7 saved";
    }

    void dialogs()
    {
        QFETCH(int, item);
        QFETCH(int, stored);
        QFETCH(QString, steps);
        QFETCH(int, end);
        QFETCH(QString, expected);
        TempStore store;
        store.Write(QStringLiteral("[General]\nBoard=%1\n").arg(stored).toUtf8());
        auto frame = std::make_unique<CMainFrame>();
        frame->show();
        QVERIFY(QTest::qWaitForWindowActive(frame.get()));
        GameBoard& board = *frame->Board();
        ClickButton(board, kCmdDeal);
        TapHand(board, 1);
        TapHand(board, 2);  // "Send To Crib" is shown: a leaked key would press it
        const QStringList lines = LogLines(board);
        // Changed behind the game's back, the store tells whether it is saved.
        QSettings(QStringLiteral("Quorvan"), QStringLiteral("Vennick")).setValue(QStringLiteral("Board"), 9);
        const bool byKey = end == Qt::Key_Return || end == Qt::Key_Escape;
        if (!byKey)
            QTest::keyPress(&board, Qt::Key_Return);

        QString trace;
        QTimer::singleShot(0, frame.get(), [&] {
            QDialog& dialog = *qobject_cast<QDialog*>(QApplication::activeModalWidget());
            QTimer::singleShot(2000, &dialog, &QDialog::reject);  // left open, it cannot hang the run
            trace = dialog.windowTitle() + ':';
            QRect before;  // each label right of the one before or below it, all above the buttons
            for (const QLabel* label : dialog.findChildren<QLabel*>()) {
                const bool placed = (label->x() > before.right() || label->y() > before.bottom())
                                    && label->geometry().bottom() < dialog.findChild<QDialogButtonBox*>()->y();
                trace += ' ' + (label->pixmap().isNull() ? label->text() : QString::number(label->pixmap().width()))
                         + (placed ? "" : " misplaced");
                before = label->geometry();
            }
            auto* options = qobject_cast<COptionsDlg*>(&dialog);
            for (int s = 1; options && s <= 3; ++s)
                trace += ' ' + options->StyleButton(kStyleButtonNormal + s - 1)->text();
            for (const QChar k : options ? QStringLiteral("-") + steps : QString()) {
                if (k.isDigit())
                    QTest::mouseClick(options->StyleButton(kStyleButtonNormal + k.digitValue() - 1), Qt::LeftButton);
                else if (k == u'e') {
                    QTest::keyClick(dialog.windowHandle(), Qt::Key_E, Qt::AltModifier);  // through the shortcuts
                    QTRY_VERIFY(options->ExplainBox()->isChecked());  // a mnemonic clicks after a moment
                } else if (k != u'-')
                    QTest::keyClick(dialog.focusWidget(), k == u'd' ? Qt::Key_Down : Qt::Key_Up);
                trace += ' ';
                for (int s = 1; s <= 3; ++s) {
                    const QRadioButton* button = options->StyleButton(kStyleButtonNormal + s - 1);
                    trace += (button->isChecked() ? QString::number(s) : QString()) + (dialog.focusWidget() == button ? "f" : "");
                }
            }
            if (byKey)
                QTest::keyPress(dialog.focusWidget() ? dialog.focusWidget() : &dialog, Qt::Key(end));
            else
                QTest::mouseClick(dialog.findChild<QDialogButtonBox*>()->button(QDialogButtonBox::StandardButton(end)), Qt::LeftButton);
        });
        frame->ToolsMenu()->actions().at(item)->trigger();
        QTest::keyRelease(&board, byKey ? Qt::Key(end) : Qt::Key_Return);
        QTest::qWait(60);
        const QSettings settings(QStringLiteral("Quorvan"), QStringLiteral("Vennick"));
        trace += QStringLiteral(" > %1").arg(board.record.boardStyle) + (board.record.explainScores ? " explained" : "")
                 + (settings.value("Board").toInt() == 9 ? "" : " saved");
        QCOMPARE(trace, expected);
        QVERIFY(HoldsBoard(board, board.record.boardStyle));
        QCOMPARE(LogLines(board), lines);
        frame->activateWindow();  // what a window manager does as a dialog closes
        QVERIFY(QTest::qWaitForWindowActive(frame.get()));
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_2);
        QCOMPARE(board.SelectedCount(), 1);
    }
};

VENNICK_TEST(ShellTest);
#include "ShellTest.moc"

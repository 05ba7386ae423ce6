#include "shell/AboutDialog.h"
#include "support/TestMain.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QPushButton>

// The About box: its title, the icon, the name and a single OK that closes it.
class AboutTest : public QObject {
    Q_OBJECT

private slots:
    void contentAndOk()
    {
        CAboutDlg dialog;
        QCOMPARE(dialog.windowTitle(), QStringLiteral("About Vennick"));
        auto* name = dialog.findChild<QLabel*>(QStringLiteral("name"));
        QVERIFY(name);
        QCOMPARE(name->text(), QStringLiteral("Vennick"));
        QCOMPARE(name->textFormat(), Qt::PlainText);

        auto* icon = dialog.findChild<QLabel*>(QStringLiteral("icon"));
        QVERIFY(icon);
        QCOMPARE(icon->pixmap().deviceIndependentSize().toSize(), QSize(32, 32));
        // Drawn, not blank.
        const QImage image = icon->pixmap().toImage();
        QImage plain = image;
        plain.fill(image.pixel(0, 0));
        QVERIFY(image != plain);

        const QList<QPushButton*> buttons = dialog.findChildren<QPushButton*>();
        QCOMPARE(buttons.size(), 1);
        QCOMPARE(dialog.findChild<QDialogButtonBox*>()->buttonRole(buttons.first()), QDialogButtonBox::AcceptRole);
        dialog.show();
        QVERIFY(QTest::qWaitForWindowExposed(&dialog));
        QTest::mouseClick(buttons.first(), Qt::LeftButton);
        QVERIFY(dialog.isHidden());
        QCOMPARE(dialog.result(), int(QDialog::Accepted));
    }
};

VENNICK_TEST(AboutTest);
#include "AboutTest.moc"

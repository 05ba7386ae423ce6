#include "shell/AboutDialog.h"
#include "support/TestMain.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QPushButton>

// The About box: its title, the icon, the name and a single OK.
class AboutTest : public QObject {
    Q_OBJECT

private slots:
    void content()
    {
        CAboutDlg dialog;
        QCOMPARE(dialog.windowTitle(), QStringLiteral("About Vennick"));

        auto* name = dialog.findChild<QLabel*>(QStringLiteral("name"));
        QVERIFY(name);
        QCOMPARE(name->text(), QStringLiteral("Vennick"));
        QCOMPARE(name->textFormat(), Qt::PlainText);

        auto* icon = dialog.findChild<QLabel*>(QStringLiteral("icon"));
        QVERIFY(icon);
        const QPixmap pixmap = icon->pixmap();
        QVERIFY(!pixmap.isNull());
        QCOMPARE(pixmap.deviceIndependentSize().toSize(), QSize(32, 32));
        // Drawn, not blank: the icon has more than one colour.
        const QImage image = pixmap.toImage();
        bool varied = false;
        for (int y = 0; y < image.height() && !varied; ++y)
            for (int x = 0; x < image.width() && !varied; ++x)
                varied = image.pixel(x, y) != image.pixel(0, 0);
        QVERIFY(varied);

        const QList<QPushButton*> buttons = dialog.findChildren<QPushButton*>();
        QCOMPARE(buttons.size(), 1);
        auto* box = dialog.findChild<QDialogButtonBox*>();
        QVERIFY(box);
        QCOMPARE(box->buttonRole(buttons.first()), QDialogButtonBox::AcceptRole);
    }

    void okCloses()
    {
        CAboutDlg dialog;
        dialog.show();
        QVERIFY(QTest::qWaitForWindowExposed(&dialog));
        QTest::mouseClick(dialog.findChild<QPushButton*>(), Qt::LeftButton);
        QVERIFY(dialog.isHidden());
        QCOMPARE(dialog.result(), int(QDialog::Accepted));
    }
};

VENNICK_TEST(AboutTest);
#include "AboutTest.moc"

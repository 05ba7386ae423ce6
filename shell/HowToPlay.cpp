#include "shell/HowToPlay.h"

#include <QDialogButtonBox>
#include <QTextBrowser>
#include <QUrl>
#include <QVBoxLayout>

CHowToPlayWnd::CHowToPlayWnd(QWidget* parent)
    : QDialog(parent)
{
    setWindowTitle(QStringLiteral("How to Play Vennick"));
    setModal(false);

    browser = new QTextBrowser(this);
    browser->setOpenExternalLinks(false);
    browser->setSource(QUrl(QStringLiteral("qrc:/help/how-to-play.html")));

    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Close, this);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(browser);
    layout->addWidget(buttons);
    // About forty lines of text, and as wide as a comfortable column.
    const int line = fontMetrics().lineSpacing();
    resize(36 * line, 30 * line);
}

#include "shell/AboutDialog.h"

#include <QDialogButtonBox>
#include <QGridLayout>
#include <QIcon>
#include <QLabel>

CAboutDlg::CAboutDlg(QWidget* parent)
    : QDialog(parent)
{
    setWindowTitle(QStringLiteral("About Vennick"));

    // The large rendering keeps the icon sharp where the screen scales up.
    QIcon icon;
    icon.addFile(QStringLiteral(":/icons/vennick-32.png"));
    icon.addFile(QStringLiteral(":/icons/vennick-256.png"));
    auto* iconLabel = new QLabel(this);
    iconLabel->setObjectName(QStringLiteral("icon"));
    iconLabel->setPixmap(icon.pixmap(QSize(32, 32)));

    auto* nameLabel = new QLabel(QStringLiteral("Vennick"), this);
    nameLabel->setObjectName(QStringLiteral("name"));
    nameLabel->setTextFormat(Qt::PlainText);

    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);

    auto* layout = new QGridLayout(this);
    layout->addWidget(iconLabel, 0, 0, Qt::AlignTop);
    layout->addWidget(nameLabel, 0, 1, Qt::AlignTop | Qt::AlignLeft);
    layout->addWidget(buttons, 1, 0, 1, 2);
    layout->setSizeConstraint(QLayout::SetFixedSize);
}

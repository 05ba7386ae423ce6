#include "shell/AboutDialog.h"

#include <QCoreApplication>
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
    auto* versionLabel = new QLabel(QStringLiteral("Version ") + QCoreApplication::applicationVersion(), this);
    versionLabel->setObjectName(QStringLiteral("version"));
    versionLabel->setTextFormat(Qt::PlainText);
    auto* licenceLabel = new QLabel(QStringLiteral("Free software under the MIT licence."), this);
    licenceLabel->setObjectName(QStringLiteral("licence"));
    licenceLabel->setTextFormat(Qt::PlainText);

    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);

    auto* layout = new QGridLayout(this);
    layout->addWidget(iconLabel, 0, 0, 3, 1, Qt::AlignTop);
    layout->addWidget(nameLabel, 0, 1, Qt::AlignTop | Qt::AlignLeft);
    layout->addWidget(versionLabel, 1, 1, Qt::AlignTop | Qt::AlignLeft);
    layout->addWidget(licenceLabel, 2, 1, Qt::AlignTop | Qt::AlignLeft);
    layout->addWidget(buttons, 3, 0, 1, 2);
    layout->setSizeConstraint(QLayout::SetFixedSize);
}

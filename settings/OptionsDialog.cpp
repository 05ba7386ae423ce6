#include "settings/OptionsDialog.h"

#include "game/GameBoard.h"

#include <QButtonGroup>
#include <QDialogButtonBox>
#include <QRadioButton>
#include <QVBoxLayout>

COptionsDlg::COptionsDlg(QWidget* parent)
    : QDialog(parent)
{
    setWindowTitle(QStringLiteral("Options"));

    auto* layout = new QVBoxLayout(this);
    styleGroup = new QButtonGroup(this);
    const struct {
        int id;
        const char* label;
        void (COptionsDlg::*handler)();
    } styles[] = {
        {kStyleButtonNormal, "Normal", &COptionsDlg::OnNormal},
        {kStyleButtonWooden, "Wooden", &COptionsDlg::OnWooden},
        {kStyleButtonEmbossed, "Embossed", &COptionsDlg::OnEmbossed},
    };
    for (const auto& style : styles) {
        auto* button = new QRadioButton(QString::fromLatin1(style.label), this);
        button->setObjectName(QString::number(style.id));
        styleGroup->addButton(button, style.id);
        connect(button, &QRadioButton::clicked, this, style.handler);
        layout->addWidget(button, 0, Qt::AlignLeft);
    }

    buttonBox = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttonBox, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttonBox, &QDialogButtonBox::rejected, this, &QDialog::reject);
    layout->addWidget(buttonBox);
    layout->setSizeConstraint(QLayout::SetFixedSize);

    ShowSelection();
}

void COptionsDlg::SetSelectedStyle(int32_t style)
{
    selectedStyle = style;
    ShowSelection();
}

void COptionsDlg::OnNormal()
{
    SetSelectedStyle(1);
}

void COptionsDlg::OnWooden()
{
    SetSelectedStyle(2);
}

void COptionsDlg::OnEmbossed()
{
    SetSelectedStyle(3);
}

QRadioButton* COptionsDlg::StyleButton(int id) const
{
    return qobject_cast<QRadioButton*>(styleGroup->button(id));
}

void COptionsDlg::ShowSelection()
{
    // Each button is set explicitly; an exclusive group would refuse to clear
    // the last selected one, which a style outside 1..3 needs.
    styleGroup->setExclusive(false);
    for (QAbstractButton* button : styleGroup->buttons())
        button->setChecked(styleGroup->id(button) - kStyleButtonNormal + 1 == selectedStyle);
    styleGroup->setExclusive(true);
}

void GameBoard::OnOptions()
{
    COptionsDlg dialog(this);
    dialog.SetSelectedStyle(record.boardStyle);
    if (dialog.exec() == QDialog::Accepted)
        ApplyBoardStyle(dialog.selectedStyle);
}

void GameBoard::ApplyBoardStyle(int style)
{
    record.boardStyle = style;
    SaveSettings();
    ReloadBoardBitmap();
}

#include "settings/OptionsDialog.h"

#include "game/GameBoard.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QDialogButtonBox>
#include <QKeyEvent>
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
        button->installEventFilter(this);
        layout->addWidget(button, 0, Qt::AlignLeft);
    }

    explainBox = new QCheckBox(QStringLiteral("&Explain each score"), this);
    layout->addWidget(explainBox, 0, Qt::AlignLeft);

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
    // The keyboard starts on the style shown selected.
    if (style >= 1 && style <= 3)
        StyleButton(kStyleButtonNormal + style - 1)->setFocus();
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

bool COptionsDlg::eventFilter(QObject* watched, QEvent* event)
{
    // The arrow keys choose the next or previous style, round the three, as
    // radio buttons do on every desktop; Qt alone would only move the focus
    // when no style is selected.
    if (event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        const int step = key == Qt::Key_Down || key == Qt::Key_Right ? 1 : key == Qt::Key_Up || key == Qt::Key_Left ? -1 : 0;
        const int id = styleGroup->id(qobject_cast<QAbstractButton*>(watched));
        if (step != 0 && id >= kStyleButtonNormal) {
            QRadioButton* next = StyleButton(kStyleButtonNormal + (id - kStyleButtonNormal + step + 3) % 3);
            next->setFocus();
            next->click();
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
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
    dialog.ExplainBox()->setChecked(record.explainScores != 0);
    if (dialog.exec() == QDialog::Accepted) {
        record.explainScores = dialog.ExplainBox()->isChecked() ? 1 : 0;
        ApplyBoardStyle(dialog.selectedStyle);
    }
}

void GameBoard::ApplyBoardStyle(int style)
{
    record.boardStyle = style;
    SaveSettings();
    ReloadBoardBitmap();
}

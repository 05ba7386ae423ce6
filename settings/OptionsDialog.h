#pragma once

#include <QDialog>

#include <cstdint>

class QButtonGroup;
class QCheckBox;
class QDialogButtonBox;
class QRadioButton;

// Ids of the three style buttons; style n has id kStyleButtonNormal + n - 1.
enum StyleButtonId : int {
    kStyleButtonNormal = 1000,
    kStyleButtonWooden = 1001,
    kStyleButtonEmbossed = 1002,
};

// The Options dialog: one radio button per board style and the choice to
// explain each score, confirmed with OK.
class COptionsDlg : public QDialog {
    Q_OBJECT

public:
    explicit COptionsDlg(QWidget* parent = nullptr);

    // The style shown and chosen: 1 Normal, 2 Wooden, 3 Embossed. Another
    // value (a damaged setting) shows no button selected.
    int32_t selectedStyle = 1;
    void SetSelectedStyle(int32_t style);

    void OnNormal();
    void OnWooden();
    void OnEmbossed();

    QRadioButton* StyleButton(int id) const;
    QCheckBox* ExplainBox() const { return explainBox; }
    QDialogButtonBox* ButtonBox() const { return buttonBox; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void ShowSelection();

    QButtonGroup* styleGroup = nullptr;
    QCheckBox* explainBox = nullptr;
    QDialogButtonBox* buttonBox = nullptr;
};

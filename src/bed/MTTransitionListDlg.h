#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTTransitionGrid;
class CMTTransitionListKiv;
class QCheckBox;

// Whether transition between layers is included, and the transitions of all layer pairs.
class CMTTransitionListDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTTransitionListDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    QCheckBox* IncludeBox() const { return m_include; }
    CMTTransitionGrid* Grid() const { return m_grid; }

private:
    CMTTransitionListKiv* List() const;
    void OnInclude(bool checked);

    QCheckBox* m_include;
    CMTTransitionGrid* m_grid;
};

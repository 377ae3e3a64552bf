#include "MTErosionListDlg.h"

#include "MTErosionGrid.h"
#include "MTErosionListKiv.h"
#include "widgets/ZoNumberEdit.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTErosionListDlg)

namespace {
constexpr long kConcentrationGroup = 100403;
}

CMTErosionListDlg::CMTErosionListDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_maxConcentration(new CZoNumberEdit(
                                CZoEditStyle().SetOvuUnitBaseGroup(kConcentrationGroup).SetFloatRange(), this)),
      m_unit(new QLabel(this)), m_grid(new CMTErosionGrid(this)) {
    HelpID(5027);
    m_maxConcentration->setObjectName("maxConcentration");
    m_unit->setObjectName("maxConcentrationUnit");
    m_grid->setObjectName("grid");

    auto* group = new QGroupBox("Erosion parameters", this);
    auto* row = new QGridLayout(group);
    auto* label = new QLabel("Maximum concentration allowed due to erosion", group);
    label->setBuddy(m_maxConcentration);
    row->addWidget(label, 0, 0);
    row->addWidget(m_maxConcentration, 0, 1);
    row->addWidget(m_unit, 0, 2);
    row->setColumnStretch(3, 1);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(group);
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);
    layout->addStretch(1);
}

CMTErosionListKiv* CMTErosionListDlg::List() const {
    return Section<CMTErosionListKiv>();
}

void CMTErosionListDlg::Initialize() {
    if (CMTErosionListKiv* list = List()) {
        m_grid->Initialize(this, list);
        m_maxConcentration->BindDouble(
            this, [this] { return List()->MaxConcentration(); },
            [this](double value) { List()->MaxConcentration(value); });
    }
    CZoSEDlgBase::Initialize();
}

void CMTErosionListDlg::SetData() {
    CZoSEDlgBase::SetData();
    const CString unit = m_maxConcentration->Style().UnitName();
    m_unit->setText(QString::fromStdString(unit));
    m_grid->Refresh();
}

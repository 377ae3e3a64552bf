#include "MTBoundaryConditionsComponentDlg.h"

#include "MTBoundaryConditionsKiv.h"

#include <QLabel>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTBoundaryConditionsComponentDlg)

CMTBoundaryConditionsComponentDlg::CMTBoundaryConditionsComponentDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_boundary(new QLabel(this)) {
    HelpID(5014);
    m_boundary->setObjectName("boundary");
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_boundary);
    layout->addStretch(1);
}

void CMTBoundaryConditionsComponentDlg::SetData() {
    CZoSEDlgBase::SetData();
    auto* component = Section<CMTBoundaryConditionsComponentKiv>();
    m_boundary->setText(component ? QString("Boundary %1, code %2")
                                        .arg(QString::fromStdString(component->GetTitle()))
                                        .arg(component->BoundaryCode())
                                  : QString());
}

#include "MTSolutionTechniqueDlg.h"

#include "MTSolutionTechniqueKiv.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTSolutionTechniqueDlg)

CMTSolutionTechniqueDlg::CMTSolutionTechniqueDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_time(new QComboBox(this)), m_space(new QComboBox(this)) {
    HelpID(5047);
    m_time->setObjectName("timeIntegration");
    m_space->setObjectName("spaceDiscretization");
    auto* grid = new QGridLayout;
    auto row = [&](int r, const char* label, QComboBox* box) {
        box->addItems({"Low order, fast algorithm", "Higher order"});
        auto* l = new QLabel(label, this);
        l->setBuddy(box);
        grid->addWidget(l, r, 0);
        grid->addWidget(box, r, 1);
        connect(box, &QComboBox::activated, this, [this] { Store(); });
    };
    row(0, "Time integration", m_time);
    row(1, "Space discretization", m_space);
    grid->setColumnStretch(2, 1);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(grid);
    layout->addStretch(1);
}

CMTSolutionTechniqueKiv* CMTSolutionTechniqueDlg::Technique() const {
    return Section<CMTSolutionTechniqueKiv>();
}

void CMTSolutionTechniqueDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTSolutionTechniqueKiv* t = Technique();
    if (!t)
        return;
    // Values the lists do not hold show no entry rather than a wrong one.
    auto show = [](QComboBox* box, int scheme) {
        const QSignalBlocker block(box);
        box->setCurrentIndex(scheme >= 1 && scheme <= box->count() ? scheme - 1 : -1);
    };
    show(m_time, t->TimeIntegration());
    show(m_space, t->SpaceHorizontal());
    t->SyncVerticalScheme();
}

void CMTSolutionTechniqueDlg::Store() {
    CMTSolutionTechniqueKiv* t = Technique();
    if (!t)
        return;
    if (m_time->currentIndex() >= 0)
        t->TimeIntegration(m_time->currentIndex() + 1);
    if (m_space->currentIndex() >= 0)
        t->SpaceHorizontal(m_space->currentIndex() + 1);
    t->SyncVerticalScheme();
    UpdateDoc(kHintValueChanged);
}

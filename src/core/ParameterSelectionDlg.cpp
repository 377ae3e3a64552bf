#include "ParameterSelectionDlg.h"

#include "ParameterSelectionKiv.h"
#include "widgets/ZoNumberEdit.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CParameterSelectionDlg)

namespace {
constexpr int kMaxFractions = 8;
constexpr int kMaxLayers = 12;
}  // namespace

CParameterSelectionDlg::CParameterSelectionDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_frame(new QGroupBox("Parameter Selection", this)),
      m_fractions(new CZoNumberEdit(CZoEditStyle().SetRange(1, kMaxFractions), m_frame)),
      m_layers(new CZoNumberEdit(CZoEditStyle().SetRange(1, kMaxLayers), m_frame)),
      m_fractionsSpin(new CZoSpinButton(m_fractions, m_frame)),
      m_layersSpin(new CZoSpinButton(m_layers, m_frame)) {
    HelpID(5046);
    m_fractions->setObjectName("fractions");
    m_layers->setObjectName("layers");
    m_fractionsSpin->setObjectName("fractionsSpin");
    m_layersSpin->setObjectName("layersSpin");

    auto* grid = new QGridLayout(m_frame);
    auto row = [&](int r, const char* label, CZoNumberEdit* edit, CZoSpinButton* spin,
                   const char* note) {
        auto* l = new QLabel(label, m_frame);
        l->setBuddy(edit);
        edit->setMaximumWidth(edit->fontMetrics().horizontalAdvance("00000") + 12);
        edit->SetStoreOnChange(true);
        grid->addWidget(l, r, 0);
        grid->addWidget(edit, r, 1);
        grid->addWidget(spin, r, 2);
        grid->addWidget(new QLabel(note, m_frame), r, 3);
    };
    row(0, "Number of Fractions", m_fractions, m_fractionsSpin, "(Max 8)");
    row(1, "Number of Layers", m_layers, m_layersSpin, "(Max 12)");
    grid->setColumnStretch(4, 1);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_frame);
    layout->addStretch(1);
}

CParameterSelectionKiv* CParameterSelectionDlg::Model() const {
    return Section<CParameterSelectionKiv>();
}

void CParameterSelectionDlg::Initialize() {
    AddAlignRight(m_frame);
    // The setters report themselves: the hint depends on how the count moved.
    m_fractions->BindInt(
        nullptr, [this] { return Model() ? Model()->NumberOfFractions() : 0; },
        [this](int n) {
            if (CParameterSelectionKiv* model = Model()) {
                const int before = model->NumberOfFractions();
                model->NumberOfFractions(n);
                Stored(before, n);
            }
        });
    m_layers->BindInt(
        nullptr, [this] { return Model() ? Model()->NumberOfLayers() : 0; },
        [this](int n) {
            if (CParameterSelectionKiv* model = Model()) {
                const int before = model->NumberOfLayers();
                model->NumberOfLayers(n);
                Stored(before, n);
            }
        });
    CZoSEDlgBase::Initialize();
}

void CParameterSelectionDlg::Stored(int before, int after) {
    UpdateDoc(after > before ? kHintItemsAdded : after < before ? kHintItemsDeleted
                                                                : kHintValueChanged);
}

#include "ForcingsWaveDBDlg.h"

#include "ForcingsWaveDBAxisKiv.h"
#include "ForcingsWaveDBGrid.h"
#include "ForcingsWaveDBListKiv.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoSEDlgBase.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QVBoxLayout>

CForcingsWaveDBDlg::CForcingsWaveDBDlg(CForcingsWaveDBListKiv* list, CZoSEDlgBase* owner,
                                       QWidget* parent)
    : QWidget(parent), m_list(list), m_owner(owner), m_grid(new CForcingsWaveDBGrid(this)) {
    setObjectName("waveDatabase");
    m_grid->setObjectName("grid");
    struct Row {
        const char* label;
        const char* name;
        long group;
    };
    const Row rows[] = {{"Wind Speed", "speed", 100274},
                        {"Wind Direction", "direction", 100003},
                        {"Water Level", "level", 100000}};
    auto* frame = new QGroupBox("Wave Database Settings", this);
    auto* grid = new QGridLayout(frame);
    const char* headings[] = {"Start Value", "Increment", "No. of Values"};
    for (int c = 0; c < 3; ++c)
        grid->addWidget(new QLabel(headings[c], frame), 0, c + 1);
    const char* parts[] = {"Start", "Increment", "Count"};
    for (int a = 0; a < 3; ++a) {
        grid->addWidget(new QLabel(rows[a].label, frame), a + 1, 0);
        for (int c = 0; c < 3; ++c) {
            auto* edit = c < 2 ? new CZoNumberEdit(
                                     CZoEditStyle().SetOvuUnitBaseGroup(rows[a].group), frame)
                               : new CZoNumberEdit(CZoEditStyle().SetMinimum(0), frame);
            edit->setObjectName(QString("%1%2").arg(rows[a].name, parts[c]));
            grid->addWidget(edit, a + 1, c + 1);
            m_edits[a][c] = edit;
        }
        // The user's unit of the row, after its count.
        auto* unit = new QLabel(
            QString::fromStdString(CZoEditStyle().SetOvuUnitBaseGroup(rows[a].group).UnitName()),
            frame);
        unit->setObjectName(QString("%1Unit").arg(rows[a].name));
        grid->addWidget(unit, a + 1, 4);
    }
    grid->setColumnStretch(5, 1);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(frame);
    layout->addWidget(new QLabel("Database file names", this));
    layout->addWidget(m_grid, 0, Qt::AlignLeft | Qt::AlignTop);

    for (int a = 0; a < 3; ++a) {
        // Stored without a hint of their own: ApplyAxes resizes and sends the one that fits.
        m_edits[a][0]->BindDouble(
            nullptr, [this, a] { return Axis(a)->Start(); }, [this, a](double v) { Axis(a)->Start(v); });
        m_edits[a][1]->BindDouble(
            nullptr, [this, a] { return Axis(a)->Increment(); },
            [this, a](double v) { Axis(a)->Increment(v); });
        m_edits[a][2]->BindInt(
            nullptr, [this, a] { return Axis(a)->Count(); }, [this, a](int v) { Axis(a)->Count(v); });
        for (CZoNumberEdit* e : m_edits[a])
            connect(e, &CZoNumberEdit::Stored, this, &CForcingsWaveDBDlg::ApplyAxes);
    }
    m_grid->Initialize(owner, list);
}

CForcingsWaveDBAxisKiv* CForcingsWaveDBDlg::Axis(int axis) const {
    switch (axis) {
    case 0: return m_list->WindSpeed();
    case 1: return m_list->WindDirection();
    default: return m_list->WaterLevel();
    }
}

void CForcingsWaveDBDlg::SetData() {
    for (auto& row : m_edits)
        for (CZoNumberEdit* e : row)
            e->Refresh();
    m_grid->Refresh();
}

void CForcingsWaveDBDlg::ApplyAxes() {
    // An axis whose increment is 0 has one value, whatever its count said.
    for (int a : {2, 1, 0}) {
        CForcingsWaveDBAxisKiv* axis = Axis(a);
        if (axis->Increment() == 0.0 && axis->Count() >= 2)
            axis->Count(1);
    }
    const int before = m_list->GetItemCount();
    m_list->ResizeToAxes();
    const int after = m_list->GetItemCount();
    SetData();
    if (m_owner)
        m_owner->UpdateDoc(after > before   ? kHintItemsAdded
                           : after < before ? kHintItemsDeleted
                                            : kHintValueChanged);
}

#include "PreferencesDialog.h"

#include "EditorSettings.h"
#include "fem/UnitUtil.h"
#include "widgets/ZoWheelGuard.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QScrollArea>
#include <QSettings>
#include <QVBoxLayout>

#include <algorithm>
#include <vector>

namespace {
QString Key(long group) { return QStringLiteral("units/%1").arg(group); }
}  // namespace

CPreferencesDialog::CPreferencesDialog(QWidget* parent) : QDialog(parent) {
    ZoInstallWheelGuard();
    setWindowTitle(tr("Preferences"));
    auto* layout = new QVBoxLayout(this);
    auto* note = new QLabel(tr("Values are shown and entered in these units; the setup file "
                               "always stores them in the first unit of each quantity."),
                            this);
    note->setWordWrap(true);
    layout->addWidget(note);

    auto* box = new QGroupBox(tr("Units"), this);
    auto* form = new QFormLayout(box);
    std::vector<const QuantityInfo*> quantities;
    for (const QuantityInfo& q : CUnitUtil::Quantities())
        quantities.push_back(&q);
    std::stable_sort(quantities.begin(), quantities.end(), [](const QuantityInfo* a, const QuantityInfo* b) {
        return QString::fromUtf8(a->name).compare(QString::fromUtf8(b->name), Qt::CaseInsensitive) < 0;
    });
    for (const QuantityInfo* quantity : quantities) {
        const QuantityInfo& q = *quantity;
        if (q.units.size() < 2)
            continue;  // nothing to choose
        auto* combo = new QComboBox(box);
        for (const UnitInfo& u : q.units)
            combo->addItem(QString::fromUtf8(u.name), u.id);
        combo->setCurrentIndex(combo->findData(CUnitUtil::GetUserUnit(q.code)));
        form->addRow(QString::fromUtf8(q.name), combo);
        m_rows.push_back({q.code, combo});
    }
    auto* scroll = new QScrollArea(this);
    scroll->setWidget(box);
    scroll->setWidgetResizable(true);
    scroll->setFrameShape(QFrame::NoFrame);
    layout->addWidget(scroll, 1);

    auto* buttons = new QDialogButtonBox(
        QDialogButtonBox::Ok | QDialogButtonBox::Cancel | QDialogButtonBox::RestoreDefaults, this);
    connect(buttons, &QDialogButtonBox::accepted, this, [this] {
        Apply();
        accept();
    });
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(buttons->button(QDialogButtonBox::RestoreDefaults), &QPushButton::clicked, this,
            [this] { RestoreDefaults(); });
    layout->addWidget(buttons);
    resize(460, 560);
}

bool CPreferencesDialog::ChooseUnit(long group, const QString& unitName) {
    for (const Row& r : m_rows)
        if (r.group == group) {
            const int index = r.units->findText(unitName);
            if (index < 0)
                return false;
            r.units->setCurrentIndex(index);
            return true;
        }
    return false;
}

void CPreferencesDialog::RestoreDefaults() {
    for (const Row& r : m_rows)
        r.units->setCurrentIndex(0);
}

void CPreferencesDialog::Apply() {
    QSettings settings = EditorSettings();
    for (const Row& r : m_rows) {
        const int unit = r.units->currentData().toInt();
        CUnitUtil::SetUserUnit(r.group, unit);
        // By name: unit codes are the program's, names are what the user chose.
        settings.setValue(Key(r.group), r.units->currentText());
    }
}

void CPreferencesDialog::LoadRemembered() {
    QSettings settings = EditorSettings();
    for (const QuantityInfo& q : CUnitUtil::Quantities()) {
        const QString name = settings.value(Key(q.code)).toString();
        if (name.isEmpty())
            continue;
        for (const UnitInfo& u : q.units)
            if (name == QString::fromUtf8(u.name))
                CUnitUtil::SetUserUnit(q.code, u.id);
    }
}

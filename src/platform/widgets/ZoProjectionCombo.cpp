#include "ZoProjectionCombo.h"

#include "projection/ZoMapProjection.h"

CZoProjectionCombo::CZoProjectionCombo(QWidget* parent) : QComboBox(parent) {
    for (const ProjectionEntry& e : CZoMapProjection::Entries()) {
        addItem(QString::fromStdString(e.name));
        setItemData(count() - 1, QString::fromStdString(e.description), Qt::ToolTipRole);
    }
    m_registered = count();
    setMaxVisibleItems(20);
    connect(this, &QComboBox::activated, this,
            [this](int) { emit projectionChosen(Projection()); });
}

void CZoProjectionCombo::SetProjection(const std::string& projection) {
    const QString text = QString::fromStdString(projection);
    while (count() > m_registered)
        removeItem(count() - 1);
    int index = findText(text, Qt::MatchExactly);
    if (index < 0) {
        addItem(text);
        index = count() - 1;
        setItemData(index,
                    CZoMapProjection::IsKnown(projection) ? tr("EPSG code")
                                                          : tr("Not a known projection"),
                    Qt::ToolTipRole);
    }
    setCurrentIndex(index);
}

std::string CZoProjectionCombo::Projection() const {
    return currentText().toStdString();
}

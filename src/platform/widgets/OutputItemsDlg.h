// The page of a section of selectable output items: one check box per item.
#pragma once

#include "ZoSEDlgBase.h"

class COutputItemsKiv;
class QListWidget;
class QListWidgetItem;

class COutputItemsDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit COutputItemsDlg(QWidget* parent = nullptr);
    void SetData() override;
    QListWidget* Items() const { return m_items; }

private:
    void OnItemChanged(QListWidgetItem* row);
    QListWidget* m_items;
};

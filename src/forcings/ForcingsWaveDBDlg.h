#pragma once

#include <QPointer>
#include <QWidget>

class CForcingsWaveDBAxisKiv;
class CForcingsWaveDBGrid;
class CForcingsWaveDBListKiv;
class CZoNumberEdit;
class CZoSEDlgBase;

// The wave database, a sub-form of the waves dialog: the three axes and the grid of points
// with their files.
class CForcingsWaveDBDlg : public QWidget {
    Q_OBJECT
public:
    // owner receives the update hints and holds the grid.
    CForcingsWaveDBDlg(CForcingsWaveDBListKiv* list, CZoSEDlgBase* owner,
                       QWidget* parent = nullptr);

    CForcingsWaveDBListKiv* List() const { return m_list; }
    void SetData();

    // axis 0 speed, 1 direction, 2 level.
    CZoNumberEdit* StartEdit(int axis) const { return m_edits[axis][0]; }
    CZoNumberEdit* IncrementEdit(int axis) const { return m_edits[axis][1]; }
    CZoNumberEdit* CountEdit(int axis) const { return m_edits[axis][2]; }
    CForcingsWaveDBGrid* Grid() const { return m_grid; }

private:
    CForcingsWaveDBAxisKiv* Axis(int axis) const;
    void ApplyAxes();

    CForcingsWaveDBListKiv* m_list;
    QPointer<CZoSEDlgBase> m_owner;
    CZoNumberEdit* m_edits[3][3] = {};
    CForcingsWaveDBGrid* m_grid;
};

// The "Output specification" page: kind, format, result file, flood and dry, time steps, map
// projection, interpolation, the line's number of points, the layer range and the
// coordinates of the geometry, with an import of points from an xyz file.
#pragma once

#include "widgets/ZoSEDlgBase.h"

class CMTOutputCoordGrid;
class CMTOutputItemMainKiv;
class CZoNumberEdit;
class CZoSEGridToolbar;
class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QPushButton;

class CMTOutputItemMainDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CMTOutputItemMainDlg(QWidget* parent = nullptr);
    void Initialize() override;
    void SetData() override;

    // The file last imported from, shared by every output while the program runs.
    static QString& LastImportFile();

private:
    CMTOutputItemMainKiv* Output() const;
    void FillCombos();
    void ApplyControlStates();
    void OnFieldType(int index);
    void OnFormat(int index);
    void OnInterpolation(int index);
    void OnFloodAndDry(int index);
    void OnProjection(int index);
    void OnFileTyped();
    void OnBrowse();
    void OnImport();
    QString FileFilter() const;

    QComboBox* m_type;
    QComboBox* m_format;
    QLabel* m_formatLabel;
    QLineEdit* m_file;
    QPushButton* m_browse;
    QComboBox* m_flood;
    QLabel* m_floodLabel;
    CZoNumberEdit* m_first;
    CZoNumberEdit* m_last;
    CZoNumberEdit* m_frequency;
    QGroupBox* m_geometry;
    QComboBox* m_projection;
    QComboBox* m_interpolation;
    QLabel* m_interpolationLabel;
    CZoNumberEdit* m_linePoints;
    QLabel* m_linePointsLabel;
    CZoNumberEdit* m_layerMin;
    CZoNumberEdit* m_layerMax;
    QLabel* m_layerLabel;
    QLabel* m_layerTo;
    CMTOutputCoordGrid* m_grid;
    CZoSEGridToolbar* m_toolbar;
    QPushButton* m_import;
};

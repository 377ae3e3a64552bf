#include "MTOutputItemMainDlg.h"

#include "MTOutputCoordGrid.h"
#include "MTOutputCoordListKiv.h"
#include "MTOutputItemMainKiv.h"
#include "datafile/ZoFileSelector.h"
#include "fem/DomainKiv.h"
#include "projection/ZoMapProjection.h"
#include "setupeditor/MessageTable.h"
#include "widgets/ZoNumberEdit.h"
#include "widgets/ZoPrompts.h"
#include "widgets/ZoSEGridToolbar.h"

#include <QComboBox>
#include <QFileInfo>
#include <QFormLayout>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>
#include <QVBoxLayout>

IMPLEMENT_DYNCREATE_DLG(CMTOutputItemMainDlg)

namespace {
constexpr long kCountGroup = 100370;

QString Q(const CString& s) { return QString::fromStdString(s); }

CZoNumberEdit* CountField(const char* name, QWidget* parent) {
    auto* f = new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(kCountGroup), parent);
    f->setObjectName(name);
    return f;
}

bool ThreeD(const CZoSEKivBase* node) {
    const CDomainKiv* d = Domain(node);
    return d && d->ThreeD();
}
}  // namespace

QString& CMTOutputItemMainDlg::LastImportFile() {
    static QString last;
    return last;
}

CMTOutputItemMainDlg::CMTOutputItemMainDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_type(new QComboBox(this)), m_format(new QComboBox(this)),
      m_formatLabel(new QLabel("Output format", this)), m_file(new QLineEdit(this)),
      m_browse(new QPushButton("...", this)), m_flood(new QComboBox(this)),
      m_floodLabel(new QLabel("Treatment of flood and dry", this)),
      m_first(CountField("firstTimeStep", this)), m_last(CountField("lastTimeStep", this)),
      m_frequency(CountField("timeStepFrequency", this)), m_geometry(new QGroupBox(this)),
      m_projection(new QComboBox(this)), m_interpolation(new QComboBox(this)),
      m_interpolationLabel(new QLabel("Interpolation type", this)),
      m_linePoints(CountField("pointsOnLine", this)),
      m_linePointsLabel(new QLabel("No. of points on line", this)),
      m_layerMin(CountField("layerMin", this)), m_layerMax(CountField("layerMax", this)),
      m_layerLabel(new QLabel("Layer range", this)), m_layerTo(new QLabel("to", this)),
      m_grid(new CMTOutputCoordGrid(this)), m_toolbar(new CZoSEGridToolbar(m_grid, this)),
      m_import(new QPushButton("Import from file ...", this)) {
    HelpID(5032);
    m_type->setObjectName("fieldType");
    m_format->setObjectName("outputFormat");
    m_file->setObjectName("outputFile");
    m_browse->setObjectName("browseOutputFile");
    m_flood->setObjectName("floodAndDry");
    m_floodLabel->setObjectName("floodAndDryLabel");
    m_geometry->setObjectName("geometry");
    m_projection->setObjectName("projection");
    m_interpolation->setObjectName("interpolationType");
    m_interpolationLabel->setObjectName("interpolationLabel");
    m_linePointsLabel->setObjectName("pointsOnLineLabel");
    m_layerLabel->setObjectName("layerRangeLabel");
    m_layerTo->setObjectName("layerToLabel");
    m_grid->setObjectName("coordinates");
    m_toolbar->setObjectName("coordinatesToolbar");
    m_import->setObjectName("importFromFile");
    m_file->setToolTip("The result file the simulation writes");

    auto* top = new QGridLayout;
    top->addWidget(new QLabel("Field type", this), 0, 0);
    top->addWidget(m_type, 0, 1);
    top->addWidget(m_formatLabel, 1, 0);
    top->addWidget(m_format, 1, 1);
    top->addWidget(new QLabel("Output file", this), 2, 0);
    auto* fileRow = new QHBoxLayout;
    fileRow->addWidget(m_file, 1);
    fileRow->addWidget(m_browse);
    top->addLayout(fileRow, 2, 1);
    top->addWidget(m_floodLabel, 3, 0);
    top->addWidget(m_flood, 3, 1);

    auto* steps = new QGroupBox("Time step", this);
    auto* stepRow = new QHBoxLayout(steps);
    for (auto [text, field] : {std::pair{"First", m_first}, std::pair{"Last", m_last},
                               std::pair{"Frequency", m_frequency}}) {
        stepRow->addWidget(new QLabel(text, steps));
        stepRow->addWidget(field);
    }
    stepRow->addStretch(1);

    auto* geo = new QGridLayout(m_geometry);
    geo->addWidget(new QLabel("Map projection", m_geometry), 0, 0);
    geo->addWidget(m_projection, 0, 1, 1, 3);
    geo->addWidget(m_interpolationLabel, 1, 0);
    geo->addWidget(m_interpolation, 1, 1, 1, 3);
    geo->addWidget(m_linePointsLabel, 2, 0);
    geo->addWidget(m_linePoints, 2, 1);
    geo->addWidget(m_layerLabel, 3, 0);
    geo->addWidget(m_layerMin, 3, 1);
    geo->addWidget(m_layerTo, 3, 2);
    geo->addWidget(m_layerMax, 3, 3);
    geo->addWidget(m_toolbar, 4, 0, 1, 4);
    geo->addWidget(m_grid, 5, 0, 1, 4);
    geo->addWidget(m_import, 6, 0, 1, 2, Qt::AlignLeft);
    geo->setColumnStretch(4, 1);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top);
    layout->addWidget(steps);
    layout->addWidget(m_geometry, 1);

    for (const char* t : {"Whole area", "Only wet area", "Only real wet area"})
        m_flood->addItem(t);
    m_interpolation->addItem("Discrete values");
    m_interpolation->addItem("Interpolated values");
    for (const ProjectionEntry& e : CZoMapProjection::Entries()) {
        m_projection->addItem(Q(e.name));
        m_projection->setItemData(m_projection->count() - 1, Q(e.description), Qt::ToolTipRole);
    }

    connect(m_type, &QComboBox::activated, this, &CMTOutputItemMainDlg::OnFieldType);
    connect(m_format, &QComboBox::activated, this, &CMTOutputItemMainDlg::OnFormat);
    connect(m_interpolation, &QComboBox::activated, this, &CMTOutputItemMainDlg::OnInterpolation);
    connect(m_flood, &QComboBox::activated, this, &CMTOutputItemMainDlg::OnFloodAndDry);
    connect(m_projection, &QComboBox::activated, this, &CMTOutputItemMainDlg::OnProjection);
    connect(m_file, &QLineEdit::editingFinished, this, &CMTOutputItemMainDlg::OnFileTyped);
    connect(m_browse, &QPushButton::clicked, this, &CMTOutputItemMainDlg::OnBrowse);
    connect(m_import, &QPushButton::clicked, this, &CMTOutputItemMainDlg::OnImport);
}

CMTOutputItemMainKiv* CMTOutputItemMainDlg::Output() const { return Section<CMTOutputItemMainKiv>(); }

void CMTOutputItemMainDlg::Initialize() {
    if (CMTOutputItemMainKiv* o = Output()) {
        m_grid->Initialize(this, o);
        auto bind = [this](CZoNumberEdit* field, int (CMTOutputItemMainKiv::*get)() const,
                           void (CMTOutputItemMainKiv::*set)(int)) {
            field->BindInt(
                this, [this, get] { return (Output()->*get)(); },
                [this, set](int v) { (Output()->*set)(v); });
        };
        bind(m_first, &CMTOutputItemMainKiv::FirstTimeStep, &CMTOutputItemMainKiv::FirstTimeStep);
        bind(m_last, &CMTOutputItemMainKiv::LastTimeStep, &CMTOutputItemMainKiv::LastTimeStep);
        bind(m_frequency, &CMTOutputItemMainKiv::TimeStepFrequency, &CMTOutputItemMainKiv::TimeStepFrequency);
        bind(m_linePoints, &CMTOutputItemMainKiv::NumberOfPointsOnLine,
             &CMTOutputItemMainKiv::NumberOfPointsOnLine);
        bind(m_layerMin, &CMTOutputItemMainKiv::LayerMin, &CMTOutputItemMainKiv::LayerMin);
        bind(m_layerMax, &CMTOutputItemMainKiv::LayerMax, &CMTOutputItemMainKiv::LayerMax);
        o->GeometryToCoordList(true);
    }
    CZoSEDlgBase::Initialize();
    // Widths from a sample of the rows: an output may hold a great many points.
    m_grid->FitToContents();
}

void CMTOutputItemMainDlg::FillCombos() {
    CMTOutputItemMainKiv* o = Output();
    const QSignalBlocker b1(m_type), b2(m_format);
    m_type->clear();
    m_type->addItem("2D (horizontal)", 1);
    if (ThreeD(o))
        m_type->addItem("3D", 2);
    m_type->addItem("Mass Budget", 3);
    m_type->addItem("Discharge", 4);
    const int type = o->Type();
    m_format->clear();
    m_format->addItem(type == 3 ? "Domain series" : type == 4 ? "Cross section series" : "Point series");
    m_format->addItem("Line series");
    m_format->addItem(type == 2 ? "Volume series" : "Area series");
}

QString CMTOutputItemMainDlg::FileFilter() const {
    switch (Output()->Format()) {
    case 0: return "Point Series Files (*.qrd0)";
    case 1: return "Line Series Files (*.qrd1)";
    default: return "Area Data Files (*.qrdu)";
    }
}

void CMTOutputItemMainDlg::SetData() {
    CZoSEDlgBase::SetData();
    CMTOutputItemMainKiv* o = Output();
    if (!o)
        return;
    o->CoordListToGeometry();
    FillCombos();
    if (o->Type() == 3 || o->Type() == 4)
        o->Format(0);
    {
        const QSignalBlocker b1(m_type), b2(m_format), b3(m_flood), b4(m_projection), b5(m_interpolation);
        m_type->setCurrentIndex(m_type->findData(o->Type()));
        m_format->setCurrentIndex(std::min(o->Format(), 2));
        m_flood->setCurrentIndex(o->FloodAndDry());
        int p = m_projection->findText(Q(o->CoordinateType()));
        if (p < 0) {
            m_projection->addItem(Q(o->CoordinateType()));
            p = m_projection->count() - 1;
        }
        m_projection->setCurrentIndex(p);
        m_interpolation->setCurrentIndex(o->InterpolationType() - 1);
    }
    if (m_file->text() != Q(o->FileName()))
        m_file->setText(Q(o->FileName()));
    o->GeometryToCoordList(false);
    ApplyControlStates();
}

void CMTOutputItemMainDlg::ApplyControlStates() {
    CMTOutputItemMainKiv* o = Output();
    m_geometry->setTitle(m_format->currentText());
    const bool pointSeries = o->UsesPoints();
    if (!pointSeries) {
        o->InterpolationType(o->Format() <= 1 ? 2 : 1);
        const QSignalBlocker block(m_interpolation);
        m_interpolation->setCurrentIndex(o->InterpolationType() - 1);
    }
    m_interpolation->setVisible(pointSeries);
    m_interpolationLabel->setVisible(pointSeries);
    const bool linePoints = o->Format() == 1 && o->InputFormat() == 1;
    m_linePoints->setVisible(linePoints);
    m_linePointsLabel->setVisible(linePoints);
    const bool detailed = o->Type() < 3;
    m_format->setEnabled(detailed);
    m_formatLabel->setEnabled(detailed);
    m_flood->setVisible(detailed);
    m_floodLabel->setVisible(detailed);
    const bool layers = ThreeD(o) && (o->Type() == 3 || o->Format() == 3);
    for (QWidget* w : std::initializer_list<QWidget*>{m_layerLabel, m_layerTo, m_layerMin, m_layerMax}) {
        w->setVisible(layers);
        w->setEnabled(o->Format() == 3);
    }
    m_toolbar->setVisible(!(o->Type() == 4 || o->Format() == 1));
    m_grid->UpdateHeadings();
    m_grid->Redraw();
}

void CMTOutputItemMainDlg::OnFieldType(int index) {
    CMTOutputItemMainKiv* o = Output();
    if (!o || index < 0)
        return;
    o->CoordListToGeometry();
    const int type = m_type->itemData(index).toInt();
    o->Type(type);
    if (type == 1 && o->Format() == 3)
        o->Format(2);
    else if (type == 2 && o->Format() == 2)
        o->Format(3);
    else if (type >= 3)
        o->Format(0);
    o->GeometryToCoordList(true);
    FillCombos();
    UpdateDoc(kHintValueChanged);
}

void CMTOutputItemMainDlg::OnFormat(int index) {
    CMTOutputItemMainKiv* o = Output();
    if (!o || index < 0)
        return;
    o->CoordListToGeometry();
    o->Format(index == 2 && ThreeD(o) && o->Type() == 2 ? 3 : index);
    o->GeometryToCoordList(true);
    if (index == 0)
        o->InterpolationType(2);
    ApplyControlStates();
    UpdateDoc(kHintValueChanged);
}

void CMTOutputItemMainDlg::OnInterpolation(int index) {
    if (CMTOutputItemMainKiv* o = Output(); o && index >= 0) {
        o->InterpolationType(index + 1);
        ApplyControlStates();
        UpdateDoc(kHintValueChanged);
    }
}

void CMTOutputItemMainDlg::OnFloodAndDry(int index) {
    if (CMTOutputItemMainKiv* o = Output(); o && index >= 0) {
        o->FloodAndDry(index);
        UpdateDoc(kHintValueChanged);
    }
}

void CMTOutputItemMainDlg::OnProjection(int index) {
    if (CMTOutputItemMainKiv* o = Output(); o && index >= 0) {
        o->CoordinateType(m_projection->itemText(index).toStdString());
        UpdateDoc(kHintValueChanged);
    }
}

void CMTOutputItemMainDlg::OnFileTyped() {
    CMTOutputItemMainKiv* o = Output();
    const CString text = m_file->text().trimmed().toStdString();
    if (!o || text == o->FileName())
        return;
    o->FileName(text);
    UpdateDoc(kHintValueChanged);
}

void CMTOutputItemMainDlg::OnBrowse() {
    CMTOutputItemMainKiv* o = Output();
    if (!o)
        return;
    const QString start = o->FileName().empty() ? QString() : Q(o->AbsolutePath(o->FileName()));
    const QString chosen = ZoGetSaveFileName(this, "Select Output File Name", start, FileFilter(),
                                             QString(CMTOutputItemMainKiv::ExtensionOfFormat(o->Format())).mid(1));
    if (chosen.isEmpty())
        return;
    // Kept relative to the setup where it lies beside it, as data files are.
    o->FileName(CZoFileSelector(o).StoredName(chosen.toStdString()));
    m_file->setText(Q(o->FileName()));
    UpdateDoc(kHintValueChanged);
}

void CMTOutputItemMainDlg::OnImport() {
    CMTOutputItemMainKiv* o = Output();
    if (!o)
        return;
    const QString chosen = ZoGetOpenFileName(this, "Select Input File Name", LastImportFile(),
                                             "Xyz files (*.xyz);;All Files (*)");
    if (chosen.isEmpty())
        return;
    LastImportFile() = chosen;
    o->CoordListToGeometry();
    CString error;
    if (!o->ImportXyz(chosen.toStdString(), &error)) {
        ZoShowMessage(this, Q(LoadMessage(4116)) + "\n\n" + Q(error));
        return;
    }
    o->GeometryToCoordList(true);
    UpdateDoc(kHintValueChanged);
}

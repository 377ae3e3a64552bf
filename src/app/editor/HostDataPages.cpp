#include "HostDataPages.h"

#include "HelpTopics.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "host/ModuleSelection.h"
#include "host/SetupDocument.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "hydro/HDWindForcingKiv.h"
#include "widgets/FemBase.h"
#include "widgets/ZoFileSelectorDlg.h"
#include "projection/ZoMapProjection.h"
#include "widgets/GisNavigationDlg.h"
#include "widgets/ZoProjectionCombo.h"
#include "widgets/ZoPrompts.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDateTimeEdit>
#include <QDir>
#include <QFileInfo>
#include <QDoubleValidator>
#include <QFormLayout>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QTableWidget>
#include <QVBoxLayout>

#include <climits>
#include <functional>

namespace {

QString Q(const CString& s) { return QString::fromStdString(s); }
CString S(const QString& s) { return s.toStdString(); }

QString FormatNumber(double v) { return QLocale::c().toString(v, 'g', QLocale::FloatingPointShortest); }

// A number field that stores when it is left; it shows the stored value again when the
// text is not a number.
class NumberEdit : public QLineEdit {
public:
    NumberEdit(std::function<double()> get, std::function<void(double)> set, QWidget* parent)
        : QLineEdit(parent), m_get(std::move(get)), m_set(std::move(set)) {
        auto* v = new QDoubleValidator(this);
        v->setLocale(QLocale::c());
        setValidator(v);
        setAlignment(Qt::AlignRight);
        connect(this, &QLineEdit::editingFinished, this, [this] {
            bool ok = false;
            const double value = QLocale::c().toDouble(text(), &ok);
            if (ok && value != m_get())
                m_set(value);
            else
                Show();
        });
    }
    void Show() {
        if (!hasFocus() || !isModified())
            setText(FormatNumber(m_get()));
    }

private:
    std::function<double()> m_get;
    std::function<void(double)> m_set;
};

// Common frame of the pages: a column of groups, not wider than a form needs.
class CHostPage : public CZoSEDlgBase {
public:
    explicit CHostPage(unsigned long helpId) { HelpID(helpId); }

protected:
    QVBoxLayout* Column() {
        if (!m_column) {
            m_outer = new QHBoxLayout(this);
            m_outer->setContentsMargins(0, 0, 0, 0);
            m_column = new QVBoxLayout;
            m_column->setSpacing(12);
            m_outer->addLayout(m_column, 1);
            m_outer->addStretch(0);
        }
        return m_column;
    }
    // A map beside the column takes the room the column does not need.
    void AddMap(QWidget* map) {
        Column();
        delete m_outer->takeAt(1);
        m_outer->setStretch(0, 0);
        m_outer->addWidget(map, 1);
    }
    QFormLayout* Group(const QString& title) {
        auto* box = new QGroupBox(title, this);
        auto* form = new QFormLayout(box);
        form->setFieldGrowthPolicy(QFormLayout::ExpandingFieldsGrow);
        form->setLabelAlignment(Qt::AlignLeft);
        box->setMaximumWidth(720);
        Column()->addWidget(box);
        return form;
    }
    void Finish() {
        Column()->addStretch(1);
        CZoSEDlgBase::Initialize();
    }

private:
    QHBoxLayout* m_outer = nullptr;
    QVBoxLayout* m_column = nullptr;
};

// The map of the domain inside a host page, bound to the page's node and host.
CMeshNavigationDlg* EmbedMap(CZoSEDlgBase* page) {
    auto* map = new CMeshNavigationDlg;
    map->setParent(page);
    map->setMinimumHeight(320);
    map->Attach(page->GetSection(), page->Host());
    map->Initialize();
    return map;
}

// --- modules ---------------------------------------------------------------------------

class CModulesPage : public CHostPage {
public:
    CModulesPage() : CHostPage(kHelpModules) {}
    void Initialize() override {
        QFormLayout* f = Group(tr("Modules in use"));
        m_mud = new QCheckBox(tr("Mud transport"), this);
        m_mudNote = new QLabel(this);
        m_mudNote->setStyleSheet("color: gray");
        m_waves = new QCheckBox(tr("Spectral waves"), this);
        f->addRow(m_mud);
        f->addRow(m_mudNote);
        f->addRow(m_waves);
        m_decoupled = new QCheckBox(tr("Decoupled: the flow is read from stored results"), this);
        m_decoupled->setObjectName("decoupledSimulation");
        f->addRow(m_decoupled);
        connect(m_decoupled, &QCheckBox::clicked, this, [this](bool on) {
            Node()->DecoupledSimulation(on);
            UpdateDoc(kHintValueChanged);
        });
        connect(m_mud, &QCheckBox::clicked, this, [this](bool on) {
            Node()->Mode(on ? 2 : 0);
            UpdateDoc(kHintValueChanged);
        });
        connect(m_waves, &QCheckBox::clicked, this, [this](bool on) {
            Node()->SpectralWaveMode(on ? 1 : 0);
            UpdateDoc(kHintValueChanged);
        });
        Finish();
    }
    void SetData() override {
        const QSignalBlocker b1(m_mud), b2(m_waves), b3(m_decoupled);
        const int mode = Node()->Mode();
        m_mud->setChecked(mode == 2);
        m_mudNote->setText(mode == 2 || mode == 0
                               ? QString()
                               : tr("Mode %1 is stored; the module is used with mode 2.").arg(mode));
        m_mudNote->setVisible(!m_mudNote->text().isEmpty());
        m_waves->setChecked(Node()->SpectralWaveMode() >= 1);
        m_decoupled->setChecked(Node()->DecoupledSimulation());
    }

private:
    CModuleSelection* Node() const { return Section<CModuleSelection>(); }
    QCheckBox* m_mud = nullptr;
    QLabel* m_mudNote = nullptr;
    QCheckBox* m_waves = nullptr;
    QCheckBox* m_decoupled = nullptr;
};

// --- domain ----------------------------------------------------------------------------

class CDomainPage : public CHostPage {
public:
    CDomainPage() : CHostPage(kHelpDomain) {}
    void Initialize() override {
        QFormLayout* mesh = Group(tr("Mesh"));
        m_file = new QLineEdit(this);
        m_file->setPlaceholderText(tr("No mesh"));
        auto* browse = new QPushButton(tr("Browse..."), this);
        auto* fileRow = new QHBoxLayout;
        fileRow->addWidget(m_file, 1);
        fileRow->addWidget(browse);
        mesh->addRow(tr("Mesh file"), fileRow);
        m_projection = new CZoProjectionCombo(this);
        // An "EPSG:n" code can be typed.
        m_projection->setEditable(true);
        m_projection->setInsertPolicy(QComboBox::NoInsert);
        mesh->addRow(tr("Projection"), m_projection);

        auto* extentBox = new QGroupBox(tr("Extent"), this);
        extentBox->setMaximumWidth(720);
        auto* grid = new QGridLayout(extentBox);
        grid->addWidget(new QLabel(tr("Minimum"), this), 0, 1, Qt::AlignCenter);
        grid->addWidget(new QLabel(tr("Maximum"), this), 0, 2, Qt::AlignCenter);
        const char* axes[] = {"X", "Y", "Z"};
        for (int a = 0; a < 3; ++a) {
            grid->addWidget(new QLabel(tr(axes[a]), this), a + 1, 0);
            for (int m = 0; m < 2; ++m) {
                double MeshInfo::*member = Member(a, m);
                m_extent[a][m] = new NumberEdit(
                    [this, member] { return Node()->GetMeshInfo().*member; },
                    [this, member](double v) {
                        MeshInfo info = Node()->GetMeshInfo();
                        info.*member = v;
                        Node()->SetMeshInfo(info);
                        UpdateDoc(kHintValueChanged);
                    },
                    this);
                grid->addWidget(m_extent[a][m], a + 1, m + 1);
            }
        }
        grid->setColumnStretch(1, 1);
        grid->setColumnStretch(2, 1);
        Column()->addWidget(extentBox);

        QFormLayout* vertical = Group(tr("Vertical"));
        m_threeD = new QCheckBox(tr("Three-dimensional"), this);
        vertical->addRow(m_threeD);
        m_kind = new QComboBox(this);
        m_kind->addItem(tr("Sigma layers"), 1);
        m_kind->addItem(tr("Sigma and z layers"), 2);
        vertical->addRow(tr("Layering"), m_kind);
        m_sigma = new QSpinBox(this);
        m_sigma->setRange(0, CDomainKiv::kMaxLayers);
        vertical->addRow(tr("Sigma layers"), m_sigma);
        m_z = new QSpinBox(this);
        m_z->setRange(0, CDomainKiv::kMaxLayers);
        vertical->addRow(tr("Z layers"), m_z);
        m_total = new QLabel(this);
        vertical->addRow(tr("Layers in total"), m_total);
        m_counts = new QLabel(this);
        mesh->addRow(tr("Contents"), m_counts);
        // What reading the mesh passed over, converted or did not find.
        m_notes = new QLabel(this);
        m_notes->setObjectName("meshNotes");
        m_notes->setWordWrap(true);
        m_notes->setTextInteractionFlags(Qt::TextSelectableByMouse);
        mesh->addRow(m_notes);

        connect(m_file, &QLineEdit::editingFinished, this, [this] {
            if (S(m_file->text()) != Node()->MeshFile())
                OpenMesh(m_file->text());
        });
        connect(browse, &QPushButton::clicked, this, [this] {
            const QString file = ZoGetOpenFileName(
                this, tr("Mesh file"), Q(AbsoluteFilePath(S(m_file->text()))),
                tr("Meshes (*.2dm *.nc);;SMS 2dm meshes (*.2dm);;UGRID netCDF meshes (*.nc);;All files (*)"));
            if (!file.isEmpty())
                OpenMesh(Relative(file));
        });
        auto storeProjection = [this] {
            const CString p = S(m_projection->currentText().trimmed());
            if (p == Node()->Projection())
                return;
            if (!CZoMapProjection::IsKnown(p)) {
                ZoShowMessage(this, tr("\"%1\" is not a known projection.").arg(Q(p)));
                SetData();
                return;
            }
            Node()->Projection(p);
            UpdateDoc(kHintValueChanged);
        };
        connect(m_projection, &QComboBox::activated, this, storeProjection);
        connect(m_projection->lineEdit(), &QLineEdit::editingFinished, this, storeProjection);
        connect(m_threeD, &QCheckBox::clicked, this, [this](bool on) {
            Node()->ThreeD(on);
            UpdateDoc(kHintValueChanged);
        });
        connect(m_kind, &QComboBox::activated, this, [this](int index) {
            Node()->VerticalKind(m_kind->itemData(index).toInt());
            UpdateDoc(kHintValueChanged);
        });
        connect(m_sigma, &QSpinBox::editingFinished, this, [this] {
            if (m_sigma->value() != Node()->LayerCount1()) {
                Node()->LayerCount1(m_sigma->value());
                UpdateDoc(kHintValueChanged);
            }
        });
        connect(m_z, &QSpinBox::editingFinished, this, [this] {
            if (m_z->value() != Node()->LayerCount2()) {
                Node()->LayerCount2(m_z->value());
                UpdateDoc(kHintValueChanged);
            }
        });
        m_map = EmbedMap(this);
        AddMap(m_map);
        Finish();
    }

    CMeshNavigationDlg* MapPage() const { return m_map; }

    // Reads the mesh and takes everything from it; a mesh that cannot be read changes nothing.
    bool OpenMesh(const QString& stored) {
        const CString name = S(stored.trimmed());
        if (name.empty()) {
            Node()->MeshFile(name);
            UpdateDoc(kHintValueChanged);
            return true;
        }
        std::string error;
        const int before = Node()->BoundaryNames()->GetItemCount();
        if (!Node()->LoadMesh(name, AbsoluteFilePath(name), &error)) {
            ZoShowMessage(this, Q(error));
            SetData();
            return false;
        }
        const int after = Node()->BoundaryNames()->GetItemCount();
        UpdateDoc(kHintValueChanged | (after > before ? kHintItemsAdded : 0) |
                  (after < before ? kHintItemsDeleted : 0) | kHintTitleChanged);
        return true;
    }

    void SetData() override {
        CDomainKiv* d = Node();
        const QSignalBlocker b1(m_file), b2(m_projection), b3(m_threeD), b4(m_kind), b5(m_sigma),
            b6(m_z);
        if (!m_file->hasFocus())
            m_file->setText(Q(d->MeshFile()));
        if (!m_projection->lineEdit()->hasFocus())
            m_projection->SetProjection(d->Projection());
        for (auto& axis : m_extent)
            for (NumberEdit* e : axis) {
                e->Show();
                // A mesh that was read gives the extent.
                e->setReadOnly(d->Mesh() != nullptr);
            }
        m_threeD->setChecked(d->ThreeD());
        int kindIndex = m_kind->findData(d->VerticalKind());
        if (kindIndex < 0) {
            m_kind->addItem(tr("Unknown layering %1").arg(d->VerticalKind()), d->VerticalKind());
            kindIndex = m_kind->count() - 1;
        }
        m_kind->setCurrentIndex(kindIndex);
        m_sigma->setValue(d->LayerCount1());
        m_z->setValue(d->LayerCount2());
        m_total->setText(QString::number(d->LayerTotNum()));
        m_kind->setEnabled(d->ThreeD());
        m_sigma->setEnabled(d->ThreeD());
        m_z->setEnabled(d->ThreeD() && d->VerticalKind() == 2);
        m_map->SetData();
        const MeshPtr& m = d->Mesh();
        if (m)
            m_counts->setText(tr("%1 nodes, %2 triangles, %3 quadrilaterals, %4 open boundaries")
                                  .arg(m->NodeCount())
                                  .arg(m->TriangleCount())
                                  .arg(m->QuadrilateralCount())
                                  .arg(m->boundaries.size()));
        else
            m_counts->setText(d->MeshExist() ? tr("The mesh cannot be read") : tr("No mesh"));
        QStringList notes;
        if (m)
            for (const std::string& note : m->notes)
                notes << QStringLiteral("\u2022 ") + Q(note);
        m_notes->setText(notes.isEmpty() ? QString()
                                         : tr("Read with notes:\n%1").arg(notes.join('\n')));
        m_notes->setVisible(!notes.isEmpty());
    }

private:
    static double MeshInfo::*Member(int axis, int max) {
        static double MeshInfo::*const members[3][2] = {{&MeshInfo::xMin, &MeshInfo::xMax},
                                                        {&MeshInfo::yMin, &MeshInfo::yMax},
                                                        {&MeshInfo::zMin, &MeshInfo::zMax}};
        return members[axis][max];
    }
    CDomainKiv* Node() const { return Section<CDomainKiv>(); }
    // A file inside the setup's folder is stored relative to it.
    QString Relative(const QString& file) const {
        const QString base = Q(AbsoluteFilePath("."));
        const QString rel = QDir(base).relativeFilePath(file);
        return rel.startsWith("..") || QFileInfo(rel).isAbsolute() ? file : rel;
    }
    QLineEdit* m_file = nullptr;
    QLabel* m_counts = nullptr;
    QLabel* m_notes = nullptr;
    CMeshNavigationDlg* m_map = nullptr;
    CZoProjectionCombo* m_projection = nullptr;
    NumberEdit* m_extent[3][2] = {};
    QCheckBox* m_threeD = nullptr;
    QComboBox* m_kind = nullptr;
    QSpinBox* m_sigma = nullptr;
    QSpinBox* m_z = nullptr;
    QLabel* m_total = nullptr;
};

// --- simulation period -----------------------------------------------------------------

const char* const kTimeFormat = "yyyy-MM-dd HH:mm:ss";

class CPeriodPage : public CHostPage {
public:
    CPeriodPage() : CHostPage(kHelpPeriod) {}
    void Initialize() override {
        QFormLayout* f = Group(tr("Simulation period"));
        m_start = new QDateTimeEdit(this);
        m_start->setDisplayFormat(kTimeFormat);
        m_start->setCalendarPopup(true);
        m_start->setTimeSpec(Qt::UTC);
        f->addRow(tr("Start"), m_start);
        m_startNote = new QLabel(this);
        m_startNote->setStyleSheet("color: #b00000");
        f->addRow(m_startNote);
        m_steps = new QSpinBox(this);
        m_steps->setRange(0, INT_MAX);
        f->addRow(tr("Number of time steps"), m_steps);
        m_interval = new NumberEdit([this] { return Node()->TimeStepInterval(); },
                                    [this](double v) {
                                        Node()->TimeStepInterval(v);
                                        UpdateDoc(kHintValueChanged);
                                    },
                                    this);
        m_interval->setMaximumWidth(160);
        auto* intervalRow = new QHBoxLayout;
        intervalRow->addWidget(m_interval);
        intervalRow->addWidget(new QLabel(tr("s"), this));
        intervalRow->addStretch(1);
        f->addRow(tr("Time step interval"), intervalRow);
        m_end = new QLabel(this);
        f->addRow(tr("End"), m_end);
        m_duration = new QLabel(this);
        f->addRow(tr("Duration"), m_duration);

        // Not stored: a file to hold against the period while it is edited.
        QFormLayout* d = Group(tr("Data files"));
        d->addRow(new QLabel(tr("Data files that vary in time must cover the whole period."), this));
        m_dataFile = new QLineEdit(this);
        m_dataFile->setObjectName("dataFile");
        auto* select = new QPushButton(tr("Select ..."), this);
        select->setObjectName("selectDataFile");
        m_viewDataFile = new QPushButton(tr("View ..."), this);
        m_viewDataFile->setObjectName("viewDataFile");
        auto* fileRow = new QHBoxLayout;
        fileRow->addWidget(m_dataFile, 1);
        fileRow->addWidget(select);
        fileRow->addWidget(m_viewDataFile);
        d->addRow(tr("Check a file"), fileRow);
        m_dataFileCheck = new QLabel(this);
        m_dataFileCheck->setObjectName("dataFileCheck");
        m_dataFileCheck->setWordWrap(true);
        d->addRow(m_dataFileCheck);
        connect(m_dataFile, &QLineEdit::editingFinished, this, [this] { CheckDataFile(); });
        connect(select, &QPushButton::clicked, this, [this] { SelectDataFile(); });
        connect(m_viewDataFile, &QPushButton::clicked, this, [this] {
            CFemBase::OpenDataFile(FileSelector().AbsolutePath(S(m_dataFile->text())), {}, this);
        });

        connect(m_start, &QDateTimeEdit::editingFinished, this, [this] {
            const CString text = S(m_start->dateTime().toString(kTimeFormat));
            if (text != Node()->StartTime()) {
                Node()->StartTime(text);
                UpdateDoc(kHintValueChanged);
            }
        });
        connect(m_steps, &QSpinBox::editingFinished, this, [this] {
            if (m_steps->value() != Node()->TimeStepCount()) {
                Node()->TimeStepCount(m_steps->value());
                UpdateDoc(kHintValueChanged);
            }
        });
        Finish();
    }

    void SetData() override {
        CSimulationPeriodKiv* p = Node();
        const QSignalBlocker b1(m_start), b2(m_steps);
        QDateTime start = QDateTime::fromString(Q(p->StartTime()), kTimeFormat);
        start.setTimeSpec(Qt::UTC);
        m_startNote->setVisible(!start.isValid());
        if (start.isValid())
            m_start->setDateTime(start);
        else
            m_startNote->setText(tr("The stored start \"%1\" is not a date and time.")
                                     .arg(Q(p->StartTime())));
        m_steps->setValue(p->TimeStepCount());
        m_interval->Show();
        const double seconds = p->TimeStepCount() * p->TimeStepInterval();
        const qint64 whole = static_cast<qint64>(seconds);
        m_duration->setText(tr("%1 days %2").arg(whole / 86400).arg(
            QTime(0, 0).addSecs(static_cast<int>(whole % 86400)).toString("HH:mm:ss")));
        m_end->setText(start.isValid() && seconds >= 0 && seconds < 1e11
                           ? start.addSecs(whole).toString(kTimeFormat)
                           : QString("-"));
        CheckDataFile();
    }

private:
    CSimulationPeriodKiv* Node() const { return Section<CSimulationPeriodKiv>(); }
    static constexpr const char* kDataFilter =
        "Data files (*.qrd0;*.qrd1;*.qrd2;*.qrdu;*.kx0;*.kx2)|*.qrd0;*.qrd1;*.qrd2;*.qrdu;*.kx0;"
        "*.kx2|All files (*.*)|*.*||";
    // A selector with the period's time check, relative names against the setup's folder.
    CZoFileSelector FileSelector() const {
        CZoFileSelector s(Node());
        s.SetFilter(kDataFilter);
        Node()->SetUpQrdValidation_SimulationPeriod(s);
        return s;
    }
    void CheckDataFile() {
        const CString name = S(m_dataFile->text().trimmed());
        const CZoFileSelector s = FileSelector();
        const auto header = name.empty() ? nullptr : s.Header(name);
        m_viewDataFile->setEnabled(header && header->header);
        if (name.empty()) {
            m_dataFileCheck->clear();
            return;
        }
        CString error;
        if (s.IsQrdFileValid(name, &error)) {
            m_dataFileCheck->setStyleSheet("");
            m_dataFileCheck->setText(tr("The file covers the period."));
        } else {
            m_dataFileCheck->setStyleSheet("color: #b00000");
            m_dataFileCheck->setText(Q(error));
        }
    }
    void SelectDataFile() {
        CZoFileSelectorDlg dialog(S(m_dataFile->text().trimmed()), kDataFilter, "qrd0", this);
        const CZoFileSelector s = FileSelector();
        dialog.SetBaseFolder(s.BaseFolder());
        Node()->SetUpQrdValidation_SimulationPeriod(dialog);
        if (ZoRunFileSelector(dialog) != QDialog::Accepted)
            return;
        m_dataFile->setText(Q(dialog.FileName()));
        CheckDataFile();
    }

    QLineEdit* m_dataFile = nullptr;
    QPushButton* m_viewDataFile = nullptr;
    QLabel* m_dataFileCheck = nullptr;
    QDateTimeEdit* m_start = nullptr;
    QLabel* m_startNote = nullptr;
    QSpinBox* m_steps = nullptr;
    NumberEdit* m_interval = nullptr;
    QLabel* m_end = nullptr;
    QLabel* m_duration = nullptr;
};

// --- item lists (boundaries, sources) --------------------------------------------------

// A table over a host list with the list operations as buttons. The table holds only what
// it shows; every change goes to the list and comes back through SetData.
class CListPage : public CHostPage {
public:
    CListPage(unsigned long helpId, QStringList headers) : CHostPage(helpId), m_headers(std::move(headers)) {}

    void Initialize() override {
        auto* box = new QGroupBox(GroupTitle(), this);
        box->setMaximumWidth(880);
        box->setMinimumWidth(MinimumWidth());
        auto* layout = new QHBoxLayout(box);
        m_table = new QTableWidget(this);
        m_table->setColumnCount(m_headers.size());
        m_table->setHorizontalHeaderLabels(m_headers);
        m_table->setSelectionBehavior(QAbstractItemView::SelectRows);
        m_table->setSelectionMode(QAbstractItemView::SingleSelection);
        m_table->setEditTriggers(QAbstractItemView::DoubleClicked | QAbstractItemView::EditKeyPressed |
                                 QAbstractItemView::AnyKeyPressed);
        QHeaderView* header = m_table->horizontalHeader();
        header->setSectionResizeMode(0, QHeaderView::Stretch);
        for (int c = 1; c < m_headers.size(); ++c) {
            header->setSectionResizeMode(c, QHeaderView::Interactive);
            header->resizeSection(c, ColumnWidth(c));
        }
        m_table->verticalHeader()->setDefaultSectionSize(m_table->fontMetrics().height() + 10);
        m_table->setMinimumHeight(260);
        layout->addWidget(m_table, 1);

        auto* buttons = new QVBoxLayout;
        auto add = [&](const QString& text, auto handler) {
            auto* b = new QPushButton(text, this);
            connect(b, &QPushButton::clicked, this, handler);
            buttons->addWidget(b);
            return b;
        };
        add(tr("Add"), [this] { AddItem(); });
        m_insert = add(tr("Insert"), [this] { InsertItem(); });
        m_rename = add(tr("Rename"), [this] {
            if (int r = m_table->currentRow(); r >= 0)
                m_table->editItem(m_table->item(r, 0));
        });
        m_delete = add(tr("Delete"), [this] { DeleteItem(); });
        m_up = add(tr("Move Up"), [this] { Move(-1); });
        m_down = add(tr("Move Down"), [this] { Move(+1); });
        buttons->addStretch(1);
        layout->addLayout(buttons);
        Column()->addWidget(box, 1);
        // The items on the map: a click there selects the item here, and back.
        m_map = EmbedMap(this);
        AddMap(m_map);

        connect(m_table, &QTableWidget::itemChanged, this, [this](QTableWidgetItem* item) {
            StoreCell(item->row() + 1, item->column(), item);
        });
        connect(m_table, &QTableWidget::currentCellChanged, this, [this] {
            EnableButtons();
            m_map->Map()->SelectFeature(MapOverlay(), CurrentItem());
        });
        connect(m_map, &CGisNavigationDlg::featureSelected, this, [this](int overlay, int number) {
            if (overlay == MapOverlay() && number >= 1 && number <= List()->GetItemCount())
                SelectItem(number);
        });
        CZoSEDlgBase::Initialize();
        if (List()->GetItemCount() > 0)
            SelectItem(1);
    }

    void SetData() override {
        const QSignalBlocker block(m_table);
        CZoSEKivListBaseInterface* list = List();
        const int count = list->GetItemCount();
        m_table->setRowCount(count);
        for (int r = 0; r < count; ++r)
            for (int c = 0; c < m_headers.size(); ++c) {
                QTableWidgetItem* item = m_table->item(r, c);
                if (!item) {
                    item = new QTableWidgetItem;
                    m_table->setItem(r, c, item);
                }
                FillCell(r + 1, c, item);
            }
        EnableButtons();
        m_map->SetData();
        m_map->Map()->SelectFeature(MapOverlay(), CurrentItem());
    }

    // The list operations, also for tests: positions from 1.
    int CurrentItem() const { return m_table->currentRow() + 1; }
    void SelectItem(int index) { m_table->setCurrentCell(index - 1, 0); }
    QTableWidget* Table() const { return m_table; }
    CMeshNavigationDlg* MapPage() const { return m_map; }

    void AddItem() {
        CZoSEKivBase* item = AppendToList();
        Named(item);
        UpdateDoc(kHintItemsAdded);
        SelectItem(List()->GetItemCount());
    }
    void InsertItem() {
        const int at = CurrentItem();
        if (at < 1)
            return AddItem();
        List()->Insert(at, 1);
        Named(List()->GetItemNode(at));
        UpdateDoc(kHintItemsAdded);
        SelectItem(at);
    }
    void DeleteItem() {
        const int at = CurrentItem();
        if (at < 1)
            return;
        List()->Delete(at, 1);
        UpdateDoc(kHintItemsDeleted);
        if (List()->GetItemCount() > 0)
            SelectItem(std::min(at, List()->GetItemCount()));
    }
    void Move(int direction) {
        const int at = CurrentItem();
        const bool moved = direction < 0 ? List()->MoveUp(at, 1) : List()->MoveDown(at, 1);
        if (!moved)
            return;
        UpdateDoc(kHintItemsReordered);
        SelectItem(at + direction);
    }

protected:
    virtual QString GroupTitle() const = 0;
    virtual int ColumnWidth(int column) const = 0;
    virtual CZoSEKivListBaseInterface* List() const = 0;
    virtual CZoSEKivBase* AppendToList() = 0;
    virtual QString BaseName() const = 0;
    virtual void FillCell(int index, int column, QTableWidgetItem* item) = 0;
    virtual void StoreCell(int index, int column, QTableWidgetItem* item) = 0;
    // The map layer that shows the items.
    virtual int MapOverlay() const = 0;
    virtual int MinimumWidth() const { return 360; }

    // Stores a new name; an empty one is refused (the name is what the other modules show).
    bool Rename(CZoSEKivBase* node, const QString& text) {
        const CString name = S(text.trimmed());
        if (name.empty() || name == node->GetTitle())
            return false;
        node->SetTitle(name);
        UpdateDoc(kHintTitleChanged);
        return true;
    }

private:
    // A new item gets the first "<base> N" that no other item has.
    void Named(CZoSEKivBase* item) {
        if (!item)
            return;
        QSet<QString> taken;
        for (int i = 1; i <= List()->GetItemCount(); ++i)
            if (List()->GetItemNode(i) != item)
                taken.insert(Q(List()->GetItemNode(i)->GetTitle()));
        for (int n = List()->GetItemCount();; ++n) {
            const QString name = QStringLiteral("%1 %2").arg(BaseName()).arg(n);
            if (!taken.contains(name)) {
                item->SetTitle(S(name));
                return;
            }
        }
    }
    void EnableButtons() {
        const int at = CurrentItem();
        const int count = List()->GetItemCount();
        m_insert->setEnabled(at >= 1);
        m_rename->setEnabled(at >= 1);
        m_delete->setEnabled(at >= 1);
        m_up->setEnabled(at > 1);
        m_down->setEnabled(at >= 1 && at < count);
    }

    QStringList m_headers;
    QTableWidget* m_table = nullptr;
    CMeshNavigationDlg* m_map = nullptr;
    QPushButton* m_insert = nullptr;
    QPushButton* m_rename = nullptr;
    QPushButton* m_delete = nullptr;
    QPushButton* m_up = nullptr;
    QPushButton* m_down = nullptr;
};

class CBoundariesPage : public CListPage {
public:
    CBoundariesPage() : CListPage(kHelpBoundaries, {tr("Name"), tr("Code")}) {}

protected:
    QString GroupTitle() const override { return tr("Open boundaries of the mesh"); }
    int ColumnWidth(int) const override { return 80; }
    CZoSEKivListBaseInterface* List() const override { return Section<CBoundaryNamesKiv>(); }
    CZoSEKivBase* AppendToList() override { return Section<CBoundaryNamesKiv>()->Append(); }
    QString BaseName() const override { return tr("Boundary"); }
    int MapOverlay() const override { return MapPage()->BoundaryOverlay(); }
    void FillCell(int index, int column, QTableWidgetItem* item) override {
        const CBoundaryNameKiv* b = Section<CBoundaryNamesKiv>()->GetItem(index);
        if (column == 0) {
            item->setText(Q(b->Identifier()));
        } else {
            item->setText(QString::number(b->BoundaryCode()));
            item->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
        }
    }
    void StoreCell(int index, int column, QTableWidgetItem* item) override {
        CBoundaryNameKiv* b = Section<CBoundaryNamesKiv>()->GetItem(index);
        if (!b)
            return;
        if (column == 0) {
            if (!Rename(b, item->text()))
                SetData();
            return;
        }
        bool ok = false;
        const int code = item->text().trimmed().toInt(&ok);
        if (ok && code != b->BoundaryCode()) {
            b->BoundaryCode(code);
            UpdateDoc(kHintValueChanged);
        } else {
            SetData();
        }
    }
};

class CSourcesPage : public CListPage {
public:
    CSourcesPage() : CListPage(kHelpSources, {tr("Name"), tr("Included"), tr("X"), tr("Y")}) {}

protected:
    QString GroupTitle() const override { return tr("Point sources of the flow model"); }
    int ColumnWidth(int column) const override { return column == 1 ? 80 : 130; }
    CZoSEKivListBaseInterface* List() const override { return Section<CHDSourcesKiv>(); }
    CZoSEKivBase* AppendToList() override { return Section<CHDSourcesKiv>()->Append(); }
    QString BaseName() const override { return tr("Source"); }
    int MapOverlay() const override { return MapPage()->SourceOverlay(); }
    int MinimumWidth() const override { return 560; }
    void FillCell(int index, int column, QTableWidgetItem* item) override {
        const CHDSourceItemKiv* s = Section<CHDSourcesKiv>()->GetItem(index);
        switch (column) {
        case 0:
            item->setText(Q(s->Name()));
            break;
        case 1:
            item->setFlags((item->flags() | Qt::ItemIsUserCheckable) & ~Qt::ItemIsEditable);
            item->setCheckState(s->Include() ? Qt::Checked : Qt::Unchecked);
            break;
        default:
            item->setText(FormatNumber(column == 2 ? s->X() : s->Y()));
            item->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
        }
    }
    void StoreCell(int index, int column, QTableWidgetItem* item) override {
        CHDSourceItemKiv* s = Section<CHDSourcesKiv>()->GetItem(index);
        if (!s)
            return;
        if (column == 0) {
            if (!Rename(s, item->text()))
                SetData();
            return;
        }
        if (column == 1) {
            const bool on = item->checkState() == Qt::Checked;
            if (on != (s->Include() != 0)) {
                s->Include(on);
                UpdateDoc(kHintValueChanged);
            }
            return;
        }
        bool ok = false;
        const double v = QLocale::c().toDouble(item->text().trimmed(), &ok);
        if (!ok) {
            SetData();
            return;
        }
        if (column == 2)
            s->X(v);
        else
            s->Y(v);
        UpdateDoc(kHintValueChanged);
    }
};

// --- density and wind ------------------------------------------------------------------

// A choice among fixed texts; a stored value outside them is shown as such.
void FillChoice(QComboBox* box, const std::vector<CString>& texts, int value, const QString& unknown) {
    const QSignalBlocker block(box);
    box->clear();
    for (size_t i = 0; i < texts.size(); ++i)
        box->addItem(Q(texts[i]), static_cast<int>(i));
    if (value < 0 || value >= static_cast<int>(texts.size()))
        box->addItem(unknown.arg(value), value);
    box->setCurrentIndex(box->findData(value));
}

class CDensityPage : public CHostPage {
public:
    CDensityPage() : CHostPage(kHelpDensity) {}
    void Initialize() override {
        QFormLayout* f = Group(tr("Density of the water"));
        m_mode = new QComboBox(this);
        f->addRow(tr("Density"), m_mode);
        connect(m_mode, &QComboBox::activated, this, [this](int index) {
            Section<CHDDensityKiv>()->DensityMode(m_mode->itemData(index).toInt());
            UpdateDoc(kHintValueChanged);
        });
        Finish();
    }
    void SetData() override {
        FillChoice(m_mode, CHDDensityKiv::DensityModeTexts(), Section<CHDDensityKiv>()->DensityMode(),
                   tr("Unknown mode %1"));
    }

private:
    QComboBox* m_mode = nullptr;
};

class CWindPage : public CHostPage {
public:
    CWindPage() : CHostPage(kHelpWind) {}
    void Initialize() override {
        QFormLayout* f = Group(tr("Wind forcing"));
        m_include = new QCheckBox(tr("Include wind forcing"), this);
        f->addRow(m_include);
        m_type = new QComboBox(this);
        f->addRow(tr("Wind type"), m_type);
        connect(m_include, &QCheckBox::clicked, this, [this](bool on) {
            Section<CHDWindForcingKiv>()->Include(on);
            UpdateDoc(kHintValueChanged);
        });
        connect(m_type, &QComboBox::activated, this, [this](int index) {
            Section<CHDWindForcingKiv>()->WindType(m_type->itemData(index).toInt());
            UpdateDoc(kHintValueChanged);
        });
        Finish();
    }
    void SetData() override {
        const CHDWindForcingKiv* w = Section<CHDWindForcingKiv>();
        const QSignalBlocker block(m_include);
        m_include->setChecked(w->Include() != 0);
        FillChoice(m_type, CHDWindForcingKiv::WindTypeTexts(), w->WindType(), tr("Unknown type %1"));
        m_type->setEnabled(w->Include() != 0);
    }

private:
    QCheckBox* m_include = nullptr;
    QComboBox* m_type = nullptr;
};

}  // namespace

CZoSEDlgBase* CreateHostDataPage(CZoSEKivBase* node, const CSetupDocument& doc) {
    if (node == doc.GetModuleSelection())
        return new CModulesPage;
    if (node == doc.GetDomain())
        return new CDomainPage;
    if (node == doc.GetBoundaryNames())
        return new CBoundariesPage;
    if (node == doc.GetPeriod())
        return new CPeriodPage;
    if (node == doc.GetSources())
        return new CSourcesPage;
    if (node == doc.GetDensity())
        return new CDensityPage;
    if (node == doc.GetWind())
        return new CWindPage;
    return nullptr;
}

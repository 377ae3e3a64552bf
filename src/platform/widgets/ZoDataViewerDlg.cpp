#include "ZoDataViewerDlg.h"

#include "FemBase.h"
#include "ZoSEDlgBase.h"
#include "fem/UnitUtil.h"

#include <QAbstractTableModel>
#include <QCheckBox>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QMouseEvent>
#include <QPushButton>
#include <QSlider>
#include <QWheelEvent>
#include <QPainter>
#include <QPainterPath>
#include <QPlainTextEdit>
#include <QSpinBox>
#include <QTabWidget>
#include <QTableView>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

namespace {

QString Q(const std::string& s) { return QString::fromStdString(s); }

QString Number(double v) {
    if (std::isnan(v))
        return QString();
    return QLocale::c().toString(v, 'g', QLocale::FloatingPointShortest);
}

// Items shown when the caller names none: enough for a readable plot.
constexpr int kDefaultItems = 8;

const QColor kColours[] = {QColor(0x1f, 0x77, 0xb4), QColor(0xd6, 0x27, 0x28), QColor(0x2c, 0xa0, 0x2c),
                           QColor(0xff, 0x7f, 0x0e), QColor(0x94, 0x67, 0xbd), QColor(0x8c, 0x56, 0x4b),
                           QColor(0xe3, 0x77, 0xc2), QColor(0x7f, 0x7f, 0x7f)};

// A step of 1, 2 or 5 times a power of ten that cuts range into about n parts.
double NiceStep(double range, int n) {
    const double raw = range / n;
    const double p = std::pow(10.0, std::floor(std::log10(raw)));
    for (double m : {1.0, 2.0, 5.0})
        if (raw <= m * p)
            return m * p;
    return 10 * p;
}

}  // namespace

// The table: a time column and one column per item.
class CZoSeriesModel : public QAbstractTableModel {
public:
    using QAbstractTableModel::QAbstractTableModel;
    void Set(std::vector<double> times, QStringList headers, std::vector<std::vector<double>> rows) {
        beginResetModel();
        m_times = std::move(times);
        m_headers = std::move(headers);
        m_rows = std::move(rows);
        endResetModel();
    }
    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(m_rows.size());
    }
    int columnCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(m_headers.size()) + 1;
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (role == Qt::TextAlignmentRole)
            return index.column() == 0 ? QVariant() : QVariant(Qt::AlignRight | Qt::AlignVCenter);
        if (role != Qt::DisplayRole)
            return {};
        const std::size_t r = static_cast<std::size_t>(index.row());
        if (index.column() == 0)
            return Q(datafile::FormatDateTime(static_cast<std::int64_t>(std::floor(m_times[r]))));
        return Number(m_rows[r][static_cast<std::size_t>(index.column() - 1)]);
    }
    QVariant headerData(int section, Qt::Orientation o, int role) const override {
        if (role != Qt::DisplayRole)
            return {};
        if (o == Qt::Vertical)
            return section + 1;
        return section == 0 ? QString("Time") : m_headers.value(section - 1);
    }

private:
    std::vector<double> m_times;
    QStringList m_headers;
    std::vector<std::vector<double>> m_rows;
};

CZoLinePlot::CZoLinePlot(QWidget* parent) : QWidget(parent) {
    setMinimumSize(240, 160);
    setBackgroundRole(QPalette::Base);
    setAutoFillBackground(true);
    setCursor(Qt::OpenHandCursor);
}

void CZoLinePlot::SetData(std::vector<double> times, std::vector<Series> series) {
    m_times = std::move(times);
    m_series = std::move(series);
    m_view0 = FullStart();
    m_view1 = FullEnd();
    update();
}

double CZoLinePlot::FullStart() const { return m_times.empty() ? 0 : m_times.front(); }
double CZoLinePlot::FullEnd() const {
    return m_times.size() > 1 ? m_times.back() : FullStart() + 1;
}

void CZoLinePlot::SetSeriesVisible(int k, bool visible) {
    if (k < 0 || k >= SeriesCount())
        return;
    m_series[static_cast<std::size_t>(k)].visible = visible;
    update();
}

bool CZoLinePlot::SeriesVisible(int k) const {
    return k >= 0 && k < SeriesCount() && m_series[static_cast<std::size_t>(k)].visible;
}

QStringList CZoLinePlot::Axes() const {
    QStringList axes;
    for (const Series& s : m_series)
        if (s.visible && !axes.contains(s.quantity))
            axes << s.quantity;
    return axes;
}

void CZoLinePlot::SetView(double t0, double t1) {
    const double full0 = FullStart(), full1 = FullEnd();
    const double fullSpan = full1 - full0;
    // Not narrower than a second nor wider than the data, and kept over the data.
    double span = std::clamp(t1 - t0, std::min(1.0, fullSpan), fullSpan);
    t0 = std::clamp(t0, full0, full1 - span);
    if (t0 == m_view0 && t0 + span == m_view1)
        return;
    m_view0 = t0;
    m_view1 = t0 + span;
    update();
    emit ViewChanged();
}

void CZoLinePlot::Zoom(double factor, double at) {
    if (!(factor > 0) || !std::isfinite(at))
        return;
    SetView(at - (at - m_view0) * factor, at + (m_view1 - at) * factor);
}

void CZoLinePlot::Pan(double seconds) { SetView(m_view0 + seconds, m_view1 + seconds); }

void CZoLinePlot::ResetView() { SetView(FullStart(), FullEnd()); }

double CZoLinePlot::TimeAt(double x) const {
    const double w = std::max(1, m_right - m_left);
    return m_view0 + (x - m_left) / w * (m_view1 - m_view0);
}

void CZoLinePlot::wheelEvent(QWheelEvent* event) {
    const int delta = event->angleDelta().y();
    if (delta == 0)
        return;
    Zoom(std::pow(0.8, delta / 120.0), TimeAt(event->position().x()));
    event->accept();
}

void CZoLinePlot::mousePressEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton) {
        m_dragX = event->position().x();
        setCursor(Qt::ClosedHandCursor);
    }
}

void CZoLinePlot::mouseMoveEvent(QMouseEvent* event) {
    if (!m_dragX)
        return;
    const double x = event->position().x();
    Pan(TimeAt(*m_dragX) - TimeAt(x));
    m_dragX = x;
}

void CZoLinePlot::mouseReleaseEvent(QMouseEvent*) {
    m_dragX.reset();
    setCursor(Qt::OpenHandCursor);
}

void CZoLinePlot::paintEvent(QPaintEvent*) {
    QPainter p(this);
    p.setRenderHint(QPainter::Antialiasing);
    const QFontMetrics fm(font());
    const QStringList axes = Axes();
    if (m_times.empty() || axes.isEmpty()) {
        p.drawText(rect(), Qt::AlignCenter, tr("No values to show"));
        return;
    }
    const double t0 = m_view0, t1 = m_view1;
    struct Panel {
        double lo = 0, hi = 0, step = 1;
        bool any = false;
        QStringList labels;
    };
    std::vector<Panel> panels(static_cast<std::size_t>(axes.size()));
    for (const Series& s : m_series) {
        if (!s.visible)
            continue;
        Panel& pn = panels[static_cast<std::size_t>(axes.indexOf(s.quantity))];
        const std::size_t n = std::min(s.values.size(), m_times.size());
        for (std::size_t i = 0; i < n; ++i) {
            const double v = s.values[i];
            if (!std::isfinite(v) || m_times[i] < t0 || m_times[i] > t1)
                continue;
            pn.lo = pn.any ? std::min(pn.lo, v) : v;
            pn.hi = pn.any ? std::max(pn.hi, v) : v;
            pn.any = true;
        }
    }
    int labelWidth = 0;
    for (Panel& pn : panels) {
        if (!pn.any) {
            pn.lo = 0;
            pn.hi = 1;
        }
        if (pn.hi - pn.lo < 1e-300) {
            const double pad = std::max(std::fabs(pn.lo) * 0.1, 1.0);
            pn.lo -= pad;
            pn.hi += pad;
        }
        pn.step = NiceStep(pn.hi - pn.lo, 4);
        pn.lo = std::floor(pn.lo / pn.step) * pn.step;
        pn.hi = std::ceil(pn.hi / pn.step) * pn.step;
        for (double y = pn.lo; y <= pn.hi + pn.step / 2; y += pn.step) {
            pn.labels << Number(std::fabs(y) < pn.step * 1e-9 ? 0 : y);
            labelWidth = std::max(labelWidth, fm.horizontalAdvance(pn.labels.back()));
        }
    }
    const int legendHeight = fm.height() + 6;
    const int top = legendHeight + 6;
    const int bottom = height() - 2 * fm.height() - 12;
    const int gap = fm.height() + 10;  // room for each panel's quantity
    const int panelCount = static_cast<int>(panels.size());
    const int panelHeight = (bottom - top - gap * panelCount) / panelCount;
    m_left = labelWidth + 12;
    m_right = width() - 12;
    if (m_right - m_left < 20 || panelHeight < 20)
        return;
    auto X = [&](double t) { return m_left + (t - t0) / (t1 - t0) * (m_right - m_left); };
    const QColor grid = palette().color(QPalette::Mid);
    const QColor text = palette().color(QPalette::Text);
    const int xTicks = std::max(1, std::min(5, (m_right - m_left) / (fm.horizontalAdvance("0000-00-00") + 20)));

    std::vector<QRect> areas;
    for (int a = 0; a < panelCount; ++a) {
        const Panel& pn = panels[static_cast<std::size_t>(a)];
        const QRect area(m_left, top + a * (panelHeight + gap) + gap, m_right - m_left, panelHeight);
        areas.push_back(area);
        p.setPen(text);
        p.drawText(QRect(area.left(), area.top() - gap, area.width(), gap - 2), Qt::AlignLeft | Qt::AlignBottom,
                   axes[a]);
        int i = 0;
        for (double y = pn.lo; y <= pn.hi + pn.step / 2; y += pn.step, ++i) {
            const int py = static_cast<int>(std::lround(area.bottom() - (y - pn.lo) / (pn.hi - pn.lo) * area.height()));
            p.setPen(QPen(grid, 0, Qt::DotLine));
            p.drawLine(area.left(), py, area.right(), py);
            p.setPen(text);
            p.drawText(QRect(0, py - fm.height() / 2, labelWidth + 6, fm.height()), Qt::AlignRight | Qt::AlignVCenter,
                       pn.labels.value(i));
        }
        for (int k = 0; k <= xTicks; ++k) {
            const int px = static_cast<int>(std::lround(X(t0 + (t1 - t0) * k / xTicks)));
            p.setPen(QPen(grid, 0, Qt::DotLine));
            p.drawLine(px, area.top(), px, area.bottom());
        }
        p.setPen(text);
        p.drawRect(area);
    }
    // Times under the lowest panel only.
    const int below = areas.back().bottom() + 4;
    p.setPen(text);
    for (int k = 0; k <= xTicks; ++k) {
        const double t = t0 + (t1 - t0) * k / xTicks;
        const int px = static_cast<int>(std::lround(X(t)));
        const QStringList parts = Q(datafile::FormatDateTime(static_cast<std::int64_t>(std::floor(t)))).split(' ');
        const int w = fm.horizontalAdvance(parts.value(0)) + 4;
        const int left = std::clamp(px - w / 2, 0, std::max(0, width() - w));
        p.drawText(QRect(left, below, w, fm.height()), Qt::AlignCenter, parts.value(0));
        p.drawText(QRect(left, below + fm.height(), w, fm.height()), Qt::AlignCenter, parts.value(1).left(5));
    }

    int legendX = m_left;
    for (std::size_t k = 0; k < m_series.size(); ++k) {
        const Series& s = m_series[k];
        if (!s.visible)
            continue;
        const int a = static_cast<int>(axes.indexOf(s.quantity));
        const Panel& pn = panels[static_cast<std::size_t>(a)];
        const QRect& area = areas[static_cast<std::size_t>(a)];
        auto Y = [&](double v) { return area.bottom() - (v - pn.lo) / (pn.hi - pn.lo) * area.height(); };
        const QColor colour = kColours[k % std::size(kColours)];
        QPainterPath path;
        bool open = false;
        const std::size_t n = std::min(s.values.size(), m_times.size());
        for (std::size_t i = 0; i < n; ++i) {
            const double v = s.values[i];
            if (!std::isfinite(v)) {
                open = false;
                continue;
            }
            const QPointF pt(X(m_times[i]), Y(v));
            if (open)
                path.lineTo(pt);
            else
                path.moveTo(pt);
            open = true;
        }
        p.setPen(QPen(colour, 1.5));
        p.setClipRect(area.adjusted(-1, -1, 1, 1));
        p.drawPath(path);
        if (n == 1 && std::isfinite(s.values[0]))
            p.drawEllipse(QPointF(X(m_times[0]), Y(s.values[0])), 2.5, 2.5);
        p.setClipping(false);
        p.drawLine(legendX, 3 + fm.height() / 2, legendX + 16, 3 + fm.height() / 2);
        p.setPen(text);
        p.drawText(legendX + 20, 3 + fm.ascent(), s.name);
        legendX += 32 + fm.horizontalAdvance(s.name);
    }
}

CZoFieldView::CZoFieldView(QWidget* parent) : QWidget(parent) {
    setMinimumSize(240, 160);
    setBackgroundRole(QPalette::Base);
    setAutoFillBackground(true);
}

void CZoFieldView::SetField(std::vector<double> values, std::int64_t columns, std::int64_t rows, QString title) {
    m_values = std::move(values);
    m_columns = std::max<std::int64_t>(columns, 1);
    m_rows = std::max<std::int64_t>(rows, 1);
    m_title = std::move(title);
    bool any = false;
    for (double v : m_values)
        if (std::isfinite(v)) {
            m_lo = any ? std::min(m_lo, v) : v;
            m_hi = any ? std::max(m_hi, v) : v;
            any = true;
        }
    if (!any)
        m_lo = m_hi = 0;
    update();
}

QColor CZoFieldView::ColourOf(double v) const {
    if (!std::isfinite(v))
        return palette().color(QPalette::Base);
    const double f = m_hi > m_lo ? std::clamp((v - m_lo) / (m_hi - m_lo), 0.0, 1.0) : 0.5;
    // Blue through green to red: low to high.
    return QColor::fromHsvF(static_cast<float>((1 - f) * 240.0 / 360.0), 0.85f, 0.95f);
}

QStringList CZoFieldView::LegendLabels() const {
    QStringList labels;
    if (m_values.empty())
        return labels;
    constexpr int kSteps = 5;
    for (int i = 0; i <= kSteps; ++i)
        labels << QLocale::c().toString(m_lo + (m_hi - m_lo) * i / kSteps, 'g', 4);
    labels.removeDuplicates();
    return labels;
}

void CZoFieldView::paintEvent(QPaintEvent*) {
    QPainter p(this);
    const QFontMetrics fm(font());
    if (m_values.empty()) {
        p.drawText(rect(), Qt::AlignCenter, tr("No values to show"));
        return;
    }
    const QStringList labels = LegendLabels();
    int labelWidth = 0;
    for (const QString& l : labels)
        labelWidth = std::max(labelWidth, fm.horizontalAdvance(l));
    const int legendWidth = 20 + 6 + labelWidth + 8;
    const int top = fm.height() + 8;
    const QRect room(8, top, width() - legendWidth - 24, height() - top - 8);
    if (room.width() < 20 || room.height() < 20)
        return;
    p.setPen(palette().color(QPalette::Text));
    p.drawText(QRect(8, 2, width() - 16, fm.height() + 4), Qt::AlignLeft | Qt::AlignVCenter, m_title);
    // Square cells; row 1 at the bottom as on a map.
    const double cell = std::min(static_cast<double>(room.width()) / static_cast<double>(m_columns),
                                 static_cast<double>(room.height()) / static_cast<double>(m_rows));
    const QRectF field(room.left(), room.top(), cell * static_cast<double>(m_columns),
                       cell * static_cast<double>(m_rows));
    const bool edges = cell >= 6;
    p.setPen(edges ? QPen(palette().color(QPalette::Mid), 0) : QPen(Qt::NoPen));
    for (std::size_t i = 0; i < m_values.size(); ++i) {
        const auto c = static_cast<std::int64_t>(i) % m_columns;
        const auto r = static_cast<std::int64_t>(i) / m_columns;
        if (r >= m_rows)
            break;
        p.setBrush(ColourOf(m_values[i]));
        p.drawRect(QRectF(field.left() + cell * static_cast<double>(c),
                          field.bottom() - cell * static_cast<double>(r + 1), cell, cell));
    }
    p.setBrush(Qt::NoBrush);
    p.setPen(palette().color(QPalette::Text));
    p.drawRect(field);

    // The legend: a colour bar from the lowest value (bottom) to the highest.
    const QRect bar(width() - legendWidth - 8, top + fm.height() / 2, 20,
                    std::min(room.height() - fm.height(), 240));
    for (int y = 0; y < bar.height(); ++y) {
        const double f = 1.0 - static_cast<double>(y) / std::max(1, bar.height() - 1);
        p.setPen(ColourOf(m_lo + (m_hi - m_lo) * f));
        p.drawLine(bar.left(), bar.top() + y, bar.right(), bar.top() + y);
    }
    p.setPen(palette().color(QPalette::Text));
    p.drawRect(bar);
    for (int i = 0; i < labels.size(); ++i) {
        const int y = labels.size() == 1 ? bar.center().y()
                                         : bar.bottom() - bar.height() * i / static_cast<int>(labels.size() - 1);
        p.drawText(QRect(bar.right() + 6, y - fm.height() / 2, labelWidth + 4, fm.height()),
                   Qt::AlignLeft | Qt::AlignVCenter, labels[i]);
    }
}

CZoDataViewerDlg::CZoDataViewerDlg(const CString& path, const std::vector<int>& items, QWidget* parent)
    : QDialog(parent), m_path(path), m_items(items) {
    setWindowTitle(tr("Data file - %1").arg(Q(path)));
    auto* layout = new QVBoxLayout(this);
    m_headerText = new QPlainTextEdit(this);
    m_headerText->setObjectName("header");
    m_headerText->setReadOnly(true);
    m_headerText->setMaximumHeight(150);
    layout->addWidget(m_headerText);

    auto* pointRow = new QHBoxLayout;
    m_pointLabel = new QLabel(tr("Point"), this);
    m_point = new QSpinBox(this);
    m_point->setObjectName("point");
    pointRow->addWidget(m_pointLabel);
    pointRow->addWidget(m_point);
    pointRow->addStretch(1);
    layout->addLayout(pointRow);

    m_tabs = new QTabWidget(this);
    m_table = new QTableView(m_tabs);
    m_table->setObjectName("table");
    m_model = new CZoSeriesModel(m_table);
    m_table->setModel(m_model);
    m_table->horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    auto* plotPage = new QWidget(m_tabs);
    auto* plotLayout = new QVBoxLayout(plotPage);
    m_checkRow = new QHBoxLayout;
    plotLayout->addLayout(m_checkRow);
    m_plot = new CZoLinePlot(plotPage);
    m_plot->setObjectName("plot");
    m_plot->setToolTip(tr("Wheel: zoom the time axis; drag: move along it"));
    plotLayout->addWidget(m_plot, 1);
    m_tabs->addTab(plotPage, tr("Plot"));
    m_tabs->addTab(m_table, tr("Table"));
    layout->addWidget(m_tabs, 1);

    m_status = new QLabel(this);
    m_status->setObjectName("status");
    m_status->setWordWrap(true);
    layout->addWidget(m_status);
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Close, this);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    layout->addWidget(buttons);
    resize(720, 560);

    datafile::HeaderResult r = datafile::ReadHeader(path);
    if (r.error) {
        m_headerText->setPlainText(Q(r.error->ToString()));
        m_status->setText(Q(r.error->ToString()));
        m_point->setEnabled(false);
        m_pointLabel->setVisible(false);
        m_point->setVisible(false);
        return;
    }
    m_header = std::move(r.header);
    const datafile::Header& h = *m_header;
    const int held = static_cast<int>(h.items.size());
    std::vector<int> shown;
    for (int n : m_items)
        if (n >= 1 && n <= held && std::find(shown.begin(), shown.end(), n) == shown.end())
            shown.push_back(n);
    if (shown.empty())
        for (int n = 1; n <= std::min(held, kDefaultItems); ++n)
            shown.push_back(n);
    m_items = shown;

    QString text = tr("File: %1\nKind: %2 (%3)\n").arg(Q(path), Q(datafile::KindName(h.kind)), Q(h.kindWord));
    if (!h.title.empty())
        text += tr("Title: %1\n").arg(Q(h.title));
    text += tr("Time: %1\n").arg(Q(datafile::DescribeTimeAxis(h.time)));
    text += tr("Values: %1\n").arg(Q(datafile::DescribeLayout(h)));
    text += tr("Items:");
    for (int i = 0; i < held; ++i) {
        const datafile::Item& it = h.items[static_cast<std::size_t>(i)];
        const bool on = std::find(m_items.begin(), m_items.end(), i + 1) != m_items.end();
        text += QString("\n %1 %2  %3  %4  [%5]")
                    .arg(on ? "*" : " ")
                    .arg(i + 1, 3)
                    .arg(Q(it.name), Q(datafile::DescribeUnitType(it.unitType)), Q(it.unit));
    }
    m_headerText->setPlainText(text);

    for (std::size_t k = 0; k < m_items.size(); ++k) {
        const datafile::Item& it = h.items[static_cast<std::size_t>(m_items[k] - 1)];
        auto* check = new QCheckBox(Q(it.name), this);
        check->setObjectName(QString("item%1").arg(m_items[k]));
        check->setChecked(true);
        connect(check, &QCheckBox::toggled, this,
                [this, k](bool on) { m_plot->SetSeriesVisible(static_cast<int>(k), on); });
        m_checkRow->addWidget(check);
        m_checks.push_back(check);
    }
    m_checkRow->addStretch(1);
    m_reset = new QPushButton(tr("Whole Period"), this);
    m_reset->setObjectName("resetView");
    m_reset->setEnabled(false);
    connect(m_reset, &QPushButton::clicked, m_plot, &CZoLinePlot::ResetView);
    connect(m_plot, &CZoLinePlot::ViewChanged, this, [this] {
        m_reset->setEnabled(m_plot->ViewStart() > m_times0 || m_plot->ViewEnd() < m_times1);
    });
    m_checkRow->addWidget(m_reset);

    const bool spatial = h.kind != datafile::Kind::TimeSeries;
    m_pointLabel->setVisible(spatial);
    m_point->setVisible(spatial);
    m_pointLabel->setText(h.kind == datafile::Kind::Grid       ? tr("Cell")
                          : h.kind == datafile::Kind::MeshData ? (h.location == datafile::MeshLocation::Nodes ? tr("Node") : tr("Element"))
                                                               : tr("Point"));
    const std::int64_t perStep = h.ValuesPerStep();
    m_point->setRange(1, static_cast<int>(std::min<std::int64_t>(perStep, INT32_MAX)));
    m_point->setValue(1);
    connect(m_point, &QSpinBox::valueChanged, this, [this] { Load(); });
    Load();

    if (h.kind == datafile::Kind::Grid || h.kind == datafile::Kind::MeshData) {
        auto* page = new QWidget(m_tabs);
        auto* pageLayout = new QVBoxLayout(page);
        auto* row = new QHBoxLayout;
        m_fieldItem = new QComboBox(page);
        m_fieldItem->setObjectName("fieldItem");
        for (int n : m_items)
            m_fieldItem->addItem(Q(h.items[static_cast<std::size_t>(n - 1)].name), n);
        row->addWidget(new QLabel(tr("Item"), page));
        row->addWidget(m_fieldItem);
        row->addWidget(new QLabel(tr("Time step"), page));
        m_stepSlider = new QSlider(Qt::Horizontal, page);
        m_stepSlider->setObjectName("step");
        m_stepSlider->setRange(1, static_cast<int>(std::min<std::int64_t>(h.time.steps, INT32_MAX)));
        m_stepSlider->setPageStep(std::max(1, m_stepSlider->maximum() / 10));
        row->addWidget(m_stepSlider, 1);
        m_stepLabel = new QLabel(page);
        m_stepLabel->setObjectName("stepTime");
        row->addWidget(m_stepLabel);
        pageLayout->addLayout(row);
        m_field = new CZoFieldView(page);
        m_field->setObjectName("field");
        pageLayout->addWidget(m_field, 1);
        m_tabs->insertTab(0, page, tr("Field"));
        m_tabs->setCurrentIndex(0);
        connect(m_stepSlider, &QSlider::valueChanged, this, [this] { LoadField(); });
        connect(m_fieldItem, &QComboBox::currentIndexChanged, this, [this] { LoadField(); });
        LoadField();
    }
}

void CZoDataViewerDlg::LoadField() {
    if (!m_header || !m_field || m_fieldItem->currentIndex() < 0)
        return;
    const datafile::Header& h = *m_header;
    const int item = m_fieldItem->currentData().toInt();
    const std::int64_t step = m_stepSlider->value() - 1;
    datafile::ValuesRequest req;
    req.items = {item - 1};
    req.point = -1;
    req.fieldStep = step;
    req.maxSteps = step + 1;
    req.check = false;
    datafile::ValuesResult v = datafile::ReadValues(m_path, req);
    const std::int64_t time = h.time.start + static_cast<std::int64_t>(std::floor(h.time.step * static_cast<double>(step)));
    m_stepLabel->setText(tr("%1 of %2: %3").arg(step + 1).arg(h.time.steps).arg(Q(datafile::FormatDateTime(time))));
    const datafile::Item& it = h.items[static_cast<std::size_t>(item - 1)];
    const QString title = QString("%1 [%2]").arg(Q(it.name), Q(it.unit));
    if (h.kind == datafile::Kind::Grid) {
        m_field->SetField(std::move(v.field), h.columns, h.rows, title);
    } else {
        // No geometry in the file: the values in their numbering, in a square block.
        const auto n = static_cast<std::int64_t>(v.field.size());
        const auto columns = std::max<std::int64_t>(1, static_cast<std::int64_t>(std::ceil(std::sqrt(static_cast<double>(n)))));
        const QString what = h.location == datafile::MeshLocation::Nodes ? tr("nodes") : tr("elements");
        m_field->SetField(std::move(v.field), columns, (n + columns - 1) / columns,
                          tr("%1, %2 1 to %3 from the bottom left, row by row").arg(title, what).arg(n));
    }
    if (v.error)
        m_status->setText(Q(v.error->ToString()));
}

CZoDataViewerDlg::~CZoDataViewerDlg() = default;

void CZoDataViewerDlg::ShowPoint(int point) {
    if (m_point->isEnabled())
        m_point->setValue(point);
}

void CZoDataViewerDlg::Load() {
    if (!m_header)
        return;
    const datafile::Header& h = *m_header;
    datafile::ValuesRequest req;
    for (int n : m_items)
        req.items.push_back(n - 1);
    req.point = m_point->value() - 1;
    req.maxSteps = kMaxRows;
    req.check = h.time.steps <= kMaxRows;
    datafile::ValuesResult v = datafile::ReadValues(m_path, req);
    std::vector<double> times;
    for (std::size_t s = 0; s < v.rows.size(); ++s)
        times.push_back(static_cast<double>(h.time.start) + h.time.step * static_cast<double>(s));
    QStringList headers;
    std::vector<CZoLinePlot::Series> series;
    for (std::size_t k = 0; k < m_items.size(); ++k) {
        const datafile::Item& it = h.items[static_cast<std::size_t>(m_items[k] - 1)];
        const QString name = QString("%1 [%2]").arg(Q(it.name), Q(it.unit));
        headers << name;
        const QuantityInfo* known = CUnitUtil::FindQuantity(it.unitType);
        const QString quantity = QString("%1 [%2]").arg(known ? QString(known->name) : QString::number(it.unitType), Q(it.unit));
        CZoLinePlot::Series s{name, {}, quantity, true};
        for (const auto& row : v.rows)
            s.values.push_back(row[k]);
        series.push_back(std::move(s));
    }
    m_model->Set(times, headers, std::move(v.rows));
    m_times0 = times.empty() ? 0 : times.front();
    m_times1 = times.size() > 1 ? times.back() : m_times0 + 1;
    m_plot->SetData(std::move(times), std::move(series));
    for (std::size_t k = 0; k < m_checks.size(); ++k)
        m_plot->SetSeriesVisible(static_cast<int>(k), m_checks[k]->isChecked());
    if (m_reset)
        m_reset->setEnabled(false);
    if (v.error)
        m_status->setText(Q(v.error->ToString()));
    else if (h.time.steps > kMaxRows)
        m_status->setText(tr("The first %1 of %2 time steps are shown.").arg(kMaxRows).arg(h.time.steps));
    else
        m_status->setText(QString());
}

CZoDataViewerDlg* CFemBase::OpenDataFile(const CString& path, const std::vector<int>& items,
                                         QWidget* parent) {
    // A window of its own beside the editor's, not closed when the page that opened it goes.
    auto* viewer = new CZoDataViewerDlg(path, items, parent ? parent->window() : nullptr);
    viewer->setWindowFlag(Qt::Window);
    viewer->setAttribute(Qt::WA_DeleteOnClose);
    viewer->show();
    return viewer;
}

CZoDataViewerDlg* CFemBase::OpenDataFile(CZoSEDlgBase* from, const CString& fileName,
                                         const std::vector<int>& items) {
    return OpenDataFile(from ? from->AbsoluteFilePath(fileName) : fileName, items, from);
}

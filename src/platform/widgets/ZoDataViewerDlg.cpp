#include "ZoDataViewerDlg.h"

#include "FemBase.h"
#include "ZoSEDlgBase.h"

#include <QAbstractTableModel>
#include <QDialogButtonBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
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
}

void CZoLinePlot::SetData(std::vector<double> times, std::vector<Series> series) {
    m_times = std::move(times);
    m_series = std::move(series);
    update();
}

void CZoLinePlot::paintEvent(QPaintEvent*) {
    QPainter p(this);
    p.setRenderHint(QPainter::Antialiasing);
    const QFontMetrics fm(font());
    double lo = 0, hi = 0;
    bool any = false;
    for (const Series& s : m_series)
        for (double v : s.values)
            if (std::isfinite(v)) {
                lo = any ? std::min(lo, v) : v;
                hi = any ? std::max(hi, v) : v;
                any = true;
            }
    if (m_times.empty() || !any) {
        p.drawText(rect(), Qt::AlignCenter, tr("No values to show"));
        return;
    }
    if (hi - lo < 1e-300) {
        const double pad = std::max(std::fabs(lo) * 0.1, 1.0);
        lo -= pad;
        hi += pad;
    }
    const double yStep = NiceStep(hi - lo, 5);
    lo = std::floor(lo / yStep) * yStep;
    hi = std::ceil(hi / yStep) * yStep;
    const double t0 = m_times.front();
    const double t1 = m_times.size() > 1 ? m_times.back() : t0 + 1;

    int labelWidth = 0;
    for (double y = lo; y <= hi + yStep / 2; y += yStep)
        labelWidth = std::max(labelWidth, fm.horizontalAdvance(Number(std::fabs(y) < yStep * 1e-9 ? 0 : y)));
    const int legendHeight = fm.height() + 6;
    const QRect area(labelWidth + 12, legendHeight + 6, width() - labelWidth - 24,
                     height() - legendHeight - 2 * fm.height() - 18);
    if (area.width() < 20 || area.height() < 20)
        return;
    auto X = [&](double t) { return area.left() + (t - t0) / (t1 - t0) * area.width(); };
    auto Y = [&](double v) { return area.bottom() - (v - lo) / (hi - lo) * area.height(); };

    const QColor grid = palette().color(QPalette::Mid);
    p.setPen(QPen(grid, 0, Qt::DotLine));
    for (double y = lo; y <= hi + yStep / 2; y += yStep) {
        const double shown = std::fabs(y) < yStep * 1e-9 ? 0 : y;
        const int py = static_cast<int>(std::lround(Y(y)));
        p.setPen(QPen(grid, 0, Qt::DotLine));
        p.drawLine(area.left(), py, area.right(), py);
        p.setPen(palette().color(QPalette::Text));
        p.drawText(QRect(0, py - fm.height() / 2, labelWidth + 6, fm.height()),
                   Qt::AlignRight | Qt::AlignVCenter, Number(shown));
    }
    const int xTicks = std::max(1, std::min(5, area.width() / (fm.horizontalAdvance("0000-00-00") + 20)));
    for (int i = 0; i <= xTicks; ++i) {
        const double t = t0 + (t1 - t0) * i / xTicks;
        const int px = static_cast<int>(std::lround(X(t)));
        p.setPen(QPen(grid, 0, Qt::DotLine));
        p.drawLine(px, area.top(), px, area.bottom());
        p.setPen(palette().color(QPalette::Text));
        const QString text = Q(datafile::FormatDateTime(static_cast<std::int64_t>(std::floor(t))));
        const QStringList parts = text.split(' ');
        const int w = fm.horizontalAdvance(parts.value(0)) + 4;
        const int left = std::clamp(px - w / 2, 0, std::max(0, width() - w));
        p.drawText(QRect(left, area.bottom() + 4, w, fm.height()), Qt::AlignCenter, parts.value(0));
        p.drawText(QRect(left, area.bottom() + 4 + fm.height(), w, fm.height()), Qt::AlignCenter,
                   parts.value(1).left(5));
    }
    p.setPen(palette().color(QPalette::Text));
    p.drawRect(area);

    int legendX = area.left();
    for (std::size_t k = 0; k < m_series.size(); ++k) {
        const QColor colour = kColours[k % std::size(kColours)];
        QPainterPath path;
        bool open = false;
        const std::size_t n = std::min(m_series[k].values.size(), m_times.size());
        for (std::size_t i = 0; i < n; ++i) {
            const double v = m_series[k].values[i];
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
        if (n == 1)
            p.drawEllipse(QPointF(X(m_times[0]), Y(m_series[k].values[0])), 2.5, 2.5);
        p.setClipping(false);
        p.drawLine(legendX, 3 + fm.height() / 2, legendX + 16, 3 + fm.height() / 2);
        p.setPen(palette().color(QPalette::Text));
        const QString& name = m_series[k].name;
        p.drawText(legendX + 20, 3 + fm.ascent(), name);
        legendX += 32 + fm.horizontalAdvance(name);
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
    m_plot = new CZoLinePlot(m_tabs);
    m_plot->setObjectName("plot");
    m_tabs->addTab(m_plot, tr("Plot"));
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
        CZoLinePlot::Series s{name, {}};
        for (const auto& row : v.rows)
            s.values.push_back(row[k]);
        series.push_back(std::move(s));
    }
    m_model->Set(times, headers, std::move(v.rows));
    m_plot->SetData(std::move(times), std::move(series));
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

// The data viewer: a data file's header, and the values of some of its items over time as
// a table and as a line plot. Files of values in space show one point (node, cell) at a time.
#pragma once

#include "common/Platform.h"
#include "datafile/DataFile.h"

#include <QDialog>
#include <QWidget>

#include <optional>
#include <vector>

class QLabel;
class QPlainTextEdit;
class QSpinBox;
class QTabWidget;
class QTableView;
class CZoSeriesModel;

// Lines over a time axis, drawn with QPainter: one colour per series, a legend, and
// labelled axes.
class CZoLinePlot : public QWidget {
    Q_OBJECT
public:
    explicit CZoLinePlot(QWidget* parent = nullptr);
    struct Series {
        QString name;
        std::vector<double> values;  // nan leaves a gap
    };
    // times in seconds since 1970 (UTC), one per value.
    void SetData(std::vector<double> times, std::vector<Series> series);
    int SeriesCount() const { return static_cast<int>(m_series.size()); }
    QSize sizeHint() const override { return {520, 300}; }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    std::vector<double> m_times;
    std::vector<Series> m_series;
};

class CZoDataViewerDlg : public QDialog {
    Q_OBJECT
public:
    // items: 1-based item numbers; invalid ones are left out.
    CZoDataViewerDlg(const CString& path, const std::vector<int>& items, QWidget* parent = nullptr);
    ~CZoDataViewerDlg() override;

    // Steps read for the table and the plot; a longer file shows its first ones.
    static constexpr std::int64_t kMaxRows = 100000;

    const CString& Path() const { return m_path; }
    const std::vector<int>& Items() const { return m_items; }
    // The point shown (1-based) for files with values in space.
    void ShowPoint(int point);
    QPlainTextEdit* HeaderText() const { return m_headerText; }
    QTableView* Table() const { return m_table; }
    CZoLinePlot* Plot() const { return m_plot; }
    QLabel* StatusLabel() const { return m_status; }
    QSpinBox* PointBox() const { return m_point; }

private:
    void Load();

    CString m_path;
    std::vector<int> m_items;
    std::optional<datafile::Header> m_header;
    QPlainTextEdit* m_headerText = nullptr;
    QSpinBox* m_point = nullptr;
    QLabel* m_pointLabel = nullptr;
    QTabWidget* m_tabs = nullptr;
    QTableView* m_table = nullptr;
    CZoSeriesModel* m_model = nullptr;
    CZoLinePlot* m_plot = nullptr;
    QLabel* m_status = nullptr;
};

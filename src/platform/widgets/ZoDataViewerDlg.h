// The data viewer: a data file's header, and the values of some of its items over time as
// a table and as a line plot. Files of values in space show one point (node, cell) at a time.
#pragma once

#include "common/Platform.h"
#include "datafile/DataFile.h"

#include <QDialog>
#include <QWidget>

#include <optional>
#include <vector>

class QCheckBox;
class QComboBox;
class QHBoxLayout;
class QLabel;
class QPushButton;
class QSlider;
class QPlainTextEdit;
class QSpinBox;
class QTabWidget;
class QTableView;
class CZoSeriesModel;

// Lines over a time axis, drawn with QPainter: one colour per series, a legend, and one
// panel with its own value axis per quantity, all sharing the time axis. The wheel zooms
// the time axis around the cursor, a drag pans it.
class CZoLinePlot : public QWidget {
    Q_OBJECT
public:
    explicit CZoLinePlot(QWidget* parent = nullptr);
    struct Series {
        QString name;
        std::vector<double> values;  // nan leaves a gap
        QString quantity;            // series of one quantity share a value axis
        bool visible = true;
    };
    // times in seconds since 1970 (UTC), one per value. Shows the whole time range.
    void SetData(std::vector<double> times, std::vector<Series> series);
    int SeriesCount() const { return static_cast<int>(m_series.size()); }
    void SetSeriesVisible(int k, bool visible);
    bool SeriesVisible(int k) const;
    // Quantities of the visible series, one value axis each, in order of first appearance.
    QStringList Axes() const;
    double ViewStart() const { return m_view0; }
    double ViewEnd() const { return m_view1; }
    // factor < 1 zooms in; at stays where it is on screen.
    void Zoom(double factor, double at);
    void Pan(double seconds);
    void ResetView();
    QSize sizeHint() const override { return {520, 300}; }

signals:
    void ViewChanged();

protected:
    void paintEvent(QPaintEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;

private:
    double FullStart() const;
    double FullEnd() const;
    void SetView(double t0, double t1);
    double TimeAt(double x) const;

    std::vector<double> m_times;
    std::vector<Series> m_series;
    double m_view0 = 0, m_view1 = 1;
    int m_left = 0, m_right = 1;  // the time axis' pixels, from the last paint
    std::optional<double> m_dragX;
};

// Values in space at one time step: a grid's cells, or a mesh's nodes or elements in their
// numbering (the file does not hold the mesh), coloured by value with a legend.
class CZoFieldView : public QWidget {
    Q_OBJECT
public:
    explicit CZoFieldView(QWidget* parent = nullptr);
    // values row by row from the first, columns × rows of them; nan is drawn blank.
    void SetField(std::vector<double> values, std::int64_t columns, std::int64_t rows, QString title);
    const std::vector<double>& Values() const { return m_values; }
    double Minimum() const { return m_lo; }
    double Maximum() const { return m_hi; }
    // The legend's texts, lowest value first.
    QStringList LegendLabels() const;
    QColor ColourOf(double v) const;
    QSize sizeHint() const override { return {520, 300}; }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    std::vector<double> m_values;
    std::int64_t m_columns = 0, m_rows = 0;
    double m_lo = 0, m_hi = 0;
    QString m_title;
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
    // One per item shown, in the order of Items().
    const std::vector<QCheckBox*>& ItemChecks() const { return m_checks; }
    QPushButton* ResetViewButton() const { return m_reset; }
    // Files with values in space: the field at a chosen step (null otherwise).
    CZoFieldView* Field() const { return m_field; }
    QSlider* StepSlider() const { return m_stepSlider; }
    QLabel* StepLabel() const { return m_stepLabel; }
    QTabWidget* Tabs() const { return m_tabs; }

private:
    void Load();
    void LoadField();

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
    QHBoxLayout* m_checkRow = nullptr;
    std::vector<QCheckBox*> m_checks;
    double m_times0 = 0, m_times1 = 1;
    QPushButton* m_reset = nullptr;
    CZoFieldView* m_field = nullptr;
    QSlider* m_stepSlider = nullptr;
    QLabel* m_stepLabel = nullptr;
    QComboBox* m_fieldItem = nullptr;
};

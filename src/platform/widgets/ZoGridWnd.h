// The plain grid: a table whose every cell is asked for when drawn (GetStyleRowCol) and
// written back when edited (StoreStyleRowCol). The grid holds no data of its own.
//
// Coordinates are the grid's: row 0 holds the column headings, column 0 the row headings;
// rows 1..GetRowCount() and columns 1..GetColCount() are the cells.
#pragma once

#include "ZoEditStyle.h"
#include "ZoSEDlgBase.h"
#include "common/Platform.h"

#include <QPointer>
#include <QTableView>

#include <vector>

class CZoGridModel;
class QAbstractButton;

enum class ZoCellKind {
    Static,      // text only
    Text,        // editable text
    Number,      // editable number, shown in the user's unit of its style's group
    CheckBox,    // toggled by a click
    ComboBox,    // choice among fixed texts, stored on selection
    FileName,    // editable path with a browse button at the right
    PushButton,  // a button; a click calls OnClickedButtonRowCol
};

enum class ZoCellAlign { Default, Left, Center, Right };

// What a cell shows and how it is edited; filled by the grid's style query.
struct CGridCellStyle {
    ZoCellKind kind = ZoCellKind::Static;
    CString text;  // static and editable text, file name, button label, heading
    double value = 0.0;  // number, in the internal unit
    ZoNumberKind numberKind = ZoNumberKind::Double;
    CZoEditStyle numberStyle;
    bool checked = false;
    std::vector<CString> choices;
    int choice = -1;
    bool readOnly = false;  // drawn disabled: button-face background, grey text
    ZoCellAlign align = ZoCellAlign::Default;
    CString toolTip;     // defaults to the unit tooltip of a number's group
    CString fileFilter;  // file chooser filter of a file-name cell

    CGridCellStyle& SetStatic(const CString& t);
    CGridCellStyle& SetText(const CString& t);
    CGridCellStyle& SetNumber(double internal, const CZoEditStyle& style = CZoEditStyle(),
                              ZoNumberKind kind = ZoNumberKind::Double);
    CGridCellStyle& SetCheckBox(bool on);
    CGridCellStyle& SetChoice(std::vector<CString> texts, int index);
    CGridCellStyle& SetFileName(const CString& path, const CString& filter = CString());
    CGridCellStyle& SetButton(const CString& label);
    CGridCellStyle& SetReadOnly(bool on = true);
    CGridCellStyle& SetAlign(ZoCellAlign a);
    CGridCellStyle& SetToolTip(const CString& tip);

    bool IsEditable() const;  // edited through an editor widget
    QString DisplayText() const;
    QString EffectiveToolTip() const;
};

// A changed cell: the kind of its style and the value the user gave.
struct CGridCellValue {
    ZoCellKind kind = ZoCellKind::Static;
    double number = 0.0;  // internal unit
    bool checked = false;
    int choice = -1;
    CString text;
};

// Label of the link buttons of overview grids.
inline constexpr const char* kGoToLabel = "Go to...";

// The decision of fitting a grid into the space it has: size and scroll bars.
struct ZoGridFit {
    QSize size;
    bool horizontalBar = false;
    bool verticalBar = false;
};
ZoGridFit ZoFitGrid(QSize available, QSize content, int verticalBarWidth,
                    int horizontalBarHeight);

class CZoGridWnd : public QTableView {
    Q_OBJECT
public:
    explicit CZoGridWnd(QWidget* parent = nullptr);
    ~CZoGridWnd() override;

    // The dialog that receives the grid's update hints and whose frame the grid fits into.
    void SetDialog(CZoSEDlgBase* dialog);
    CZoSEDlgBase* Dialog() const { return m_dialogWidget ? m_dialog : nullptr; }

    void SetRowCount(int rows);
    void SetColCount(int cols);
    int GetRowCount() const;
    int GetColCount() const { return m_colCount; }

    // Reads the counts again and redraws every cell; the grid fits its contents again.
    void Redraw();
    // Columns as wide as their widest text and heading (the row headings' column and its
    // heading in the corner included), rows as high as their tallest cell. Measured on a
    // sample of rows (the first, the last and some between), so long lists stay cheap.
    void FitColumns();
    // A column (0: the row headings) is never fitted narrower than this.
    void SetMinimumColumnWidth(int col, int width);
    // Sizes the grid to its contents within the dialog (up to the dialog's layout margins),
    // with scroll bars where it does not fit; done again whenever the dialog is resized.
    void SizeToDialog();
    // FitColumns, then SizeToDialog.
    void FitToContents();
    const ZoGridFit& LastFit() const { return m_fit; }
    // Width and height of the headings and cells (what the grid shows without scrolling).
    QSize ContentSize() const;

    // A title row is drawn as one cell across the whole row, row heading included, showing
    // the row heading's text: a heading over the rows that follow it.
    virtual bool IsTitleRow(int row) const;

    // The style query: what cell (row, col) shows. Headings included.
    virtual void GetStyleRowCol(int row, int col, CGridCellStyle& style);
    // Writes a changed cell back; returns the update hint to send, 0 when nothing changed.
    virtual int StoreStyleRowCol(int row, int col, const CGridCellValue& value);
    // A push-button cell was clicked.
    virtual void OnClickedButtonRowCol(int row, int col);

    // Stores a cell as the user changed it: the hint goes to the dialog and the grid redraws.
    void StoreCell(int row, int col, const CGridCellValue& value);
    CGridCellStyle CellStyle(int row, int col);

    // Current cell and selection, in grid coordinates.
    bool GetCurrentCell(int& row, int& col) const;
    void SetCurrentCell(int row, int col);
    struct RowRange {
        int top;
        int bottom;
    };
    // Whole rows selected (by their headings), joined into ranges from the top.
    std::vector<RowRange> GetSelectedRowRanges() const;
    void SelectRows(int top, int bottom);
    void ClearSelection();
    QModelIndex IndexOf(int row, int col) const;  // a cell (row, col >= 1)
    QRect CellRect(int row, int col) const;       // in viewport coordinates

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;

protected:
    // Number of rows; list grids follow their list.
    virtual int RowCountFromData() const { return m_rowCount; }
    void UpdateDoc(int hint);
    void mousePressEvent(QMouseEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    friend class CZoGridRowHeader;
    // Draws the part of a title row that falls into the painter's widget; rowRect is the
    // whole row (row heading and cells) in that widget's coordinates.
    void PaintTitleRow(QPainter& painter, QWidget* on, int row, const QRect& rowRect);
    std::vector<int> SampleRows() const;

    CZoGridModel* m_model;
    std::vector<int> m_minWidths;  // by column, 0 the row headings
    QPointer<QAbstractButton> m_corner;
    // Watched as a plain widget: its events still come while it is being destroyed.
    CZoSEDlgBase* m_dialog = nullptr;
    QPointer<QWidget> m_dialogWidget;
    int m_rowCount = 0;
    int m_colCount = 0;
    ZoGridFit m_fit;
    bool m_fitted = false;
    bool m_fitting = false;
};

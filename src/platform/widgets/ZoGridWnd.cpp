#include "ZoGridWnd.h"

#include "ZoNumberEdit.h"
#include "ZoPrompts.h"
#include "ZoSEDlgBase.h"

#include <QAbstractButton>
#include <QAbstractTableModel>
#include <QApplication>
#include <QComboBox>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLayout>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPainter>
#include <QScrollBar>
#include <QStyleOption>
#include <QStyledItemDelegate>

#include <algorithm>

// --- cell styles ---------------------------------------------------------------------

CGridCellStyle& CGridCellStyle::SetStatic(const CString& t) {
    kind = ZoCellKind::Static;
    text = t;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetText(const CString& t) {
    kind = ZoCellKind::Text;
    text = t;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetNumber(double internal, const CZoEditStyle& style,
                                          ZoNumberKind k) {
    kind = ZoCellKind::Number;
    value = internal;
    numberStyle = style;
    numberKind = k;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetCheckBox(bool on) {
    kind = ZoCellKind::CheckBox;
    checked = on;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetChoice(std::vector<CString> texts, int index) {
    kind = ZoCellKind::ComboBox;
    choices = std::move(texts);
    choice = index;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetFileName(const CString& path, const CString& filter) {
    kind = ZoCellKind::FileName;
    text = path;
    fileFilter = filter;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetButton(const CString& label) {
    kind = ZoCellKind::PushButton;
    text = label;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetReadOnly(bool on) {
    readOnly = on;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetAlign(ZoCellAlign a) {
    align = a;
    return *this;
}
CGridCellStyle& CGridCellStyle::SetToolTip(const CString& tip) {
    toolTip = tip;
    return *this;
}

bool CGridCellStyle::IsEditable() const {
    return kind == ZoCellKind::Text || kind == ZoCellKind::Number ||
           kind == ZoCellKind::ComboBox || kind == ZoCellKind::FileName;
}

QString CGridCellStyle::DisplayText() const {
    switch (kind) {
    case ZoCellKind::Number:
        return numberStyle.Format(value, numberKind);
    case ZoCellKind::ComboBox:
        return choice >= 0 && choice < static_cast<int>(choices.size())
                   ? QString::fromStdString(choices[choice])
                   : QString();
    case ZoCellKind::CheckBox:
        return QString();
    default:
        return QString::fromStdString(text);
    }
}

QString CGridCellStyle::EffectiveToolTip() const {
    if (!toolTip.empty())
        return QString::fromStdString(toolTip);
    if (kind == ZoCellKind::Number)
        return QString::fromStdString(numberStyle.ToolTip());
    return QString();
}

ZoGridFit ZoFitGrid(QSize available, QSize content, int verticalBarWidth,
                    int horizontalBarHeight) {
    ZoGridFit fit;
    if (content.height() <= available.height()) {
        if (content.width() <= available.width()) {
            fit.size = content;
            return fit;
        }
        fit.horizontalBar = true;
        fit.size = QSize(available.width(), content.height() + horizontalBarHeight);
        if (fit.size.height() > available.height()) {
            fit.verticalBar = true;
            fit.size.setHeight(available.height());
        }
        return fit;
    }
    fit.verticalBar = true;
    fit.size = QSize(content.width() + verticalBarWidth, available.height());
    if (fit.size.width() > available.width()) {
        fit.horizontalBar = true;
        fit.size.setWidth(available.width());
    }
    return fit;
}

// --- the table model: every cell read from the grid's style query ---------------------

class CZoGridModel : public QAbstractTableModel {
public:
    explicit CZoGridModel(CZoGridWnd* grid) : QAbstractTableModel(grid), m_grid(grid) {}

    int rowCount(const QModelIndex& parent) const override { return parent.isValid() ? 0 : m_rows; }
    int columnCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : m_cols;
    }

    QVariant data(const QModelIndex& index, int role) const override {
        if (!index.isValid())
            return {};
        return RoleData(m_grid->CellStyle(index.row() + 1, index.column() + 1), role);
    }

    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        const CGridCellStyle style = orientation == Qt::Horizontal
                                         ? m_grid->CellStyle(0, section + 1)
                                         : m_grid->CellStyle(section + 1, 0);
        if (role == Qt::BackgroundRole && !style.readOnly)
            return {};
        return RoleData(style, role);
    }

    Qt::ItemFlags flags(const QModelIndex& index) const override {
        if (!index.isValid())
            return Qt::NoItemFlags;
        Qt::ItemFlags f = Qt::ItemIsEnabled | Qt::ItemIsSelectable;
        const CGridCellStyle style = m_grid->CellStyle(index.row() + 1, index.column() + 1);
        if (style.IsEditable() && !style.readOnly)
            f |= Qt::ItemIsEditable;
        return f;
    }

    // Brings the shape in line with the grid's counts, keeping the selection of rows that
    // stay, and redraws every cell.
    void Sync(int rows, int cols) {
        rows = std::max(rows, 0);
        cols = std::max(cols, 0);
        if (cols != m_cols) {
            beginResetModel();
            m_rows = rows;
            m_cols = cols;
            endResetModel();
            return;
        }
        if (rows > m_rows) {
            beginInsertRows({}, m_rows, rows - 1);
            m_rows = rows;
            endInsertRows();
        } else if (rows < m_rows) {
            beginRemoveRows({}, rows, m_rows - 1);
            m_rows = rows;
            endRemoveRows();
        }
        if (m_rows > 0 && m_cols > 0)
            emit dataChanged(index(0, 0), index(m_rows - 1, m_cols - 1));
        if (m_cols > 0)
            emit headerDataChanged(Qt::Horizontal, 0, m_cols - 1);
        if (m_rows > 0)
            emit headerDataChanged(Qt::Vertical, 0, m_rows - 1);
    }

    static QVariant RoleData(const CGridCellStyle& style, int role) {
        switch (role) {
        case Qt::DisplayRole:
        case Qt::EditRole:
            return style.DisplayText();
        case Qt::ToolTipRole: {
            const QString tip = style.EffectiveToolTip();
            return tip.isEmpty() ? QVariant() : QVariant(tip);
        }
        case Qt::TextAlignmentRole:
            return QVariant::fromValue(Alignment(style));
        case Qt::BackgroundRole:
            if (style.readOnly)
                return QApplication::palette().brush(QPalette::Active, QPalette::Button);
            return {};
        case Qt::ForegroundRole:
            if (style.readOnly)
                return QBrush(QColor(160, 160, 160));
            return {};
        default:
            return {};
        }
    }

    static Qt::Alignment Alignment(const CGridCellStyle& style) {
        switch (style.align) {
        case ZoCellAlign::Left:
            return Qt::AlignLeft | Qt::AlignVCenter;
        case ZoCellAlign::Center:
            return Qt::AlignCenter;
        case ZoCellAlign::Right:
            return Qt::AlignRight | Qt::AlignVCenter;
        case ZoCellAlign::Default:
            break;
        }
        switch (style.kind) {
        case ZoCellKind::Number:
            return Qt::AlignRight | Qt::AlignVCenter;
        case ZoCellKind::CheckBox:
        case ZoCellKind::PushButton:
            return Qt::AlignCenter;
        default:
            return Qt::AlignLeft | Qt::AlignVCenter;
        }
    }

private:
    CZoGridWnd* m_grid;
    int m_rows = 0;
    int m_cols = 0;
};

// --- the delegate: drawing and editing by cell kind ----------------------------------

namespace {

QRect FileButtonRect(const QRect& cell) {
    const int w = std::min(cell.height(), 24);
    return QRect(cell.right() - w + 1, cell.top(), w, cell.height());
}

// The cell's palette for a control drawn in it: a disabled control takes the disabled
// colours, or its label stays black and it looks clickable.
QPalette ControlPalette(const QStyleOptionViewItem& opt, bool enabled) {
    QPalette palette = opt.palette;
    if (!enabled)
        palette.setCurrentColorGroup(QPalette::Disabled);
    return palette;
}

class CZoGridDelegate : public QStyledItemDelegate {
public:
    explicit CZoGridDelegate(CZoGridWnd* grid) : QStyledItemDelegate(grid), m_grid(grid) {}

    void paint(QPainter* painter, const QStyleOptionViewItem& option,
               const QModelIndex& index) const override {
        const CGridCellStyle style = Style(index);
        QStyleOptionViewItem opt = option;
        initStyleOption(&opt, index);
        QStyle* qs = m_grid->style();
        const bool enabled = !style.readOnly;
        switch (style.kind) {
        case ZoCellKind::CheckBox: {
            opt.text.clear();
            qs->drawPrimitive(QStyle::PE_PanelItemViewItem, &opt, painter, m_grid);
            QStyleOptionButton box;
            const int w = qs->pixelMetric(QStyle::PM_IndicatorWidth, nullptr, m_grid);
            const int h = qs->pixelMetric(QStyle::PM_IndicatorHeight, nullptr, m_grid);
            box.rect = QRect(opt.rect.center() - QPoint(w / 2, h / 2), QSize(w, h));
            box.state = (style.checked ? QStyle::State_On : QStyle::State_Off) |
                        (enabled ? QStyle::State_Enabled : QStyle::State_None);
            box.palette = ControlPalette(opt, enabled);
            qs->drawPrimitive(QStyle::PE_IndicatorCheckBox, &box, painter, m_grid);
            return;
        }
        case ZoCellKind::PushButton: {
            opt.text.clear();
            qs->drawPrimitive(QStyle::PE_PanelItemViewItem, &opt, painter, m_grid);
            QStyleOptionButton button;
            button.rect = opt.rect.adjusted(1, 1, -1, -1);
            button.text = QString::fromStdString(style.text);
            button.state = QStyle::State_Raised |
                           (enabled ? QStyle::State_Enabled : QStyle::State_None);
            button.palette = ControlPalette(opt, enabled);
            button.fontMetrics = opt.fontMetrics;
            qs->drawControl(QStyle::CE_PushButton, &button, painter, m_grid);
            return;
        }
        case ZoCellKind::FileName: {
            const QRect buttonRect = FileButtonRect(opt.rect);
            QStyleOptionViewItem textOpt = opt;
            textOpt.rect.setRight(buttonRect.left() - 1);
            qs->drawControl(QStyle::CE_ItemViewItem, &textOpt, painter, m_grid);
            QStyleOptionButton button;
            button.rect = buttonRect.adjusted(1, 1, -1, -1);
            button.text = "...";
            button.state = QStyle::State_Raised |
                           (enabled ? QStyle::State_Enabled : QStyle::State_None);
            button.palette = ControlPalette(opt, enabled);
            button.fontMetrics = opt.fontMetrics;
            qs->drawControl(QStyle::CE_PushButton, &button, painter, m_grid);
            return;
        }
        default:
            qs->drawControl(QStyle::CE_ItemViewItem, &opt, painter, m_grid);
        }
    }

    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        const CGridCellStyle style = Style(index);
        QSize size = QStyledItemDelegate::sizeHint(option, index);
        const QFontMetrics fm(option.font);
        switch (style.kind) {
        case ZoCellKind::CheckBox:
            size.setWidth(m_grid->style()->pixelMetric(QStyle::PM_IndicatorWidth) + 12);
            break;
        case ZoCellKind::PushButton:
            size.setWidth(fm.horizontalAdvance(QString::fromStdString(style.text)) + 20);
            size.setHeight(std::max(size.height(), fm.height() + 8));
            break;
        case ZoCellKind::FileName:
            size.setWidth(size.width() + std::min(size.height(), 24) + 4);
            break;
        case ZoCellKind::ComboBox: {
            int widest = 0;
            for (const CString& c : style.choices)
                widest = std::max(widest, fm.horizontalAdvance(QString::fromStdString(c)));
            size.setWidth(std::max(size.width(), widest + 36));
            break;
        }
        default:
            break;
        }
        return size;
    }

    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
        QStyledItemDelegate::initStyleOption(option, index);
        if (Style(index).readOnly)
            option->state &= ~QStyle::State_Enabled;
    }

    QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem&,
                          const QModelIndex& index) const override {
        const CGridCellStyle style = Style(index);
        switch (style.kind) {
        case ZoCellKind::Number:
            return new CZoNumberEdit(style.numberStyle, parent);
        case ZoCellKind::ComboBox: {
            auto* box = new QComboBox(parent);
            for (const CString& c : style.choices)
                box->addItem(QString::fromStdString(c));
            // A choice is stored as soon as it is made.
            auto* self = const_cast<CZoGridDelegate*>(this);
            connect(box, &QComboBox::activated, self, [self, box] {
                emit self->commitData(box);
                emit self->closeEditor(box);
            });
            return box;
        }
        case ZoCellKind::Text:
        case ZoCellKind::FileName:
            return new QLineEdit(parent);
        default:
            return nullptr;
        }
    }

    void setEditorData(QWidget* editor, const QModelIndex& index) const override {
        const CGridCellStyle style = Style(index);
        if (auto* number = qobject_cast<CZoNumberEdit*>(editor)) {
            number->ShowValue(style.value, style.numberKind);
            number->selectAll();
        } else if (auto* box = qobject_cast<QComboBox*>(editor)) {
            box->setCurrentIndex(style.choice);
        } else if (auto* line = qobject_cast<QLineEdit*>(editor)) {
            line->setText(QString::fromStdString(style.text));
            line->selectAll();
        }
    }

    void setModelData(QWidget* editor, QAbstractItemModel*, const QModelIndex& index) const override {
        const int row = index.row() + 1;
        const int col = index.column() + 1;
        const CGridCellStyle style = Style(index);
        CGridCellValue value;
        value.kind = style.kind;
        if (auto* number = qobject_cast<CZoNumberEdit*>(editor)) {
            // An untouched rounded display must not overwrite the value it shows.
            if (number->text() == style.numberStyle.Format(style.value, style.numberKind))
                return;
            QString message;
            if (!number->ReadValue(value.number, message)) {
                ZoShowMessage(m_grid, message);
                return;
            }
        } else if (auto* box = qobject_cast<QComboBox*>(editor)) {
            value.choice = box->currentIndex();
            if (value.choice < 0 || value.choice == style.choice)
                return;
        } else if (auto* line = qobject_cast<QLineEdit*>(editor)) {
            value.text = line->text().toStdString();
            if (value.text == style.text)
                return;
        } else {
            return;
        }
        m_grid->StoreCell(row, col, value);
    }

    bool editorEvent(QEvent* event, QAbstractItemModel* model, const QStyleOptionViewItem& option,
                     const QModelIndex& index) override {
        const CGridCellStyle style = Style(index);
        const int row = index.row() + 1;
        const int col = index.column() + 1;
        const bool clickable = style.kind == ZoCellKind::CheckBox ||
                               style.kind == ZoCellKind::PushButton ||
                               style.kind == ZoCellKind::FileName;
        if (!clickable || style.readOnly)
            return QStyledItemDelegate::editorEvent(event, model, option, index);

        if (event->type() == QEvent::KeyPress) {
            auto* key = static_cast<QKeyEvent*>(event);
            if (key->key() == Qt::Key_Space && key->modifiers() == Qt::NoModifier &&
                style.kind != ZoCellKind::FileName) {
                Click(style, row, col);
                return true;
            }
            return false;
        }
        if (event->type() != QEvent::MouseButtonRelease &&
            event->type() != QEvent::MouseButtonDblClick)
            return false;
        auto* mouse = static_cast<QMouseEvent*>(event);
        if (mouse->button() != Qt::LeftButton)
            return false;
        QRect target = option.rect;
        if (style.kind == ZoCellKind::FileName)
            target = FileButtonRect(option.rect);
        if (!target.contains(mouse->position().toPoint()))
            return false;
        if (event->type() == QEvent::MouseButtonRelease)
            Click(style, row, col);
        return true;
    }

private:
    CGridCellStyle Style(const QModelIndex& index) const {
        return m_grid->CellStyle(index.row() + 1, index.column() + 1);
    }

    void Click(const CGridCellStyle& style, int row, int col) const {
        CGridCellValue value;
        value.kind = style.kind;
        switch (style.kind) {
        case ZoCellKind::CheckBox:
            value.checked = !style.checked;
            m_grid->StoreCell(row, col, value);
            break;
        case ZoCellKind::PushButton:
            m_grid->OnClickedButtonRowCol(row, col);
            break;
        case ZoCellKind::FileName: {
            QString start = QString::fromStdString(style.text);
            if (m_grid->Dialog() && !style.text.empty())
                start = QString::fromStdString(m_grid->Dialog()->AbsoluteFilePath(style.text));
            const QString filter = style.fileFilter.empty()
                                       ? QStringLiteral("All files (*)")
                                       : QString::fromStdString(style.fileFilter);
            const QString chosen = ZoGetOpenFileName(m_grid, "Select file", start, filter);
            if (chosen.isEmpty())
                return;
            value.text = chosen.toStdString();
            m_grid->StoreCell(row, col, value);
            break;
        }
        default:
            break;
        }
    }

    CZoGridWnd* m_grid;
};

}  // namespace

// --- the row headings: title rows drawn across the whole row ------------------------------

class CZoGridRowHeader : public QHeaderView {
public:
    explicit CZoGridRowHeader(CZoGridWnd* grid) : QHeaderView(Qt::Vertical, grid), m_grid(grid) {
        // As the table's own: a click on a heading selects its row.
        setSectionsClickable(true);
        setHighlightSections(true);
    }

protected:
    void paintSection(QPainter* painter, const QRect& rect, int logicalIndex) const override {
        if (!m_grid->IsTitleRow(logicalIndex + 1)) {
            QHeaderView::paintSection(painter, rect, logicalIndex);
            return;
        }
        const QRect row(-m_grid->horizontalHeader()->offset(), rect.top(),
                        width() + m_grid->horizontalHeader()->length(), rect.height());
        m_grid->PaintTitleRow(*painter, viewport(), logicalIndex + 1, row);
    }

private:
    CZoGridWnd* m_grid;
};

namespace {

// The width and height a heading needs in a header, as the header measures its sections.
QSize HeadingSize(const QHeaderView* header, const QString& text, const QFont& font) {
    QStyleOptionHeader opt;
    opt.initFrom(header);
    opt.orientation = Qt::Horizontal;
    opt.text = text;
    opt.fontMetrics = QFontMetrics(font);
    opt.position = QStyleOptionHeader::OnlyOneSection;
    // A little beyond the style's margins for the section's frame lines.
    return header->style()->sizeFromContents(QStyle::CT_HeaderSection, &opt, QSize(), header) +
           QSize(6, 0);
}

QFont TitleFont(const QFont& font) {
    QFont bold = font;
    bold.setBold(true);
    return bold;
}

}  // namespace

// --- the grid --------------------------------------------------------------------------

CZoGridWnd::CZoGridWnd(QWidget* parent) : QTableView(parent), m_model(new CZoGridModel(this)) {
    setVerticalHeader(new CZoGridRowHeader(this));
    setModel(m_model);
    setItemDelegate(new CZoGridDelegate(this));
    setSelectionMode(QAbstractItemView::ExtendedSelection);
    setSelectionBehavior(QAbstractItemView::SelectItems);
    setEditTriggers(QAbstractItemView::DoubleClicked | QAbstractItemView::SelectedClicked |
                    QAbstractItemView::EditKeyPressed | QAbstractItemView::AnyKeyPressed);
    horizontalHeader()->setSectionsMovable(false);
    verticalHeader()->setSectionsMovable(false);
    horizontalHeader()->setHighlightSections(false);
    verticalHeader()->setHighlightSections(true);
    setWordWrap(false);
    // Column 0's heading is drawn in the corner.
    m_corner = findChild<QAbstractButton*>();
    if (m_corner)
        m_corner->installEventFilter(this);
}

CZoGridWnd::~CZoGridWnd() {
    // Nothing may ask the style query while the derived grid is gone.
    if (selectionModel())
        selectionModel()->clear();
    setModel(nullptr);
}

void CZoGridWnd::SetDialog(CZoSEDlgBase* dialog) {
    if (m_dialogWidget)
        m_dialogWidget->removeEventFilter(this);
    m_dialog = dialog;
    m_dialogWidget = dialog;
    if (m_dialogWidget)
        m_dialogWidget->installEventFilter(this);
}

void CZoGridWnd::SetRowCount(int rows) {
    m_rowCount = std::max(rows, 0);
    Redraw();
}

void CZoGridWnd::SetColCount(int cols) {
    m_colCount = std::max(cols, 0);
    Redraw();
}

int CZoGridWnd::GetRowCount() const { return m_model->rowCount({}); }

void CZoGridWnd::Redraw() {
    m_model->Sync(RowCountFromData(), m_colCount);
    FitToContents();
    viewport()->update();
    horizontalHeader()->viewport()->update();
    verticalHeader()->viewport()->update();
    if (m_corner)
        m_corner->update();
}

bool CZoGridWnd::IsTitleRow(int) const { return false; }

void CZoGridWnd::SetMinimumColumnWidth(int col, int width) {
    if (col < 0)
        return;
    if (static_cast<size_t>(col) >= m_minWidths.size())
        m_minWidths.resize(static_cast<size_t>(col) + 1, 0);
    m_minWidths[static_cast<size_t>(col)] = width;
}

std::vector<int> CZoGridWnd::SampleRows() const {
    constexpr int kEdge = 100;     // rows measured at either end
    constexpr int kBetween = 100;  // rows measured between them, evenly spread
    const int rows = GetRowCount();
    std::vector<int> sample;
    if (rows <= 2 * kEdge + kBetween) {
        for (int r = 1; r <= rows; ++r)
            sample.push_back(r);
        return sample;
    }
    for (int r = 1; r <= kEdge; ++r)
        sample.push_back(r);
    const double step = double(rows - 2 * kEdge) / (kBetween + 1);
    for (int i = 1; i <= kBetween; ++i)
        sample.push_back(kEdge + static_cast<int>(i * step));
    for (int r = rows - kEdge + 1; r <= rows; ++r)
        sample.push_back(r);
    return sample;
}

void CZoGridWnd::FitColumns() {
    const int cols = m_model->columnCount({});
    const std::vector<int> sample = SampleRows();
    auto minimum = [&](int col) {
        return static_cast<size_t>(col) < m_minWidths.size() ? m_minWidths[static_cast<size_t>(col)] : 0;
    };
    QHeaderView* rowHeader = verticalHeader();
    QHeaderView* colHeader = horizontalHeader();
    const QFont rowFont = rowHeader->font();

    // Cells: each column as wide as its widest text, every row as high as the tallest cell.
    // The item view draws its text inside margins of its own beyond the size it asks for.
    constexpr int kTextSlack = 8;
    int height = std::max(HeadingSize(rowHeader, QStringLiteral("Xg"), rowFont).height(),
                          fontMetrics().height() + 8);
    int cellsWidth = 0;
    for (int c = 1; c <= cols; ++c) {
        int width = colHeader->sectionSizeHint(c - 1);
        for (int r : sample) {
            if (IsTitleRow(r))
                continue;
            const QSize hint = sizeHintForIndex(IndexOf(r, c));
            width = std::max(width, hint.width() + kTextSlack);
            height = std::max(height, hint.height());
        }
        width = std::max(width, minimum(c));
        if (columnWidth(c - 1) != width)
            setColumnWidth(c - 1, width);
        cellsWidth += width;
    }

    // Row headings with the heading of their column, drawn in the corner; a title spans the
    // whole row, so only what the cells leave is asked of the headings' column.
    int headings = HeadingSize(colHeader, CellStyle(0, 0).DisplayText(), colHeader->font()).width();
    int titles = 0;
    for (int r : sample) {
        const QString text = CellStyle(r, 0).DisplayText();
        if (IsTitleRow(r))
            titles = std::max(titles, HeadingSize(rowHeader, text, TitleFont(rowFont)).width());
        else
            headings = std::max(headings, HeadingSize(rowHeader, text, rowFont).width());
    }
    headings = std::max({headings, titles - cellsWidth, minimum(0)});
    if (rowHeader->minimumWidth() != headings || rowHeader->maximumWidth() != headings)
        rowHeader->setFixedWidth(headings);
    if (rowHeader->defaultSectionSize() != height || rowHeader->length() != height * GetRowCount())
        rowHeader->setDefaultSectionSize(height);
}

void CZoGridWnd::FitToContents() {
    FitColumns();
    SizeToDialog();
}

QSize CZoGridWnd::ContentSize() const {
    // As the table lays out its headers.
    const QHeaderView* rows = verticalHeader();
    const QHeaderView* cols = horizontalHeader();
    const int headingsWidth =
        rows->isHidden() ? 0
                         : std::min(std::max(rows->minimumWidth(), rows->sizeHint().width()), rows->maximumWidth());
    const int headingsHeight =
        cols->isHidden() ? 0
                         : std::min(std::max(cols->minimumHeight(), cols->sizeHint().height()), cols->maximumHeight());
    return {headingsWidth + cols->length(), headingsHeight + rows->length()};
}

void CZoGridWnd::PaintTitleRow(QPainter& painter, QWidget* on, int row, const QRect& rowRect) {
    painter.save();
    painter.setClipRect(on->rect().intersected(rowRect));
    painter.setFont(TitleFont(verticalHeader()->font()));
    QStyleOptionHeader opt;
    opt.initFrom(on);
    opt.rect = rowRect;
    opt.orientation = Qt::Horizontal;
    opt.position = QStyleOptionHeader::OnlyOneSection;
    opt.textAlignment = Qt::AlignCenter;
    opt.state |= QStyle::State_Raised;
    opt.text = CellStyle(row, 0).DisplayText();
    style()->drawControl(QStyle::CE_Header, &opt, &painter, on);
    painter.restore();
}

void CZoGridWnd::paintEvent(QPaintEvent* event) {
    QTableView::paintEvent(event);
    const int rows = GetRowCount();
    if (rows == 0)
        return;
    // Only the rows in view: a long list costs no more than a short one.
    int first = rowAt(0);
    int last = rowAt(viewport()->height() - 1);
    if (first < 0)
        return;
    if (last < 0)
        last = rows - 1;
    QPainter painter(viewport());
    const int headings = verticalHeader()->width();
    for (int r = first; r <= last; ++r) {
        if (!IsTitleRow(r + 1))
            continue;
        const QRect row(-horizontalHeader()->offset() - headings, rowViewportPosition(r),
                        headings + horizontalHeader()->length(), rowHeight(r));
        PaintTitleRow(painter, viewport(), r + 1, row);
    }
}

void CZoGridWnd::SizeToDialog() {
    QWidget* frame = m_dialogWidget ? m_dialogWidget.data() : window();
    if (!frame || frame == this || !frame->isAncestorOf(this) || m_fitting)
        return;
    m_fitting = true;
    // The dialog's right and bottom margins: its layout's, or else 7 dialog units of its font.
    const QFontMetrics fm(frame->font());
    int marginX = 7 * fm.averageCharWidth() / 4;
    int marginY = 7 * fm.height() / 8;
    if (frame->layout()) {
        marginX = frame->layout()->contentsMargins().right();
        marginY = frame->layout()->contentsMargins().bottom();
    }
    const QPoint topLeft = mapTo(frame, QPoint(0, 0));
    // The frame is outside the cells: what is left for them is the space less the frame.
    const int frameSize = 2 * frameWidth();
    const QSize available(frame->width() - marginX - topLeft.x() - frameSize,
                          frame->height() - marginY - topLeft.y() - frameSize);
    const QSize content = ContentSize();
    if (available.width() <= 0 || available.height() <= 0)
        m_fit = ZoGridFit{content, false, false};  // not laid out yet
    else
        m_fit = ZoFitGrid(available, content, verticalScrollBar()->sizeHint().width(),
                          horizontalScrollBar()->sizeHint().height());
    m_fitted = true;
    setHorizontalScrollBarPolicy(m_fit.horizontalBar ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAsNeeded);
    setVerticalScrollBarPolicy(m_fit.verticalBar ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAsNeeded);
    const QSize total = sizeHint();
    setMaximumSize(total);
    resize(total);
    updateGeometry();
    m_fitting = false;
}

QSize CZoGridWnd::sizeHint() const {
    if (!m_fitted)
        return QTableView::sizeHint();
    return m_fit.size + QSize(2 * frameWidth(), 2 * frameWidth());
}

QSize CZoGridWnd::minimumSizeHint() const {
    // A short grid keeps all its rows in view (the editor scrolls the dialog instead); a
    // long one settles for a few rows and scrolls itself.
    const QSize hint = sizeHint();
    return QSize(std::min(hint.width(), 480), std::min(hint.height(), 240));
}

CGridCellStyle CZoGridWnd::CellStyle(int row, int col) {
    CGridCellStyle style;
    GetStyleRowCol(row, col, style);
    return style;
}

void CZoGridWnd::GetStyleRowCol(int, int, CGridCellStyle&) {}

int CZoGridWnd::StoreStyleRowCol(int, int, const CGridCellValue&) { return 0; }

void CZoGridWnd::OnClickedButtonRowCol(int, int) {}

void CZoGridWnd::StoreCell(int row, int col, const CGridCellValue& value) {
    QPointer<CZoGridWnd> self(this);
    const int hint = StoreStyleRowCol(row, col, value);
    if (!self || hint == 0)
        return;
    Redraw();
    UpdateDoc(hint);
}

void CZoGridWnd::UpdateDoc(int hint) {
    if (CZoSEDlgBase* dialog = Dialog())
        dialog->UpdateDoc(hint);
}

bool CZoGridWnd::GetCurrentCell(int& row, int& col) const {
    const QModelIndex current = currentIndex();
    if (!current.isValid())
        return false;
    row = current.row() + 1;
    col = current.column() + 1;
    return true;
}

void CZoGridWnd::SetCurrentCell(int row, int col) {
    const QModelIndex index = IndexOf(row, std::max(col, 1));
    if (index.isValid())
        selectionModel()->setCurrentIndex(index, QItemSelectionModel::NoUpdate);
}

std::vector<CZoGridWnd::RowRange> CZoGridWnd::GetSelectedRowRanges() const {
    std::vector<RowRange> ranges;
    const int cols = m_model->columnCount({});
    if (cols == 0 || !selectionModel())
        return ranges;
    std::vector<int> rows;
    for (const QItemSelectionRange& r : selectionModel()->selection())
        if (r.left() == 0 && r.right() == cols - 1)
            for (int row = r.top(); row <= r.bottom(); ++row)
                rows.push_back(row + 1);
    std::sort(rows.begin(), rows.end());
    rows.erase(std::unique(rows.begin(), rows.end()), rows.end());
    for (int row : rows) {
        if (!ranges.empty() && ranges.back().bottom + 1 == row)
            ranges.back().bottom = row;
        else
            ranges.push_back({row, row});
    }
    return ranges;
}

void CZoGridWnd::SelectRows(int top, int bottom) {
    const QModelIndex from = IndexOf(top, 1);
    const QModelIndex to = IndexOf(bottom, m_model->columnCount({}));
    if (from.isValid() && to.isValid())
        selectionModel()->select(QItemSelection(from, to), QItemSelectionModel::ClearAndSelect);
}

void CZoGridWnd::ClearSelection() {
    if (selectionModel())
        selectionModel()->clearSelection();
}

QModelIndex CZoGridWnd::IndexOf(int row, int col) const { return m_model->index(row - 1, col - 1); }

QRect CZoGridWnd::CellRect(int row, int col) const { return visualRect(IndexOf(row, col)); }

void CZoGridWnd::mousePressEvent(QMouseEvent* event) {
    QTableView::mousePressEvent(event);
    // A click activates the cell: editable cells open their editor at once.
    if (event->button() != Qt::LeftButton || event->modifiers() != Qt::NoModifier ||
        state() == QAbstractItemView::EditingState)
        return;
    const QModelIndex index = indexAt(event->position().toPoint());
    if (!index.isValid() || !(index.flags() & Qt::ItemIsEditable))
        return;
    const CGridCellStyle style = CellStyle(index.row() + 1, index.column() + 1);
    if (style.kind == ZoCellKind::FileName &&
        FileButtonRect(visualRect(index)).contains(event->position().toPoint()))
        return;
    edit(index);
}

bool CZoGridWnd::eventFilter(QObject* watched, QEvent* event) {
    if (watched == m_dialogWidget.data() && m_fitted &&
        (event->type() == QEvent::Resize || event->type() == QEvent::Show)) {
        SizeToDialog();
    } else if (event->type() == QEvent::Paint && m_corner && watched == m_corner) {
        auto* corner = static_cast<QAbstractButton*>(watched);
        QStyleOptionHeader opt;
        opt.initFrom(corner);
        opt.rect = corner->rect();
        opt.position = QStyleOptionHeader::OnlyOneSection;
        opt.textAlignment = Qt::AlignCenter;
        const CGridCellStyle style = CellStyle(0, 0);
        opt.text = style.DisplayText();
        if (style.readOnly)
            opt.palette.setColor(QPalette::ButtonText, QColor(160, 160, 160));
        QPainter painter(corner);
        corner->style()->drawControl(QStyle::CE_Header, &opt, &painter, corner);
        return true;
    }
    return QTableView::eventFilter(watched, event);
}

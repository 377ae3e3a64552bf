#include "ZoNumberEdit.h"

#include "ZoPrompts.h"
#include "ZoSEDlgBase.h"

#include <QPointer>
#include <QToolButton>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

CZoNumberEdit::CZoNumberEdit(QWidget* parent) : CZoNumberEdit(CZoEditStyle(), parent) {}

CZoNumberEdit::CZoNumberEdit(const CZoEditStyle& style, QWidget* parent) : QLineEdit(parent) {
    SetStyle(style);
    connect(this, &QLineEdit::editingFinished, this, [this] { Commit(true); });
    connect(this, &QLineEdit::textEdited, this, [this] {
        if (m_storeOnChange)
            Commit(false);
    });
}

void CZoNumberEdit::SetStyle(const CZoEditStyle& style) {
    m_style = style;
    setToolTip(QString::fromStdString(m_style.ToolTip()));
    if (IsBound())
        Refresh();
}

void CZoNumberEdit::BindDouble(CZoSEDlgBase* dialog, std::function<double()> get,
                               std::function<void(double)> set) {
    m_kind = ZoNumberKind::Double;
    m_dialog = dialog;
    m_get = std::move(get);
    m_set = std::move(set);
    Refresh();
}

void CZoNumberEdit::BindDouble(CZoSEDlgBase* dialog, double& value) {
    BindDouble(dialog, [&value] { return value; }, [&value](double v) { value = v; });
}

void CZoNumberEdit::BindFloat(CZoSEDlgBase* dialog, std::function<float()> get,
                              std::function<void(float)> set) {
    m_kind = ZoNumberKind::Float;
    m_dialog = dialog;
    m_get = [get = std::move(get)] { return static_cast<double>(get()); };
    m_set = [set = std::move(set)](double v) { set(static_cast<float>(v)); };
    Refresh();
}

void CZoNumberEdit::BindFloat(CZoSEDlgBase* dialog, float& value) {
    BindFloat(dialog, [&value] { return value; }, [&value](float v) { value = v; });
}

void CZoNumberEdit::BindInt(CZoSEDlgBase* dialog, std::function<int()> get,
                            std::function<void(int)> set) {
    m_kind = ZoNumberKind::Int;
    m_dialog = dialog;
    m_get = [get = std::move(get)] { return static_cast<double>(get()); };
    m_set = [set = std::move(set)](double v) { set(static_cast<int>(v)); };
    Refresh();
}

void CZoNumberEdit::BindInt(CZoSEDlgBase* dialog, int& value) {
    BindInt(dialog, [&value] { return value; }, [&value](int v) { value = v; });
}

void CZoNumberEdit::ShowText(const QString& text) {
    m_shownText = text;
    m_waiting = false;
    if (QLineEdit::text() != text)
        setText(text);
}

void CZoNumberEdit::Refresh() {
    if (m_get)
        ShowText(m_style.Format(m_get(), m_kind));
}

void CZoNumberEdit::ShowValue(double internal, ZoNumberKind kind) {
    m_kind = kind;
    ShowText(m_style.Format(internal, kind));
}

bool CZoNumberEdit::ReadValue(double& internal, QString& message) const {
    return m_style.Parse(text(), m_kind, internal, message);
}

void CZoNumberEdit::StepBy(int delta) {
    double current = 0.0;
    QString message;
    if (!ReadValue(current, message))
        current = m_get ? m_get() : 0.0;
    double next = current + delta;
    if (m_style.HasMinimum())
        next = std::max(next, m_style.Minimum());
    if (m_style.HasMaximum())
        next = std::min(next, m_style.Maximum());
    if (next == current && text() == m_shownText)
        return;
    setText(m_style.Format(next, m_kind));
    // A step gives a whole value: nothing more will be typed after it.
    Commit(true);
}

void CZoNumberEdit::Commit(bool finished) {
    if (!m_get || m_busy)
        return;
    const QString typed = text();
    if (finished) {
        // Leaving a field without typing stores nothing: a rounded display must not
        // overwrite the value it shows. A count that waited for more digits was typed.
        if (typed == m_shownText && !m_waiting)
            return;
    } else {
        const QString t = typed.trimmed();
        if (t.isEmpty() || t == "-" || t == "+")
            return;  // still typing
    }
    double value = 0.0;
    QString message;
    if (!ReadValue(value, message)) {
        m_busy = true;
        Refresh();
        m_busy = false;
        ZoShowMessage(this, message);
        return;
    }
    // A count that more digits could still turn into another valid count waits for them or
    // for the field to be left: "1" on the way to "12" must not first cut the lists to one
    // item and lose the items' values.
    if (!finished && m_kind == ZoNumberKind::Int && m_style.HasMaximum() && value > 0 &&
        value * 10 <= m_style.Maximum()) {
        m_waiting = true;
        return;
    }
    m_waiting = false;
    QPointer<CZoNumberEdit> self(this);
    QPointer<CZoSEDlgBase> dialog(m_dialog);
    const ZoEditSourceScope source(this);
    m_busy = true;
    m_set(value);
    Refresh();
    m_busy = false;
    if (dialog)
        dialog->UpdateDoc(kHintValueChanged);
    if (self)
        emit Stored();
}

CZoSpinButton::CZoSpinButton(CZoNumberEdit* buddy, QWidget* parent)
    : QWidget(parent), m_up(new QToolButton(this)), m_down(new QToolButton(this)) {
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    const int h = std::max(8, buddy->sizeHint().height() / 2);
    for (QToolButton* b : {m_up, m_down}) {
        b->setAutoRepeat(true);
        b->setFixedSize(h + 6, h);
        b->setFocusPolicy(Qt::NoFocus);
        layout->addWidget(b);
    }
    m_up->setArrowType(Qt::UpArrow);
    m_down->setArrowType(Qt::DownArrow);
    QPointer<CZoNumberEdit> target(buddy);
    connect(m_up, &QToolButton::clicked, this, [target] {
        if (target)
            target->StepBy(1);
    });
    connect(m_down, &QToolButton::clicked, this, [target] {
        if (target)
            target->StepBy(-1);
    });
}

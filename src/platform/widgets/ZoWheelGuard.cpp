#include "ZoWheelGuard.h"

#include <QAbstractScrollArea>
#include <QAbstractSlider>
#include <QAbstractSpinBox>
#include <QApplication>
#include <QComboBox>
#include <QPointer>
#include <QWheelEvent>

namespace {

// The value widget a wheel event over this widget would change (a spin box's line edit
// belongs to its spin box).
QWidget* ValueWidgetAt(QWidget* w) {
    for (int depth = 0; w && depth < 2; ++depth, w = w->parentWidget()) {
        if (qobject_cast<QComboBox*>(w) || qobject_cast<QAbstractSpinBox*>(w))
            return w;
        // Scroll bars are sliders too, and scrolling is what they are for.
        if (auto* slider = qobject_cast<QAbstractSlider*>(w);
            slider && !slider->inherits("QScrollBar"))
            return w;
    }
    return nullptr;
}

class CWheelGuard : public QObject {
public:
    using QObject::QObject;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (!watched->isWidgetType())
            return false;
        auto* widget = static_cast<QWidget*>(watched);
        if (event->type() == QEvent::Polish) {
            // The wheel must not give these the focus either, or the next roll edits.
            if (widget->focusPolicy() == Qt::WheelFocus && ValueWidgetAt(widget) == widget)
                widget->setFocusPolicy(Qt::StrongFocus);
            return false;
        }
        if (event->type() != QEvent::Wheel)
            return false;
        QWidget* value = ValueWidgetAt(widget);
        if (!value || value->hasFocus() || (value->focusProxy() && value->focusProxy()->hasFocus()))
            return false;
        if (m_forwarding)
            return true;
        // Hand the event to the scroll area behind the field, so that the form scrolls.
        QWidget* behind = nullptr;
        for (QWidget* w = value->parentWidget(); w && !behind; w = w->parentWidget())
            if (auto* area = qobject_cast<QAbstractScrollArea*>(w))
                behind = area->viewport();
        if (behind) {
            const auto* wheel = static_cast<QWheelEvent*>(event);
            const QPointF pos = behind->mapFromGlobal(wheel->globalPosition());
            QWheelEvent copy(pos, wheel->globalPosition(), wheel->pixelDelta(), wheel->angleDelta(),
                             wheel->buttons(), wheel->modifiers(), wheel->phase(), wheel->inverted(),
                             wheel->source());
            m_forwarding = true;
            QCoreApplication::sendEvent(behind, &copy);
            m_forwarding = false;
        }
        return true;
    }

private:
    bool m_forwarding = false;
};

}  // namespace

void ZoInstallWheelGuard() {
    static QPointer<CWheelGuard> guard;
    if (guard || !qApp)
        return;
    guard = new CWheelGuard(qApp);
    qApp->installEventFilter(guard);
}

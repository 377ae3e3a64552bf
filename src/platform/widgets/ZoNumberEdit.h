// Number fields bound to a value of the node. A field shows the value in the user's unit of
// its unit group and stores it in the internal unit when the user leaves it (or, for counts,
// on every change). A refused entry leaves the node as it was, shows the node's value again
// and tells the user why through ZoShowMessage.
//
//   m_velocity = new CZoNumberEdit(CZoEditStyle().SetOvuUnitBaseGroup(100128), this);
//   m_velocity->BindDouble(this, [this] { return Item()->Velocity(); },
//                          [this](double v) { Item()->Velocity(v); });
//
// CZoSEDlgBase::SetData refreshes every bound field of the dialog.
#pragma once

#include "ZoEditStyle.h"

#include <QLineEdit>
#include <QWidget>

#include <functional>

class CZoSEDlgBase;
class QToolButton;

class CZoNumberEdit : public QLineEdit {
    Q_OBJECT
public:
    explicit CZoNumberEdit(QWidget* parent = nullptr);
    explicit CZoNumberEdit(const CZoEditStyle& style, QWidget* parent = nullptr);

    void SetStyle(const CZoEditStyle& style);
    const CZoEditStyle& Style() const { return m_style; }
    ZoNumberKind Kind() const { return m_kind; }

    // Binding to a value in the internal unit. After each store the dialog, when given,
    // receives UpdateDoc(1); pass null where the setter reports to the document itself.
    void BindDouble(CZoSEDlgBase* dialog, std::function<double()> get,
                    std::function<void(double)> set);
    void BindDouble(CZoSEDlgBase* dialog, double& value);
    void BindFloat(CZoSEDlgBase* dialog, std::function<float()> get,
                   std::function<void(float)> set);
    void BindFloat(CZoSEDlgBase* dialog, float& value);
    void BindInt(CZoSEDlgBase* dialog, std::function<int()> get, std::function<void(int)> set);
    void BindInt(CZoSEDlgBase* dialog, int& value);
    bool IsBound() const { return static_cast<bool>(m_get); }

    // Counts store on every change of the text instead of when the field is left; a count
    // that further digits could still change ("1" of a field up to 12) waits until then.
    void SetStoreOnChange(bool onChange) { m_storeOnChange = onChange; }
    bool StoresOnChange() const { return m_storeOnChange; }

    // Shows the bound value (SetData does this for every bound field).
    void Refresh();
    // Spin buttons: shows the value plus delta, kept in range, and stores it as typed.
    void StepBy(int delta);

    // Without a binding (grid cells): show a value of the kind; read the text back.
    void ShowValue(double internal, ZoNumberKind kind);
    bool ReadValue(double& internal, QString& message) const;

signals:
    // A value was stored into the node.
    void Stored();

private:
    void Commit(bool finished);
    void ShowText(const QString& text);

    CZoEditStyle m_style;
    ZoNumberKind m_kind = ZoNumberKind::Double;
    CZoSEDlgBase* m_dialog = nullptr;
    std::function<double()> m_get;
    std::function<void(double)> m_set;
    bool m_storeOnChange = false;
    bool m_busy = false;
    bool m_waiting = false;  // a typed count waits for more digits or for the field to be left
    QString m_shownText;
};

// A pair of arrow buttons beside a number field; each click steps the field by one.
class CZoSpinButton : public QWidget {
    Q_OBJECT
public:
    explicit CZoSpinButton(CZoNumberEdit* buddy, QWidget* parent = nullptr);
    QToolButton* UpButton() const { return m_up; }
    QToolButton* DownButton() const { return m_down; }

private:
    QToolButton* m_up;
    QToolButton* m_down;
};

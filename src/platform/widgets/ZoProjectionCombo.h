// The projection drop-down list of the forms: the registry's entries, each with its
// description as a tool tip. A stored string that the registry does not list (an "EPSG:n"
// code, or one no longer known) is shown as an extra entry rather than lost.
#pragma once

#include <QComboBox>

#include <string>

class CZoProjectionCombo : public QComboBox {
    Q_OBJECT
public:
    explicit CZoProjectionCombo(QWidget* parent = nullptr);

    void SetProjection(const std::string& projection);
    std::string Projection() const;

signals:
    // The user chose another projection.
    void projectionChosen(const std::string& projection);

private:
    int m_registered = 0;
};

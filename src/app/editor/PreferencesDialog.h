// The user's unit for each unit group, remembered between runs.
#pragma once

#include <QDialog>

#include <vector>

class QComboBox;

class CPreferencesDialog : public QDialog {
    Q_OBJECT
public:
    explicit CPreferencesDialog(QWidget* parent = nullptr);

    // Chooses a unit by name for a unit group; false when the group has no such unit.
    bool ChooseUnit(long group, const QString& unitName);
    // Makes the choices the user's units and remembers them.
    void Apply();

    // The remembered units, made the user's units (at start-up).
    static void LoadRemembered();

private:
    void RestoreDefaults();
    struct Row {
        long group;
        QComboBox* units;
    };
    std::vector<Row> m_rows;
};

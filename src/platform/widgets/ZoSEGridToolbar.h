// The grid toolbar: insert, delete, move up and move down for the grid it serves.
#pragma once

#include <QPointer>
#include <QToolBar>

class CZoSEGridWndBaseInterface;
class QAction;

class CZoSEGridToolbar : public QToolBar {
    Q_OBJECT
public:
    explicit CZoSEGridToolbar(CZoSEGridWndBaseInterface* grid, QWidget* parent = nullptr);

    QAction* InsertAction() const { return m_insert; }
    QAction* DeleteAction() const { return m_delete; }
    QAction* MoveUpAction() const { return m_up; }
    QAction* MoveDownAction() const { return m_down; }

private:
    QPointer<CZoSEGridWndBaseInterface> m_grid;
    QAction* m_insert;
    QAction* m_delete;
    QAction* m_up;
    QAction* m_down;
};

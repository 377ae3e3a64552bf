#include "ZoSEGridToolbar.h"

#include "ZoSEGridWndBase.h"

#include <QAction>
#include <QStyle>

CZoSEGridToolbar::CZoSEGridToolbar(CZoSEGridWndBaseInterface* grid, QWidget* parent)
    : QToolBar(parent), m_grid(grid) {
    setIconSize(QSize(16, 16));
    setToolButtonStyle(Qt::ToolButtonIconOnly);
    auto add = [this](QStyle::StandardPixmap icon, const char* text, const char* tip,
                      const char* name, void (CZoSEGridWndBaseInterface::*op)()) {
        QAction* action = addAction(style()->standardIcon(icon), text);
        action->setToolTip(tip);
        action->setObjectName(name);
        connect(action, &QAction::triggered, this, [this, op] {
            if (m_grid)
                (m_grid.data()->*op)();
        });
        return action;
    };
    m_insert = add(QStyle::SP_FileDialogNewFolder, "Insert", "Insert items before the selected rows",
                   "insertItems", &CZoSEGridWndBaseInterface::InsertItems);
    m_delete = add(QStyle::SP_TrashIcon, "Delete", "Delete the selected rows", "deleteItems",
                   &CZoSEGridWndBaseInterface::DeleteItems);
    m_up = add(QStyle::SP_ArrowUp, "Move Up", "Move the selected rows up", "moveItemsUp",
               &CZoSEGridWndBaseInterface::MoveItemsUp);
    m_down = add(QStyle::SP_ArrowDown, "Move Down", "Move the selected rows down",
                 "moveItemsDown", &CZoSEGridWndBaseInterface::MoveItemsDown);
}

// Services of the editor's base library that dialogs call.
#pragma once

#include "common/Platform.h"

#include <vector>

class CZoDataViewerDlg;
class CZoSEDlgBase;
class QWidget;

class CFemBase {
public:
    // Opens the data viewer on a file (an absolute path) with the given item numbers (all
    // items, up to a screenful, when none are given). The window deletes itself when closed.
    static CZoDataViewerDlg* OpenDataFile(const CString& path, const std::vector<int>& items,
                                          QWidget* parent = nullptr);
    // The same for a file name as a setup stores it: relative to the setup's folder.
    static CZoDataViewerDlg* OpenDataFile(CZoSEDlgBase* from, const CString& fileName,
                                          const std::vector<int>& items);
};

// A dialog of pages: each page is a section dialog created from its class name and bound to
// a node. The sheet is its pages' host: their update hints reach the document as the sheet's,
// and the document's refresh of the sheet refreshes every page.
#pragma once

#include "ZoSEDlgBase.h"

#include <memory>

class QTabWidget;

class CFemPropertySheetDlg : public CZoSEDlgBase {
    Q_OBJECT
public:
    explicit CFemPropertySheetDlg(QWidget* parent = nullptr);
    ~CFemPropertySheetDlg() override;

    // Creates, binds and initialises a page of the dialog class for node (the sheet's own
    // node when null); the title defaults to the node's. Null for an unknown class name.
    CZoSEDlgBase* AddPage(const char* className, CZoSEKivBase* node = nullptr,
                          const CString& title = CString());
    int GetPageCount() const;
    CZoSEDlgBase* GetPage(int index) const;
    int GetActiveIndex() const;
    void SetActivePage(int index);
    QTabWidget* Tabs() const { return m_tabs; }

    // The page shown first when a sheet is initialised (kept for the next sheet as well).
    static void SetInitialSelectedPage(int index);
    static int GetInitialSelectedPage();

    // Derived sheets add their pages, then call this: it selects the initial page.
    void Initialize() override;
    void SetData() override;
    // The help of the page shown, or the sheet's own when the page has none.
    unsigned long CurrentHelpID() const override;

private:
    class PageHost;
    std::unique_ptr<PageHost> m_pageHost;
    QTabWidget* m_tabs;
    static int s_initialPage;
};

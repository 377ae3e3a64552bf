#include "FemPropertySheetDlg.h"

#include <QTabWidget>
#include <QVBoxLayout>

int CFemPropertySheetDlg::s_initialPage = 0;

// The pages' host: everything goes on to the sheet's own host, as the sheet's.
class CFemPropertySheetDlg::PageHost : public CDialogHost {
public:
    explicit PageHost(CFemPropertySheetDlg* sheet) : m_sheet(sheet) {}
    void UpdateDoc(CZoSEDlgBase* page, int hint) override {
        // A page edits its own node; it counts as touched as well as the sheet's.
        if (page && page->GetSection())
            page->GetSection()->SetHasBeenTouched(true);
        m_sheet->UpdateDoc(hint);
    }
    void SelectTreeItem(CZoSEKivBase* node) override { m_sheet->SelectTreeItem(node); }
    void ShowHelp(unsigned long helpId) override {
        if (m_sheet->Host())
            m_sheet->Host()->ShowHelp(helpId);
    }
    CString AbsoluteFilePath(const CString& path) override {
        return m_sheet->AbsoluteFilePath(path);
    }

private:
    CFemPropertySheetDlg* m_sheet;
};

CFemPropertySheetDlg::CFemPropertySheetDlg(QWidget* parent)
    : CZoSEDlgBase(parent), m_pageHost(std::make_unique<PageHost>(this)),
      m_tabs(new QTabWidget(this)) {
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_tabs);
    connect(m_tabs, &QTabWidget::currentChanged, this, &CZoSEDlgBase::helpTopicChanged);
}

CFemPropertySheetDlg::~CFemPropertySheetDlg() = default;

CZoSEDlgBase* CFemPropertySheetDlg::AddPage(const char* className, CZoSEKivBase* node,
                                            const CString& title) {
    CZoSEDlgBase* page = CreateDialogFromClass(className);
    if (!page)
        return nullptr;
    if (!node)
        node = GetSection();
    CString text = title;
    if (text.empty() && node)
        text = node->GetTitle();
    m_tabs->addTab(page, QString::fromStdString(text));
    page->Attach(node, m_pageHost.get());
    page->Initialize();
    return page;
}

int CFemPropertySheetDlg::GetPageCount() const { return m_tabs->count(); }

CZoSEDlgBase* CFemPropertySheetDlg::GetPage(int index) const {
    return qobject_cast<CZoSEDlgBase*>(m_tabs->widget(index));
}

int CFemPropertySheetDlg::GetActiveIndex() const { return m_tabs->currentIndex(); }

void CFemPropertySheetDlg::SetActivePage(int index) {
    if (index >= 0 && index < m_tabs->count())
        m_tabs->setCurrentIndex(index);
}

void CFemPropertySheetDlg::SetInitialSelectedPage(int index) { s_initialPage = index; }

int CFemPropertySheetDlg::GetInitialSelectedPage() { return s_initialPage; }

void CFemPropertySheetDlg::Initialize() {
    SetActivePage(s_initialPage < m_tabs->count() ? s_initialPage : 0);
    CZoSEDlgBase::Initialize();
}

void CFemPropertySheetDlg::SetData() {
    CZoSEDlgBase::SetData();
    for (int i = 0; i < GetPageCount(); ++i)
        GetPage(i)->SetData();
}

unsigned long CFemPropertySheetDlg::CurrentHelpID() const {
    const CZoSEDlgBase* page = GetPage(GetActiveIndex());
    const unsigned long id = page ? page->CurrentHelpID() : 0;
    return id != 0 ? id : GetHelpID();
}

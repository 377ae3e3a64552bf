// The editor's pages as a modeller reads them: grids that show what they hold within the
// page, help that names the page on show, a tree that stays with the form, and messages
// that name places by their titles.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "HelpTopics.h"
#include "conditions/InitialConditionsKiv.h"
#include "core/MudTransportModuleKiv.h"
#include "dredging/MTDredgingFile.h"
#include "dredging/MTDredgingItemsKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/UnitUtil.h"
#include "forcings/ForcingsWavesKiv.h"
#include "support/UiTestSupport.h"
#include "widgets/FemPropertySheetDlg.h"
#include "widgets/ZoGridWnd.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDir>
#include <QFile>
#include <QHeaderView>
#include <QLineEdit>
#include <QScrollArea>
#include <QScrollBar>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTextBrowser>
#include <QToolButton>
#include <QTreeWidget>

#include <gtest/gtest.h>

#include <memory>

namespace {

const QString kExample = QStringLiteral(MUD_SOURCE_DIR "/examples/estuary.setup");

class EditorPages : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, m_dir.filePath("settings"));
        EditorSettings().clear();
        CUnitUtil::ResetUserUnits();
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([](const CEditorWindow::Prompt&) { return QMessageBox::Cancel; });
        m_window->resize(1280, 800);
        m_window->show();
        ASSERT_TRUE(QTest::qWaitForWindowExposed(m_window.get()));
        const QDir examples(QStringLiteral(MUD_SOURCE_DIR "/examples"));
        m_path = m_dir.filePath("estuary.setup");
        ASSERT_TRUE(QFile::copy(kExample, m_path));
        QFile::copy(examples.filePath("estuary.2dm"), m_dir.filePath("estuary.2dm"));
        QDir(m_dir.path()).mkpath("data");
        for (const QString& f : QDir(examples.filePath("data")).entryList(QDir::Files))
            QFile::copy(examples.filePath("data/" + f), m_dir.filePath("data/" + f));
        ASSERT_TRUE(m_window->OpenFile(m_path));
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        CUnitUtil::ResetUserUnits();
    }

    CZoSEDlgBase* Form() { return m_window->CurrentDialog(); }
    // Selects a node and, on a property sheet, the page of that title.
    bool Show(const QString& path, const QString& page = QString()) {
        if (!m_window->SelectPath(path) || !Form())
            return false;
        if (!page.isEmpty()) {
            auto* tabs = Form()->findChild<QTabWidget*>();
            if (!tabs)
                return false;
            int index = -1;
            for (int i = 0; i < tabs->count(); ++i)
                if (tabs->tabText(i) == page)
                    index = i;
            if (index < 0)
                return false;
            tabs->setCurrentIndex(index);
        }
        QApplication::processEvents();
        return true;
    }
    std::vector<CZoGridWnd*> VisibleGrids() {
        std::vector<CZoGridWnd*> grids;
        for (CZoGridWnd* g : Form()->findChildren<CZoGridWnd*>())
            if (g->isVisible())
                grids.push_back(g);
        return grids;
    }

    QTemporaryDir m_dir;
    QString m_path;
    std::unique_ptr<CEditorWindow> m_window;
};

int TextWidth(const QWidget* w, const QString& text) { return w->fontMetrics().horizontalAdvance(text); }

// Every heading, row heading and cell text fits its column, and a grid whose content fits
// the page shows all of it without scroll bars.
void ExpectFits(CZoGridWnd* grid, const std::string& where) {
    SCOPED_TRACE(where + " (" + grid->metaObject()->className() + ")");
    const QHeaderView* rows = grid->verticalHeader();
    EXPECT_LE(TextWidth(grid->horizontalHeader(), grid->CellStyle(0, 0).DisplayText()), rows->width())
        << "corner heading " << grid->CellStyle(0, 0).DisplayText().toStdString();
    for (int c = 1; c <= grid->GetColCount(); ++c) {
        const QString heading = grid->CellStyle(0, c).DisplayText();
        EXPECT_LE(TextWidth(grid->horizontalHeader(), heading), grid->columnWidth(c - 1))
            << "heading " << heading.toStdString();
    }
    for (int r = 1; r <= std::min(grid->GetRowCount(), 50); ++r) {
        if (grid->IsTitleRow(r))
            continue;
        EXPECT_LE(TextWidth(rows, grid->CellStyle(r, 0).DisplayText()), rows->width())
            << "row heading " << grid->CellStyle(r, 0).DisplayText().toStdString();
        for (int c = 1; c <= grid->GetColCount(); ++c) {
            const CGridCellStyle style = grid->CellStyle(r, c);
            // The view keeps a margin on either side of a cell's text.
            EXPECT_LE(TextWidth(grid, style.DisplayText()) + 8, grid->columnWidth(c - 1))
                << "cell " << r << "," << c << " " << style.DisplayText().toStdString();
        }
    }
    // No scroll bar where the whole content is in view.
    const QSize content = grid->ContentSize();
    const bool fits = grid->viewport()->width() >= grid->horizontalHeader()->length() &&
                      grid->viewport()->height() >= grid->verticalHeader()->length();
    if (!grid->LastFit().horizontalBar && !grid->LastFit().verticalBar) {
        EXPECT_TRUE(fits) << "content " << content.width() << "x" << content.height() << " in a viewport of "
                          << grid->viewport()->width() << "x" << grid->viewport()->height();
        EXPECT_FALSE(grid->horizontalScrollBar()->isVisible());
        EXPECT_FALSE(grid->verticalScrollBar()->isVisible());
    }
}

}  // namespace

// Each grid of the editor, in the example as it ships: nothing it holds is hidden, and
// scroll bars appear only where the page is too small.
TEST_F(EditorPages, EveryGridFitsItsContentAndThePage) {
    auto* waves = uitest::FindNodeAs<CForcingsWavesKiv>(m_window->Document().Module(), {"FORCINGS", "WAVES"});
    ASSERT_TRUE(waves);
    waves->WaveType(CForcingsWavesKiv::kWaveDatabase);
    const struct {
        const char* path;
        const char* page;
        int grids;
    } pages[] = {
        {"MUD_TRANSPORT_MODULE/WATER_COLUMN/SAND_FRACTIONS", "", 1},
        {"MUD_TRANSPORT_MODULE/WATER_COLUMN/SETTLING_VELOCITY", "", 1},
        {"MUD_TRANSPORT_MODULE/WATER_COLUMN/DEPOSITION", "", 1},
        {"MUD_TRANSPORT_MODULE/DISPERSION/HORIZONTAL_DISPERSION", "", 1},
        {"MUD_TRANSPORT_MODULE/BED/EROSION", "", 1},
        {"MUD_TRANSPORT_MODULE/BED/BED_DENSITY", "", 1},
        {"MUD_TRANSPORT_MODULE/BED/TRANSITION", "", 1},
        {"MUD_TRANSPORT_MODULE/FORCINGS/WAVES", "", 1},
        {"MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Concentration", "", 1},
        {"MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Layer Thickness", "", 1},
        {"MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Distribution", "", 1},
        {"MUD_TRANSPORT_MODULE/BOUNDARY_CONDITIONS", "List view", 1},
        {"MUD_TRANSPORT_MODULE/SOURCES", "List view", 1},
        {"MUD_TRANSPORT_MODULE/SOURCES/SOURCE_1", "", 1},
        {"MUD_TRANSPORT_MODULE/DREDGING", "", 1},
        {"MUD_TRANSPORT_MODULE/DREDGING/DREDGER_1", "", 1},
        {"MUD_TRANSPORT_MODULE/OUTPUTS", "", 1},
        {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1", "Output specification", 1},
        {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_3", "Output specification", 1},
    };
    for (const auto& p : pages) {
        ASSERT_TRUE(Show(p.path, p.page)) << p.path;
        const std::vector<CZoGridWnd*> grids = VisibleGrids();
        EXPECT_EQ(static_cast<int>(grids.size()), p.grids) << p.path;
        for (CZoGridWnd* grid : grids)
            ExpectFits(grid, p.path);
    }
}


// One fraction: the share of 100 and the heading "Fraction 1" are shown whole.
TEST_F(EditorPages, AOneFractionDistributionShowsItsHeadingAndHundred) {
    m_window->NewSetup(1, 1);
    ASSERT_TRUE(Show("MUD_TRANSPORT_MODULE/INITIAL_CONDITIONS/Fraction Distribution"));
    const std::vector<CZoGridWnd*> grids = VisibleGrids();
    ASSERT_EQ(grids.size(), 1u);
    EXPECT_EQ(grids[0]->CellStyle(0, 1).DisplayText(), "Fraction 1");
    EXPECT_EQ(grids[0]->CellStyle(1, 1).DisplayText(), "100");
    ExpectFits(grids[0], "one fraction");
}

// A value refused as the tree is clicked keeps its form, and the tree shows that form's
// node, current and highlighted, not the node that was clicked.
TEST_F(EditorPages, TheTreeStaysOnTheFormThatKeepsARefusedValue) {
    uitest::MessageRecorder messages;
    ASSERT_TRUE(Show("MUD_TRANSPORT_MODULE/WATER_COLUMN/SETTLING_VELOCITY"));
    CZoSEKivBase* settling = m_window->CurrentNode();
    QLineEdit* field = nullptr;
    for (QLineEdit* edit : Form()->findChildren<QLineEdit*>())
        if (!field && edit->isVisible() && edit->isEnabled() && edit->inherits("CZoNumberEdit"))
            field = edit;
    ASSERT_TRUE(field);
    field->setFocus();
    field->selectAll();
    QTest::keyClicks(field, "x");
    QTreeWidgetItem* deposition = nullptr;
    for (QTreeWidgetItemIterator it(m_window->Tree()); *it && !deposition; ++it)
        if ((*it)->text(0) == "Deposition")
            deposition = *it;
    ASSERT_TRUE(deposition);
    QTest::mouseClick(m_window->Tree()->viewport(), Qt::LeftButton, {},
                      m_window->Tree()->visualItemRect(deposition).center());
    QApplication::processEvents();
    EXPECT_EQ(messages.Messages().size(), 1u);
    EXPECT_EQ(m_window->CurrentNode(), settling);
    ASSERT_TRUE(m_window->Tree()->currentItem());
    EXPECT_EQ(m_window->Tree()->currentItem()->text(0), "Settling");
    const QList<QTreeWidgetItem*> selected = m_window->Tree()->selectedItems();
    ASSERT_EQ(selected.size(), 1);
    EXPECT_EQ(selected.front()->text(0), "Settling");
}

// Messages name places by the titles the user sees, never by internal names, and the place
// is shown whole.
TEST_F(EditorPages, MessagesNamePlacesByTheirTitles) {
    CZoSEKivBase* module = m_window->Document().Module();
    auto* share = InitialConditions(module)->FractionDistribution()->GetItem(1);
    ASSERT_TRUE(share);
    share->GetItem(1)->ConstantValue(share->GetItem(1)->ConstantValue() + 1.0f);
    auto* dredger = uitest::FindNodeAs<CMTDredgingItemsKiv>(module, {"DREDGING", "DREDGER_1"});
    ASSERT_TRUE(dredger);
    dredger->DataFile()->FileName("data/missing.qrd0");
    EXPECT_FALSE(m_window->Validate());

    QStringList sections;
    QTreeWidget* list = m_window->Messages();
    for (int i = 0; i < list->topLevelItemCount(); ++i)
        sections << list->topLevelItem(i)->text(0);
    EXPECT_TRUE(sections.contains("Initial Conditions > Fraction Distribution > Layer 1"))
        << sections.join(" | ").toStdString();
    EXPECT_TRUE(sections.contains("Dredging > Fairway hopper > Dredging file")) << sections.join(" | ").toStdString();
    for (const QString& s : sections) {
        EXPECT_FALSE(s.contains("MT ") || s.contains('_')) << s.toStdString();
        EXPECT_LE(list->fontMetrics().horizontalAdvance(s), list->header()->sectionSize(0)) << s.toStdString();
    }
}

// F1 and the pane's Help button show the topic of the page on show in a sheet of pages, and
// the help pane follows the pages as it follows the tree.
TEST_F(EditorPages, HelpShowsTheTopicOfThePageOnShow) {
    QAction* sectionHelp = nullptr;
    for (QAction* a : m_window->findChildren<QAction*>())
        if (a->shortcut() == QKeySequence(QKeySequence::HelpContents))
            sectionHelp = a;
    ASSERT_TRUE(sectionHelp);
    QToolButton* paneHelp = nullptr;
    for (QToolButton* b : m_window->findChildren<QToolButton*>())
        if (b->text() == "Help")
            paneHelp = b;
    ASSERT_TRUE(paneHelp);
    const QString general = FindHelpTopic(0).title;
    const struct {
        const char* path;
        const char* page;
        unsigned long topic;
    } pages[] = {
        {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1", "Geographic View", 5030},
        {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1", "Output specification", 5032},
        {"MUD_TRANSPORT_MODULE/OUTPUTS/OUTPUT_1", "Output items", 5031},
        {"MUD_TRANSPORT_MODULE/BOUNDARY_CONDITIONS", "Geographic View", 5013},
        {"MUD_TRANSPORT_MODULE/BOUNDARY_CONDITIONS", "List view", 5016},
        {"MUD_TRANSPORT_MODULE/SOURCES", "Geographic View", 5037},
        {"MUD_TRANSPORT_MODULE/SOURCES", "List view", 5038},
    };
    for (const auto& p : pages) {
        SCOPED_TRACE(std::string(p.path) + " " + p.page);
        const QString title = FindHelpTopic(p.topic).title;
        ASSERT_NE(title, general);
        ASSERT_TRUE(Show(p.path, p.page));
        // Followed on show, without asking.
        EXPECT_TRUE(m_window->HelpView()->toPlainText().contains(title));
        m_window->HelpView()->clear();
        m_window->Tree()->setFocus();
        sectionHelp->trigger();
        EXPECT_TRUE(m_window->HelpView()->toPlainText().contains(title));
        m_window->HelpView()->clear();
        paneHelp->click();
        EXPECT_TRUE(m_window->HelpView()->toPlainText().contains(title));
    }
}

// The maps of the host's pages in the editor: a click on the map selects the boundary or
// source in the table and back; a mesh chosen on the domain's page gives the boundaries, and
// one that cannot be read changes nothing.
#include "EditorSettings.h"
#include "EditorWindow.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "projection/ZoMapProjection.h"
#include "widgets/GisNavigationDlg.h"
#include "widgets/ZoProjectionCombo.h"
#include "widgets/ZoPrompts.h"

#include <QFile>
#include <QImage>
#include <QProcess>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableWidget>
#include <QTemporaryDir>
#include <QTest>

#include <gtest/gtest.h>

#include <memory>

namespace {

class HostMaps : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_dir.isValid());
        QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope,
                           m_dir.filePath("settings"));
        EditorSettings().clear();
        for (const char* name : {"estuary.setup", "estuary.2dm"})
            ASSERT_TRUE(
                QFile::copy(QString(MUD_SOURCE_DIR "/examples/") + name, m_dir.filePath(name)));
        m_window = std::make_unique<CEditorWindow>();
        m_window->SetPrompter([](const CEditorWindow::Prompt&) { return QMessageBox::Cancel; });
        m_window->resize(1280, 800);
        m_window->show();
        ASSERT_TRUE(QTest::qWaitForWindowExposed(m_window.get()));
        ASSERT_TRUE(m_window->OpenFile(m_dir.filePath("estuary.setup")));
    }
    void TearDown() override {
        m_window.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
    CMeshNavigationDlg* MapPage() {
        auto* page = m_window->CurrentDialog()->findChild<CMeshNavigationDlg*>();
        EXPECT_NE(page, nullptr);
        return page;
    }
    QTableWidget* Table() { return m_window->CurrentDialog()->findChild<QTableWidget*>(); }
    // Clicks the middle of feature number n of a layer.
    void ClickFeature(int overlay, int n) {
        CZoMapView* map = MapPage()->Map();
        for (const CZoMapFeature& f : map->Overlay(overlay).features)
            if (f.number == n) {
                const QPointF at = f.points[f.points.size() / 2];
                QTest::mouseClick(map, Qt::LeftButton, {}, map->ToPixel(at.x(), at.y()).toPoint());
                return;
            }
        ADD_FAILURE() << "no feature " << n;
    }

    QTemporaryDir m_dir;
    std::unique_ptr<CEditorWindow> m_window;
};

TEST_F(HostMaps, AClickOnTheMapSelectsTheBoundaryOrSourceAndBack) {
    ASSERT_TRUE(m_window->SelectPath("DOMAIN/BOUNDARY_NAMES"));
    CMeshNavigationDlg* page = MapPage();
    ASSERT_TRUE(page->Map()->Mesh());
    EXPECT_EQ(page->Map()->Mesh(), m_window->Document().GetDomain()->Mesh());
    const int boundaries = page->BoundaryOverlay();
    ASSERT_EQ(page->Map()->Overlay(boundaries).features.size(), 3u);
    ClickFeature(boundaries, 3);
    EXPECT_EQ(Table()->currentRow(), 2);
    Table()->setCurrentCell(1, 0);
    EXPECT_EQ(page->Map()->Overlay(boundaries).selected, 2);
    // A renamed boundary is renamed on the map.
    Table()->item(1, 0)->setText("Elbe");
    EXPECT_EQ(MapPage()->Map()->Overlay(boundaries).features[1].name, "Elbe");

    ASSERT_TRUE(m_window->SelectPath("HYDRODYNAMIC_SOURCES"));
    const int sources = MapPage()->SourceOverlay();
    ASSERT_EQ(MapPage()->Map()->Overlay(sources).features.size(), 2u);
    ClickFeature(sources, 2);
    EXPECT_EQ(Table()->currentRow(), 1);
    Table()->setCurrentCell(0, 0);
    EXPECT_EQ(MapPage()->Map()->Overlay(sources).selected, 1);
}

TEST_F(HostMaps, AMeshChosenOnTheDomainPageGivesTheBoundariesAndABadOneChangesNothing) {
    ASSERT_TRUE(m_window->SelectPath("DOMAIN"));
    QFile other(m_dir.filePath("other.2dm"));
    ASSERT_TRUE(other.open(QIODevice::WriteOnly));
    other.write("MESH2D\nE3T 1 1 2 3 1\nND 1 500000 5950000 -3\nND 2 501000 5950000 -4\n"
                "ND 3 501000 5951000 -2\nNS 1 -2 7 Harbour mouth\n");
    other.close();
    QFile bad(m_dir.filePath("bad.2dm"));
    ASSERT_TRUE(bad.open(QIODevice::WriteOnly));
    bad.write("MESH2D\nE3T 1 1 2 3 1\n");
    bad.close();

    QString chosen;
    const ZoOpenFileHook previous = ZoSetOpenFileHook(
        [&](QWidget*, const QString&, const QString&, const QString&) { return chosen; });
    QStringList messages;
    const ZoMessageSink sink =
        ZoSetMessageSink([&](QWidget*, const QString& text) { messages << text; });
    QPushButton* browse = nullptr;
    for (QPushButton* b : m_window->CurrentDialog()->findChildren<QPushButton*>())
        if (b->text() == "Browse...")
            browse = b;
    ASSERT_NE(browse, nullptr);

    CDomainKiv* domain = m_window->Document().GetDomain();
    chosen = m_dir.filePath("bad.2dm");
    browse->click();
    ASSERT_EQ(messages.size(), 1);
    EXPECT_TRUE(messages[0].endsWith("bad.2dm: no nodes (ND)")) << messages[0].toStdString();
    EXPECT_EQ(domain->MeshFile(), "estuary.2dm");
    EXPECT_EQ(domain->BoundaryNames()->GetItemCount(), 3);

    chosen = m_dir.filePath("other.2dm");
    browse->click();
    EXPECT_EQ(messages.size(), 1);
    EXPECT_EQ(domain->MeshFile(), "other.2dm"); // beside the setup: stored relative to it
    ASSERT_EQ(domain->BoundaryNames()->GetItemCount(), 1);
    EXPECT_EQ(domain->BoundaryNames()->GetItem(1)->Identifier(), "Harbour mouth");
    EXPECT_EQ(domain->GetMeshInfo().xMax, 501000.0);
    EXPECT_EQ(MapPage()->Map()->Mesh(), domain->Mesh());
    EXPECT_TRUE(m_window->IsModified());

    ZoSetOpenFileHook(previous);
    ZoSetMessageSink(sink);
}

TEST_F(HostMaps, NotesOnReadingTheMeshAreShownOnTheDomainPageAndInTheMessages) {
    ASSERT_TRUE(m_window->SelectPath("DOMAIN"));
    auto* notes = m_window->CurrentDialog()->findChild<QLabel*>("meshNotes");
    ASSERT_NE(notes, nullptr);
    EXPECT_TRUE(notes->isHidden()); // the example reads without a note
    QFile lines(m_dir.filePath("lines.2dm"));
    ASSERT_TRUE(lines.open(QIODevice::WriteOnly));
    lines.write("MESH2D\nE3T 1 1 2 3 1\nE2L 2 1 2 1\nND 1 500000 5950000 -3\n"
                "ND 2 501000 5950000 -4\nND 3 501000 5951000 -2\n");
    lines.close();
    auto* file = m_window->CurrentDialog()->findChild<QLineEdit*>();
    ASSERT_NE(file, nullptr);
    file->setText("lines.2dm");
    emit file->editingFinished();
    ASSERT_EQ(m_window->Document().GetDomain()->MeshFile(), "lines.2dm");
    EXPECT_FALSE(notes->isHidden());
    EXPECT_TRUE(notes->text().contains("1 line element (E2L, E3L) passed over"))
        << notes->text().toStdString();

    m_window->Validate();
    EXPECT_TRUE(m_window->MessagesText(false).contains(
        "DOMAIN: mesh: 1 line element (E2L, E3L) passed over"))
        << m_window->MessagesText(false).toStdString();
}

TEST_F(HostMaps, TheProjectionListOffersTheRegistryAndRefusesUnknownStrings) {
    ASSERT_TRUE(m_window->SelectPath("DOMAIN"));
    auto* combo = m_window->CurrentDialog()->findChild<CZoProjectionCombo*>();
    ASSERT_NE(combo, nullptr);
    EXPECT_EQ(combo->count(), static_cast<int>(CZoMapProjection::Entries().size()));
    EXPECT_EQ(combo->Projection(), "UTM-32");
    CDomainKiv* domain = m_window->Document().GetDomain();

    QStringList messages;
    const ZoMessageSink sink =
        ZoSetMessageSink([&](QWidget*, const QString& text) { messages << text; });
    auto type = [&](const QString& text) {
        combo->lineEdit()->setText(text);
        emit combo->lineEdit()->editingFinished();
    };
    type("EPSG:25832");
    EXPECT_EQ(domain->Projection(), "EPSG:25832");
    type("MERCATOR");
    EXPECT_EQ(domain->Projection(), "EPSG:25832");
    ASSERT_EQ(messages.size(), 1);
    EXPECT_EQ(messages[0], "Domain: \"MERCATOR\" is not a known projection.");
    combo->setCurrentIndex(combo->findText("UTM-33"));
    emit combo->activated(combo->currentIndex());
    EXPECT_EQ(domain->Projection(), "UTM-33");
    ZoSetMessageSink(sink);

    // A stored string the registry does not list is shown as it is.
    domain->Projection("GK-3");
    m_window->CurrentDialog()->SetData();
    EXPECT_EQ(combo->Projection(), "GK-3");
}
#ifdef MUDSETUP_EDITOR_EXE
TEST(HostMapScreenshot, TheDomainPageShowsTheMesh) {
    QTemporaryDir dir;
    const QString png = dir.filePath("domain.png");
    QProcess p;
    p.start(MUDSETUP_EDITOR_EXE, {"--screenshot", png, "--select", "DOMAIN",
                                  MUD_SOURCE_DIR "/examples/estuary.setup"});
    ASSERT_TRUE(p.waitForFinished(120000));
    ASSERT_EQ(p.exitCode(), 0) << p.readAllStandardError().toStdString();
    const QImage image(png);
    ASSERT_FALSE(image.isNull());
    // The deep water of the estuary: the palette's dark blues, which no form shows.
    int water = 0;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x) {
            const QColor c = image.pixelColor(x, y);
            water += c.red() < 40 && c.green() < 110 && c.blue() > 80;
        }
    EXPECT_GT(water, 2000);
}
#endif

}  // namespace

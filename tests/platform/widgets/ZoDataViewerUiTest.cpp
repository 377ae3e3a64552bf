// The data viewer's plot and field as a user drives them: items on and off, one axis per
// quantity, zoom and pan over time, and a grid's field stepped through time.
#include "widgets/ZoDataViewerDlg.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QPushButton>
#include <QSlider>
#include <QTabWidget>
#include <QTest>
#include <QWheelEvent>

#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

namespace {

const std::string kData = std::string(MUD_SOURCE_DIR) + "/examples/data";

// Screenshots for a look by eye when MUD_SCREENSHOTS names a folder.
void Shoot(QWidget& w, const char* name) {
    if (const char* dir = std::getenv("MUD_SCREENSHOTS"))
        w.grab().save(QString("%1/%2.png").arg(dir, name));
}

void Wheel(QWidget* w, QPoint at, int delta) {
    QWheelEvent e(at, w->mapToGlobal(at), QPoint(), QPoint(0, delta), Qt::NoButton, Qt::NoModifier,
                  Qt::NoScrollPhase, false);
    QApplication::sendEvent(w, &e);
}

}  // namespace

TEST(DataViewerPlot, ItemsOfEachQuantityShareAnAxisAndCheckBoxesHideThem) {
    // x and y in m, the dredged mass in t/h, the spill in %.
    CZoDataViewerDlg viewer(kData + "/dredger_1.qrd0", {1, 2, 3, 4});
    viewer.show();
    CZoLinePlot* plot = viewer.Plot();
    ASSERT_EQ(viewer.ItemChecks().size(), 4u);
    EXPECT_EQ(viewer.ItemChecks()[2]->text(), "rate of dredged mass");
    ASSERT_EQ(plot->Axes().size(), 3);
    EXPECT_TRUE(plot->Axes()[0].endsWith("[m]")) << plot->Axes()[0].toStdString();
    EXPECT_TRUE(plot->Axes()[1].endsWith("[t/h]"));
    Shoot(viewer, "viewer_quantities");

    // Hiding both items in m drops their axis; hiding one keeps it.
    viewer.ItemChecks()[0]->click();
    EXPECT_FALSE(plot->SeriesVisible(0));
    EXPECT_EQ(plot->Axes().size(), 3);
    viewer.ItemChecks()[1]->click();
    EXPECT_EQ(plot->Axes().size(), 2);
    EXPECT_TRUE(plot->Axes()[0].endsWith("[t/h]"));
    viewer.ItemChecks()[2]->click();
    viewer.ItemChecks()[3]->click();
    EXPECT_TRUE(plot->Axes().isEmpty());
    EXPECT_FALSE(plot->grab().isNull());
    viewer.ItemChecks()[3]->click();
    EXPECT_EQ(plot->Axes(), QStringList{plot->Axes()[0]});
    EXPECT_TRUE(plot->Axes()[0].endsWith("[%]"));
}

TEST(DataViewerPlot, WheelZoomsAroundTheCursorDragPansAndResetShowsAll) {
    CZoDataViewerDlg viewer(kData + "/dredger_1.qrd0", {3});
    viewer.show();
    CZoLinePlot* plot = viewer.Plot();
    plot->grab();  // lays the axes out
    const double t0 = plot->ViewStart(), t1 = plot->ViewEnd();
    EXPECT_DOUBLE_EQ(t1 - t0, 144 * 3600.0);
    EXPECT_FALSE(viewer.ResetViewButton()->isEnabled());

    const QPoint middle(plot->width() / 2, plot->height() / 2);
    Wheel(plot, middle, 240);
    const double z0 = plot->ViewStart(), z1 = plot->ViewEnd();
    EXPECT_LT(z1 - z0, (t1 - t0) * 0.7);
    EXPECT_GT(z0, t0);
    EXPECT_LT(z1, t1);
    EXPECT_TRUE(viewer.ResetViewButton()->isEnabled());
    Shoot(viewer, "viewer_zoomed");

    // Dragging right shows earlier times; never past the data's start.
    QTest::mousePress(plot, Qt::LeftButton, {}, middle);
    QTest::mouseMove(plot, middle + QPoint(40, 0));
    QTest::mouseRelease(plot, Qt::LeftButton, {}, middle + QPoint(40, 0));
    EXPECT_LT(plot->ViewStart(), z0);
    EXPECT_NEAR(plot->ViewEnd() - plot->ViewStart(), z1 - z0, 1e-6);
    plot->Pan(-1e9);
    EXPECT_DOUBLE_EQ(plot->ViewStart(), t0);

    // Zooming out stops at the whole period; zooming in at a second.
    Wheel(plot, middle, -2400);
    EXPECT_DOUBLE_EQ(plot->ViewStart(), t0);
    EXPECT_DOUBLE_EQ(plot->ViewEnd(), t1);
    plot->Zoom(1e-12, t0 + 100);
    EXPECT_NEAR(plot->ViewEnd() - plot->ViewStart(), 1.0, 1e-9);

    viewer.ResetViewButton()->click();
    EXPECT_DOUBLE_EQ(plot->ViewStart(), t0);
    EXPECT_DOUBLE_EQ(plot->ViewEnd(), t1);
    EXPECT_FALSE(viewer.ResetViewButton()->isEnabled());
}

TEST(DataViewerField, GridsAndMeshDataShowAFieldPerStepWithALegend) {
    const fs::path dir = fs::temp_directory_path() / "mudsetup-viewer-field-ui";
    fs::create_directories(dir);
    std::ofstream(dir / "g.qrd2") << "qrd2 1\nstart 2024-01-01 00:00\nstep 3600\nsteps 3\ngrid 3 2\n"
                                     "items 2\nitem h 100084 m\nitem c 100403 kg/m^3\nvalues\n"
                                     "1 2 3 4 5 6  0 0 0 0 0 0\n"
                                     "6 5 4 3 2 1  0 0 0 0 0 0\n"
                                     "9 9 9 9 9 nan  7 7 7 7 7 7\n";
    std::ofstream(dir / "m.qrdu") << "qrdu 1\nstart 2024-01-01 00:00\nstep 60\nsteps 1\nelements 5\n"
                                     "items 1\nitem z 100084 m\nvalues\n-1 0 1 2 3\n";
    {
        CZoDataViewerDlg viewer((dir / "g.qrd2").string(), {});
        viewer.show();
        ASSERT_TRUE(viewer.Field());
        EXPECT_EQ(viewer.Tabs()->currentWidget(), viewer.Field()->parentWidget());
        CZoFieldView* field = viewer.Field();
        EXPECT_EQ(viewer.StepSlider()->maximum(), 3);
        EXPECT_EQ(field->Values(), (std::vector<double>{1, 2, 3, 4, 5, 6}));
        EXPECT_EQ(field->LegendLabels().front(), "1");
        EXPECT_EQ(field->LegendLabels().back(), "6");
        EXPECT_NE(field->ColourOf(1), field->ColourOf(6));
        EXPECT_TRUE(viewer.StepLabel()->text().contains("2024-01-01 00:00:00"));
        Shoot(viewer, "viewer_grid");

        viewer.StepSlider()->setValue(2);
        EXPECT_EQ(field->Values(), (std::vector<double>{6, 5, 4, 3, 2, 1}));
        EXPECT_TRUE(viewer.StepLabel()->text().contains("2024-01-01 01:00:00"));
        // One value left and a gap: a legend of one label, and no crash drawing it.
        viewer.StepSlider()->setValue(3);
        EXPECT_EQ(field->LegendLabels(), QStringList{"9"});
        EXPECT_TRUE(std::isnan(field->Values()[5]));
        EXPECT_FALSE(field->grab().isNull());
        // The other item at the same step.
        viewer.findChild<QComboBox*>("fieldItem")->setCurrentIndex(1);
        EXPECT_EQ(field->Values(), std::vector<double>(6, 7.0));
        EXPECT_EQ(viewer.StatusLabel()->text(), "");
    }
    {
        CZoDataViewerDlg viewer((dir / "m.qrdu").string(), {});
        viewer.show();
        ASSERT_TRUE(viewer.Field());
        EXPECT_EQ(viewer.Field()->Values(), (std::vector<double>{-1, 0, 1, 2, 3}));
        EXPECT_EQ(viewer.Field()->Minimum(), -1);
        EXPECT_EQ(viewer.Field()->Maximum(), 3);
        EXPECT_EQ(viewer.Field()->LegendLabels()[2], "0.6");  // not 0.6000000000000001
        Shoot(viewer, "viewer_mesh");
    }
    {
        CZoDataViewerDlg series(kData + "/dredger_1.qrd0", {});
        EXPECT_FALSE(series.Field());
    }
    fs::remove_all(dir);
}

// The bundled example: it reads without warnings, is valid and holds what it promises.
#include "TestSupport.h"

#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/DomainKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "host/ModuleSelection.h"
#include "hydro/HDDensityKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "hydro/HDWindForcingKiv.h"

using namespace testsupport;

TEST(Example, TheEstuaryIsAValidThreeDimensionalSetup) {
    CSetupDocument::OpenResult r = CSetupDocument::Open(MUD_SOURCE_DIR "/examples/estuary.setup");
    ASSERT_FALSE(r.error) << r.error->ToString();
    for (const paramfile::Diagnostic& w : r.warnings)
        ADD_FAILURE() << w.ToString();
    CSetupDocument& doc = *r.document;
    EXPECT_EQ(doc.ValidateAll(), 1) << ::testing::PrintToString(Messages(doc));

    EXPECT_EQ(doc.GetModuleSelection()->Mode(), 2);
    EXPECT_EQ(ModelDefinition(doc.Module())->NumberOfFractions(), 3);
    EXPECT_EQ(ModelDefinition(doc.Module())->NumberOfLayers(), 2);
    const CDomainKiv* d = doc.GetDomain();
    EXPECT_TRUE(d->MeshExist());
    EXPECT_TRUE(d->Is3D());
    EXPECT_EQ(d->LayerTotNum(), 10);
    EXPECT_LT(d->GetMeshInfo().xMin, d->GetMeshInfo().xMax);
    ASSERT_GE(doc.GetBoundaryNames()->GetItemCount(), 2);
    EXPECT_EQ(doc.GetBoundaryNames()->GetItem(1)->Identifier(), "Sea boundary");
    EXPECT_EQ(doc.GetBoundaryNames()->GetItem(2)->Identifier(), "River Elbe");
    EXPECT_EQ(doc.GetSources()->GetItemCount(), 2);
    EXPECT_GT(doc.GetPeriod()->TimeStepCount(), 0);
    EXPECT_GT(doc.GetDensity()->DensityMode(), 0);
    EXPECT_EQ(doc.GetWind()->Include(), 1);
}

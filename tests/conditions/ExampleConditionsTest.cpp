// The bundled example's boundary conditions, sources and initial conditions.
#include "ConditionsTestSupport.h"
#include "datafile/DataFile.h"

using namespace testsupport;

TEST(ExampleConditions, BoundariesSourcesAndTheStartAreSetUp) {
    CSetupDocument::OpenResult r = CSetupDocument::Open(MUD_SOURCE_DIR "/examples/estuary.setup");
    ASSERT_TRUE(r.document);
    EXPECT_TRUE(r.warnings.empty());
    CSetupDocument& doc = *r.document;
    EXPECT_EQ(doc.ValidateAll(), 1) << ::testing::PrintToString(Messages(doc));

    CMTBoundaryConditionsKiv* bc = MTBoundaryConditions(doc.Module());
    ASSERT_EQ(bc->GetItemCount(), doc.GetBoundaryNames()->GetItemCount());
    ASSERT_GE(bc->GetItemCount(), 2);
    EXPECT_EQ(bc->GetItem(1)->GetTitle(), "Sea boundary");
    // The sea boundary's values come from a time series beside the example, one item per
    // fraction.
    for (int f = 1; f <= 3; ++f) {
        const CMTBoundaryConditionsComponentItemKiv* item = bc->GetItem(1)->GetItem(f);
        EXPECT_EQ(item->TypeText(), "Specified values");
        EXPECT_EQ(item->Format(), 1);
        datafile::Header header;
        const datafile::ValuesResult values = datafile::ReadValues(
            MUD_SOURCE_DIR "/examples/" + item->QrdData()->FileName(), {{f - 1}, 0, 1, true}, &header);
        ASSERT_FALSE(values.error) << values.error->ToString();
        ASSERT_EQ(item->QrdData()->ItemNumbers(), (std::vector<int>{f}));
        EXPECT_EQ(header.items[static_cast<size_t>(f - 1)].name, item->QrdData()->ItemName());
    }
    EXPECT_GT(bc->GetItem(2)->GetItem(1)->Constant(), 0.0);

    CMTSourceKiv* sources = MTSources(doc.Module());
    ASSERT_EQ(sources->GetItemCount(), 2);
    EXPECT_GT(sources->GetItem(1)->GetItem(1)->Value()->Constant(), 0.0);
    EXPECT_EQ(sources->GetItem(2)->GetItem(2)->TypeOfComponent(),
              CMTSourceItemSubKiv::kExcessConcentration);

    // The first fraction starts from a data file beside the example, whose item it names.
    const CFemInDataKiv* ssc = InitialConditions(doc.Module())->Fractions()->GetItem(1)->Value();
    EXPECT_NE(ssc->Format(), 0);
    const std::string path = MUD_SOURCE_DIR "/examples/" + ssc->QrdData()->FileName();
    datafile::Header header;
    datafile::ValuesResult values = datafile::ReadValues(path, {{0}, 0, 1, true}, &header);
    ASSERT_FALSE(values.error) << values.error->ToString();
    ASSERT_EQ(header.items.size(), 1u);
    EXPECT_EQ(header.items[0].name, ssc->QrdData()->ItemName());
    EXPECT_EQ(header.items[0].unitType, ssc->ItemType());
    EXPECT_GT(values.minimum, 0.0);
    EXPECT_EQ(InitialConditions(doc.Module())->FractionDistribution()->GetItem(1)->Share(1), 60.0f);
}

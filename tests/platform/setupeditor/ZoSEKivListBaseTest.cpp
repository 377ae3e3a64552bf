#include "TestSupport.h"
#include "setupeditor/ZoSEKivListBase.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

// An item with one value and a default, numbered like the module's items.
class ValueItem : public CZoSEKivBase {
public:
    explicit ValueItem(CZoSEKivBase* parent) : CZoSEKivBase("Item %d", "ITEM_%d", parent) {}
    void SetDefault() override { value = 7; }
    void WriteData(void* h) override { kivPutParam(h, "value", value); }
    void ReadData(void* h) override { kivGetParam(h, "value", &value, 1, 1); }
    int value = 7;
};

class ValueList : public CZoSEKivListBase<ValueItem> {
public:
    explicit ValueList(CZoSEKivBase* parent, const char* section = "VALUES")
        : CZoSEKivListBase<ValueItem>("Values", section, parent) {}
};

// Records what a master list forwards to it.
class RecordingList : public CZoSEKivListBaseInterface {
public:
    RecordingList() : CZoSEKivListBaseInterface("Recorder", "", nullptr) {}
    void SetItemCount(int count, int level) override { Log("count", count, level); }
    void Delete(int index, int level) override { Log("delete", index, level); }
    void Insert(int index, int level) override { Log("insert", index, level); }
    bool MoveUp(int index, int level) override { return Log("up", index, level), true; }
    bool MoveDown(int index, int level) override { return Log("down", index, level), true; }
    int GetItemCount() const override { return 0; }
    CZoSEKivBase* GetItemNode(int) const override { return nullptr; }
    void ReInitialize(int, bool) override {}
    std::vector<std::string> calls;

private:
    void Log(const char* what, int a, int level) {
        calls.push_back(std::string(what) + " " + std::to_string(a) + "@" + std::to_string(level));
    }
};

class ListTest : public ::testing::Test {
protected:
    void SetUp() override {
        list = new ValueList(&root);
        root.AddChild(list);
        list->SetItemCount(5, 1);
        for (int i = 1; i <= 5; ++i)
            list->GetItem(i)->value = i * 10;
        list->RegisterSyncedList(&recorder, 3);
    }
    std::vector<int> Values() const {
        std::vector<int> v;
        for (int i = 1; i <= list->GetItemCount(); ++i)
            v.push_back(list->GetItem(i)->value);
        return v;
    }
    CZoSEKivGlobalBase root;
    ValueList* list = nullptr;
    RecordingList recorder;
};

TEST_F(ListTest, OperationsOutsideTheListChangeNothingButAreStillForwarded) {
    list->Delete(7, 1);
    list->Insert(6, 1);
    EXPECT_EQ(Values(), (std::vector<int>{10, 20, 30, 40, 50}));
    EXPECT_EQ(recorder.calls, (std::vector<std::string>{"delete 7@3", "insert 6@3"}));

    recorder.calls.clear();
    EXPECT_FALSE(list->MoveUp(1, 1));
    EXPECT_FALSE(list->MoveDown(5, 1));
    EXPECT_FALSE(list->MoveUp(3, 2));
    EXPECT_TRUE(recorder.calls.empty());
}

TEST_F(ListTest, NegativeCountEmptiesAndForwardsTheCountUnchanged) {
    list->SetItemCount(-3, 1);
    EXPECT_EQ(list->GetItemCount(), 0);
    EXPECT_EQ(recorder.calls, (std::vector<std::string>{"count -3@3"}));
}

TEST_F(ListTest, InsertDeleteAndMovesKeepValuesAndRenumber) {
    list->Insert(3, 1);
    EXPECT_EQ(Values(), (std::vector<int>{10, 20, 7, 30, 40, 50}));
    EXPECT_EQ(list->GetItem(4)->GetNumberWhatAmI(), 4);
    EXPECT_EQ(list->GetItem(4)->GetTitle(), "Item 4");
    EXPECT_EQ(list->GetItem(4)->GetSectionName(), "ITEM_4");

    list->Delete(1, 1);
    EXPECT_EQ(Values(), (std::vector<int>{20, 7, 30, 40, 50}));
    EXPECT_TRUE(list->MoveUp(2, 1));
    EXPECT_TRUE(list->MoveDown(4, 1));
    EXPECT_EQ(Values(), (std::vector<int>{7, 20, 30, 50, 40}));
    for (int i = 1; i <= list->GetItemCount(); ++i)
        EXPECT_EQ(list->GetItem(i)->GetNumberWhatAmI(), i);
    EXPECT_EQ(recorder.calls, (std::vector<std::string>{"insert 3@3", "delete 1@3", "up 2@3",
                                                        "down 4@3"}));

    ValueItem* appended = list->Append();
    EXPECT_EQ(appended, list->GetItem(6));
    EXPECT_EQ(recorder.calls.back(), "count 6@3");
}

// An item that looks at its list as it goes.
class WatchingItem : public CZoSEKivBase {
public:
    explicit WatchingItem(CZoSEKivBase* parent) : CZoSEKivBase("Item %d", "ITEM_%d", parent) {}
    ~WatchingItem() override {
        auto* list = static_cast<CZoSEKivListBaseInterface*>(GetParent());
        seen.push_back(std::to_string(list->GetItemCount()) + "/" + std::to_string(GetNumberWhatAmI()));
    }
    static inline std::vector<std::string> seen;
};

TEST(ListItems, LeaveTheListBeforeTheyAreDeleted) {
    CZoSEKivGlobalBase root;
    auto* list = new CZoSEKivListBase<WatchingItem>("Items", "ITEMS", &root);
    root.AddChild(list);
    list->SetItemCount(4, 1);
    WatchingItem::seen.clear();
    list->Delete(2, 1);
    list->SetItemCount(2, 1);
    EXPECT_EQ(WatchingItem::seen, (std::vector<std::string>{"3/-1", "2/-1"}));
}

TEST_F(ListTest, TouchedListMarksNewItemsTouchedAndReInitializeRespectsIt) {
    // A dialog's edit touches the list alone; growing it touches all it holds.
    list->SetHasBeenTouched(true);
    list->SetItemCount(5, 1);
    EXPECT_FALSE(list->GetItem(2)->GetHasBeenTouched());
    list->SetItemCount(6, 1);
    list->Insert(1, 1);
    EXPECT_TRUE(list->GetItem(1)->GetHasBeenTouched());
    EXPECT_TRUE(list->GetItem(3)->GetHasBeenTouched());
    EXPECT_TRUE(list->GetItem(7)->GetHasBeenTouched());

    list->ReInitialize(1, false);
    EXPECT_EQ(list->GetItem(2)->value, 10);
    list->ReInitialize(1, true);
    EXPECT_EQ(list->GetItem(2)->value, 7);
}

TEST_F(ListTest, OrdinaryChildrenComeFirstAndAreNotNumberedAsItems) {
    auto* child = new CZoSEKivBase("Child", "CHILD", list);
    list->AddChild(child);
    EXPECT_EQ(list->GetNumberWhatIs(child), -1);
    EXPECT_EQ(list->GetChildCount(), 5);  // items only
    POSITION pos = 0;
    std::vector<CZoSEKivBase*> order;
    for (CZoSEKivBase* c = list->GetFirstChild(pos); c; c = list->GetNextChild(pos))
        order.push_back(c);
    ASSERT_EQ(order.size(), 6u);
    EXPECT_EQ(order[0], child);
    EXPECT_EQ(order[1], list->GetItem(1));
    EXPECT_EQ(list->GetNextChild(child), list->GetItem(1));
}

// A list of lists: levels address the lists below.
class InnerList : public CZoSEKivListBase<ValueItem> {
public:
    explicit InnerList(CZoSEKivBase* parent) : CZoSEKivListBase<ValueItem>("Layer %d", "LAYER_%d", parent) {}
};
class OuterList : public CZoSEKivListBase<InnerList> {
public:
    explicit OuterList(CZoSEKivBase* parent) : CZoSEKivListBase<InnerList>("Layers", "LAYERS", parent) {}
};

TEST(ListLevels, LevelTwoReachesEveryInnerList) {
    CZoSEKivGlobalBase root;
    auto* outer = new OuterList(&root);
    root.AddChild(outer);
    outer->SetItemCount(3, 1);
    outer->SetItemCount(4, 2);
    for (int i = 1; i <= 3; ++i)
        EXPECT_EQ(outer->GetItem(i)->GetItemCount(), 4);
    outer->GetItem(2)->GetItem(3)->value = 99;
    outer->Delete(1, 2);
    EXPECT_EQ(outer->GetItem(2)->GetItemCount(), 3);
    EXPECT_EQ(outer->GetItem(2)->GetItem(2)->value, 99);
    outer->Insert(1, 2);
    EXPECT_EQ(outer->GetItem(3)->GetItemCount(), 4);
    EXPECT_EQ(outer->GetItem(2)->GetItem(3)->value, 99);
}

// The item count in the file.
class CountInFile : public ::testing::Test {
protected:
    // Loads a VALUES section into a list of two items.
    std::vector<paramfile::Diagnostic> LoadWith(const std::string& body) {
        parsed = paramfile::ParseText("TOP {\n VALUES {\n" + body + "\n }\n}\n", "count.setup");
        EXPECT_FALSE(parsed.error) << parsed.error->ToString();
        list = new ValueList(&root);
        root.AddChild(list);
        list->SetItemCount(2, 1);
        list->Load(const_cast<paramfile::Section*>(parsed.document->Root().FindSection("TOP")));
        return parsed.document->Warnings();
    }
    CZoSEKivGlobalBase root;
    ValueList* list = nullptr;
    paramfile::ParseResult parsed;
};

TEST_F(CountInFile, CountAndItemsAreRead) {
    // Items the count promises but the file lacks are reported once, at the count.
    const auto warnings = LoadWith("ZoSEKivListItemCount = 3\n ITEM_3 {\n value = 33\n }");
    ASSERT_EQ(warnings.size(), 1u);
    EXPECT_EQ(warnings[0].pos.line, 3);
    EXPECT_EQ(warnings[0].message, "2 of 3 sections are missing (ITEM_1, ITEM_2); those items take their defaults");
    ASSERT_EQ(list->GetItemCount(), 3);
    EXPECT_EQ(list->GetItem(1)->value, 7);
    EXPECT_EQ(list->GetItem(3)->value, 33);
}

TEST_F(CountInFile, MissingCountKeepsTheConstructedCount) {
    LoadWith("ITEM_1 {\n value = 1\n }");
    EXPECT_EQ(list->GetItemCount(), 2);
}

TEST_F(CountInFile, AbsurdCountsAreRefusedWithAWarning) {
    for (const char* count : {"2000000000", "-4", "100001"}) {
        SCOPED_TRACE(count);
        const auto warnings = LoadWith(std::string("ZoSEKivListItemCount = ") + count);
        EXPECT_EQ(list->GetItemCount(), 2);
        // The items kept have no sections either, which is said as well.
        ASSERT_EQ(warnings.size(), 2u);
        EXPECT_EQ(warnings[0].pos.line, 3);
        EXPECT_NE(warnings[0].message.find("kept 2"), std::string::npos) << warnings[0].message;
        EXPECT_NE(warnings[1].message.find("2 of 2 sections are missing"), std::string::npos);
    }
}

TEST_F(CountInFile, CountOfTheWrongTypeKeepsTheConstructedCount) {
    const auto warnings = LoadWith("ZoSEKivListItemCount = \"three\"\n ITEM_1 {\n }\n ITEM_2 {\n }");
    EXPECT_EQ(list->GetItemCount(), 2);
    EXPECT_EQ(warnings.size(), 1u);
}

TEST(ListSave, CountIsWrittenFirstAndNamelessListsWriteNoCount) {
    CZoSEKivGlobalBase root;
    auto* named = new ValueList(&root);
    auto* nameless = new ValueList(&root, "");
    root.AddChild(named);
    root.AddChild(nameless);
    named->SetItemCount(2, 1);
    nameless->SetItemCount(1, 1);
    paramfile::Document doc;
    paramfile::Builder b(doc);
    b.BeginSection("TOP");
    named->Save(&b);
    nameless->Save(&b);
    b.EndSection();
    const paramfile::Section* top = doc.Root().FindSection("TOP");
    ASSERT_TRUE(top);
    EXPECT_EQ(testsupport::Entries(*top), (std::vector<std::string>{"[VALUES]", "[ITEM_1]"}));
    EXPECT_EQ(testsupport::Entries(*top->FindSection("VALUES")),
              (std::vector<std::string>{"ZoSEKivListItemCount", "[ITEM_1]", "[ITEM_2]"}));
}

}  // namespace

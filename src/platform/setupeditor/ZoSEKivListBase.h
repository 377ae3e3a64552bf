// Lists of like items (one per fraction, layer, boundary, source, output...). Every change
// by position is repeated on the lists registered as synchronised with this one.
#pragma once

#include "ZoSEKivBase.h"
#include "paramfile/Kiv.h"
#include "setupeditor/Keywords.h"

#include <algorithm>
#include <memory>
#include <vector>

// Counts in a file beyond this are refused: no setup has that many boundaries, sources,
// outputs or dredgers, and honouring a corrupt count would exhaust memory.
constexpr int kMaxListItemCount = 100000;

class CZoSEKivListBaseInterface : public CZoSEKivBase {
public:
    using CZoSEKivBase::CZoSEKivBase;

    virtual void SetItemCount(int count, int level) = 0;
    virtual void Delete(int index, int level) = 0;
    virtual void Insert(int index, int level) = 0;
    virtual bool MoveUp(int index, int level) = 0;
    virtual bool MoveDown(int index, int level) = 0;
    virtual int GetItemCount() const = 0;
    virtual CZoSEKivBase* GetItemNode(int index) const = 0;  // 1-based, null outside
    virtual void ReInitialize(int level, bool force) = 0;

protected:
    // The keyword besides ZoSEKivListItemCount through which the file gives the number of
    // items ("number_of_outputs"), or null.
    virtual const char* CountKeyword() const { return nullptr; }
    // Once the list's section was read: one warning for the items whose sections it lacks,
    // when the section gives a count.
    void ReportMissingItems(void* section);
};

struct NodeInListOfSyncedLists {
    CZoSEKivListBaseInterface* list;
    int level;
};

template <class T>
class CZoSEKivAbstractListBase : public CZoSEKivListBaseInterface {
public:
    CZoSEKivAbstractListBase(const CString& title, const CString& sectionName,
                             CZoSEKivBase* parent)
        : CZoSEKivListBaseInterface(title, sectionName, parent) {}

    ~CZoSEKivAbstractListBase() override {
        // From the head, each item gone from the list before it is deleted.
        std::vector<T*> items;
        items.swap(m_items);
        for (T* item : items)
            delete item;
        m_synced.clear();
    }

    virtual T* Create() = 0;

    void SetItemCount(int count, int level) override {
        if (level != 1) {
            ForwardToItemLists([&](CZoSEKivListBaseInterface* l) { l->SetItemCount(count, level - 1); });
            return;
        }
        const size_t target = static_cast<size_t>(std::max(count, 0));
        if (m_items.size() != target)
            this->TellShapeChanged();
        // Each item leaves the list before it is deleted.
        while (m_items.size() > target) {
            T* last = m_items.back();
            m_items.pop_back();
            DiscardItem(last);
        }
        const bool grows = m_items.size() < target;
        while (m_items.size() < target) {
            m_items.push_back(Create());
            m_items.back()->m_positionHint = static_cast<int>(m_items.size());
        }
        // The new items count as edited like the rest; once for all of them keeps it linear.
        if (grows && GetHasBeenTouched())
            TouchAllChildren();
        for (const NodeInListOfSyncedLists& r : SyncedCopy())
            r.list->SetItemCount(count, r.level);
    }

    void Delete(int index, int level) override {
        if (level != 1) {
            ForwardToItemLists([&](CZoSEKivListBaseInterface* l) { l->Delete(index, level - 1); });
            return;
        }
        if (index >= 1 && index <= static_cast<int>(m_items.size())) {
            T* item = m_items[index - 1];
            m_items.erase(m_items.begin() + (index - 1));
            m_numberingDirty = true;
            this->TellShapeChanged();
            delete item;
        }
        for (const NodeInListOfSyncedLists& r : SyncedCopy())
            r.list->Delete(index, r.level);
    }

    void Insert(int index, int level) override {
        if (level != 1) {
            ForwardToItemLists([&](CZoSEKivListBaseInterface* l) { l->Insert(index, level - 1); });
            return;
        }
        if (index >= 1 && index <= static_cast<int>(m_items.size())) {
            // Create() may look at the list (titles numbered from the count), so the item is
            // made before it is placed.
            T* item = Create();
            m_items.insert(m_items.begin() + (index - 1), item);
            m_numberingDirty = true;
            this->TellShapeChanged();
            if (GetHasBeenTouched())
                TouchAllChildren();
        }
        for (const NodeInListOfSyncedLists& r : SyncedCopy())
            r.list->Insert(index, r.level);
    }

    bool MoveUp(int index, int level) override {
        if (level != 1 || index < 2 || index > static_cast<int>(m_items.size()))
            return false;
        SwapItems(index - 1, index);
        for (const NodeInListOfSyncedLists& r : SyncedCopy())
            r.list->MoveUp(index, r.level);
        return true;
    }

    bool MoveDown(int index, int level) override {
        if (level != 1 || index < 1 || index >= static_cast<int>(m_items.size()))
            return false;
        SwapItems(index, index + 1);
        for (const NodeInListOfSyncedLists& r : SyncedCopy())
            r.list->MoveDown(index, r.level);
        return true;
    }

    int GetItemCount() const override { return static_cast<int>(m_items.size()); }

    T* GetItem(int index) const {
        if (index < 1 || index > static_cast<int>(m_items.size()))
            return nullptr;
        return m_items[index - 1];
    }
    CZoSEKivBase* GetItemNode(int index) const override { return GetItem(index); }

    T* Append() {
        const int count = GetItemCount();
        SetItemCount(count + 1, 1);
        return GetItem(count + 1);
    }

    void RegisterSyncedList(CZoSEKivListBaseInterface* list, int level) {
        m_synced.push_back({list, level});
    }

    void UnRegisterSyncedList(CZoSEKivListBaseInterface* list) {
        auto it = std::find_if(m_synced.begin(), m_synced.end(),
                               [&](const NodeInListOfSyncedLists& r) { return r.list == list; });
        if (it != m_synced.end())
            m_synced.erase(it);
    }

    void ReInitialize(int level, bool force) override {
        if (GetHasBeenTouched() && !force)
            return;
        if (level == 1) {
            for (T* item : m_items)
                item->SetDefault();
        } else if (level == 2) {
            ForwardToItemLists([](CZoSEKivListBaseInterface* l) { l->ReInitialize(1, true); });
        }
    }

    virtual float CountOutputSize() { return 0.0f; }

    // Ordinary children first, then the items.
    CZoSEKivBase* GetNextChild(POSITION& pos) override {
        const int children = static_cast<int>(Children().size());
        if (pos < 0)
            return nullptr;
        if (pos < children)
            return Children()[pos++];
        const int item = pos - children;
        if (item < static_cast<int>(m_items.size())) {
            ++pos;
            return m_items[item];
        }
        return nullptr;
    }
    using CZoSEKivBase::GetFirstChild;
    using CZoSEKivBase::GetNextChild;

    CZoSEKivBase* GetChild(int index) override { return GetItem(index + 1); }
    int GetChildCount() override { return GetItemCount(); }

    int GetNumberWhatIs(const CZoSEKivBase* node) override {
        if (m_numberingDirty) {
            for (size_t i = 0; i < m_items.size(); ++i)
                m_items[i]->m_positionHint = static_cast<int>(i + 1);
            m_numberingDirty = false;
        }
        const int hint = node->m_positionHint;
        if (hint >= 1 && hint <= static_cast<int>(m_items.size()) &&
            m_items[hint - 1] == node)
            return hint;
        return -1;
    }

    void DescribeSize(KeywordSink& sink) override {
        static const KeywordDecl kCount{"ZoSEKivListItemCount", KeywordType::Int, "0",
                                        "Number of items in the list", 0, "0 .. 100000"};
        if (!GetSectionNamePattern().empty())
            sink.Add(kCount);
    }

    void SaveSize(void* h) override {
        if (!GetSectionNamePattern().empty())
            kivPutParam(h, "ZoSEKivListItemCount", GetItemCount());
    }

    void LoadSize(void* h) override {
        // A list without a section of its own shares its parent's, whose count is not its own.
        if (GetSectionNamePattern().empty())
            return;
        void* keyword = kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1);
        if (!keyword)
            return;
        // No value counts as 0; a value of the wrong type keeps the count (with a warning).
        int n = 0;
        if (kivParamCount(keyword) > 0) {
            n = GetItemCount();
            kivGetParam(h, "ZoSEKivListItemCount", &n, 1, 1);
        }
        if (n < 0 || n > kMaxListItemCount) {
            kivWarn(h, "ZoSEKivListItemCount",
                    FormatString("item count %d is not between 0 and %d; kept %d", n,
                                 kMaxListItemCount, GetItemCount()));
            return;
        }
        SetItemCount(n, 1);
    }

    void Load(void* h) override {
        CZoSEKivListBaseInterface::Load(h);
        if (!h || GetSectionNamePattern().empty())
            return;
        if (void* own = kivSectionByNameNum(h, GetSectionName().c_str(), 1))
            ReportMissingItems(own);
    }

    // A count the engine reads beside the list's own (which LoadSize applied) has the last
    // word; where the two disagree, that is said. A count that is missing or cannot be used
    // keeps the one held. noun names an item ("dredger").
    void ReadEngineCount(void* h, const char* keyword, const char* noun) {
        if (!kivKeywordByNameNum(h, keyword, 1))
            return;
        int count = GetItemCount();
        kivGetParam(h, keyword, &count, 1, 1);
        if (count < 0 || count > kMaxListItemCount) {
            kivWarn(h, keyword,
                    FormatString("%s = %d is not between 0 and %d; kept %d", keyword, count,
                                 kMaxListItemCount, GetItemCount()));
            return;
        }
        if (kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1) && count != GetItemCount())
            kivWarn(h, keyword,
                    FormatString("%s = %d, but ZoSEKivListItemCount = %d; %d %s%s read", keyword,
                                 count, GetItemCount(), count, noun,
                                 count == 1 ? " is" : "s are"));
        SetItemCount(count, 1);
    }

    const std::vector<NodeInListOfSyncedLists>& SyncedLists() const { return m_synced; }

protected:
    const std::vector<T*>& Items() const { return m_items; }
    // An item that shrinking took off the end. Lists that remake items by the thousand (one
    // per boundary and fraction) may keep it for their next Create instead.
    virtual void DiscardItem(T* item) { delete item; }

private:
    template <class F>
    void ForwardToItemLists(F f) {
        for (T* item : m_items)
            if (auto* list = dynamic_cast<CZoSEKivListBaseInterface*>(
                    static_cast<CZoSEKivBase*>(item)))
                f(list);
    }

    // A synced list may register or unregister while it is told of a change.
    std::vector<NodeInListOfSyncedLists> SyncedCopy() const { return m_synced; }

    void SwapItems(int a, int b) {
        std::swap(m_items[a - 1], m_items[b - 1]);
        this->TellShapeChanged();
        m_items[a - 1]->m_positionHint = a;
        m_items[b - 1]->m_positionHint = b;
    }

    std::vector<T*> m_items;
    std::vector<NodeInListOfSyncedLists> m_synced;
    bool m_numberingDirty = false;
};

template <class T>
class CZoSEKivListBase : public CZoSEKivAbstractListBase<T> {
public:
    using CZoSEKivAbstractListBase<T>::CZoSEKivAbstractListBase;
    T* Create() override { return new T(this); }
};

// A list of another module with one item per item of a host list (boundaries, sources), as
// the module's boundary-condition and source lists are. Each item remembers the master item
// it was made for, so that inserts, deletes and moves can be followed.
#pragma once

#include "setupeditor/ZoSEKivListBase.h"

#include <vector>

namespace testsupport {

class FollowerItem : public CZoSEKivBase {
public:
    explicit FollowerItem(CZoSEKivBase* parent) : CZoSEKivBase("", "", parent) {}
    CString tag;
};

template <class Master>
class Follower : public CZoSEKivListBase<FollowerItem> {
public:
    explicit Follower(Master* master)
        : CZoSEKivListBase<FollowerItem>("Follower", "", master->GetRoot()), m_master(master) {
        SetItemCount(master->GetItemCount(), 1);
        master->RegisterSyncedList(this, 1);
        Tag();
    }
    ~Follower() override { m_master->UnRegisterSyncedList(this); }

    // Items made since the last call take the title of the master item at their place.
    void Tag() {
        for (int i = 1; i <= GetItemCount(); ++i)
            if (GetItem(i)->tag.empty())
                GetItem(i)->tag = m_master->GetItemNode(i)->GetTitle();
    }
    std::vector<CString> Tags() {
        std::vector<CString> out;
        for (int i = 1; i <= GetItemCount(); ++i)
            out.push_back(GetItem(i)->tag);
        return out;
    }

private:
    Master* m_master;
};

template <class List>
std::vector<CString> Titles(List* list) {
    std::vector<CString> out;
    for (int i = 1; i <= list->GetItemCount(); ++i)
        out.push_back(list->GetItemNode(i)->GetTitle());
    return out;
}

}  // namespace testsupport

// The coordinate table of an output: the geometry in use, copied in when a page opens and
// written back after every edit. Not stored in the setup.
#pragma once

#include "MTOutputCoordItemKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

class CMTOutputCoordListKiv : public CZoSEKivListBase<CMTOutputCoordItemKiv> {
public:
    explicit CMTOutputCoordListKiv(CZoSEKivBase* parent)
        : CZoSEKivListBase("MTOutputCoordList", "", parent) {
        SetItemCount(1, 1);
    }
    void Save(void*) override {}
    void Load(void*) override {}
    int Validate() override { return 1; }
};

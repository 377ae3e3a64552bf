#pragma once

#include "FemHelpBase.h"
#include "setupeditor/ZoSEKivBase.h"

// A group node with a help topic.
class CFemKivGroupBase : public CZoSEKivGroupBase, public CFemHelpBase {
public:
    CFemKivGroupBase(const CString& title, const CString& sectionName, CZoSEKivBase* parent,
                     unsigned long helpId)
        : CZoSEKivGroupBase(title, sectionName, parent), CFemHelpBase(helpId) {}
};

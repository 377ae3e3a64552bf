#pragma once

#include "fem/FemKivGroupBase.h"

// A group of sections with no keywords of its own: always valid, its dialog always in use.
class CMTGroupKiv : public CFemKivGroupBase {
public:
    CMTGroupKiv(const CString& title, const CString& sectionName, CZoSEKivBase* parent,
                unsigned long helpId, const char* dialogClass)
        : CFemKivGroupBase(title, sectionName, parent, helpId), m_dialogClass(dialogClass) {}

    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override {
        return code == kDlgRuntimeClassRequest ? m_dialogClass
                                               : CFemKivGroupBase::GetDlgRuntimeClass(code);
    }

private:
    const char* m_dialogClass;
};

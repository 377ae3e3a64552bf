// The point sources of the flow model ("HDSources"): name, position and whether each is
// included. Lists of per-source values register as synchronised lists of this one.
#pragma once

#include "setupeditor/ZoSEKivListBase.h"

class CHDSourceItemKiv : public CZoSEKivBase {
public:
    // A new source is named after its number at creation and placed in the middle of the
    // mesh when there is one.
    explicit CHDSourceItemKiv(CZoSEKivBase* parent);

    const CString& Name() const { return m_name; }
    void Name(const CString& name) { m_name = name; }
    int Include() const { return m_include ? 1 : 0; }
    void Include(bool include) { m_include = include; }
    double X() const { return m_x; }
    void X(double x) { m_x = x; }
    double Y() const { return m_y; }
    void Y(double y) { m_y = y; }

    CString GetTitle() const override { return m_name; }
    void SetTitle(const CString& title) override { m_name = title; }
    bool IsDlgUsedInSetup() override { return m_include; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;

private:
    friend struct HDSourceFields;
    CString m_name;
    bool m_include = true;
    double m_x = 0.0;
    double m_y = 0.0;
};

class CHDSourcesKiv : public CZoSEKivListBase<CHDSourceItemKiv> {
public:
    explicit CHDSourcesKiv(CZoSEKivBase* parent);
    ~CHDSourcesKiv() override;
};

CHDSourcesKiv* HDSources(const CZoSEKivBase* node);

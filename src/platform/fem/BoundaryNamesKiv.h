// The open boundaries of the mesh ("BoundaryNames"): one named item per boundary, with the
// boundary's code in the mesh. Lists of per-boundary values register as synchronised lists
// of this one and follow every insert, delete, move and resize.
#pragma once

#include "BoundaryBaseInterface.h"
#include "setupeditor/ZoSEKivListBase.h"

class CBoundaryNameKiv : public CZoSEKivBase, public CBoundaryBaseInterface {
public:
    // New boundaries are named and coded after their number at creation.
    explicit CBoundaryNameKiv(CZoSEKivBase* parent);

    const CString& Identifier() const { return m_name; }
    void Identifier(const CString& name) { m_name = name; }
    int BoundaryCode() override { return m_code; }
    int BoundaryCode() const { return m_code; }
    void BoundaryCode(int code) { m_code = code; }

    // The title is the boundary's name.
    CString GetTitle() const override { return m_name; }
    void SetTitle(const CString& title) override { m_name = title; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;

private:
    friend struct BoundaryNameFields;
    CString m_name;
    int m_code = 2;
};

class CBoundaryNamesKiv : public CZoSEKivListBase<CBoundaryNameKiv> {
public:
    explicit CBoundaryNamesKiv(CZoSEKivBase* parent);
    ~CBoundaryNamesKiv() override;

    // Two boundaries with one code would be the same boundary of the mesh.
    int ValidateData() override;
};

CBoundaryNamesKiv* BoundaryNames(const CZoSEKivBase* node);

// A data-input value: either a constant or a data file with the item numbers to read.
#pragma once

#include "setupeditor/ZoSEKivBase.h"

#include <vector>

class CZoFileSelector;

// The data file of a data-input value.
class CFemInDataFile {
public:
    const CString& FileName() const { return m_fileName; }
    void FileName(const CString& name) { m_fileName = name; }
    const std::vector<int>& ItemNumbers() const { return m_items; }
    void ItemNumbers(std::vector<int> items) { m_items = std::move(items); }
    const CString& ItemName() const { return m_itemName; }
    void ItemName(const CString& name) { m_itemName = name; }
    // The item's name where one is known, else its numbers ("1, 3").
    CString ItemString() const;

private:
    CString m_fileName;
    std::vector<int> m_items{1};
    CString m_itemName;
};

// Format values: 0 a constant; otherwise a data file whose values vary in time (1), over
// the horizontal domain (2) or over the vertical (8), or in a combination of these bits.
// The format code given at construction is the set of those bits the value may use.
class CFemInDataKiv : public CZoSEKivBase {
public:
    CFemInDataKiv(const CString& sectionName, const CString& title, int formatCode, bool flag1,
                  bool flag2, double defaultConstant, long itemType, CZoSEKivBase* parent);

    double Constant() const { return m_constant; }
    void Constant(double value) { m_constant = value; }
    double DefaultConstant() const { return m_default; }
    // Where the owner saves the constant as a float, forms refuse numbers beyond its range.
    bool ConstantIsFloat() const { return m_constantIsFloat; }
    void ConstantIsFloat(bool isFloat) { m_constantIsFloat = isFloat; }
    int Format() const { return m_format; }
    void Format(int format) { m_format = format; }
    int FormatCode() const { return m_formatCode; }
    void FormatCode(int code) { m_formatCode = code; }
    bool IsDisabled() const { return m_disabled; }
    void Disable(bool disabled) { m_disabled = disabled; }
    int Type() const { return m_type; }
    void Type(int type) { m_type = type; }
    long ItemType() const { return m_itemType; }
    std::vector<long>& FurtherItemTypes() { return m_furtherItemTypes; }
    bool Flag1() const { return m_flag1; }
    bool Flag2() const { return m_flag2; }
    CFemInDataFile* QrdData() { return &m_file; }
    const CFemInDataFile* QrdData() const { return &m_file; }

    // What the value asks of its data file: one item of its item type (or a further one),
    // of a kind that fits the format, and for a format varying in time the period covered.
    void SetUpFileSelector(CZoFileSelector& selector) const;

    // The formats this value may take, constant first.
    std::vector<int> AllowedFormats() const;
    bool IsFormatAllowed(int format) const;
    // On reading: a warning at the value's "format" keyword of section h when the format is
    // not one the value may take (it is kept as read, and validation reports it).
    void WarnUnlessFormatAllowed(void* h) const;
    static CString FormatName(int format);
    // One line for grids: "Constant 0.1 N/m^2" (in the user's unit) or the kind of variation
    // with its file.
    CString FormatText() const;

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    // The value's keywords in section path, for owners that write it under other names.
    void DescribeAt(KeywordSink& sink, const std::string& path, const char* constantKeyword,
                    bool constantIsFloat, const char* itemKeyword) const;
    void ReadData(void* h) override;
    int ValidateData() override;
    void SetDefault() override;
    bool IsDlgUsedInSetup() override { return !m_disabled; }

private:
    int m_formatCode;
    int m_format = 0;
    bool m_flag1;
    bool m_flag2;
    double m_default;
    double m_constant;
    long m_itemType;
    std::vector<long> m_furtherItemTypes;
    bool m_disabled = false;
    bool m_constantIsFloat = false;
    int m_type = 0;
    CFemInDataFile m_file;
};

#pragma once

#include "setupeditor/ZoSEQrdSelection.h"

#include <array>

class CMTWaveFieldKiv;

// The wave field's data file: three items (height, period, direction), each with the name
// the file gives it. The wave-field section writes and reads its keywords.
class CMTWaveFieldFile : public ZoSEQrdSelection {
public:
    explicit CMTWaveFieldFile(CMTWaveFieldKiv* parent);

    static constexpr int kItems = 3;
    // index 1 to 3; empty for any other.
    CString ItemName(int index) const override;
    void ItemName(int index, const CString& name);

    // The period's time check, and for a data-file format the three item requests.
    void SetUpFileSelector(CZoFileSelector& selector) override;
    // Passes unless the waves take the wave field from a file that will not do; why says
    // what is wrong.
    bool CheckFile(CString* why = nullptr);

    void WriteData(void*) override {}
    void DescribeKeywords(KeywordSink&) override {}
    void ReadData(void*) override {}
    void SetDefault() override;
    // "File is not valid" when CheckFile fails.
    int ValidateData() override;

private:
    CMTWaveFieldKiv* WaveField() const;
    std::array<CString, kItems> m_itemNames;
};

// Whether name ends in ext (without regard to case); false for a name shorter than ext.
bool EndsWithNoCase(const CString& name, const char* ext);

#pragma once

#include "setupeditor/ZoSEQrdSelection.h"

// The data file of one point of the wave database, with its three items (height, period,
// direction). The database writes and reads its keywords.
class CForcingsWaveDBFile : public ZoSEQrdSelection {
public:
    explicit CForcingsWaveDBFile(CZoSEKivBase* parent);

    static constexpr int kItems = 3;
    void SetUpFileSelector(CZoFileSelector& selector) override;
    // Passes unless the waves come from the database and the file will not do (why says
    // what is wrong).
    bool CheckFile(CString* why = nullptr);

    void WriteData(void*) override {}
    void DescribeKeywords(KeywordSink&) override {}
    void ReadData(void*) override {}
    void SetDefault() override;
    int ValidateData() override;
};

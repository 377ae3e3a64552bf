// The quantities of a 2D or 3D output: a basic and an additional list, each quantity with
// its label, keyword, class and selection. The lists follow the numbers of fractions and
// layers; a quantity that survives a change keeps its selection.
#pragma once

#include "fem/FemNotifier.h"
#include "setupeditor/ZoSEKivBase.h"

#include <memory>
#include <vector>

class CMTOutputItemMainKiv;

class CMTOutputItemSubKiv : public CZoSEKivBase, public CFemListener {
public:
    // A quantity's description; shared by every output with the same counts.
    struct Quantity {
        CString label;
        CString keyword;
        int itemClass;  // 2: offered to 2D outputs of a 3D domain, 3: to 3D outputs
    };
    struct Table {
        int fractions = 0;
        int layers = 0;
        std::vector<Quantity> basic;
        std::vector<Quantity> additional;
    };
    // A quantity with its selection, as the dialogs see it.
    struct _COutputItem {
        const CString& label;
        const CString& keyword;
        int itemClass;
        int value;
    };
    enum class List { Basic, Additional };

    CMTOutputItemSubKiv(const CString& sectionName, CZoSEKivBase* parent);
    ~CMTOutputItemSubKiv() override;

    int Count(List list) const;
    _COutputItem Item(List list, int index) const;  // index from 0
    void Value(List list, int index, int value);
    // Whether the dialog offers a quantity of this class (the domain's dimension and the
    // output's type decide).
    bool IsOffered(int itemClass) const;

    // The lists anew for the current counts, keeping the selections of the quantities that
    // remain.
    virtual void Rebuild();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void Notify(CFemNotifier* notifier, ENotifyMessage message) override;

    CMTOutputItemMainKiv* Output() const;

protected:
    // The table for the given counts (built once per count pair and shared).
    virtual std::shared_ptr<const Table> MakeTable(int fractions, int layers) const = 0;

private:
    std::shared_ptr<const Table> m_table;
    std::vector<int> m_basic;
    std::vector<int> m_additional;
};

class CMTOutputItemSub2DKiv : public CMTOutputItemSubKiv {
public:
    explicit CMTOutputItemSub2DKiv(CZoSEKivBase* parent);
    bool IsDlgUsedInSetup() override;

protected:
    std::shared_ptr<const Table> MakeTable(int fractions, int layers) const override;
};

class CMTOutputItemSub3DKiv : public CMTOutputItemSubKiv {
public:
    explicit CMTOutputItemSub3DKiv(CZoSEKivBase* parent);
    bool IsDlgUsedInSetup() override;

protected:
    std::shared_ptr<const Table> MakeTable(int fractions, int layers) const override;
};

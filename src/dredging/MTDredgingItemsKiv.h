#pragma once

#include "fem/FemNotifier.h"
#include "setupeditor/ZoSEKivBase.h"

#include <vector>

class CMTDredgingFile;

// One dredger (DREDGER_%d): whether it is active, where its spill is released, its load,
// how the dredged mass is split over the fractions and the time series of its track.
class CMTDredgingItemsKiv : public CZoSEKivBase, public CFemListener {
public:
    // Where the spill is released.
    enum SpillType {
        kSpillBottom = 1,
        kSpillTop = 2,
        kSpillBottomAndTop = 3,
        kSpillWaterColumn = 4,
    };
    // Weights that add up to 100 within this pass.
    static constexpr double kWeightTolerance = 0.0001;

    explicit CMTDredgingItemsKiv(CZoSEKivBase* parent);
    ~CMTDredgingItemsKiv() override;

    int Include() const { return m_include; }
    void Include(int include) { m_include = include; }
    const CString& Name() const { return m_name; }
    void Name(const CString& name) { m_name = name; }
    int Type() const { return m_type; }
    void Type(int type) { m_type = type; }
    bool UpdateDredger() const { return m_updateDredger; }
    void UpdateDredger(bool update) { m_updateDredger = update; }
    double InitialDredgerMass() const { return m_initialMass; }
    void InitialDredgerMass(double mass) { m_initialMass = mass; }
    double MaximumDredgerMass() const { return m_maximumMass; }
    void MaximumDredgerMass(double mass) { m_maximumMass = mass; }
    bool UpdateDistribution() const { return m_updateDistribution; }
    void UpdateDistribution(bool update) { m_updateDistribution = update; }
    const CString& CoordinateType() const { return m_coordinateType; }
    void CoordinateType(const CString& projection) { m_coordinateType = projection; }

    // Percent per fraction, in fraction order.
    const std::vector<double>& WeightsFraction() const { return m_weights; }
    void WeightsFraction(const std::vector<double>& weights) { m_weights = weights; }
    // index from 1; 0 beyond the list.
    double WeightFraction(int index) const;
    void WeightFraction(int index, double weight);
    // When the list's length is not the number of fractions, an even split over them.
    // True when the weights were reset.
    bool MatchWeightsToFractions();

    CMTDredgingFile* DataFile() const { return m_file; }

    CString GetTitle() const override { return m_name; }
    void SetTitle(const CString& title) override { m_name = title; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    bool IsDlgUsedInSetup() override { return m_include != 0; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    void SetDefault() override;

private:
    friend struct DredgerFields;
    void ReadWeights(void* h);
    void ReadDataFile(void* h);

    int m_include = 1;
    CString m_name;
    int m_type = kSpillBottom;
    bool m_updateDredger = true;
    double m_initialMass = 0.0;
    double m_maximumMass = 1e7;
    bool m_updateDistribution = true;
    std::vector<double> m_weights;
    CString m_coordinateType;
    CMTDredgingFile* m_file = nullptr;
};

// An even split of 100 percent over n fractions.
std::vector<double> EvenWeights(int fractions);

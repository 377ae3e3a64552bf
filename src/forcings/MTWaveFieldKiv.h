#pragma once

#include "setupeditor/ZoSEKivBase.h"

class CMTWaveFieldFile;

// WAVE_FIELD: wave height, period and direction as constants or from a data file (a time
// series, or a field varying in time and over the domain), with a soft start.
class CMTWaveFieldKiv : public CZoSEKivBase {
public:
    enum Format { kConstant = 0, kTimeSeries = 1, kStoredOnly = 2, kTimeAndDomain = 3 };

    explicit CMTWaveFieldKiv(CZoSEKivBase* parent);
    ~CMTWaveFieldKiv() override;

    int GetFormat() const { return m_format; }
    void SetFormat(int format) { m_format = format; }
    double WaveHeight() const { return m_height; }
    void WaveHeight(double v) { m_height = v; }
    double WavePeriod() const { return m_period; }
    void WavePeriod(double v) { m_period = v; }
    double WaveDirection() const { return m_direction; }
    void WaveDirection(double v) { m_direction = v; }
    double SoftStartInterval() const { return m_softInterval; }
    void SoftStartInterval(double seconds) { m_softInterval = seconds; }
    int SoftStartType() const { return m_softType; }
    void SoftStartType(int type) { m_softType = type; }
    CMTWaveFieldFile* File() const { return m_file; }

    // Read by other modules through "MTWaveField"; not stored.
    int HeightUnitType() const { return m_heightUnitType; }
    int PeriodUnitType() const { return m_periodUnitType; }
    int DirectionUnitType() const { return m_directionUnitType; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    void SetDefault() override;

private:
    friend struct WaveFieldFields;
    int m_heightUnitType = 100084;
    int m_periodUnitType = 100085;
    int m_directionUnitType = 100407;
    int m_format = 0;
    double m_height = 1.0;
    double m_period = 3.0;
    double m_direction = 180.0;
    int m_softType = 2;
    double m_softInterval = 0.0;
    CMTWaveFieldFile* m_file = nullptr;
};

CMTWaveFieldKiv* WaveFieldSection(const CZoSEKivBase* node);

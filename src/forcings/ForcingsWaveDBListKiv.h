#pragma once

#include "ForcingsWaveDBItemKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

#include <cstdint>
#include <map>
#include <tuple>
#include <vector>
#include <optional>

class CForcingsWaveDBAxisKiv;
class CForcingsWaveDBWindSpeedKiv;
class CForcingsWaveDBWindDirectionKiv;
class CForcingsWaveDBWaterLevelKiv;

// WAVE_DATABASE: one precomputed wave field per wind speed, wind direction and water level.
// Points are numbered with the speed varying slowest and the level fastest; point k is item
// k, and points past the first 100 have no item.
class CForcingsWaveDBListKiv : public CZoSEKivListBase<CForcingsWaveDBItemKiv> {
public:
    static constexpr int kMaxPoints = 100;

    explicit CForcingsWaveDBListKiv(CZoSEKivBase* parent);

    CForcingsWaveDBWindSpeedKiv* WindSpeed() const { return m_speed; }
    CForcingsWaveDBWindDirectionKiv* WindDirection() const { return m_direction; }
    CForcingsWaveDBWaterLevelKiv* WaterLevel() const { return m_level; }

    // Effective counts of the axes: speeds, directions, levels.
    struct Shape {
        int speeds = 0;
        int directions = 0;
        int levels = 0;
        bool operator==(const Shape&) const = default;
    };
    Shape CurrentShape() const;
    // Their product, capped at kMaxPoints (no overflow, whatever the counts).
    static int PointCount(const Shape& shape);
    // 1-based indices of point k (from 1) of a shape.
    struct Point {
        int speed = 0;
        int direction = 0;
        int level = 0;
    };
    static Point PointOf(int k, const Shape& shape);
    // "Data_Base_Item_<speed>_<level>_<direction>".
    static CString PointSectionName(const Point& p);
    // Whether all three axes hold values they accept.
    bool AxesValid() const;

    // Sizes the list to the axes. Each file stays with the speed, direction and level it was
    // chosen for; points that drop out keep theirs until the setup is read again, so that an
    // axis cut and restored in the form brings them back. New points start empty.
    void ResizeToAxes();

    void Load(void* h) override;
    // The count follows the axes; the stored one is not used.
    void LoadSize(void* h) override;
    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }

private:
    CForcingsWaveDBWindSpeedKiv* m_speed;
    CForcingsWaveDBWindDirectionKiv* m_direction;
    CForcingsWaveDBWaterLevelKiv* m_level;
    Shape m_shape;  // the one the items are laid out for
    struct Chosen {
        CString fileName;
        std::vector<int> items;
    };
    std::map<std::tuple<int, int, int>, Chosen> m_parked;  // by speed, direction, level
    // The count a file gave, checked against the axes once the section is read.
    std::optional<int> m_storedCount;
    void* m_storedCountSection = nullptr;
};

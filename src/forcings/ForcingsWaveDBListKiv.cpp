#include "ForcingsWaveDBListKiv.h"

#include "setupeditor/Keywords.h"
#include "ForcingsWaveDBAxisKiv.h"
#include "ForcingsWaveDBFile.h"
#include "paramfile/Kiv.h"

#include <algorithm>

namespace {
const char* const kItemNumberKeywords[] = {"item_number_for_wave_height",
                                           "item_number_for_wave_period",
                                           "item_number_for_wave_direction"};
}  // namespace

CForcingsWaveDBListKiv::CForcingsWaveDBListKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase("Wave Database", "WAVE_DATABASE", parent),
      m_speed(new CForcingsWaveDBWindSpeedKiv(this)),
      m_direction(new CForcingsWaveDBWindDirectionKiv(this)),
      m_level(new CForcingsWaveDBWaterLevelKiv(this)) {
    AddChild(m_speed);
    AddChild(m_direction);
    AddChild(m_level);
    ResizeToAxes();
}

CForcingsWaveDBListKiv::Shape CForcingsWaveDBListKiv::CurrentShape() const {
    return {m_speed->EffectiveCount(), m_direction->EffectiveCount(), m_level->EffectiveCount()};
}

int CForcingsWaveDBListKiv::PointCount(const Shape& shape) {
    std::int64_t n = 1;
    for (int c : {shape.speeds, shape.directions, shape.levels}) {
        n *= std::max(c, 0);
        n = std::min<std::int64_t>(n, kMaxPoints);  // saturates before it could overflow
    }
    return static_cast<int>(n);
}

CForcingsWaveDBListKiv::Point CForcingsWaveDBListKiv::PointOf(int k, const Shape& shape) {
    const std::int64_t levels = std::max(shape.levels, 1);
    const std::int64_t directions = std::max(shape.directions, 1);
    const std::int64_t index = std::max(k, 1) - 1;
    Point p;
    p.level = static_cast<int>(index % levels) + 1;
    p.direction = static_cast<int>((index / levels) % directions) + 1;
    p.speed = static_cast<int>(index / (levels * directions)) + 1;
    return p;
}

CString CForcingsWaveDBListKiv::PointSectionName(const Point& p) {
    return FormatString("Data_Base_Item_%d_%d_%d", p.speed, p.level, p.direction);
}

bool CForcingsWaveDBListKiv::AxesValid() const {
    return m_speed->IsValid() && m_direction->IsValid() && m_level->IsValid();
}

void CForcingsWaveDBListKiv::ResizeToAxes() {
    const Shape shape = CurrentShape();
    const int count = PointCount(shape);
    if (shape == m_shape && count == GetItemCount())
        return;
    // What every point holds now, with what earlier resizes parked.
    std::map<std::tuple<int, int, int>, Chosen> chosen = std::move(m_parked);
    m_parked.clear();
    for (int k = 1; k <= GetItemCount(); ++k) {
        const Point p = PointOf(k, m_shape);
        const CForcingsWaveDBFile* f = GetItem(k)->File();
        chosen[{p.speed, p.direction, p.level}] = {f->FileName(), f->ItemNumber()};
    }
    SetItemCount(count, 1);
    for (int k = 1; k <= count; ++k) {
        const Point p = PointOf(k, shape);
        CForcingsWaveDBFile* f = GetItem(k)->File();
        auto it = chosen.find({p.speed, p.direction, p.level});
        if (it == chosen.end()) {
            f->SetDefault();
            continue;
        }
        f->FileName(it->second.fileName);
        f->ItemNumber(it->second.items);
        chosen.erase(it);
    }
    // Only points that hold a file are worth keeping.
    for (auto& [point, c] : chosen)
        if (!c.fileName.empty())
            m_parked.emplace(point, std::move(c));
    m_shape = shape;
}

void CForcingsWaveDBListKiv::Load(void* h) {
    m_storedCount.reset();
    CZoSEKivListBase::Load(h);
    ResizeToAxes();
    if (m_storedCount && *m_storedCount != GetItemCount())
        kivWarn(m_storedCountSection, "ZoSEKivListItemCount",
                FormatString("item count %d does not match the %d points of the axes; the axes "
                             "hold",
                             *m_storedCount, GetItemCount()));
    m_storedCount.reset();
    m_storedCountSection = nullptr;
}

void CForcingsWaveDBListKiv::LoadSize(void* h) {
    if (!kivKeywordByNameNum(h, "ZoSEKivListItemCount", 1))
        return;
    int n = GetItemCount();
    kivGetParam(h, "ZoSEKivListItemCount", &n, 1, 1);
    m_storedCount = n;
    m_storedCountSection = h;
}

void CForcingsWaveDBListKiv::WriteData(void* h) {
    for (int k = 1; k <= GetItemCount(); ++k) {
        const CForcingsWaveDBFile* f = GetItem(k)->File();
        kivAddSection(h, PointSectionName(PointOf(k, m_shape)).c_str());
        kivPutParamFilename(h, "file_name", f->FileName());
        for (int i = 1; i <= CForcingsWaveDBFile::kItems; ++i)
            kivPutParam(h, kItemNumberKeywords[i - 1], f->ItemNumber(i));
        kivEndSection(h);
    }
}

void CForcingsWaveDBListKiv::ReadData(void* h) {
    m_parked.clear();  // the file says which points there are
    for (CForcingsWaveDBAxisKiv* axis :
         std::initializer_list<CForcingsWaveDBAxisKiv*>{m_speed, m_direction, m_level})
        if (void* s = kivSectionByNameNum(h, axis->GetSectionName().c_str(), 1))
            axis->ReadData(s);
    ResizeToAxes();
    // Only the points that have an item: at most kMaxPoints, whatever the counts.
    for (int k = 1; k <= GetItemCount(); ++k) {
        void* s = kivSectionByNameNum(h, PointSectionName(PointOf(k, m_shape)).c_str(), 1);
        if (!s)
            continue;
        CForcingsWaveDBFile* f = GetItem(k)->File();
        // A keyword that is missing keeps the point's own value.
        CString name = f->FileName();
        kivGetParamFilename(s, "file_name", &name, 1, 1);
        f->FileName(name);
        std::vector<int> items(CForcingsWaveDBFile::kItems);
        for (int i = 1; i <= CForcingsWaveDBFile::kItems; ++i) {
            items[static_cast<std::size_t>(i - 1)] = f->ItemNumber(i) ? f->ItemNumber(i) : i;
            kivGetParam(s, kItemNumberKeywords[i - 1], &items[static_cast<std::size_t>(i - 1)], 1, 1);
        }
        f->ItemNumber(items);
    }
}

void CForcingsWaveDBListKiv::DescribeKeywords(KeywordSink& sink) {
    // One section per point of the database, named by its wind speed, water level and
    // wind direction numbers.
    static const KeywordDecl kDecls[] = {
        {"file_name", KeywordType::FileName, "''", "Wave-field file of the database point", 0, "", "", "Data_Base_Item_%d_%d_%d"},
        {kItemNumberKeywords[0], KeywordType::Int, "1", "Item of the file for the wave height", 0, "", "", "Data_Base_Item_%d_%d_%d"},
        {kItemNumberKeywords[1], KeywordType::Int, "2", "Item of the file for the wave period", 0, "", "", "Data_Base_Item_%d_%d_%d"},
        {kItemNumberKeywords[2], KeywordType::Int, "3", "Item of the file for the wave direction", 0, "", "", "Data_Base_Item_%d_%d_%d"},
    };
    sink.Add(kDecls);
}

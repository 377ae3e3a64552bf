#include "MTWaveFieldKiv.h"

#include "MTWaveFieldFile.h"
#include "paramfile/Kiv.h"
#include "setupeditor/KivFields.h"

namespace {
const char* const kKey = "MTWaveField";

// Item i of the file (1 to 3) under these keywords.
const char* const kItemNumberKeywords[] = {"item_number_for_wave_height",
                                           "item_number_for_wave_period",
                                           "item_number_for_wave_direction"};
const char* const kItemNameKeywords[] = {"item_name_for_wave_height", "item_name_for_wave_period",
                                         "item_name_for_wave_direction"};
}  // namespace

struct WaveFieldFields {
    using F = KivField<CMTWaveFieldKiv>;
    using K = CMTWaveFieldKiv;
    // Before the file's keywords.
    static inline const F kHead[] = {
        F::Int("format", &K::m_format, 0).Doc("How the wave field is given"),
        F::Double("wave_height", &K::m_height, 1.0).Unit(100084).Doc("Wave height when constant"),
        F::Double("wave_period", &K::m_period, 3.0).Unit(100085).Doc("Wave period when constant"),
        F::Double("wave_direction", &K::m_direction, 180.0).Unit(100407).Doc("Wave direction when constant"),
    };
    // After them.
    static inline const F kTail[] = {
        F::Int("type_of_soft_start", &K::m_softType, 2).Doc("Shape of the soft start of the waves"),
        F::Double("soft_time_interval", &K::m_softInterval, 0.0).Unit(100290).Doc("Time over which the waves are brought in"),
    };
};

CMTWaveFieldKiv::CMTWaveFieldKiv(CZoSEKivBase* parent)
    : CZoSEKivBase("Wave field data", "WAVE_FIELD", parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
    m_file = new CMTWaveFieldFile(this);
    AddChild(m_file);
    SetDefault();
}

CMTWaveFieldKiv::~CMTWaveFieldKiv() {
    DeleteChildren();
    GetRoot()->UnregisterImportantNode(kKey);
}

void CMTWaveFieldKiv::WriteData(void* h) {
    WriteFields(h, *this, WaveFieldFields::kHead);
    kivPutParamFilename(h, "file_name", m_file->FileName());
    for (int i = 1; i <= CMTWaveFieldFile::kItems; ++i)
        kivPutParam(h, kItemNumberKeywords[i - 1], m_file->ItemNumber(i));
    for (int i = 1; i <= CMTWaveFieldFile::kItems; ++i)
        kivPutParam(h, kItemNameKeywords[i - 1], m_file->ItemName(i));
    WriteFields(h, *this, WaveFieldFields::kTail);
}

void CMTWaveFieldKiv::ReadData(void* h) {
    ReadFields(h, *this, WaveFieldFields::kHead);
    CString name = m_file->FileName();
    kivGetParamFilename(h, "file_name", &name, 1, 1);
    m_file->FileName(name);
    std::vector<int> items(CMTWaveFieldFile::kItems);
    for (int i = 1; i <= CMTWaveFieldFile::kItems; ++i) {
        items[static_cast<std::size_t>(i - 1)] = m_file->ItemNumber(i) ? m_file->ItemNumber(i) : i;
        kivGetParam(h, kItemNumberKeywords[i - 1], &items[static_cast<std::size_t>(i - 1)], 1, 1);
    }
    m_file->ItemNumber(items);
    for (int i = 1; i <= CMTWaveFieldFile::kItems; ++i) {
        CString itemName = m_file->ItemName(i);
        kivGetParam(h, kItemNameKeywords[i - 1], &itemName, 1, 1);
        m_file->ItemName(i, itemName);
    }
    ReadFields(h, *this, WaveFieldFields::kTail);
}

void CMTWaveFieldKiv::SetDefault() {
    DefaultFields(*this, WaveFieldFields::kHead);
    DefaultFields(*this, WaveFieldFields::kTail);
    m_file->SetDefault();
}

CMTWaveFieldKiv* WaveFieldSection(const CZoSEKivBase* node) {
    return GetImportant<CMTWaveFieldKiv>(node, kKey);
}

void CMTWaveFieldKiv::DescribeKeywords(KeywordSink& sink) {
    static const KeywordDecl kFile[] = {
        {"file_name", KeywordType::FileName, "''", "Data file of the wave field"},
        {kItemNumberKeywords[0], KeywordType::Int, "1", "Item of the file for the wave height"},
        {kItemNumberKeywords[1], KeywordType::Int, "2", "Item of the file for the wave period"},
        {kItemNumberKeywords[2], KeywordType::Int, "3", "Item of the file for the wave direction"},
        {kItemNameKeywords[0], KeywordType::String, "\"\"", "Name of the file's item for the wave height"},
        {kItemNameKeywords[1], KeywordType::String, "\"\"", "Name of the file's item for the wave period"},
        {kItemNameKeywords[2], KeywordType::String, "\"\"", "Name of the file's item for the wave direction"},
    };
    DescribeFields(sink, WaveFieldFields::kHead);
    sink.Add(kFile);
    DescribeFields(sink, WaveFieldFields::kTail);
}
